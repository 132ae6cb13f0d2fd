// Engines on which a stroke case is played, and what can be told of one after a stroke.
#pragma once

#include <vector>

#include "selection/rectangles.h"
#include "tests/helpers/picture.h"

// One stroke: the photo, the mask before it, the kind and the point.
struct stroke_input {
    std::vector<int> photo;  // 0xRRGGBB, as many as the mask has cells
    Picture mask{0, 0, 0};
    bool grows = true;
    int x = 0;
    int y = 0;
};

// What a caller finds after a stroke.
struct stroke_outcome {
    Picture mask{0, 0, 0};
    ze_rect rect{};         // was the empty one beyond the image
    int nodes = 0;          // nodes_used
    int count = 0;          // of the queue; 7 before the stroke
    int spare = 0;          // of the queue; 1 before the stroke
    bool has_list = false;  // the queue has a head
    std::vector<int> cost_h, cost_v;
    std::vector<int> recorded;  // 1 where node_map has a node
};

inline bool operator==(const stroke_outcome& a, const stroke_outcome& b) {
    return a.mask == b.mask && a.rect == b.rect && a.nodes == b.nodes && a.count == b.count &&
           a.spare == b.spare && a.has_list == b.has_list && a.cost_h == b.cost_h &&
           a.cost_v == b.cost_v && a.recorded == b.recorded;
}

// Which of the two costs of a cell.
enum class cost_of { STEP_LEFT, STEP_UP };

class stroke_engine {
public:
    virtual ~stroke_engine() = default;

    // The number of nodes for each entry of the queue's index, 1 or more.
    virtual void set_step(int step) = 0;

    // Writes a cost into a cell of the brush square, as if an earlier stroke had left it.
    virtual void set_cost(cost_of which, int cell, int cost) = 0;

    virtual stroke_outcome play(const stroke_input& stroke) = 0;
};

// The strokes that the library runs, and the plain ones that define their results. C names, so that
// a program can look them up in several copies of the library.
extern "C" {
[[gnu::visibility("default")]] stroke_engine* new_library_engine(int radius, int core);
[[gnu::visibility("default")]] stroke_engine* new_plain_engine(int radius, int core);
}
