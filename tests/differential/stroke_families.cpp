#include "selection/ER_selection.h"
#include "selection/brush_cells.h"
#include "selection/competition_plain.h"
#include "selection/front_competition.h"
#include "selection/rectangles.h"
#include "tests/differential/family.h"
#include "tests/differential/placed_vector.h"
#include "tests/differential/random_pictures.h"
#include "tests/reference/engine_reference.h"
#include "tests/reference/lasso_reference.h"

namespace {

using stroke = void (ER_selection::*)(int*, unsigned char*, int, int, int, int, ze_rect*);
using model_stroke = void (reference::engine::*)(const std::vector<int>&,
                                                 std::vector<unsigned char>&, int, int, int, int,
                                                 reference::rect*);

// A photo with its mask, twice.
struct scene {
    scene(random_source& random, int w, int h)
        : width(w),
          height(h),
          photo(random_photo(random, w, h)),
          library_photo(photo),
          model_mask(random_mask(random, w, h)),
          mask(model_mask) {}

    int width;
    int height;
    // Gives both masks, of the library and of the model, the model's values.
    void share_mask() { mask.assign(model_mask.begin(), model_mask.end()); }

    std::vector<int> photo;
    placed_vector<int> library_photo;
    std::vector<unsigned char> model_mask;
    placed_vector<unsigned char> mask;
};

struct position {
    int x, y;
};

// An engine of the library and one of the model.
struct engine_pair {
    engine_pair(int radius, int core) {
        library.initial(radius, core);
        model.initial(radius, core);
    }

    void stroke_at(scene* s, const position& at, stroke library_stroke,
                   model_stroke stroke_of_model, findings* found) {
        ze_rect changed = empty_beyond_image(s->width, s->height);
        reference::rect expected = {s->width, 0, s->height, 0};
        (library.*library_stroke)(s->library_photo.data(), s->mask.data(), s->width, s->height,
                                  at.x, at.y, &changed);
        (model.*stroke_of_model)(s->photo, s->model_mask, s->width, s->height, at.x, at.y,
                                 &expected);
        found->compare("rectangle", changed, expected);
        found->compare("nodes_used", library.nodes_used, model.nodes_used);
        found->compare("count in the queue", library.queue->count, model.queue->count);
        found->compare("list in the queue", library.queue->head != nullptr,
                       model.queue->head != reference::NO_NODE);
        found->compare_arrays("mask", s->mask, s->model_mask);
    }

    void compare_costs(findings* found) const {
        found->compare_arrays("cost_h", library.cost_h, model.cost_h);
        found->compare_arrays("cost_v", library.cost_v, model.cost_v);
    }

    void count_what_happened(findings* found) const {
        if (model.queue->rings > 0) found->count("cases with a ring found");
        if (model.abandoned_seedings > 0) found->count("cases with an abandoned seeding");
        if (model.cut_growths > 0) found->count("cases with a growth cut short");
    }

    ER_selection library;
    reference::engine model;
};

int random_core(random_source& random, int radius) {
    return random.one_in(6) ? radius + random.between(0, 3) : random.between(0, 12);
}

// A few strokes of one engine, at, near and over the borders, on photos of changing size.
void run_strokes(random_source& random, findings* found, stroke library_stroke,
                 model_stroke stroke_of_model) {
    const int radius = random.size_up_to(41) - 1;
    engine_pair engines(radius, random_core(random, radius));
    scene s{random, random.size_up_to(200), random.size_up_to(200)};
    for (int strokes = random.between(1, 4); strokes > 0 && found->agree(); --strokes) {
        if (random.one_in(8)) s = scene{random, random.size_up_to(200), random.size_up_to(200)};
        if (random.one_in(8)) {
            sprinkle(random, &s.model_mask, 0, 255);
            s.share_mask();
        }
        engines.stroke_at(&s, {random.between(-2, s.width + 1), random.between(-2, s.height + 1)},
                          library_stroke, stroke_of_model, found);
    }
    engines.count_what_happened(found);
    engines.compare_costs(found);
}

// Many strokes of a small brush on a tiny photo, with walls of foreign values in the mask and
// single seeds: the places where the queue's list breaks and closes into rings.
void run_tiny_strokes(random_source& random, findings* found, stroke library_stroke,
                      model_stroke stroke_of_model) {
    const int radius = random.between(2, 8);
    engine_pair engines(radius, random.between(0, 2));
    scene s{random, random.between(3, 24), random.between(3, 24)};
    for (int strokes = 0; strokes < 20 && found->agree(); ++strokes) {
        found->count("strokes");
        if (random.one_in(4)) {
            s.model_mask = random_mask(random, s.width, s.height);
            if (random.one_in(2)) sprinkle(random, &s.model_mask, 0, random.any_of({1, 4, 5, 7}));
            s.share_mask();
        }
        engines.stroke_at(&s, {random.between(0, s.width - 1), random.between(0, s.height - 1)},
                          library_stroke, stroke_of_model, found);
    }
    engines.count_what_happened(found);
    engines.compare_costs(found);
}

void run_grow(random_source& random, findings* found) {
    run_strokes(random, found, &ER_selection::DoSelection, &reference::engine::DoSelection);
}

void run_shrink(random_source& random, findings* found) {
    run_strokes(random, found, &ER_selection::DeSelection, &reference::engine::DeSelection);
}

void run_tiny_grow(random_source& random, findings* found) {
    run_tiny_strokes(random, found, &ER_selection::DoSelection, &reference::engine::DoSelection);
}

void run_tiny_shrink(random_source& random, findings* found) {
    run_tiny_strokes(random, found, &ER_selection::DeSelection, &reference::engine::DeSelection);
}

// Two engines of the library: its strokes work on one, the plain ones on the other.
struct plain_pair {
    plain_pair(int radius, int core) {
        engine.initial(radius, core);
        plain_engine.initial(radius, core);
    }

    void set_step(int step) { engine.queue->step = plain_engine.queue->step = step; }

    void stroke_at(scene* s, const position& at, bool grows, findings* found) {
        ze_rect changed = empty_beyond_image(s->width, s->height);
        ze_rect expected = changed;
        const auto run = grows ? run_growing : run_shrinking;
        const auto plain_run = grows ? plain::DoSelection : plain::DeSelection;
        const stroke_run carried_out = run(&engine, s->library_photo.data(), s->mask.data(),
                                           s->width, s->height, at.x, at.y, &changed);
        plain_run(&plain_engine, s->photo.data(), s->model_mask.data(), s->width, s->height, at.x,
                  at.y, &expected);
        if (carried_out != stroke_run::NONE) found->count("strokes");
        if (carried_out == stroke_run::SECOND) found->count("strokes that took a second queue");
        if (carried_out == stroke_run::PLAIN) found->count("strokes left to the plain version");
        found->compare(
            "rectangle", changed,
            reference::rect{expected.left, expected.right, expected.top, expected.bottom});
        found->compare("nodes_used", engine.nodes_used, plain_engine.nodes_used);
        found->compare("count in the queue", engine.queue->count, plain_engine.queue->count);
        found->compare("list in the queue", engine.queue->head != nullptr,
                       plain_engine.queue->head != nullptr);
        found->compare_arrays("mask", s->mask, s->model_mask);
    }

    void compare_engines(findings* found) const {
        const ptrdiff_t cells = brush_side(engine) * brush_side(engine);
        const auto costs_of = [cells](const int* costs) {
            return std::vector<int>(costs, costs + cells);
        };
        found->compare_arrays("cost_h", costs_of(engine.cost_h), costs_of(plain_engine.cost_h));
        found->compare_arrays("cost_v", costs_of(engine.cost_v), costs_of(plain_engine.cost_v));
        std::vector<int> recorded(static_cast<size_t>(cells)), expected_recorded(recorded);
        for (ptrdiff_t i = 0; i < cells; ++i) {
            recorded[static_cast<size_t>(i)] = engine.node_map[i] != nullptr;
            expected_recorded[static_cast<size_t>(i)] = plain_engine.node_map[i] != nullptr;
        }
        found->compare_arrays("node_map", recorded, expected_recorded);
    }

    ER_selection engine;
    ER_selection plain_engine;
};

// Strokes of the brush that the library runs, against the plain competition of fronts; for brushes
// too large for the model.
void run_competition(random_source& random, findings* found) {
    const int radius = random.one_in(2) ? random.between(1, 12) : random.between(1, 80);
    plain_pair engines(radius, random_core(random, radius));
    scene s{random, random.size_up_to(200), random.size_up_to(200)};
    if (random.one_in(3)) sprinkle(random, &s.model_mask, 0, random.any_of({1, 4, 5, 255}));
    s.share_mask();
    for (int strokes = random.between(1, 6); strokes > 0 && found->agree(); --strokes) {
        const position at = {random.between(-1, s.width), random.between(-1, s.height)};
        const bool grows = random.one_in(2);
        engines.stroke_at(&s, at, grows, found);
    }
    engines.compare_engines(found);
}

// Levels of grey next to each other, one of them the commonest, and a mask with few values of 1 and
// more that block the fronts.
void draw_ties(random_source& random, scene* s) {
    const int rarity = random.between(2, 12), levels = random.between(1, 4);
    const int blocked = random.between(2, 12), selected = random.any_of({2, 20, 1000});
    for (size_t i = 0; i < s->photo.size(); ++i) {
        const int level = random.one_in(rarity) ? random.between(0, levels) : levels / 2;
        s->photo[i] = s->library_photo[i] = level * 0x010101;
        s->model_mask[i] = random.one_in(selected);
        if (random.one_in(blocked)) s->model_mask[i] = random.between(2, 5);
    }
    s->share_mask();
}

// Strokes of small brushes, with few nodes for each entry of the queue's index, where many paths
// cost the same: what the index does, and that it names nodes popped long ago, decides who wins.
void run_small_step(random_source& random, findings* found) {
    const int radius = random.between(3, 10);  // before the core, whatever the compiler
    plain_pair engines(radius, random.between(0, 2));
    if (random.one_in(3)) engines.set_step(random.between(1, 4));
    scene s{random, random.between(3, 16), random.between(3, 16)};
    for (int strokes = 0; strokes < 10 && found->agree(); ++strokes) {
        draw_ties(random, &s);
        const position at = {random.between(0, s.width - 1), random.between(0, s.height - 1)};
        const bool grows = random.one_in(2);
        const auto point = static_cast<size_t>(at.y * s.width + at.x);
        if (!grows) s.mask[point] = s.model_mask[point] = 1;
        engines.stroke_at(&s, at, grows, found);
    }
    engines.compare_engines(found);
}

// Calls for strokes that look at the mask alone.
using mask_call = void (ER_selection::*)(unsigned char*, int, int, int, int, ze_rect*);
using model_mask_call = void (reference::engine::*)(std::vector<unsigned char>&, int, int, int, int,
                                                    reference::rect*);

void run_painting(random_source& random, findings* found) {
    const bool adds = random.one_in(2);
    const mask_call library_call = adds ? &ER_selection::Brush_Add : &ER_selection::Brush_Del;
    const model_mask_call model_call =
        adds ? &reference::engine::Brush_Add : &reference::engine::Brush_Del;
    const int radius = random.size_up_to(31) - 1;
    engine_pair engines(radius, random_core(random, radius));
    const int width = random.size_up_to(100), height = random.size_up_to(100);
    std::vector<unsigned char> model_mask = random_mask(random, width, height);
    if (random.one_in(4)) sprinkle(random, &model_mask, 0, 255);
    placed_vector<unsigned char> mask(model_mask);
    const int x = random.between(-radius - 2, width + radius + 2);
    const int y = random.between(-radius - 2, height + radius + 2);
    ze_rect changed = empty_beyond_image(width, height);
    reference::rect expected = {width, 0, height, 0};
    (engines.library.*library_call)(mask.data(), width, height, x, y, &changed);
    (engines.model.*model_call)(model_mask, width, height, x, y, &expected);
    found->compare("rectangle", changed, expected);
    found->compare_arrays("mask", mask, model_mask);
}

void run_lasso(random_source& random, findings* found) {
    const bool adds = random.one_in(2);
    const int width = random.size_up_to(200), height = random.size_up_to(200);
    std::vector<unsigned char> model_mask = random_mask(random, width, height);
    if (random.one_in(4)) sprinkle(random, &model_mask, 0, 255);
    placed_vector<unsigned char> mask(model_mask);
    ER_selection engine;
    ze_rect changed = empty_beyond_image(width, height);
    reference::rect expected = {width, 0, height, 0};
    int x0 = random.between(0, width - 1), y0 = random.between(0, height - 1);
    for (int segments = random.between(1, 5); segments > 0; --segments) {
        const int margin = random.one_in(10) ? 2 : 0;
        const int x1 = random.between(-margin, width - 1 + margin);
        const int y1 = random.between(-margin, height - 1 + margin);
        if (adds) {
            engine.Lasso_Add(mask.data(), width, height, x0, y0, x1, y1, &changed);
            reference::Lasso_Add(model_mask, width, height, x0, y0, x1, y1, &expected);
        } else {
            engine.Lasso_Del(mask.data(), width, height, x0, y0, x1, y1, &changed);
            reference::Lasso_Del(model_mask, width, height, x0, y0, x1, y1, &expected);
        }
        x0 = x1;
        y0 = y1;
    }
    found->compare("rectangle", changed, expected);
    found->compare_arrays("mask", mask, model_mask);
}

}  // namespace

const std::vector<family> stroke_families = {
    {"grow", "growing strokes, radius 0 to 40, photos up to 200 x 200", 16000, run_grow},
    {"shrink", "shrinking strokes, likewise", 32000, run_shrink},
    {"tiny-grow", "20 growing strokes each on tiny photos with walls", 2000, run_tiny_grow,
     RARE_FAULTS},
    {"tiny-shrink", "20 shrinking strokes, likewise", 5000, run_tiny_shrink, RARE_FAULTS},
    {"competition", "both kinds of strokes against plain ones, radius 1 to 80", 3000,
     run_competition, RARE_FAULTS},
    {"small-step", "10 strokes each of small brushes with many ties, against plain ones", 20000,
     run_small_step, RARE_FAULTS},
    {"painting", "Brush_Add and Brush_Del", 100000, run_painting},
    {"lasso", "segments of adding and removing lassos", 100000, run_lasso},
};
