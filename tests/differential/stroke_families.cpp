#include "selection/ER_selection.h"
#include "tests/differential/family.h"
#include "tests/differential/random_pictures.h"
#include "tests/reference/engine_reference.h"

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
          mask(random_mask(random, w, h)),
          model_mask(mask) {}

    int width;
    int height;
    std::vector<int> photo;
    std::vector<unsigned char> mask;
    std::vector<unsigned char> model_mask;
};

// An engine of the library and one of the model.
struct engine_pair {
    engine_pair(int radius, int core) {
        library.initial(radius, core);
        model.initial(radius, core);
    }

    std::string stroke_at(scene* s, int x, int y, stroke library_stroke,
                          model_stroke stroke_of_model) {
        ze_rect changed = empty_beyond_image(s->width, s->height);
        reference::rect expected = {s->width, 0, s->height, 0};
        (library.*library_stroke)(s->photo.data(), s->mask.data(), s->width, s->height, x, y,
                                  &changed);
        (model.*stroke_of_model)(s->photo, s->model_mask, s->width, s->height, x, y, &expected);
        const reference::rect found = {changed.left, changed.right, changed.top, changed.bottom};
        if (found != expected) return "another rectangle";
        if (library.nodes_used != model.nodes_used) return "another number of nodes";
        if (library.queue->count != model.queue->count) return "another count in the queue";
        if ((library.queue->head == nullptr) != (model.queue->head == reference::NO_NODE)) {
            return "another head in the queue";
        }
        return first_difference("mask", s->mask, s->model_mask);
    }

    std::string compare_costs() const {
        std::string difference = first_difference("cost_h", library.cost_h, model.cost_h);
        return difference.empty() ? first_difference("cost_v", library.cost_v, model.cost_v)
                                  : difference;
    }

    void count_what_happened(tally* seen) const {
        if (model.queue->rings > 0) (*seen)["cases with a ring found"]++;
        if (model.abandoned_seedings > 0) (*seen)["cases with an abandoned seeding"]++;
        if (model.cut_growths > 0) (*seen)["cases with a growth cut short"]++;
    }

    ER_selection library;
    reference::engine model;
};

int random_core(random_source& random, int radius) {
    return random.one_in(6) ? radius + random.between(0, 3) : random.between(0, 12);
}

// A few strokes of one engine, at, near and over the borders, on photos of changing size.
std::string run_strokes(random_source& random, tally* seen, stroke library_stroke,
                        model_stroke stroke_of_model) {
    const int radius = random.size_up_to(41) - 1;
    engine_pair engines(radius, random_core(random, radius));
    scene s(random, random.size_up_to(200), random.size_up_to(200));
    for (int strokes = random.between(1, 4); strokes > 0; --strokes) {
        if (random.one_in(8)) s = scene(random, random.size_up_to(200), random.size_up_to(200));
        if (random.one_in(8)) {
            sprinkle(random, &s.mask, 0, 255);
            s.model_mask = s.mask;
        }
        std::string difference =
            engines.stroke_at(&s, random.between(-2, s.width + 1), random.between(-2, s.height + 1),
                              library_stroke, stroke_of_model);
        if (!difference.empty()) return difference;
    }
    engines.count_what_happened(seen);
    return engines.compare_costs();
}

// Many strokes of a small brush on a tiny photo, with walls of foreign values in the mask and
// single seeds: the places where the queue's list breaks and closes into rings.
std::string run_tiny_strokes(random_source& random, tally* seen, stroke library_stroke,
                             model_stroke stroke_of_model) {
    const int radius = random.between(2, 8);
    engine_pair engines(radius, random.between(0, 2));
    scene s(random, random.between(3, 24), random.between(3, 24));
    for (int strokes = 0; strokes < 20; ++strokes) {
        (*seen)["strokes"]++;
        if (random.one_in(4)) {
            s.mask = random_mask(random, s.width, s.height);
            if (random.one_in(2)) sprinkle(random, &s.mask, 0, random.any_of({1, 4, 5, 7}));
            s.model_mask = s.mask;
        }
        std::string difference =
            engines.stroke_at(&s, random.between(0, s.width - 1), random.between(0, s.height - 1),
                              library_stroke, stroke_of_model);
        if (!difference.empty()) return difference;
    }
    engines.count_what_happened(seen);
    return engines.compare_costs();
}

std::string run_grow(random_source& random, tally* seen) {
    return run_strokes(random, seen, &ER_selection::DoSelection, &reference::engine::DoSelection);
}

std::string run_tiny_grow(random_source& random, tally* seen) {
    return run_tiny_strokes(random, seen, &ER_selection::DoSelection,
                            &reference::engine::DoSelection);
}

}  // namespace

const std::vector<family> stroke_families = {
    {"grow", "growing strokes, radius 0 to 40, photos up to 200 x 200", run_grow},
    {"tiny-grow", "20 growing strokes each on tiny photos with walls", run_tiny_grow},
};
