#include "jni/photo_columns.h"

#include <algorithm>
#include <cstring>

photo_columns::photo_columns(int32_t first, int32_t step_size, int n, int photo_width)
    : kernels(row_kernels_of_this_cpu()),
      step(step_size),
      count(n),
      last_column(clamp_to_photo(photo_width, photo_width)) {
    std::generate_n(columns, n, [this, position = first]() mutable {
        const int column = whole(position);
        position = wrap_add(position, step);
        return column;
    });
    inside = first_from(0);
    beyond = std::max(first_from(photo_width), inside);
}

int photo_columns::first_from(int column) const {
    return static_cast<int>(std::lower_bound(columns, columns + count, column) - columns);
}

void photo_columns::show(const int32_t* photo_row, int32_t* to) const { show_row(photo_row, to); }

void photo_columns::show(const uint8_t* mask_row, uint8_t* to) const { show_row(mask_row, to); }

template <class T>
void photo_columns::show_row(const T* row, T* to) const {
    std::fill(to, to + inside, row[0]);
    if (inside < beyond) show_inside(row, columns + inside, beyond - inside, to + inside);
    std::fill(to + beyond, to + count, row[last_column]);
}

void photo_columns::show_inside(const int32_t* row, const int32_t* shown, int n,
                                int32_t* to) const {
    if (step == ONE_PIXEL) {
        std::copy_n(row + shown[0], n, to);
    } else if (step == HALF_PIXEL) {
        const int alone =
            n > 1 && shown[0] != shown[1];  // of the first photo pixel the second half
        to[0] = row[shown[0]];
        kernels.double_pixels(row + shown[alone], to + alone, n - alone);
    } else {
        kernels.gather_pixels(row, shown, to, n);
    }
}

void photo_columns::show_inside(const uint8_t* row, const int32_t* shown, int n,
                                uint8_t* to) const {
    if (step == ONE_PIXEL) {
        std::copy_n(row + shown[0], n, to);
        return;
    }
    // A row of a mask is mostly long stretches of one value. To find that nothing is to be gathered
    // is cheaper than gathering, unless columns lie far apart.
    constexpr int STRETCH = 128;
    for (int i = 0; i < n; i += STRETCH) {
        const int shown_here = std::min(STRETCH, n - i);
        const uint8_t* const first = row + shown[i];
        const int others = shown[i + shown_here - 1] - shown[i];
        if (others <= 4 * STRETCH &&
            std::memcmp(first, first + 1, static_cast<size_t>(others)) == 0) {
            std::fill_n(to + i, shown_here, *first);
        } else {
            kernels.gather_bytes(row, shown + i, to + i, shown_here);
        }
    }
}

void show_unscaled(const int32_t* photo_row, int photo_width, int32_t* to, int64_t columns) {
    const int64_t last = clamp_to_photo(photo_width, photo_width);
    const int64_t before_last = std::min(columns, last);
    std::copy_n(photo_row, before_last, to);
    std::fill(to + before_last, to + columns, photo_row[last]);
}
