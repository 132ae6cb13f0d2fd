// Calls every exported function with numbers that no caller should pass. Nothing is compared: under
// AddressSanitizer and UndefinedBehaviorSanitizer, the program ends at the first access beyond a
// buffer and at the first undefined operation.
//
// Every call is counted by name. In the end each name of exports.txt must have been called, or be a
// variable of the list in exported_calls.cpp.
//
// Buffers have exactly the size that the arguments describe, at least one element. Numbers are
// hostile wherever no REQUIRES in the headers rules them out. Left out, because nobody promises
// anything about it:
//
// - pointers and pins that are null, but for a mask to be reset, and for arrays of which no element
//   is asked for: nothing to draw, an unknown mode, an image without pixels
// - null as a rectangle, a point, or an array to be pinned: JNI itself forbids it
// - arrays shorter than their sizes say
// - rectangles that reach out of the image or view that is drawn; a view drawn with its outline and
//   a rectangle out of order that reaches out of it
// - blocks of ze_modify_mask beyond the large mask
// - pixels beyond the image in ER_selection::cal_cost
// - D_Queue: a push without index or with a step below 1, a pop from an empty queue, a node that is
//   pushed while it is queued
// - set_image_points with less room than its counts ask for
// - ze_memset, ze_memcpy, ze_realloc and ze_free on anything but blocks that hold what they touch
// - calls from two threads

#include <algorithm>
#include <cinttypes>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <utility>
#include <vector>

#include "jni/view_image.h"
#include "jni/view_outline.h"
#include "render/compositing.h"
#include "render/mask_transfer.h"
#include "selection/objectsel.h"
#include "selection/rectangles.h"
#include "selection/region_shaping.h"
#include "support/fixed_point.h"
#include "support/ze_alloc.h"
#include "tests/differential/random_pictures.h"
#include "tests/differential/random_source.h"
#include "tests/helpers/util_methods.h"
#include "tests/hostile/exported_calls.h"
#include "tests/hostile/java_memory.h"

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
            CALLED(ze_init_objectsel)(hostile_int(random, 10), hostile_int(random, 10));
            break;
        case 1:
            CALLED(ze_set_brush_size)(hostile_radius(random), hostile_int(random, 10));
            break;
        case 2:
            CALLED(ze_reset_objectsel)(random.one_in(5) ? nullptr : mask, width, height);
            break;
        case 3:
            CALLED(ze_inverse_mask)(mask, width, height);
            break;
        case 4:
            CALLED(ze_set_objectROI)(hostile_rect(random, s->width, s->height));
            break;
        case 5:
            CALLED(ze_update_objectROI)(mask, width, height);
            CALLED(ze_reset_fill_boundary)(hostile_int(random, 10), hostile_int(random, 10));
            CALLED(ze_reinit_objectsel)
            (random.one_in(2) ? nullptr : mask, width, height,
             hostile_rect(random, s->width, s->height));
            CALLED(ze_get_objectROI)();
            CALLED(ze_get_brush_radius)();
            CALLED(ze_get_brush_center)();
            if (random.one_in(4)) CALLED(ze_destroy_objectsel)();
            break;
        default: {
            ze_rect changed;
            CALLED(ze_modify_objectsel)
            (s->photo.data(), mask, width, height, hostile_int(random, s->width),
             hostile_int(random, s->height), hostile_int(random, s->width),
             hostile_int(random, s->height),
             random.one_in(8) ? random.any_int() : random.between(0, 5), &changed,
             random.any_of({0, 1, 1, 1, -1, LOWEST}));
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
            CALLED(Fill_Region)
            (mask, width, height, box.left, box.right, box.top, box.bottom, &changed);
            break;
        case 1:
            CALLED(Erase_Region)(mask, width, height, &box, &changed);
            break;
        case 2:
            CALLED(ze_lasso_add_fill_mask)
            (mask, width, height, box.left, box.right, box.top, box.bottom);
            break;
        default:
            CALLED(ze_lasso_del_fill_mask)
            (mask, width, height, box.left, box.right, box.top, box.bottom);
            break;
    }
}

// An engine of its own, whose brush changes between strokes and which may lack its buffers.
void engine_calls(random_source& random, scene* s) {
    counted_life<ER_selection> counted("ER_selection");
    ER_selection& engine = counted.object;
    ze_rect changed = empty_beyond_image(s->width, s->height);
    int* const photo = s->photo.data();
    unsigned char* const mask = s->mask.data();
    for (int calls = random.between(1, 6); calls > 0; --calls) {
        const int x = hostile_int(random, s->width), y = hostile_int(random, s->height);
        switch (random.between(0, 9)) {
            case 8:
                CALLED_ON(engine, ER_selection, destroyResource)();
                break;
            case 9: {
                const int right = s->width - 1, bottom = s->height - 1;
                const int ends[] = {random.between(0, right), random.between(0, bottom),
                                    random.between(0, right), random.between(0, bottom)};
                CALLED_ON(engine, ER_selection, cal_cost)
                (photo, s->width, ends[0], ends[1], ends[2], ends[3]);
                break;
            }
            case 0:
                CALLED_ON(engine, ER_selection, initial)
                (hostile_radius(random), hostile_int(random, 8));
                break;
            case 1:
                CALLED_ON(engine, ER_selection, set_brush)
                (hostile_radius(random), hostile_int(random, 8));
                break;
            case 2:
                CALLED_ON(engine, ER_selection, DoSelection)
                (photo, mask, s->width, s->height, x, y, &changed);
                break;
            case 3:
                CALLED_ON(engine, ER_selection, DeSelection)
                (photo, mask, s->width, s->height, x, y, &changed);
                break;
            case 4:
                CALLED_ON(engine, ER_selection, Brush_Add)
                (mask, s->width, s->height, x, y, &changed);
                break;
            case 5:
                CALLED_ON(engine, ER_selection, Brush_Del)
                (mask, s->width, s->height, x, y, &changed);
                break;
            case 6:
                CALLED_ON(engine, ER_selection, Lasso_Add)
                (mask, s->width, s->height, x, y, hostile_int(random, s->width),
                 hostile_int(random, s->height), &changed);
                break;
            default:
                CALLED_ON(engine, ER_selection, Lasso_Del)
                (mask, s->width, s->height, x, y, hostile_int(random, s->width),
                 hostile_int(random, s->height), &changed);
                break;
        }
    }
}

// A queue with nodes of any cost, unlinked behind its back as the engine does it.
void queue_calls(random_source& random) {
    counted_life<D_Queue> counted("D_Queue");
    D_Queue& queue = counted.object;
    std::vector<node> nodes(static_cast<size_t>(random.between(1, 400)));
    std::vector<node*> unused;
    unused.reserve(nodes.size());
    for (node& each : nodes) unused.push_back(&each);
    if (random.one_in(2)) queue.step = random.between(1, 120);
    for (int calls = random.between(1, 600); calls > 0; --calls) {
        if (CALLED_ON(queue, D_Queue, empty)() || random.one_in(3)) {
            if (unused.empty()) return;
            node* const n = unused.back();
            unused.pop_back();  // what has been queued once may be in the index still
            n->cost = random.one_in(3) ? hostile_int(random, 1000) : random.between(0, 50);
            CALLED_ON(queue, D_Queue, push)(n);
            if (random.one_in(10)) {
                queue.count = random.one_in(2) ? random.between(-1, 130)
                                               : random.any_of({LOWEST, HIGHEST, random.any_int()});
            }
        } else if (queue.head) {
            CALLED_ON(queue, D_Queue, pop)();
        }
    }
}

void allocator_calls(random_source& random) {
    constexpr size_t WANTED = 64, NOBODY_HAS = SIZE_MAX / 2;
    const size_t most = random.one_in(20) ? NOBODY_HAS : 2 * WANTED;
    const size_t count = random.any_of({size_t{0}, size_t{1}, WANTED, most});
    const size_t size = random.any_of({size_t{0}, size_t{1}, WANTED, most});
    CALLED(ze_free)(CALLED(ze_calloc)(count, size));
    if (count < NOBODY_HAS && size < NOBODY_HAS) CALLED(ze_free)(CALLED(ze_malloc)(count, size));
    void* const block = CALLED(ze_malloc)(WANTED, 1);
    CALLED(ze_memset)(block, hostile_int(random, 256), WANTED);
    CALLED(ze_memcpy)(block, std::vector<char>(WANTED).data(), WANTED);
    void* const larger = CALLED(ze_realloc)(block, most);
    CALLED(ze_free)(larger ? larger : block);
    CALLED(ze_free)(nullptr);
}

// A rectangle in an image, or one without pixels, which may be anywhere.
ze_rect image_area(random_source& random, int width, int height) {
    ze_rect area = {random.between(0, width - 1), random.between(0, width - 1),
                    random.between(0, height - 1), random.between(0, height - 1)};
    if (area.left > area.right) std::swap(area.left, area.right);
    if (area.top > area.bottom) std::swap(area.top, area.bottom);
    if (random.one_in(2)) return area;
    ze_rect none = hostile_rect(random, width, height);
    if (random.one_in(2)) {
        if (none.left < none.right) std::swap(none.left, none.right);
        if (none.left == none.right) none.left = 1, none.right = 0;
    } else {
        if (none.top < none.bottom) std::swap(none.top, none.bottom);
        if (none.top == none.bottom) none.top = 1, none.bottom = 0;
    }
    return none;
}

bool is_empty(const ze_rect& r) { return r.left > r.right || r.top > r.bottom; }

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
    switch (random.between(0, 5)) {
        case 3: {
            const ze_rect r = image_area(random, width, height);
            CALLED(ze_draw_withmask)
            (src.data(), dst.data(), s->mask.data(), width, r.left, r.right, r.top, r.bottom);
            break;
        }
        case 4: {
            const ze_rect r = image_area(random, width, height);
            const bool unread = is_empty(r) && random.one_in(2);
            CALLED(ze_draw_withmask_v2)
            (unread ? nullptr : src.data(), unread ? nullptr : dst.data(),
             unread ? nullptr : s->mask.data(), unread ? hostile_int(random, width) : width, r.left,
             r.right, r.top, r.bottom);
            break;
        }
        case 0:
            if (random.one_in(3)) {
                if (random.one_in(2)) {
                    width = impossible_size(random);
                } else {
                    width = -width;
                    height = -height;
                }
            }
            CALLED(ze_argb2gray)(src.data(), width, height, dst.data());
            break;
        case 1:
            if (random.one_in(3)) (random.one_in(2) ? width : height) = impossible_size(random);
            CALLED(ze_draw_reverse_mask)(src.data(), dst.data(), s->mask.data(), width, height);
            break;
        case 2: {
            int mask_width = s->width, mask_height = s->height;
            if (random.one_in(3)) {
                (random.one_in(2) ? mask_width : mask_height) = impossible_size(random);
            }
            CALLED(ze_draw_reverse_mask_v2)
            (src.data(), dst.data(), s->mask.data(), 0, width, height, mask_width, mask_height,
             hostile_float(random));
            break;
        }
        default: {
            const int times = random.between(1, 3);
            const auto pixels =
                static_cast<size_t>(times * width) * static_cast<size_t>(times * height);
            std::vector<uint32_t> photo(pixels, 0xFF808080u);
            for (size_t i = 0; i < pixels; i += 3) photo[i] = src[i % src.size()];
            std::vector<unsigned char> large(pixels);
            sprinkle(random, &large, 0, 255);
            const ze_rect r = image_area(random, width, height);
            const float ratio = random.one_in(3)
                                    ? random.any_of({-1.0f, 0.0f, -0.0f, std::nanf(""), -1e30f})
                                    : 1.0f / static_cast<float>(times);
            CALLED(ze_modify_mask)
            (s->mask.data(), large.data(), photo.data(), width, height, times * width,
             random.any_int(), ratio, r.left, r.right, r.top, r.bottom,
             random.one_in(2) ? 0 : random.any_int());
            break;
        }
    }
}

void fixed_point_calls(random_source& random) {
    const int32_t x = hostile_int(random, 0x10000), y = hostile_int(random, 0x400000);
    const double d = static_cast<double>(hostile_float(random)) * random.any_of({1.0, 1e300, -1.0});
    // Callers may change the tables, to anything.
    int32_t* const entry =
        random.any_of({&_cos_tbl[random.between(0, 511)], &_tan_tbl[random.between(0, 255)],
                       &_acos_tbl[random.between(0, 512)]});
    const int32_t kept = std::exchange(*entry, random.one_in(2) ? *entry : random.any_int());
    CALLED(itofix)(x);
    CALLED(fixtoi)(x);
    CALLED(fixfloor)(x);
    CALLED(fixceil)(x);
    CALLED(fixatan)(x);
    CALLED(fixcos)(x);
    CALLED(fixsin)(x);
    CALLED(fixtan)(x);
    CALLED(fixacos)(x);
    CALLED(fixasin)(x);
    CALLED(isqrt_)(x);
    CALLED(fixadd)(x, y);
    CALLED(fixsub)(x, y);
    CALLED(fixmul)(x, y);
    CALLED(fixdiv)(x, y);
    CALLED(fixatan2)(x, y);
    CALLED(idiv)(x, y);
    CALLED(iidiv)(x, y);
    CALLED(ftofix)(d);
    CALLED(fixtof)(x);
    CALLED(round__)(d);
    *entry = kept;
}

// The native methods of Util that select, composite and allocate.
void native_session_calls(random_source& random, scene* s) {
    java_memory java;
    JNIEnv* const env = java.env();
    int width = s->width, height = s->height;
    const bool no_pixels = random.one_in(4);
    if (no_pixels) {
        width = impossible_size(random);
        height = impossible_size(random);
    }
    // An array without elements that anybody asks for may be one that could not be pinned.
    const auto mask = java.bytes(&s->mask, no_pixels && random.one_in(2));
    switch (random.between(0, 14)) {
        case 0:
            CALLED_UTIL(init_1objectsel)
            (env, nullptr, hostile_int(random, 10), hostile_int(random, 10));
            break;
        case 1:
            CALLED_UTIL(destroy_1objectsel)(env, nullptr);
            break;
        case 2:
            CALLED_UTIL(inverse_1objectsel)
            (env, nullptr, random.one_in(4) ? nullptr : mask, width, height);
            break;
        case 3:
            CALLED_UTIL(reset_1objectsel)
            (env, nullptr, random.one_in(4) ? nullptr : mask, width, height);
            break;
        case 4:
            CALLED_UTIL(set_1brush_1size)
            (env, nullptr, hostile_radius(random), hostile_int(random, 10));
            break;
        case 5: {
            const ze_rect area = image_area(random, s->width, s->height);
            const bool refused = is_empty(area) && random.one_in(2);
            std::vector<int> drawn(s->photo.size());
            CALLED_UTIL(draw_1withmask)
            (env, nullptr, java.ints(&s->photo, refused), java.ints(&drawn, refused),
             java.bytes(&s->mask, refused), s->width, java.rect(area));
            break;
        }
        case 6: {
            const bool refused = no_pixels && random.one_in(2);
            std::vector<int> drawn(s->photo.size());
            CALLED_UTIL(draw_1reversemask)
            (env, nullptr, java.ints(&s->photo, refused), java.ints(&drawn, refused), mask, width,
             height);
            break;
        }
        case 7:
            CALLED_UTIL(get_1objectROI)(env, nullptr, java.rect({}));
            CALLED_UTIL(get_1brush_1radius)(env, nullptr);
            CALLED_UTIL(get_1brush_1center)(env, nullptr);
            CALLED_UTIL(reset_1fill_1ROI)
            (env, nullptr, hostile_int(random, 10), hostile_int(random, 10));
            break;
        case 8:
            CALLED_UTIL(set_1objectROI)
            (env, nullptr, java.rect(hostile_rect(random, s->width, s->height)));
            break;
        case 9:
            CALLED_UTIL(reinit_1objectsel)
            (env, nullptr, java.bytes(&s->mask, random.one_in(2)), hostile_int(random, s->width),
             hostile_int(random, s->height), java.rect(hostile_rect(random, 10, 10)));
            break;
        case 10:
            CALLED_UTIL(update_1objectROI)(env, nullptr, mask, width, height);
            break;
        case 11: {
            const jintArray made =
                CALLED_UTIL(nativeIntAlloc)(env, nullptr, hostile_int(random, 100));
            CALLED_UTIL(nativeIntRelease)(env, nullptr, made);
            CALLED_UTIL(nativeIntRelease)(env, nullptr, java.ints(&s->photo, random.one_in(2)));
            break;
        }
        default: {
            const bool unknown = random.one_in(8);
            const int mode =
                unknown ? random.any_of({LOWEST, -1, 6, 7, 255, HIGHEST}) : random.between(0, 5);
            const bool refused = (unknown || no_pixels) && random.one_in(2);
            const jobject from =
                java.point(hostile_int(random, s->width), hostile_int(random, s->height));
            const jobject to =
                java.point(hostile_int(random, s->width), hostile_int(random, s->height));
            CALLED_UTIL(modify_1objectsel)
            (env, nullptr, java.ints(&s->photo, refused), java.bytes(&s->mask, refused), width,
             height, from, to, mode, java.rect(hostile_rect(random, 10, 10)),
             random.any_of({0, 1, 1, 1, -1, LOWEST}));
            break;
        }
    }
}

// The native methods of Util that draw into the view.
void native_drawing_calls(random_source& random, scene* s) {
    java_memory java;
    JNIEnv* const env = java.env();
    const int view_width = random.size_up_to(30), view_height = random.size_up_to(30);
    std::vector<int> view(static_cast<size_t>(view_width) * static_cast<size_t>(view_height));
    int width = s->width, height = s->height;
    if (random.one_in(6)) {
        height = impossible_size(random);
        if (random.one_in(2)) width = impossible_size(random);
    }
    const int unread = hostile_int(random, view_height);
    const float scale = hostile_float(random);
    const int x = hostile_int(random, s->width), y = hostile_int(random, s->height);
    const int kind = random.between(0, 4);
    const ze_rect area = view_area(random, view_width, view_height, kind == 2);
    // An empty rectangle draws nothing; that of an outline need not be in order.
    const bool refused = kind != 2 && area.left > area.right && random.one_in(2);
    const jintArray to = java.ints(&view, refused), photo = java.ints(&s->photo, refused);
    const jbyteArray mask = java.bytes(&s->mask, refused);
    switch (kind) {
        case 0:
            CALLED_UTIL(native_1drawImage___3III_3IIIFIILandroid_graphics_Rect_2)
            (env, nullptr, to, view_width, unread, photo, width, height, scale, x, y,
             java.rect(area));
            break;
        case 1:
            CALLED_UTIL(native_1drawSmallImage)
            (env, nullptr, to, view_width, unread, photo, width, height, java.rect(area));
            break;
        case 2:
            CALLED_UTIL(native_1drawImageWithMaskContour)
            (env, nullptr, to, view_width, unread, photo, width, height, mask, scale, x, y, 1, 2,
             java.rect(area));
            break;
        case 3:
            CALLED_UTIL(native_1drawSmallImageWithMaskContour)
            (env, nullptr, to, view_width, unread, photo, width, height, mask, 1, 2,
             java.rect(area));
            break;
        default: {
            const int columns = random.one_in(3) ? impossible_size(random) : random.between(0, 20);
            const int rows = random.one_in(3) ? impossible_size(random) : random.between(0, 20);
            std::vector<int> points(static_cast<size_t>(std::max(columns, 0)) +
                                    static_cast<size_t>(std::max(rows, 0)) + 1);
            CALLED_UTIL(native_1setImagePoints)
            (env, nullptr, columns, rows, unread, unread, scale, x, y,
             java.ints(&points, columns <= 0 && rows <= 0 && random.one_in(2)));
            break;
        }
    }
}

}  // namespace

// Under the sanitizers, sizes that no machine has yield null too instead of ending the program.
// NOLINTBEGIN: their names
extern "C" {
const char* __asan_default_options();
const char* __asan_default_options() { return "allocator_may_return_null=1"; }
const char* __msan_default_options();
const char* __msan_default_options() { return "allocator_may_return_null=1"; }
}
// NOLINTEND

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
        switch (random.between(0, 13)) {
            case 5:
                queue_calls(random);
                break;
            case 6:
                allocator_calls(random);
                break;
            case 7:
            case 8:
            case 9:
                native_session_calls(random, &s);
                break;
            case 10:
                native_drawing_calls(random, &s);
                break;
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
    CALLED(ze_destroy_objectsel)();
    if (!every_export_was_called()) return 1;
    std::printf("%" PRIu64 " rounds of hostile calls, no complaint\n", calls);
}
