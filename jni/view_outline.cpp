#include "jni/view_outline.h"

#include <algorithm>
#include <cstring>

#include "jni/photo_columns.h"
#include "jni/view_plain.h"
#include "render/row_kernels.h"

// view_plain.cpp says pixel by pixel what these draw. Here a view row is drawn without outline
// first; then flags are worked out for many of its pixels at once, and dashes drawn over those
// flagged, which are few.

namespace {

// A flag for each of up to TILE pixels, 1 or 0.
constexpr int FLAGS_READ_TOGETHER = 8;
using outline_flags = uint8_t[TILE + FLAGS_READ_TOGETHER];

// Draws dashes on the flagged ones of n pixels of view row y. `to` is the pixel of column x.
void draw_dashes(uint8_t* flags, int n, const dash_colours& dashes, int x, int y, int32_t* to) {
    std::fill_n(flags + n, FLAGS_READ_TOGETHER, uint8_t{0});
    for (int i = 0; i < n; i += FLAGS_READ_TOGETHER) {
        uint64_t any;
        static_assert(sizeof any == FLAGS_READ_TOGETHER);
        std::memcpy(&any, flags + i, sizeof any);
        if (any == 0) continue;
        for (int k = i; k < i + FLAGS_READ_TOGETHER; ++k) {
            if (flags[k] != 0) to[k] = dashes.at(x + k, y);
        }
    }
}

// What a scaled view is drawn from.
struct scaled_outline {
    view_pixels view;
    photo_pixels photo;
    const uint8_t* mask;
    view_axis columns;
    view_axis rows;
    dash_colours dashes;
    ze_rect area;

    int photo_row(int y) const { return clamp_to_photo(whole(rows.at(y)), photo.height); }

    // Mask rows from the photo's second to its last but one can be outline.
    bool can_be_outline(int photo_y) const { return photo_y > 0 && photo_y + 1 < photo.height; }

    bool is_in_photo(int photo_y) const { return photo_y >= 0 && photo_y < photo.height; }

    // Whether an entry of the mask, which may lie beyond it, is outside.
    bool is_outside(int64_t entry) const {
        const int64_t entries = int64_t{photo.width} * photo.height;
        return entry >= 0 && entry < entries &&
               (mask[entry] == 0 || mask[entry] == 4 || mask[entry] == 5);
    }
};

// A row of the mask as some view columns show it, and one more at each end: view column i of the
// tile is class i + 1.
struct class_row {
    int photo_y;
    uint8_t classes[TILE + 2];
};

// Up to TILE columns of a scaled view.
class outline_tile {
public:
    outline_tile(const scaled_outline& drawn, int left_column, int n)
        : d(drawn),
          kernels(row_kernels_of_this_cpu()),
          left(left_column),
          count(n),
          holds_left(left == d.area.left),
          holds_right(left + (count - 1) == d.area.right),
          shown(d.columns.at(left), d.columns.step, count, d.photo.width),
          looked_at(wrap_sub(d.columns.at(left), d.columns.step), d.columns.step, count + 2,
                    d.photo.width),
          first(std::max(looked_at.first_from(1), 1)),
          end(std::min(looked_at.first_from(looked_at.last_of_photo()), count + 1)) {}

    // Draws all rows. The photo is drawn one row ahead of the dashes, since a row without dashes
    // can be copied to the next.
    void draw() {
        class_row read[3];  // above, current and below, in turns
        int next = 1;
        show_row(d.area.top, d.photo_row(d.area.top), &read[0]);
        const class_row* current = &read[0];
        const class_row* above = current;
        for (int y = d.area.top; y < d.area.bottom; ++y) {
            const class_row* below = current;
            const int photo_y = d.photo_row(y + 1);
            if (photo_y == current->photo_y) {
                std::copy_n(row(y), count, row(int64_t{y} + 1));
            } else {
                show_row(y + 1, photo_y, &read[next]);
                below = &read[next];
                next = (next + 1) % 3;
            }
            if (y == d.area.top) {
                dash_selected(y, *current);
            } else {
                dash_outline(y, *above, *current, *below);
            }
            above = current;
            current = below;
        }
        dash_selected(d.area.bottom, *current);
    }

private:
    int32_t* row(int64_t y) const { return d.view.row(y) + left; }

    // Draws a row without dashes and reads what lies under it in the mask.
    void show_row(int y, int photo_y, class_row* read) const {
        shown.show(d.photo.row(photo_y), row(y));
        read->photo_y = photo_y;
        looked_at.show(d.mask + int64_t{photo_y} * d.photo.width, read->classes);
        kernels.classify(read->classes, read->classes, count + 2);
        if (first < end && d.can_be_outline(photo_y)) {
            look_beyond_photo(first - 1, read);
            look_beyond_photo(end, read);
        }
    }

    // Neighbours are not clamped to the photo as pixels are. That matters to those of the first and
    // the last pixel that can be outline.
    void look_beyond_photo(int i, class_row* read) const {
        const bool outside = d.is_outside(int64_t{read->photo_y} * d.photo.width + looked_at[i]);
        uint8_t& c = read->classes[i];
        c = static_cast<uint8_t>((c & OUTLINE_SELECTED) | (outside ? OUTLINE_OUTSIDE : 0));
    }

    void dash_selected(int y, const class_row& current) {
        for (int i = 0; i < count; ++i) dash_if_selected(i, y, current);
    }

    void dash_if_selected(int i, int y, const class_row& current) const {
        if (current.classes[i + 1] & OUTLINE_SELECTED) row(y)[i] = d.dashes.at(left + i, y);
    }

    void dash_outline(int y, const class_row& above, const class_row& current,
                      const class_row& below) {
        if (holds_left) dash_if_selected(0, y, current);
        if (holds_right) dash_if_selected(count - 1, y, current);
        if (first >= end || !d.can_be_outline(current.photo_y)) return;

        // A selected pixel is not outside, so a row in place of its own neighbour adds no outline.
        const int32_t position = d.rows.at(y);
        const bool has_above = d.is_in_photo(whole(wrap_sub(position, d.rows.step)));
        const bool has_below = d.is_in_photo(whole(wrap_add(position, d.rows.step)));
        const uint8_t* const c = current.classes + first;
        const rows_around around = {has_above ? above.classes + first : c,
                                    has_below ? below.classes + first : c, c - 1, c + 1};
        outline_flags flags;
        if (!kernels.outline(c, around, flags, end - first)) return;
        draw_dashes(flags, end - first, d.dashes, left + first - 1, y, row(y) + first - 1);
    }

    const scaled_outline& d;
    const row_kernels& kernels;
    const int left;
    const int count;
    const bool holds_left;  // the rectangle's first column, where all that is selected is dashed
    const bool holds_right;
    const photo_columns shown;
    const photo_columns looked_at;
    const int
        first;      // classes first .. end - 1 can be outline: they show neither the photo's first
    const int end;  // nor its last column, and are neither the rectangle's first nor last
};

}  // namespace

void draw_image_with_outline(const view_pixels& view, const outlined_photo& outlined, float scale,
                             int offset_x, int offset_y, const dash_colours& dashes,
                             const ze_rect& area) {
    const view_axis columns = axis_of(scale, offset_x, HALF_PIXEL);
    const view_axis rows = axis_of(scale, offset_y, HALF_PIXEL);
    const int64_t first_neighbour = int64_t{columns.at(area.left)} - columns.step;
    if (!has_rows_of_its_own(view, outlined.photo, area) || area.top > area.bottom ||
        !rises(first_neighbour, columns.step, int64_t{area.right} - area.left + 2)) {
        plain::draw_image_with_outline(view, outlined, scale, offset_x, offset_y, dashes, area);
        return;
    }
    const scaled_outline drawn = {view, outlined.photo, outlined.mask, columns, rows, dashes, area};
    for (int64_t left = area.left; left <= area.right; left += TILE) {
        const int n = static_cast<int>(std::min<int64_t>(TILE, area.right - left + 1));
        outline_tile(drawn, static_cast<int>(left), n).draw();
    }
}

namespace {

// Draws dashes on the selected pixels of a row of an unscaled photo for which no neighbour needs to
// be looked at: photo columns first .. on, of `columns` in all.
void dash_unscaled(const uint8_t* mask_row, int photo_width, int64_t first, int64_t columns,
                   const dash_colours& dashes, const ze_rect& area, int y, int32_t* to) {
    for (int64_t i = first; i < columns; ++i) {
        if (mask_row[clamp_to_photo(i, photo_width)] == 1) {
            to[i] = dashes.at(static_cast<int>(area.left + i), y);
        }
    }
}

}  // namespace

void draw_small_image_with_outline(const view_pixels& view, const outlined_photo& outlined,
                                   const dash_colours& dashes, const ze_rect& area) {
    const photo_pixels& photo = outlined.photo;
    if (!has_rows_of_its_own(view, photo, area)) {
        plain::draw_small_image_with_outline(view, outlined, dashes, area);
        return;
    }
    const row_kernels& kernels = row_kernels_of_this_cpu();
    const int64_t columns = int64_t{area.right} - area.left + 1;
    for (int64_t row = area.top; row <= area.bottom; ++row) {
        const int y = static_cast<int>(row);
        const int photo_y = clamp_to_photo(row - area.top, photo.height);
        const uint8_t* const mask = outlined.mask + int64_t{photo_y} * photo.width;
        int32_t* const to = view.row(row) + area.left;
        show_unscaled(photo.row(photo_y), photo.width, to, columns);
        if (photo_y == 0 || photo_y + 1 >= photo.height) {
            dash_unscaled(mask, photo.width, 0, columns, dashes, area, y, to);
            continue;
        }
        // Inner columns look at their neighbours; the photo's first and last need not.
        const int64_t end = std::min<int64_t>(columns, int64_t{photo.width} - 1);
        dash_unscaled(mask, photo.width, 0, 1, dashes, area, y, to);
        for (int64_t i = 1; i < end; i += TILE) {
            const int n = static_cast<int>(std::min<int64_t>(TILE, end - i));
            const uint8_t* const c = mask + i;
            outline_flags flags;
            if (kernels.small_outline(c, {c - photo.width, c + photo.width, c - 1, c + 1}, flags,
                                      n)) {
                draw_dashes(flags, n, dashes, static_cast<int>(area.left + i), y, to + i);
            }
        }
        dash_unscaled(mask, photo.width, std::max<int64_t>(end, 1), columns, dashes, area, y, to);
    }
}
