// Calls every function with numbers that no caller should pass. Nothing is compared: under
// AddressSanitizer and UndefinedBehaviorSanitizer, the program ends at the first access beyond a
// buffer and at the first undefined operation.
//
// Buffers have exactly the size that the arguments describe, at least one element. Numbers are
// hostile wherever no REQUIRES in the headers rules them out.

#include <algorithm>
#include <cinttypes>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <vector>

#include "jni/view_image.h"
#include "jni/view_outline.h"
#include "render/compositing.h"
#include "render/mask_transfer.h"
#include "selection/objectsel.h"
#include "selection/rectangles.h"
#include "selection/region_shaping.h"
#include "support/fixed_point.h"
#include "tests/differential/random_pictures.h"
#include "tests/differential/random_source.h"

namespace {

constexpr int HIGHEST = std::numeric_limits<int>::max();
constexpr int LOWEST = std::numeric_limits<int>::min();

// A position on an axis of `size`: often at its ends, sometimes far beyond.
int hostile_int(random_source& random, int size) {
    if (random.one_in(3)) return random.between(-1, size);
    return random.any_of({LOWEST, LOWEST + 1, -65536, -2, -1, 0, 1, 2, size - 1, size, size + 1,
                          32767, 32768, 65536, HIGHEST - 1, HIGHEST, random.any_int()});
}

// A size that no buffer need have: nothing may be touched.
int impossible_size(random_source& random) {
    return random.any_of({LOWEST, LOWEST + 1, -65536, -3, -2, -1, 0});
}

float hostile_float(random_source& random) {
    return random.any_of({0.0f, -0.0f, std::nanf(""), std::numeric_limits<float>::infinity(),
                          -std::numeric_limits<float>::infinity(), 1e30f, -1e30f, 1e-40f, 32767.5f,
                          32768.0f, -32768.0f, 1.0f, 0.3f, 2.7f,
                          static_cast<float>(random.any_int())});
}

// A brush that can be had, or one far too large to be had.
int hostile_radius(random_source& random) {
    return random.one_in(4) ? random.any_of({LOWEST, LOWEST + 1, -32768, -1, 40000, 1 << 20,
                                             (1 << 30) - 1, 1 << 30, HIGHEST - 1, HIGHEST})
                            : random.between(0, 12);
}

struct scene {
    explicit scene(random_source& random)
        : width(random.size_up_to(24)),
          height(random.size_up_to(24)),
          photo(random_photo(random, width, height)),
          mask(random_mask(random, width, height)) {
        if (random.one_in(3)) sprinkle(random, &mask, 0, 255);
    }

    int width, height;
    std::vector<int> photo;
    std::vector<unsigned char> mask;
};

ze_rect hostile_rect(random_source& random, int width, int height) {
    return {hostile_int(random, width), hostile_int(random, width), hostile_int(random, height),
            hostile_int(random, height)};
}

void session_calls(random_source& random, scene* s) {
    int width = s->width, height = s->height;
    if (random.one_in(6)) (random.one_in(2) ? width : height) = impossible_size(random);
    unsigned char* const mask = s->mask.data();
    switch (random.between(0, 9)) {
        case 0:
            ze_init_objectsel(hostile_int(random, 10), hostile_int(random, 10));
            break;
        case 1:
            ze_set_brush_size(hostile_radius(random), hostile_int(random, 10));
            break;
        case 2:
            ze_reset_objectsel(random.one_in(5) ? nullptr : mask, width, height);
            break;
        case 3:
            ze_inverse_mask(mask, width, height);
            break;
        case 4:
            ze_set_objectROI(hostile_rect(random, s->width, s->height));
            break;
        case 5:
            ze_update_objectROI(mask, width, height);
            ze_reset_fill_boundary(hostile_int(random, 10), hostile_int(random, 10));
            break;
        default: {
            ze_rect changed;
            ze_modify_objectsel(s->photo.data(), mask, width, height, hostile_int(random, s->width),
                                hostile_int(random, s->height), hostile_int(random, s->width),
                                hostile_int(random, s->height),
                                random.one_in(8) ? random.any_int() : random.between(0, 5),
                                &changed, random.any_of({0, 1, 1, 1, -1, LOWEST}));
            break;
        }
    }
}

void region_calls(random_source& random, scene* s) {
    int width = s->width, height = s->height;
    if (random.one_in(6)) (random.one_in(2) ? width : height) = impossible_size(random);
    ze_rect box = hostile_rect(random, s->width, s->height);
    ze_rect changed = empty_beyond_image(width, height);
    unsigned char* const mask = s->mask.data();
    switch (random.between(0, 3)) {
        case 0:
            Fill_Region(mask, width, height, box.left, box.right, box.top, box.bottom, &changed);
            break;
        case 1:
            Erase_Region(mask, width, height, &box, &changed);
            break;
        case 2:
            ze_lasso_add_fill_mask(mask, width, height, box.left, box.right, box.top, box.bottom);
            break;
        default:
            ze_lasso_del_fill_mask(mask, width, height, box.left, box.right, box.top, box.bottom);
            break;
    }
}

// An engine of its own, whose brush changes between strokes and which may lack its buffers.
void engine_calls(random_source& random, scene* s) {
    ER_selection engine;
    ze_rect changed = empty_beyond_image(s->width, s->height);
    int* const photo = s->photo.data();
    unsigned char* const mask = s->mask.data();
    for (int calls = random.between(1, 6); calls > 0; --calls) {
        const int x = hostile_int(random, s->width), y = hostile_int(random, s->height);
        switch (random.between(0, 7)) {
            case 0:
                engine.initial(hostile_radius(random), hostile_int(random, 8));
                break;
            case 1:
                engine.set_brush(hostile_radius(random), hostile_int(random, 8));
                break;
            case 2:
                engine.DoSelection(photo, mask, s->width, s->height, x, y, &changed);
                break;
            case 3:
                engine.DeSelection(photo, mask, s->width, s->height, x, y, &changed);
                break;
            case 4:
                engine.Brush_Add(mask, s->width, s->height, x, y, &changed);
                break;
            case 5:
                engine.Brush_Del(mask, s->width, s->height, x, y, &changed);
                break;
            case 6:
                engine.Lasso_Add(mask, s->width, s->height, x, y, hostile_int(random, s->width),
                                 hostile_int(random, s->height), &changed);
                break;
            default:
                engine.Lasso_Del(mask, s->width, s->height, x, y, hostile_int(random, s->width),
                                 hostile_int(random, s->height), &changed);
                break;
        }
    }
}

// Rectangles of the view lie in it or are empty; an empty one may be anywhere.
ze_rect view_area(random_source& random, int width, int height, bool unordered) {
    const ze_rect inside = {random.between(0, width - 1), random.between(0, width - 1),
                            random.between(0, height - 1), random.between(0, height - 1)};
    if (unordered || random.one_in(2)) return inside;
    return {1, 0, hostile_int(random, height), hostile_int(random, height)};
}

void drawing_calls(random_source& random, scene* s) {
    const int view_width = random.size_up_to(30), view_height = random.size_up_to(30);
    std::vector<int32_t> view(static_cast<size_t>(view_width) * static_cast<size_t>(view_height));
    const view_pixels to = {view.data(), view_width};
    photo_pixels from = {s->photo.data(), s->width, s->height};
    if (random.one_in(6)) {
        // Without pixels the photo's first one shows; rows of negative length would go before it.
        from.height = impossible_size(random);
        if (random.one_in(2)) from.width = impossible_size(random);
    }
    const outlined_photo outlined = {from, s->mask.data()};
    const float scale = hostile_float(random);
    const int x = hostile_int(random, s->width), y = hostile_int(random, s->height);
    const dash_colours dashes = {1, 2};
    switch (random.between(0, 4)) {
        case 0:
            draw_image(to, from, scale, x, y, view_area(random, view_width, view_height, false));
            break;
        case 1:
            draw_small_image(to, from, view_area(random, view_width, view_height, false));
            break;
        case 2:
            draw_image_with_outline(to, outlined, scale, x, y, dashes,
                                    view_area(random, view_width, view_height, true));
            break;
        case 3:
            draw_small_image_with_outline(to, outlined, dashes,
                                          view_area(random, view_width, view_height, false));
            break;
        default: {
            const int columns = random.one_in(3) ? impossible_size(random) : random.between(0, 20);
            const int rows = random.between(-3, 20);
            const int64_t length = int64_t{std::max(columns, 0)} + std::max(rows, 0);
            std::vector<int32_t> points(static_cast<size_t>(length) + 1);
            set_image_points(columns, rows, scale, x, y, points.data());
            break;
        }
    }
}

void compositing_calls(random_source& random, scene* s) {
    std::vector<uint32_t> src(s->photo.begin(), s->photo.end()), dst(src.size());
    int width = s->width, height = s->height;
    switch (random.between(0, 3)) {
        case 0:
            if (random.one_in(3)) {
                if (random.one_in(2)) {
                    width = impossible_size(random);
                } else {
                    width = -width;
                    height = -height;
                }
            }
            ze_argb2gray(src.data(), width, height, dst.data());
            break;
        case 1:
            if (random.one_in(3)) (random.one_in(2) ? width : height) = impossible_size(random);
            ze_draw_reverse_mask(src.data(), dst.data(), s->mask.data(), width, height);
            break;
        case 2: {
            int mask_width = s->width, mask_height = s->height;
            if (random.one_in(3)) {
                (random.one_in(2) ? mask_width : mask_height) = impossible_size(random);
            }
            ze_draw_reverse_mask_v2(src.data(), dst.data(), s->mask.data(), 0, width, height,
                                    mask_width, mask_height, hostile_float(random));
            break;
        }
        default:
            ze_modify_mask(s->mask.data(), s->mask.data(), src.data(), width, height, width, 0,
                           random.any_of({1.0f, -1.0f, 0.0f, -0.0f, std::nanf(""), -1e30f}), 0,
                           width - 1, 0, height - 1, random.any_int());
            break;
    }
}

void fixed_point_calls(random_source& random) {
    const int32_t x = hostile_int(random, 0x10000), y = hostile_int(random, 0x400000);
    const double d = static_cast<double>(hostile_float(random)) * random.any_of({1.0, 1e300, -1.0});
    for (const auto call : {itofix, fixtoi, fixfloor, fixceil, fixatan, fixcos, fixsin, fixtan,
                            fixacos, fixasin, isqrt_}) {
        call(x);
    }
    for (const auto call : {fixadd, fixsub, fixmul, fixdiv, fixatan2, idiv, iidiv}) call(x, y);
    ftofix(d);
    round__(d);
}

}  // namespace

int main(int count, char** arguments) {
    uint64_t calls = 100000, seed = 1;
    for (int i = 1; i + 1 < count; i += 2) {
        if (std::strcmp(arguments[i], "--calls") == 0) {
            calls = std::strtoull(arguments[i + 1], nullptr, 0);
        } else if (std::strcmp(arguments[i], "--seed") == 0) {
            seed = std::strtoull(arguments[i + 1], nullptr, 0);
        } else {
            count = 0;
        }
    }
    if (count % 2 == 0 || calls == 0) {
        std::fprintf(stderr, "usage: hostile [--calls N] [--seed S]\n");
        return 2;
    }
    for (uint64_t i = 0; i < calls; ++i) {
        random_source random(seed * 0x100000000u + i);
        scene s(random);
        switch (random.between(0, 6)) {
            case 0:
                region_calls(random, &s);
                break;
            case 1:
                engine_calls(random, &s);
                break;
            case 2:
                drawing_calls(random, &s);
                break;
            case 3:
                compositing_calls(random, &s);
                break;
            case 4:
                fixed_point_calls(random);
                break;
            default:
                session_calls(random, &s);
                break;
        }
        if ((i + 1) % 1000000 == 0) std::printf("%" PRIu64 " calls\n", i + 1);
    }
    ze_destroy_objectsel();
    std::printf("%" PRIu64 " hostile calls, no complaint\n", calls);
}
