#include "selection/ER_selection.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <new>

#include "selection/brush_cells.h"
#include "selection/colour_cost.h"
#include "selection/competition_memory.h"
#include "support/ze_alloc.h"

namespace {

// `count` elements from array-new, or null when they cannot be had or their bytes not be counted.
template <class T>
T* new_array(uint64_t count) {
    if (count > PTRDIFF_MAX / sizeof(T)) return nullptr;
    return new (std::nothrow) T[static_cast<size_t>(count)];
}

brush_class classify(int64_t dx, int64_t dy, int radius, int core_radius) {
    const double distance = std::sqrt(static_cast<double>(dx * dx + dy * dy));
    const int64_t d = static_cast<int64_t>(distance + 0.5);
    if (d == radius) return BRUSH_RIM;
    if (d <= core_radius) return BRUSH_CORE;
    return d < radius ? BRUSH_INNER : BRUSH_OUTSIDE;
}

void build_brush(ER_selection* engine, int radius, int core_radius) {
    engine->radius = radius;
    engine->core_radius = core_radius;
    engine->brush_cells = 0;
    engine->destroyResource();

    engine->queue = new (std::nothrow) D_Queue;
    if (!engine->queue || !engine->queue->index) return;

    const uint64_t side = radius < 0 ? 0 : 2 * static_cast<uint64_t>(radius) + 1;
    if (side * side > INT32_MAX) return;  // more cells than brush_cells can count
    const size_t cells = static_cast<size_t>(side * side);
    if (!(engine->brush_map = new_array<unsigned char>(cells))) return;
    if (!(engine->node_map = new_array<node*>(cells))) return;
    const size_t costs = cells + static_cast<size_t>(side);
    if (!(engine->cost_h = new_array<int>(costs))) return;
    if (!(engine->cost_v = new_array<int>(costs))) return;
    ze_memset(engine->cost_h, 0, costs * sizeof(int));
    ze_memset(engine->cost_v, 0, costs * sizeof(int));
    ze_memset(engine->node_map, 0, cells * sizeof(node*));

    unsigned char* cell = engine->brush_map;
    for (int64_t dy = -int64_t{radius}; dy <= radius; ++dy) {
        for (int64_t dx = -int64_t{radius}; dx <= radius; ++dx) {
            *cell = classify(dx, dy, radius, core_radius);
            engine->brush_cells += *cell != BRUSH_OUTSIDE;
            ++cell;
        }
    }
    engine->queue->step = std::max(engine->brush_cells / 100, 1);
    engine->node_pool = new_array<node>(nodes_of_pool(side, engine->brush_cells));
    if (!engine->node_pool) return;
    cost_slots* const slots = slots_of_pool(engine->node_pool, side, engine->brush_cells);
    ze_memset(slots->used, 0, sizeof slots->used);
    ze_memset(slots->used_words, 0, sizeof slots->used_words);
}

}  // namespace

ER_selection::ER_selection()
    : brush_map(nullptr),
      node_pool(nullptr),
      node_map(nullptr),
      cost_h(nullptr),
      cost_v(nullptr),
      radius(0),
      core_radius(0),
      brush_cells(0),
      nodes_used(0),
      queue(nullptr) {}

ER_selection::~ER_selection() { destroyResource(); }

void ER_selection::destroyResource() {
    delete queue;
    queue = nullptr;
    delete[] node_pool;
    node_pool = nullptr;
    delete[] node_map;
    node_map = nullptr;
    delete[] brush_map;
    brush_map = nullptr;
    delete[] cost_h;
    cost_h = nullptr;
    delete[] cost_v;
    cost_v = nullptr;
}

void ER_selection::initial(int r, int c) {
    nodes_used = 0;
    build_brush(this, r, c);
}

void ER_selection::set_brush(int r, int c) {
    if (r == radius && c == core_radius) return;
    build_brush(this, r, c);
}

int ER_selection::cal_cost(int* image, int width, int x1, int y1, int x2, int y2) {
    const auto pixel = [image, width](int x, int y) {
        return static_cast<uint32_t>(image[x + static_cast<ptrdiff_t>(y) * width]);
    };
    return colour_cost(pixel(x1, y1), pixel(x2, y2));
}

bool has_buffers(const ER_selection& engine) {
    return engine.queue && engine.queue->index && engine.brush_map && engine.node_map &&
           engine.cost_h && engine.cost_v && engine.node_pool;
}
