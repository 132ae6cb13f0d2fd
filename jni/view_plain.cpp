#include "jni/view_plain.h"

namespace plain {

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

bool on_border(const photo_pixels& photo, int x, int y) {
    return x <= 0 || x + 1 >= photo.width || y <= 0 || y + 1 >= photo.height;
}

// The scaled view of a photo and its mask, drawn in runs of pixels of one view row.
class scaled_outline {
public:
    scaled_outline(const view_pixels& v, const outlined_photo& o, const view_axis& x_axis,
                   const view_axis& y_axis, const dash_colours& d)
        : view(v),
          photo(o.photo),
          mask(o.mask),
          mask_size(int64_t{o.photo.width} * o.photo.height),
          columns(x_axis),
          rows(y_axis),
          dashes(d) {}

    // Columns left .. right of row y, where every selected pixel is outline.
    void draw_edge(int y, int64_t left, int64_t right) const {
        draw_run(y, left, right, [](int, int32_t) { return true; });
    }

    // Columns left .. right of row y, where a selected pixel is outline beside an outside one.
    void draw_inner(int y, int64_t left, int64_t right) const {
        const int photo_y = clamp_to_photo(whole(rows.at(y)), photo.height);
        const int above = whole(wrap_sub(rows.at(y), rows.step));
        const int below = whole(wrap_add(rows.at(y), rows.step));
        draw_run(y, left, right, [&](int photo_x, int32_t position) {
            return !on_border(photo, photo_x, photo_y) &&
                   (is_outside(whole(wrap_add(position, columns.step)), photo_y) ||
                    is_outside(photo_x, below) ||
                    is_outside(whole(wrap_sub(position, columns.step)), photo_y) ||
                    is_outside(photo_x, above));
        });
    }

private:
    // Draws the photo, and the dash colour on selected pixels for which
    // is_outline(clamped photo column, 16.16 position) holds.
    template <class IsOutline>
    void draw_run(int y, int64_t left, int64_t right, IsOutline is_outline) const {
        if (left > right) return;
        const int64_t first =
            int64_t{clamp_to_photo(whole(rows.at(y)), photo.height)} * photo.width;
        int32_t* const to = view.row(y);
        int32_t position = columns.at(static_cast<int>(left));
        for (int64_t x = left; x <= right; ++x) {
            const int photo_x = clamp_to_photo(whole(position), photo.width);
            const int64_t i = first + photo_x;
            const bool selected = mask[i] == 1 || mask[i] == 3;
            to[x] = selected && is_outline(photo_x, position) ? dashes.at(static_cast<int>(x), y)
                                                              : photo.pixels[i];
            position = wrap_add(position, columns.step);
        }
    }

    bool is_outside(int x, int y) const {
        const int64_t i = int64_t{y} * photo.width + x;
        return i >= 0 && i < mask_size && (mask[i] == 0 || mask[i] == 4 || mask[i] == 5);
    }

    const view_pixels view;
    const photo_pixels photo;
    const uint8_t* const mask;
    const int64_t mask_size;
    const view_axis columns;
    const view_axis rows;
    const dash_colours dashes;
};

bool is_small_outline(const outlined_photo& outlined, int x, int y) {
    const photo_pixels& photo = outlined.photo;
    if (on_border(photo, x, y)) return true;
    const uint8_t* const m = outlined.mask + int64_t{y} * photo.width + x;
    return m[1] == 0 || m[photo.width] == 0 || m[-1] == 0 || m[-int64_t{photo.width}] == 0;
}

}  // namespace

void draw_image_with_outline(const view_pixels& view, const outlined_photo& outlined, float scale,
                             int offset_x, int offset_y, const dash_colours& dashes,
                             const ze_rect& area) {
    const scaled_outline outline(view, outlined, axis_of(scale, offset_x, HALF_PIXEL),
                                 axis_of(scale, offset_y, HALF_PIXEL), dashes);
    outline.draw_edge(area.top, area.left, area.right);
    for (int64_t row = int64_t{area.top} + 1; row < area.bottom; ++row) {
        const int y = static_cast<int>(row);
        outline.draw_edge(y, area.left, area.left);
        outline.draw_inner(y, int64_t{area.left} + 1, int64_t{area.right} - 1);
        outline.draw_edge(y, area.right, area.right);
    }
    outline.draw_edge(area.bottom, area.left, area.right);
}

void draw_small_image_with_outline(const view_pixels& view, const outlined_photo& outlined,
                                   const dash_colours& dashes, const ze_rect& area) {
    if (area.left > area.right) return;
    const photo_pixels& photo = outlined.photo;
    for (int64_t y = area.top; y <= area.bottom; ++y) {
        const int py = clamp_to_photo(y - area.top, photo.height);
        const int32_t* const from = photo.row(py);
        const uint8_t* const mask = outlined.mask + int64_t{py} * photo.width;
        int32_t* const to = view.row(y);
        for (int64_t x = area.left; x <= area.right; ++x) {
            const int px = clamp_to_photo(x - area.left, photo.width);
            to[x] = mask[px] == 1 && is_small_outline(outlined, px, py)
                        ? dashes.at(static_cast<int>(x), static_cast<int>(y))
                        : from[px];
        }
    }
}

}  // namespace plain
