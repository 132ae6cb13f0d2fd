#include "jni/view_image.h"

#include <algorithm>

#include "jni/photo_columns.h"
#include "jni/view_plain.h"

// view_plain.cpp says pixel by pixel what these draw. A view row depends on nothing but its photo
// row: a row that shows the same photo row as the one above is a copy of that. What photo column a
// view column shows is the same for every row.

void draw_image(const view_pixels& view, const photo_pixels& photo, float scale, int offset_x,
                int offset_y, const ze_rect& area) {
    const view_axis columns = axis_of(scale, offset_x);
    const view_axis rows = axis_of(scale, offset_y);
    if (!has_rows_of_its_own(view, photo, area) ||
        !rises(columns.at(area.left), columns.step, int64_t{area.right} - area.left)) {
        plain::draw_image(view, photo, scale, offset_x, offset_y, area);
        return;
    }
    for (int64_t left = area.left; left <= area.right; left += TILE) {
        const int n = static_cast<int>(std::min<int64_t>(TILE, area.right - left + 1));
        const photo_columns shown(columns.at(static_cast<int>(left)), columns.step, n, photo.width);
        const int32_t* above = nullptr;
        for (int64_t y = area.top; y <= area.bottom; ++y) {
            const int photo_y = clamp_to_photo(whole(rows.at(static_cast<int>(y))), photo.height);
            const int32_t* const from = photo.row(photo_y);
            int32_t* const to = view.row(y) + left;
            if (from == above) {
                std::copy_n(to - view.width, n, to);
            } else {
                shown.show(from, to);
            }
            above = from;
        }
    }
}

void draw_small_image(const view_pixels& view, const photo_pixels& photo, const ze_rect& area) {
    if (!has_rows_of_its_own(view, photo, area)) {
        plain::draw_small_image(view, photo, area);
        return;
    }
    const int64_t columns = int64_t{area.right} - area.left + 1;
    for (int64_t y = area.top; y <= area.bottom; ++y) {
        const int photo_y = clamp_to_photo(y - area.top, photo.height);
        show_unscaled(photo.row(photo_y), photo.width, view.row(y) + area.left, columns);
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
