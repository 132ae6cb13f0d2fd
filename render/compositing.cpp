#include "render/compositing.h"

#include <algorithm>
#include <cstddef>

#include "render/row_kernels.h"
#include "support/arithmetic.h"

// compositing_plain.cpp says pixel by pixel what these draw. Pixels depend on nothing but the
// source and the mask in their own places, so whole rows of them, and rows that follow one another
// without a gap, are left to row kernels.

void ze_argb2gray(uint32_t* src, int width, int height, uint32_t* dst) {
    const int64_t pixels = int64_t{width} * height;
    if (pixels < 1) return;
    row_kernels_of_this_cpu().grey(src, dst, static_cast<ptrdiff_t>(pixels));
}

void ze_draw_withmask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width, int left,
                      int right, int top, int bottom) {
    if (left > right) return;
    const row_kernels& kernels = row_kernels_of_this_cpu();
    const int64_t columns = int64_t{right} - left + 1, rows = int64_t{bottom} - top + 1;
    // Rows of the image's width go on where the row above ends.
    const int64_t joined = columns == width ? std::max<int64_t>(rows, 1) : 1;
    for (int64_t y = top; y <= bottom; y += joined) {
        const int64_t i = y * width + left;
        kernels.colour_selection(src + i, mask + i, dst + i,
                                 static_cast<ptrdiff_t>(columns * joined));
    }
}

void ze_draw_withmask_v2(uint32_t* src, uint32_t* dst, unsigned char* mask, int width, int left,
                         int right, int top, int bottom) {
    ze_draw_withmask(src, dst, mask, width, left, right, top, bottom);
}

void ze_draw_reverse_mask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width,
                          int height) {
    if (width < 1 || height < 1) return;
    row_kernels_of_this_cpu().invert_and_colour(src, mask, dst, ptrdiff_t{width} * height);
}

namespace {

constexpr int TILE = 2048;  // columns of an image whose lookups are worked out together

// Writes what columns look up in a row of a mask of that many entries; the row starts at an entry.
void look_up(const unsigned char* mask, int64_t entries, int64_t row, const int32_t* columns, int n,
             unsigned char* found) {
    for (int x = 0; x < n; ++x) {
        const int64_t entry = row + columns[x];
        found[x] = entry >= 0 && entry < entries ? mask[entry] : 0;
    }
}

}  // namespace

// What mask column an image column looks up is the same for every row, and an image larger than its
// mask has several rows that look up the same.
void ze_draw_reverse_mask_v2(uint32_t* src, uint32_t* dst, unsigned char* mask, int, int width,
                             int height, int mask_width, int mask_height, float ratio) {
    const row_kernels& kernels = row_kernels_of_this_cpu();
    const int64_t entries =
        mask_width > 0 && mask_height > 0 ? int64_t{mask_width} * mask_height : 0;
    kernels.invert(mask, static_cast<ptrdiff_t>(entries));

    for (int64_t left = 0; left < width; left += TILE) {
        const int n = static_cast<int>(std::min<int64_t>(TILE, width - left));
        int32_t columns[TILE];
        for (int x = 0; x < n; ++x) {
            columns[x] = saturating_truncate(static_cast<float>(left + x) * ratio);
        }
        unsigned char found[TILE];
        int64_t row_found = INT64_MIN;  // of no mask
        for (int y = 0; y < height; ++y) {
            const int64_t row =
                int64_t{saturating_truncate(static_cast<float>(y) * ratio)} * mask_width;
            if (row != row_found) look_up(mask, entries, row, columns, n, found);
            row_found = row;
            const int64_t i = int64_t{y} * width + left;
            kernels.colour_selection(src + i, found, dst + i, n);
        }
    }
}
