#include "render/compositing_plain.h"

#include <cstddef>

#include "support/arithmetic.h"

namespace plain {

namespace {

uint32_t grey(uint32_t pixel) {
    const uint32_t sum = (pixel >> 16 & 0xFF) + (pixel >> 8 & 0xFF) + (pixel & 0xFF);
    return (pixel & 0xFF000000u) | sum / 3 * 0x010101u;
}

uint32_t colour_if(bool in_colour, uint32_t pixel) { return in_colour ? pixel : grey(pixel); }

unsigned char inverted(unsigned char value) { return value != 1; }

}  // namespace

void ze_argb2gray(uint32_t* src, int width, int height, uint32_t* dst) {
    const int64_t pixels = int64_t{width} * height;
    for (int64_t i = 0; i < pixels; ++i) dst[i] = grey(src[i]);
}

void ze_draw_withmask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width, int left,
                      int right, int top, int bottom) {
    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const int64_t i = y * width + x;
            dst[i] = colour_if(mask[i] == 1, src[i]);
        }
    }
}

void ze_draw_reverse_mask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width,
                          int height) {
    if (width < 1 || height < 1) return;
    const int64_t pixels = int64_t{width} * height;
    for (int64_t i = 0; i < pixels; ++i) {
        mask[i] = inverted(mask[i]);
        dst[i] = colour_if(mask[i] == 1, src[i]);
    }
}

void ze_draw_reverse_mask_v2(uint32_t* src, uint32_t* dst, unsigned char* mask, int, int width,
                             int height, int mask_width, int mask_height, float ratio) {
    const int64_t entries =
        mask_width > 0 && mask_height > 0 ? int64_t{mask_width} * mask_height : 0;
    for (int64_t i = 0; i < entries; ++i) mask[i] = inverted(mask[i]);

    for (int y = 0; y < height; ++y) {
        const int64_t mask_row =
            int64_t{saturating_truncate(static_cast<float>(y) * ratio)} * mask_width;
        for (int x = 0; x < width; ++x) {
            const int64_t entry = mask_row + saturating_truncate(static_cast<float>(x) * ratio);
            const bool selected = entry >= 0 && entry < entries && mask[entry] == 1;
            const int64_t i = int64_t{y} * width + x;
            dst[i] = colour_if(selected, src[i]);
        }
    }
}

}  // namespace plain
