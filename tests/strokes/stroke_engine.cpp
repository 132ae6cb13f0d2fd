#include "tests/strokes/stroke_engine.h"

#include <algorithm>

#include "selection/ER_selection.h"
#include "selection/brush_cells.h"
#include "selection/competition_plain.h"
#include "selection/rectangles.h"

namespace {

using stroke_call = void (*)(ER_selection*, int*, unsigned char*, int, int, int, int, ze_rect*);

void grow(ER_selection* engine, int* image, unsigned char* mask, int width, int height, int x,
          int y, ze_rect* rect) {
    engine->DoSelection(image, mask, width, height, x, y, rect);
}

void shrink(ER_selection* engine, int* image, unsigned char* mask, int width, int height, int x,
            int y, ze_rect* rect) {
    engine->DeSelection(image, mask, width, height, x, y, rect);
}

class core_engine : public stroke_engine {
public:
    core_engine(int radius, int core, stroke_call growing, stroke_call shrinking)
        : grows(growing), shrinks(shrinking) {
        engine.initial(radius, core);
        // What is not written before it is read shall be the same in every run.
        auto* const records = reinterpret_cast<int*>(engine.node_pool);
        std::fill(records, records + (engine.brush_cells + 1) * (sizeof(node) / sizeof(int)), 5);
    }

    void set_step(int step) override { engine.queue->step = step; }

    void set_cost(cost_of which, int cell, int cost) override {
        (which == cost_of::STEP_LEFT ? engine.cost_h : engine.cost_v)[cell] = cost;
    }

    stroke_outcome play(const stroke_input& s) override {
        stroke_outcome after;
        after.mask = s.mask;
        after.rect = empty_beyond_image(s.mask.width, s.mask.height);
        engine.queue->count = 7;
        engine.queue->spare = 1;
        std::vector<int> photo = s.photo;
        (s.grows ? grows : shrinks)(&engine, photo.data(), after.mask.data(), s.mask.width,
                                    s.mask.height, s.x, s.y, &after.rect);
        after.nodes = engine.nodes_used;
        after.count = engine.queue->count;
        after.spare = engine.queue->spare;
        after.has_list = engine.queue->head != nullptr;
        const ptrdiff_t cells = brush_side(engine) * brush_side(engine);
        after.cost_h.assign(engine.cost_h, engine.cost_h + cells);
        after.cost_v.assign(engine.cost_v, engine.cost_v + cells);
        for (ptrdiff_t i = 0; i < cells; ++i)
            after.recorded.push_back(engine.node_map[i] != nullptr);
        return after;
    }

private:
    ER_selection engine;
    const stroke_call grows;
    const stroke_call shrinks;
};

}  // namespace

stroke_engine* new_library_engine(int radius, int core) {
    return new core_engine(radius, core, grow, shrink);
}

stroke_engine* new_plain_engine(int radius, int core) {
    return new core_engine(radius, core, plain::DoSelection, plain::DeSelection);
}
