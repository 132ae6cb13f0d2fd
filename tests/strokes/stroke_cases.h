// Stroke cases: strokes of one engine, written down with what they have to come to.
//
//     case popped-anchor 1               the deviation of the library that it was found for
//     brush 4 0                          radius and core radius
//     step 1                             nodes for each entry of the queue's index; without this
//                                        line the step that the brush gives itself
//     cost_h 3 0 -1                      an old cost in column 3, row 0 of the brush square
//     colours 000000 0A0A0A              of the digits 0 and 1 in the photo; a is the 11th
//     photo
//       0110
//     mask                               . is 0, # is 1, 2 to 9 are themselves
//       ..5#
//     grow 2 0                           or shrink, and the point
//     rect 1 3 0 0                       left, right, top, bottom of the empty rectangle widened
//     nodes 9                            nodes_used
//     becomes
//       .###
//
// Photo and mask come before each stroke; without colours and photo they are those of the stroke
// before. Lines that begin with # outside of pictures are comments.
#pragma once

#include <istream>
#include <ostream>
#include <string>
#include <vector>

#include "tests/strokes/stroke_engine.h"

struct old_cost {
    cost_of which;
    int column;
    int row;
    int cost;
};

// What a case pins of an outcome.
struct pinned_outcome {
    Picture mask{0, 0, 0};
    ze_rect rect{};
    int nodes = 0;
};

struct stroke_case {
    std::string name;
    int radius = 0;
    int core = 0;
    int step = 0;  // 0: the brush's own
    std::vector<old_cost> old_costs;
    std::vector<stroke_input> strokes;
    std::vector<pinned_outcome> expected;  // as many as strokes, once it has been written down
};

// Makes the engine ready: the step and the old costs.
void prepare(stroke_engine* engine, const stroke_case& c);

// What the strokes of a case come to on a fresh engine.
std::vector<stroke_outcome> play(stroke_engine* (*new_engine)(int radius, int core),
                                 const stroke_case& c);

// Throws std::runtime_error, naming the line, where the text is no list of cases.
std::vector<stroke_case> read_cases(std::istream& in);

void write_case(std::ostream& out, const stroke_case& c);

// Colours that a photo of a case can have at most.
constexpr int MOST_COLOURS = 36;
