// The photo columns that consecutive view columns show, worked out once for all rows of the view,
// and how rows of a photo are shown through them.
#pragma once

#include <cstdint>

#include "jni/view_geometry.h"
#include "render/row_kernels.h"

// View columns that are worked out together: as many as the view of a phone has, and few enough for
// what is known of them to stay in the processor's first cache.
constexpr int TILE = 2048;

// Whether rows of the view can be drawn one after another, each from one row of the photo: the view
// is not the photo, and the rectangle has columns and does not run over the end of a view row.
inline bool has_rows_of_its_own(const view_pixels& view, const photo_pixels& photo,
                                const ze_rect& area) {
    return view.pixels != photo.pixels && area.left <= area.right &&
           int64_t{area.right} - area.left < view.width;
}

// Whether `steps` steps from a 16.16 position neither fall nor leave its range.
inline bool rises(int64_t position, int32_t step, int64_t steps) {
    return step >= 0 && position >= INT32_MIN && position + steps * step <= INT32_MAX;
}

// Up to TILE consecutive view columns, with one more at each end where neighbours are needed.
//
// Since positions rise, the columns left of the photo come first and show its first column, then
// those inside, then those right of it, which show its last column.
class photo_columns {
public:
    // n columns from a 16.16 position on. REQUIRES: 0 <= n <= TILE + 2; rises(first, step_size, n).
    photo_columns(int32_t first, int32_t step_size, int n, int photo_width);

    // The photo's last column; 0 for a photo without columns.
    int last_of_photo() const { return last_column; }

    // The photo column of view column i, not clamped to the photo.
    int operator[](int i) const { return columns[i]; }

    // The first view column that shows photo column `column`, unclamped, or one beyond; or n.
    int first_from(int column) const;

    // to[i] = what view column i shows of a row of the photo, or of its mask.
    void show(const int32_t* photo_row, int32_t* to) const;
    void show(const uint8_t* mask_row, uint8_t* to) const;

private:
    template <class T>
    void show_row(const T* row, T* to) const;
    void show_inside(const int32_t* row, const int32_t* shown, int n, int32_t* to) const;
    void show_inside(const uint8_t* row, const int32_t* shown, int n, uint8_t* to) const;

    const row_kernels& kernels;
    const int32_t step;
    const int count;
    const int last_column;
    int inside;  // view columns inside .. beyond - 1 show columns of the photo unclamped
    int beyond;
    int32_t columns[TILE + 2];
};

// Writes a row of an unscaled photo from its column 0 on; behind the photo its last column goes on.
void show_unscaled(const int32_t* photo_row, int photo_width, int32_t* to, int64_t columns);
