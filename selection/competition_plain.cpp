#include "selection/competition_plain.h"

#include <cstdint>

#include "selection/brush_cells.h"
#include "selection/competition_rules.h"
#include "selection/rectangles.h"
#include "support/arithmetic.h"
#include "support/ze_alloc.h"

namespace {

// The four neighbours, in the order in which the fronts visit them.
enum direction { LEFT, RIGHT, UP, DOWN, DIRECTIONS };
constexpr int DX[DIRECTIONS] = {-1, 1, 0, 0};
constexpr int DY[DIRECTIONS] = {0, 0, -1, 1};

// One stroke: the engine with the photo, the mask and the point it works on.
template <class Rules>
class competition {
public:
    competition(ER_selection* e, int* photo, unsigned char* selection, int w, int h, int px, int py)
        : engine(*e),
          queue(*e->queue),
          image(photo),
          mask(selection),
          width(w),
          height(h),
          x(px),
          y(py),
          side(brush_side(*e)) {}

    void reset() {
        queue.count = 0;
        ze_memset(queue.index, 0, QUEUE_INDEX_ENTRIES * sizeof(node*));
        if (Rules::CLEARS_SPARE) queue.spare = 0;
        engine.nodes_used = 0;
    }

    // Prices the pixels under the brush and queues the seeds of both fronts. False when the list is
    // broken.
    bool price_and_seed() {
        const ze_rect seeded = square_in_image(engine, width, height, x, y, Rules::UNSEEDED_EDGE);
        for (int py = seeded.top; py <= seeded.bottom; ++py) {
            for (int px = seeded.left; px <= seeded.right; ++px) {
                const ptrdiff_t cell = cell_at(px, py);
                const unsigned char cls = engine.brush_map[cell];
                if (px > 0 && py > 0 && cls != BRUSH_OUTSIDE) {
                    engine.cost_h[cell] = engine.cal_cost(image, width, px, py, px - 1, py);
                    engine.cost_v[cell] = engine.cal_cost(image, width, px, py, px, py - 1);
                }
                const bool own = cls == BRUSH_CORE;
                const bool keep = cls == BRUSH_RIM && mask_at(px, py) == Rules::SEED_VALUE;
                if ((own || keep) && !add_node(cell, px, py, 0, own)) return false;
            }
        }
        return true;
    }

    // Finalises the cheapest pixel, offers its neighbours to its front, and so on until the queue
    // is empty or found broken.
    void grow() {
        while (!queue.empty()) {
            // A copy: with a list left over from an earlier stroke, the record may be handed out
            // anew for a neighbour.
            const node n = *queue.pop();
            if (!in_image(n.x, n.y) || !Rules::is_open(mask_at(n.x, n.y))) continue;
            unsigned char& pixel = mask_at(n.x, n.y);
            pixel = mark_of<Rules>(n.label, pixel);
            for (int d = LEFT; d < DIRECTIONS; ++d) {
                if (!offer(n, static_cast<direction>(d))) return;
            }
        }
    }

    // Turns the marks of the competition into plain mask values, over the whole square.
    void settle(ze_rect* rect) {
        const ze_rect all = square_in_image(engine, width, height, x, y, 0);
        for (int py = all.top; py <= all.bottom; ++py) {
            for (int px = all.left; px <= all.right; ++px) {
                if (Rules::settle(&mask_at(px, py))) include(rect, px, py);
            }
        }
        ze_memset(engine.node_map, 0, static_cast<size_t>(side * side) * sizeof(node*));
    }

private:
    ptrdiff_t cell_at(int px, int py) const {
        return brush_cell(engine, ptrdiff_t{px} - x, ptrdiff_t{py} - y);
    }

    bool in_image(int px, int py) const { return px >= 0 && px < width && py >= 0 && py < height; }

    bool in_square(int px, int py) const {
        const int r = engine.radius;
        return px - x <= r && x - px <= r && py - y <= r && y - py <= r;
    }

    unsigned char& mask_at(int px, int py) const { return mask[px + ptrdiff_t{py} * width]; }

    // Takes the next record for the pixel of `cell` and queues it. False when the list is broken;
    // the record is then not recorded in node_map.
    bool add_node(ptrdiff_t cell, int px, int py, int cost, int label) {
        node* const n = &engine.node_pool[engine.nodes_used];
        *n = {px, py, cost, label, nullptr, nullptr};
        if (!queue.push(n)) return false;
        engine.node_map[cell] = n;
        ++engine.nodes_used;
        return true;
    }

    // Offers the neighbour of the finalised pixel `from` to that pixel's front. False when the list
    // is broken.
    bool offer(const node& from, direction d) {
        const int nx = from.x + DX[d];
        const int ny = from.y + DY[d];
        if (!in_image(nx, ny) || !in_square(nx, ny)) return true;
        const ptrdiff_t cell = cell_at(nx, ny);
        if (engine.brush_map[cell] != BRUSH_INNER || !Rules::is_open(mask_at(nx, ny))) return true;

        const int cost = wrap_add(from.cost, step_cost(cell, d));
        node* const n = engine.node_map[cell];
        if (!n) return add_node(cell, nx, ny, cost, from.label);
        if (cost >= n->cost) return true;
        n->cost = cost;
        n->label = from.label;
        return requeue(n);
    }

    // Colour cost of the step in direction d that ends on `cell`. cost_h and cost_v belong to the
    // right and lower pixel of a pair.
    int step_cost(ptrdiff_t cell, direction d) const {
        switch (d) {
            case LEFT:
                return engine.cost_h[cell + 1];
            case RIGHT:
                return engine.cost_h[cell];
            case UP:
                return engine.cost_v[cell + side];
            default:
                return engine.cost_v[cell];
        }
    }

    // Moves n to where its lowered cost belongs. False when the list is broken.
    //
    // Deliberate: the queue's index is not told that n leaves its place, and a new head keeps its
    // `prev`.
    bool requeue(node* n) {
        if (queue.count == 1) return true;
        if (n == queue.tail) {
            queue.tail = n->prev;
            if (queue.tail) queue.tail->next = nullptr;
        } else if (n == queue.head) {
            queue.head = n->next;
        } else {
            if (n->next) n->next->prev = n->prev;
            if (n->prev) n->prev->next = n->next;
        }
        --queue.count;
        return queue.push(n) != 0;
    }

    ER_selection& engine;
    D_Queue& queue;
    int* const image;
    unsigned char* const mask;
    const int width;
    const int height;
    const int x;
    const int y;
    const ptrdiff_t side;
};

// Runs one stroke at (x, y); see ER_selection for the arguments. Does nothing on an engine without
// all its buffers.
//
// Deliberate, for both kinds of strokes:
// - Cells in image row 0 and column 0 are not priced: they keep the costs that the same cell had in
//   an earlier stroke, 0 after a brush rebuild, and steps along the image's edge use those.
// - The queue's head and tail are not reset: what a broken list left there meets the next stroke.
// - A broken list found while seeding abandons the stroke: the mask as it was, node_map with what
//   was seeded. Found while growing, it ends the growth and the partial result stands.
template <class Rules>
void compete(ER_selection* engine, int* image, unsigned char* mask, int width, int height, int x,
             int y, ze_rect* rect) {
    if (!has_buffers(*engine) || !Rules::may_start(mask, width, height, x, y)) return;
    competition<Rules> stroke(engine, image, mask, width, height, x, y);
    stroke.reset();
    if (!stroke.price_and_seed()) return;
    stroke.grow();
    stroke.settle(rect);
}

}  // namespace

namespace plain {

void DoSelection(ER_selection* engine, int* image, unsigned char* mask, int width, int height,
                 int x, int y, ze_rect* rect) {
    compete<growing>(engine, image, mask, width, height, x, y, rect);
}

void DeSelection(ER_selection* engine, int* image, unsigned char* mask, int width, int height,
                 int x, int y, ze_rect* rect) {
    compete<shrinking>(engine, image, mask, width, height, x, y, rect);
}

}  // namespace plain
