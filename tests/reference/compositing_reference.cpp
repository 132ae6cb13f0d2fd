#include "tests/reference/compositing_reference.h"

#include <cstddef>

#include "tests/reference/arithmetic_reference.h"

namespace reference {
namespace {

// Row-major index of (x, y) where rows are `width` apart. Converted to the unsigned index type of
// a vector, a negative index is beyond every vector's end, so at() refuses it.
size_t index_of(int64_t x, int64_t y, int64_t width) { return static_cast<size_t>(y * width + x); }

uint32_t grey(uint32_t pixel) {
    const uint32_t alpha = pixel / 0x1000000u % 256u;
    const uint32_t red = pixel / 0x10000u % 256u;
    const uint32_t green = pixel / 0x100u % 256u;
    const uint32_t blue = pixel % 256u;
    const uint32_t mean = (red + green + blue) / 3u;
    return alpha * 0x1000000u + mean * 0x10000u + mean * 0x100u + mean;
}

}  // namespace

void ze_argb2gray(const std::vector<uint32_t>& src, int width, int height,
                  std::vector<uint32_t>& dst) {
    const int64_t count = int64_t{width} * height;
    for (int64_t i = 0; i < count; ++i) {
        dst.at(static_cast<size_t>(i)) = grey(src.at(static_cast<size_t>(i)));
    }
}

void ze_draw_withmask(const std::vector<uint32_t>& src, std::vector<uint32_t>& dst,
                      const std::vector<uint8_t>& mask, int width, int left, int right, int top,
                      int bottom) {
    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const size_t i = index_of(x, y, width);
            const uint32_t pixel = src.at(i);
            dst.at(i) = mask.at(i) == 1 ? pixel : grey(pixel);
        }
    }
}

void ze_draw_reverse_mask(const std::vector<uint32_t>& src, std::vector<uint32_t>& dst,
                          std::vector<uint8_t>& mask, int width, int height) {
    for (int64_t y = 0; y < height; ++y) {
        for (int64_t x = 0; x < width; ++x) {
            const size_t i = index_of(x, y, width);
            const uint32_t pixel = src.at(i);
            const bool selected = mask.at(i) == 1;
            mask.at(i) = selected ? 0 : 1;
            dst.at(i) = selected ? grey(pixel) : pixel;
        }
    }
}

void ze_draw_reverse_mask_v2(const std::vector<uint32_t>& src, std::vector<uint32_t>& dst,
                             std::vector<uint8_t>& mask, int /*unread*/, int width, int height,
                             int mask_width, int mask_height, float ratio) {
    int64_t mask_size = 0;
    for (int64_t my = 0; my < mask_height; ++my) {
        for (int64_t mx = 0; mx < mask_width; ++mx) {
            uint8_t& entry = mask.at(index_of(mx, my, mask_width));
            entry = entry == 1 ? 0 : 1;
            ++mask_size;
        }
    }

    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const float scaled_y = static_cast<float>(y) * ratio;
            const float scaled_x = static_cast<float>(x) * ratio;
            const int64_t entry = int64_t{truncated(scaled_y)} * mask_width + truncated(scaled_x);
            const bool selected =
                entry >= 0 && entry < mask_size && mask.at(static_cast<size_t>(entry)) == 1;

            const size_t i = index_of(x, y, width);
            const uint32_t pixel = src.at(i);
            dst.at(i) = selected ? pixel : grey(pixel);
        }
    }
}

}  // namespace reference
