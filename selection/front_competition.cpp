// Two fronts compete for the pixels under the brush: the heart of growing and of shrinking.
//
// The stroke's own front starts on the brush core, the keep front on the rim. Each advances through
// inner cells along the cheapest path, a step costing the squared colour distance of its two pixels
// (cal_cost), so they meet where the colour changes sharply. The nearest pixel overall is finalised
// next; on a tie the front that came first keeps it.
//
// competition_plain.cpp says what comes out, with D_Queue. Here the cells have numbers and one
// record each, the queue is front_queue, and the mask is left alone until all is decided. So a
// stroke can be begun again: when the queue is in doubt what D_Queue would do, a queue that knows
// more of D_Queue's index tries, and in the end the plain competition itself.
#include "selection/front_competition.h"

#include <algorithm>
#include <cstdint>

#include "selection/brush_cells.h"
#include "selection/colour_cost.h"
#include "selection/competition_memory.h"
#include "selection/competition_plain.h"
#include "selection/competition_rules.h"
#include "selection/front_queue.h"
#include "selection/rectangles.h"
#include "support/arithmetic.h"
#include "support/ze_alloc.h"

namespace {

// A popped cost from which no step can lead to UNREACHED or wrap.
constexpr int HIGHEST_COST = UNREACHED - 1 - MAX_COLOUR_COST;

// A stroke: the engine with the photo, the mask and the point it works on.
struct stroke_place {
    ER_selection& engine;
    int* image;
    unsigned char* mask;
    int width;
    int height;
    int x;
    int y;

    ptrdiff_t cell_at(int px, int py) const {
        return brush_cell(engine, ptrdiff_t{px} - x, ptrdiff_t{py} - y);
    }
    ptrdiff_t pixel_at(int px, int py) const { return px + ptrdiff_t{py} * width; }
    ze_rect square(int omitted) const {
        return square_in_image(engine, width, height, x, y, omitted);
    }
};

// Prices `count` cells from their pixels, `above` being the row before.
void price_row(const int* pixels, const int* above, int* cost_h, int* cost_v, int count) {
    for (int i = 0; i < count; ++i) {
        const auto pixel = static_cast<uint32_t>(pixels[i]);
        cost_h[i] = colour_cost(pixel, static_cast<uint32_t>(pixels[i - 1]));
        cost_v[i] = colour_cost(pixel, static_cast<uint32_t>(above[i]));
    }
}

// Deliberate: image row 0 and column 0 are left out; their cells keep the costs of an earlier
// stroke, as do those outside the brush.
void price(const stroke_place& s, const ze_rect& priced) {
    for (int py = std::max(priced.top, 1); py <= priced.bottom; ++py) {
        // The brush's cells in a row lie side by side.
        int left = std::max(priced.left, 1);
        int right = priced.right;
        const unsigned char* const classes = s.engine.brush_map + s.cell_at(0, py);
        while (left <= right && classes[left] == BRUSH_OUTSIDE) ++left;
        while (left <= right && classes[right] == BRUSH_OUTSIDE) --right;
        const ptrdiff_t cell = s.cell_at(left, py);
        const int* const pixels = s.image + s.pixel_at(left, py);
        price_row(pixels, pixels - s.width, s.engine.cost_h + cell, s.engine.cost_v + cell,
                  right - left + 1);
    }
}

bool can_be_a_cost(int cost) { return cost >= 0 && cost <= MAX_COLOUR_COST; }

// The costs that price() leaves as they are, and by which fronts may step, are such as it could
// have written. Anybody may write others into the engine.
bool old_costs_are_sound(const stroke_place& s, const ze_rect& square) {
    bool sound = true;
    if (square.top == 0) {
        for (int px = square.left; px <= square.right; ++px) {
            sound &= can_be_a_cost(s.engine.cost_h[s.cell_at(px, 0)]);
        }
    }
    if (square.left == 0) {
        for (int py = square.top; py <= square.bottom; ++py) {
            sound &= can_be_a_cost(s.engine.cost_v[s.cell_at(0, py)]);
        }
    }
    return sound;
}

bool node_map_is_empty(const ER_selection& engine, ptrdiff_t cells) {
    uintptr_t any = 0;
    for (ptrdiff_t i = 0; i < cells; ++i) any |= reinterpret_cast<uintptr_t>(engine.node_map[i]);
    return any == 0;
}

// The cells of a stroke and what becomes of them.
struct front_cells_of {
    explicit front_cells_of(const ER_selection& engine)
        : side(brush_side(engine)),
          first(static_cast<uint32_t>(first_of_square(static_cast<uint64_t>(side)))),
          count(static_cast<uint32_t>(front_cells(static_cast<uint64_t>(side)))),
          cells(reinterpret_cast<front_cell*>(engine.node_pool)),
          won(reinterpret_cast<unsigned char*>(cells + count)) {}

    const ptrdiff_t side;
    const uint32_t first;  // of the square
    const uint32_t count;
    front_cell* const cells;
    unsigned char* const won;  // front_mark of each cell
};

// Opens the cells that fronts may enter and queues the seeds.
template <class Rules, int KNOWN>
front_queue<KNOWN> begin(const stroke_place& s, const front_cells_of& f) {
    ze_memset(f.won, NOT_POPPED, f.count);
    front_queue<KNOWN> queue(
        f.cells, f.won,
        slots_of_pool(s.engine.node_pool, static_cast<uint64_t>(f.side), s.engine.brush_cells),
        s.engine.queue->step);
    uint32_t next = QUEUE_CELLS;
    const auto close_until = [&](uint32_t cell) {
        for (; next < cell; ++next) f.cells[next].cost = CLOSED;
    };
    const ze_rect seeded = s.square(Rules::UNSEEDED_EDGE);
    for (int py = seeded.top; py <= seeded.bottom; ++py) {
        const ptrdiff_t row = s.cell_at(seeded.left, py);
        const unsigned char* const classes = s.engine.brush_map + row;
        const unsigned char* const pixels = s.mask + s.pixel_at(seeded.left, py);
        close_until(f.first + static_cast<uint32_t>(row));
        for (int i = 0; i <= seeded.right - seeded.left; ++i, ++next) {
            front_cell& cell = f.cells[next];
            const bool is_open = Rules::is_open(pixels[i]);
            cell.cost = classes[i] == BRUSH_INNER && is_open ? UNREACHED : CLOSED;
            if (classes[i] != BRUSH_CORE && classes[i] != BRUSH_RIM) continue;
            const bool is_core = classes[i] == BRUSH_CORE;
            if (!is_core && pixels[i] != Rules::SEED_VALUE) continue;
            cell.cost = UNREACHED;
            cell.front = !is_open ? BLOCKED_SEED : is_core ? STROKE_FRONT : KEEP_FRONT;
            queue.reach(next, 0);
        }
    }
    close_until(f.count);
    return queue;
}

// Finalises the cheapest cell, offers its neighbours to its front, and so on until the queue is
// empty. Returns the number of cells reached, or -1 when the order of cells is in doubt.
template <int KNOWN>
int grow(const ER_selection& engine, const front_cells_of& f, front_queue<KNOWN> queue) {
    front_cell* const cells = f.cells;
    unsigned char* const won = f.won;
    const uint32_t row = static_cast<uint32_t>(f.side);
    const int* const cost_h = engine.cost_h;
    const int* const cost_v = engine.cost_v;
    const int* const cost_v_below = cost_v + row;
    const size_t first = f.first;
    while (!queue.empty()) {
        const uint32_t cell = queue.pop();
        const int cost = cells[cell].cost;
        if (cost > HIGHEST_COST) {
            queue.clear();
            return -1;
        }
        const int front = cells[cell].front;
        won[cell] = static_cast<unsigned char>(front);
        if (front == BLOCKED_SEED) continue;

        // The cells that it reaches at a lower cost, in order. A step's cost stands in the right or
        // lower cell of the two.
        uint32_t reached[4];
        int reached_cost[4];
        int count = 0;
        const auto offer = [&](uint32_t neighbour, int step_cost) {
            const int new_cost = wrap_add(cost, step_cost);
            reached[count] = neighbour;
            reached_cost[count] = new_cost;
            count += new_cost < cells[neighbour].cost;
        };
        const size_t place = size_t{cell} - first;
        offer(cell - 1, cost_h[place]);
        offer(cell + 1, cost_h[place + 1]);
        offer(cell - row, cost_v[place]);
        offer(cell + row, cost_v_below[place]);
        for (int i = 0; i < count; ++i) {
            queue.reach(reached[i], reached_cost[i]);
            cells[reached[i]].front = front;
        }
    }
    return queue.in_doubt() ? -1 : queue.taken();
}

// Gives a pixel its final value; true when rect takes it in.
template <class Rules>
bool settle_pixel(unsigned char* pixel, unsigned char mark) {
    if (mark == STROKE_FRONT) *pixel = mark_of<Rules>(1, *pixel);
    if (mark == KEEP_FRONT) *pixel = mark_of<Rules>(0, *pixel);
    return Rules::settle(pixel);
}

// Writes into the mask what has been won.
template <class Rules>
void settle(const stroke_place& s, const front_cells_of& f, ze_rect* rect) {
    const ze_rect all = s.square(0);
    for (int py = all.top; py <= all.bottom; ++py) {
        unsigned char* const pixels = s.mask + s.pixel_at(all.left, py);
        unsigned char* const marks = f.won + f.first + s.cell_at(all.left, py);
        const int count = all.right - all.left + 1;
        for (int i = 0; i < count; ++i) marks[i] = settle_pixel<Rules>(pixels + i, marks[i]);
        const unsigned char* const first = std::find(marks, marks + count, 1);
        if (first == marks + count) continue;
        const unsigned char* last = marks + count - 1;
        while (*last == 0) --last;
        include(rect, all.left + static_cast<int>(first - marks), py);
        include(rect, all.left + static_cast<int>(last - marks), py);
    }
}

// Carries the stroke out, or returns false, with nothing done, when its order is in doubt.
template <class Rules, int KNOWN>
bool decided(const stroke_place& s, ze_rect* rect) {
    const front_cells_of f(s.engine);
    const int reached = grow(s.engine, f, begin<Rules, KNOWN>(s, f));
    if (reached < 0) return false;
    settle<Rules>(s, f, rect);
    s.engine.nodes_used = reached;
    D_Queue& queue = *s.engine.queue;
    queue.count = 0;
    ze_memset(queue.index, 0, QUEUE_INDEX_ENTRIES * sizeof(node*));
    if (Rules::CLEARS_SPARE) queue.spare = 0;
    return true;
}

template <class Rules>
stroke_run compete(const stroke_place& s, ze_rect* rect) {
    const ptrdiff_t side = brush_side(s.engine);
    if (s.engine.queue->head || !node_map_is_empty(s.engine, side * side)) return stroke_run::PLAIN;
    const ze_rect seeded = s.square(Rules::UNSEEDED_EDGE);
    if (!old_costs_are_sound(s, seeded)) return stroke_run::PLAIN;
    price(s, seeded);
    if (decided<Rules, 1>(s, rect)) return stroke_run::FIRST;
    if (decided<Rules, 4>(s, rect)) return stroke_run::SECOND;
    return stroke_run::PLAIN;
}

}  // namespace

stroke_run run_growing(ER_selection* engine, int* image, unsigned char* mask, int width, int height,
                       int x, int y, ze_rect* rect) {
    if (!has_buffers(*engine) || !growing::may_start(mask, width, height, x, y)) {
        return stroke_run::NONE;
    }
    const stroke_run run = compete<growing>({*engine, image, mask, width, height, x, y}, rect);
    if (run == stroke_run::PLAIN) {
        plain::DoSelection(engine, image, mask, width, height, x, y, rect);
    }
    return run;
}

stroke_run run_shrinking(ER_selection* engine, int* image, unsigned char* mask, int width,
                         int height, int x, int y, ze_rect* rect) {
    if (!has_buffers(*engine) || !shrinking::may_start(mask, width, height, x, y)) {
        return stroke_run::NONE;
    }
    const stroke_run run = compete<shrinking>({*engine, image, mask, width, height, x, y}, rect);
    if (run == stroke_run::PLAIN) {
        plain::DeSelection(engine, image, mask, width, height, x, y, rect);
    }
    return run;
}

void ER_selection::DoSelection(int* image, unsigned char* mask, int width, int height, int x, int y,
                               ze_rect* rect) {
    run_growing(this, image, mask, width, height, x, y, rect);
}

void ER_selection::DeSelection(int* image, unsigned char* mask, int width, int height, int x, int y,
                               ze_rect* rect) {
    run_shrinking(this, image, mask, width, height, x, y, rect);
}
