#include "jni/view_image.h"

void draw_image(const view_pixels& view, const photo_pixels& photo, float scale, int offset_x,
                int offset_y, const ze_rect& area) {
    if (area.left > area.right) return;
    const view_axis columns = axis_of(scale, offset_x);
    const view_axis rows = axis_of(scale, offset_y);
    int32_t row_position = rows.at(area.top);
    for (int64_t y = area.top; y <= area.bottom; ++y) {
        const int32_t* const from = photo.row(clamp_to_photo(whole(row_position), photo.height));
        int32_t* const to = view.row(y);
        int32_t position = columns.at(area.left);
        for (int64_t x = area.left; x <= area.right; ++x) {
            to[x] = from[clamp_to_photo(whole(position), photo.width)];
            position = wrap_add(position, columns.step);
        }
        row_position = wrap_add(row_position, rows.step);
    }
}

void draw_small_image(const view_pixels& view, const photo_pixels& photo, const ze_rect& area) {
    if (area.left > area.right) return;
    for (int64_t y = area.top; y <= area.bottom; ++y) {
        const int32_t* const from = photo.row(clamp_to_photo(y - area.top, photo.height));
        int32_t* const to = view.row(y);
        for (int64_t x = area.left; x <= area.right; ++x) {
            to[x] = from[clamp_to_photo(x - area.left, photo.width)];
        }
    }
}

namespace {

// Writes the photo positions of view positions 0 .. count - 1 to points[first] and on.
void set_axis_points(const view_axis& axis, int count, int64_t first, int32_t* points) {
    for (int64_t i = std::max(-first, int64_t{0}); i < count; ++i) {
        points[first + i] = whole(axis.at(static_cast<int>(i)));
    }
}

}  // namespace

void set_image_points(int columns, int rows, float scale, int offset_x, int offset_y,
                      int32_t* points) {
    set_axis_points(axis_of(scale, offset_x), columns, 0, points);
    set_axis_points(axis_of(scale, offset_y), rows, columns, points);
}
