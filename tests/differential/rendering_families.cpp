#include <algorithm>
#include <cmath>
#include <limits>

#include "jni/view_image.h"
#include "jni/view_outline.h"
#include "render/compositing.h"
#include "render/mask_transfer.h"
#include "tests/differential/family.h"
#include "tests/differential/placed_vector.h"
#include "tests/differential/random_pictures.h"
#include "tests/reference/compositing_reference.h"
#include "tests/reference/drawing_reference.h"
#include "tests/reference/mask_transfer_reference.h"

namespace {

using pixels = std::vector<uint32_t>;
using placed_pixels = placed_vector<uint32_t>;
using bytes = std::vector<unsigned char>;
using placed_bytes = placed_vector<unsigned char>;

pixels random_pixels(random_source& random, int width, int height) {
    const std::vector<int> photo = random_photo(random, width, height);
    return pixels(photo.begin(), photo.end());
}

bytes random_foreign_mask(random_source& random, int width, int height) {
    bytes mask = random_mask(random, width, height);
    if (random.one_in(3)) sprinkle(random, &mask, 0, random.any_of({2, 5, 255}));
    return mask;
}

float random_scale(random_source& random) {
    switch (random.between(0, 5)) {
        case 0:
            return random.any_of({0.0f, 0.25f, 0.5f, 1.0f, 2.0f, 4.0f, -1.0f});
        case 1:
            return random.any_of({std::numeric_limits<float>::infinity(), std::nanf(""), -1e30f,
                                  32767.99f, 32768.0f, 1e-30f});
        default:
            return static_cast<float>(random.between(1, 6000)) / 1000.0f;
    }
}

int random_offset(random_source& random, int size) {
    return random.one_in(20) ? random.any_int() : random.between(-size, size);
}

// --- compositing ---------------------------------------------------------------------------------

void run_grey(random_source& random, findings* found) {
    const int width = random.size_up_to(80);
    const int height = random.size_up_to(40);
    const pixels src = random_pixels(random, width, height);
    placed_pixels library_src(src);
    placed_pixels dst(src.size());
    pixels model_dst(src.size());
    ze_argb2gray(library_src.data(), width, height, dst.data());
    reference::ze_argb2gray(src, width, height, model_dst);
    found->compare_arrays("destination", dst, model_dst);
}

void run_with_mask(random_source& random, findings* found) {
    const int width = random.size_up_to(80);
    const int height = random.size_up_to(40);
    const pixels src = random_pixels(random, width, height);
    placed_pixels library_src(src);
    const bytes mask = random_foreign_mask(random, width, height);
    placed_bytes library_mask(mask);
    placed_pixels dst(src.size(), 7);
    pixels model_dst(src.size(), 7);
    const int left = random.between(0, width - 1), right = random.between(0, width - 1);
    const int top = random.between(0, height - 1), bottom = random.between(0, height - 1);
    const auto draw = random.one_in(2) ? ze_draw_withmask : ze_draw_withmask_v2;
    draw(library_src.data(), dst.data(), library_mask.data(), width, left, right, top, bottom);
    reference::ze_draw_withmask(src, model_dst, mask, width, left, right, top, bottom);
    found->compare_arrays("destination", dst, model_dst);
}

void run_reverse_mask(random_source& random, findings* found) {
    const int width = random.size_up_to(80);
    const int height = random.size_up_to(40);
    const pixels src = random_pixels(random, width, height);
    placed_pixels library_src(src);
    bytes model_mask = random_foreign_mask(random, width, height);
    placed_bytes mask(model_mask);
    placed_pixels dst(src.size());
    pixels model_dst(src.size());
    ze_draw_reverse_mask(library_src.data(), dst.data(), mask.data(), width, height);
    reference::ze_draw_reverse_mask(src, model_dst, model_mask, width, height);
    found->compare_arrays("destination", dst, model_dst);
    found->compare_arrays("mask", mask, model_mask);
}

void run_reverse_mask_v2(random_source& random, findings* found) {
    const int width = random.size_up_to(60);
    const int height = random.size_up_to(40);
    const int mask_width = random.size_up_to(40);
    const int mask_height = random.size_up_to(30);
    const pixels src = random_pixels(random, width, height);
    placed_pixels library_src(src);
    bytes model_mask = random_foreign_mask(random, mask_width, mask_height);
    placed_bytes mask(model_mask);
    placed_pixels dst(src.size());
    pixels model_dst(src.size());
    const float ratio = random_scale(random);
    ze_draw_reverse_mask_v2(library_src.data(), dst.data(), mask.data(), 0, width, height,
                            mask_width, mask_height, ratio);
    reference::ze_draw_reverse_mask_v2(src, model_dst, model_mask, 0, width, height, mask_width,
                                       mask_height, ratio);
    found->compare_arrays("destination", dst, model_dst);
    found->compare_arrays("mask", mask, model_mask);
}

// --- mask transfer -------------------------------------------------------------------------------

void run_modify_mask(random_source& random, findings* found) {
    const int small_width = random.size_up_to(40);
    const int small_height = random.size_up_to(40);
    const bytes small = random_foreign_mask(random, small_width, small_height);
    placed_bytes library_small(small);
    const float ratio = random.one_in(10) ? static_cast<float>(random.between(100, 200)) / 100.0f
                                          : static_cast<float>(random.between(20, 100)) / 100.0f;
    const int left = random.between(0, small_width - 1);
    const int right = random.between(left - 1, small_width - 1);
    const int top = random.between(0, small_height - 1);
    const int bottom = random.between(top - 1, small_height - 1);

    // Rows of any length: positions beyond one reach into the next.
    const int columns = static_cast<int>(static_cast<float>(small_width) / ratio) + 2;
    const int rows = static_cast<int>(static_cast<float>(small_height) / ratio) + 2;
    const int large_width = random.one_in(4) ? random.between(1, columns) : columns;
    const int large_height = rows + columns / large_width + 1;
    const pixels image = random_pixels(random, large_width, large_height);
    placed_pixels library_image(image);
    bytes model_large = random_foreign_mask(random, large_width, large_height);
    placed_bytes large(model_large);
    const int flag = random.one_in(6) ? random.any_of({2, -5, -1, -254, random.any_int()})
                                      : random.between(0, 1);
    ze_modify_mask(library_small.data(), large.data(), library_image.data(), small_width,
                   small_height, large_width, 0, ratio, left, right, top, bottom, flag);
    reference::ze_modify_mask(small, model_large, image, small_width, small_height, large_width, 0,
                              ratio, left, right, top, bottom, flag);
    found->compare_arrays("large mask", large, model_large);
}

// --- drawing into the view -----------------------------------------------------------------------

// A view, a photo with its mask, and a rectangle, for the library and for the model.
struct drawing {
    explicit drawing(random_source& random)
        : view_width(random.size_up_to(120)),
          view_height(random.size_up_to(80)),
          width(random.size_up_to(200)),
          height(random.size_up_to(200)),
          photo(random_photo(random, width, height)),
          library_pixels(photo),
          mask(random_foreign_mask(random, width, height)),
          view(static_cast<size_t>(view_width * view_height), 11),
          model_view(view.size(), 11),
          area{random.between(0, view_width - 1), random.between(0, view_width - 1),
               random.between(0, view_height - 1), random.between(0, view_height - 1)},
          scale(random_scale(random)),
          offset_x(random_offset(random, width)),
          offset_y(random_offset(random, height)),
          first(random.any_int()),
          second(random.any_int()) {
        if (random.one_in(2)) area = {0, view_width - 1, 0, view_height - 1};
    }

    view_pixels library_view() { return {view.data(), view_width}; }
    photo_pixels library_photo() const { return {library_pixels.data(), width, height}; }
    outlined_photo outlined() const { return {library_photo(), mask.data()}; }
    std::vector<int8_t> model_mask() const { return {mask.begin(), mask.end()}; }
    void compare(findings* found) const { found->compare_arrays("view", view, model_view); }

    int view_width, view_height;
    int width, height;
    std::vector<int> photo;
    placed_vector<int> library_pixels;
    placed_bytes mask;
    placed_vector<int32_t> view;
    std::vector<int32_t> model_view;
    ze_rect area;
    float scale;
    int offset_x, offset_y;
    int32_t first, second;
};

void run_image(random_source& random, findings* found) {
    drawing d(random);
    draw_image(d.library_view(), d.library_photo(), d.scale, d.offset_x, d.offset_y, d.area);
    reference::native_drawImage(d.model_view, d.view_width, d.view_height, d.photo, d.width,
                                d.height, d.scale, d.offset_x, d.offset_y, d.area.left,
                                d.area.right, d.area.top, d.area.bottom);
    d.compare(found);
}

void run_small_image(random_source& random, findings* found) {
    drawing d(random);
    draw_small_image(d.library_view(), d.library_photo(), d.area);
    reference::native_drawSmallImage(d.model_view, d.view_width, d.view_height, d.photo, d.width,
                                     d.height, d.area.left, d.area.right, d.area.top,
                                     d.area.bottom);
    d.compare(found);
}

void run_outline(random_source& random, findings* found) {
    drawing d(random);
    draw_image_with_outline(d.library_view(), d.outlined(), d.scale, d.offset_x, d.offset_y,
                            {d.first, d.second}, d.area);
    reference::native_drawImageWithMaskContour(
        d.model_view, d.view_width, d.view_height, d.photo, d.width, d.height, d.model_mask(),
        d.scale, d.offset_x, d.offset_y, d.first, d.second, d.area.left, d.area.right, d.area.top,
        d.area.bottom);
    d.compare(found);
}

void run_small_outline(random_source& random, findings* found) {
    drawing d(random);
    draw_small_image_with_outline(d.library_view(), d.outlined(), {d.first, d.second}, d.area);
    reference::native_drawSmallImageWithMaskContour(
        d.model_view, d.view_width, d.view_height, d.photo, d.width, d.height, d.model_mask(),
        d.first, d.second, d.area.left, d.area.right, d.area.top, d.area.bottom);
    d.compare(found);
}

void run_image_points(random_source& random, findings* found) {
    const int columns = random.between(-2, 60);
    const int rows = random.between(-2, 60);
    if (columns < 0 && rows > 0) return;  // the model takes no index before the array
    std::vector<int32_t> model_points(static_cast<size_t>(std::max(columns, 0) + std::max(rows, 0)),
                                      5);
    placed_vector<int32_t> points(model_points);
    const float scale = random_scale(random);
    const int offset_x = random_offset(random, 3000);
    const int offset_y = random_offset(random, 3000);
    set_image_points(columns, rows, scale, offset_x, offset_y, points.data());
    reference::native_setImagePoints(columns, rows, 0, 0, scale, offset_x, offset_y, model_points);
    found->compare_arrays("points", points, model_points);
}

}  // namespace

const std::vector<family> rendering_families = {
    {"grey", "ze_argb2gray", 400000, run_grey},
    {"with-mask", "ze_draw_withmask and its _v2", 160000, run_with_mask},
    {"reverse-mask", "ze_draw_reverse_mask", 160000, run_reverse_mask},
    {"reverse-mask-v2", "ze_draw_reverse_mask_v2", 160000, run_reverse_mask_v2},
    {"modify-mask", "ze_modify_mask", 80000, run_modify_mask},
    {"image", "photo into the view, scaled", 80000, run_image},
    {"small-image", "photo into the view, unscaled", 80000, run_small_image},
    {"image-points", "view positions in the photo", 1000000, run_image_points},
    {"outline", "photo and outline into the view, scaled", 80000, run_outline},
    {"small-outline", "photo and outline into the view, unscaled", 80000, run_small_outline},
};
