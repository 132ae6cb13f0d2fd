#include "tests/reference/mask_transfer_reference.h"

#include <algorithm>
#include <cstddef>
#include <cstdlib>

#include "tests/reference/arithmetic_reference.h"

namespace reference {
namespace {

struct colour {
    int64_t red;
    int64_t green;
    int64_t blue;
};

colour colour_of(uint32_t pixel) {
    return {pixel / 0x10000u % 256u, pixel / 0x100u % 256u, pixel % 256u};
}

colour average(const std::vector<colour>& samples) {
    colour sum = {0, 0, 0};
    for (const colour& sample : samples) {
        sum.red += sample.red;
        sum.green += sample.green;
        sum.blue += sample.blue;
    }
    const int64_t count = static_cast<int64_t>(samples.size());
    return {sum.red / count, sum.green / count, sum.blue / count};
}

bool matches(const colour& wanted, const colour& p) {
    const int64_t red_difference = (wanted.red - wanted.green) - (p.red - p.green);
    const int64_t blue_difference = (wanted.blue - wanted.green) - (p.blue - p.green);
    const int64_t distance = std::abs(red_difference) + std::abs(blue_difference);
    const int64_t green_difference = wanted.green - p.green;
    return distance <= 39 && green_difference >= -59 && green_difference <= 59;
}

// The large pixels under one small pixel: columns x0 to x1 - 1, rows y0 to y1 - 1.
struct block {
    int64_t x0;
    int64_t x1;
    int64_t y0;
    int64_t y1;
};

int64_t block_start(int64_t small_coordinate, float ratio) {
    const float start = static_cast<float>(small_coordinate) / ratio;
    return truncated(start);
}

block block_of(int64_t x, int64_t y, float ratio) {
    return {block_start(x, ratio), block_start(x + 1, ratio), block_start(y, ratio),
            block_start(y + 1, ratio)};
}

// A small pixel and its three neighbours to the right and below.
struct corner {
    int value;
    int right;
    int below;
    int diagonal;
};

// The photo, and the samples taken of it.
class sampler {
public:
    sampler(const std::vector<uint32_t>& pixels, int64_t width) : photo(pixels), row(width) {}

    void take(int64_t x, int64_t y) {
        samples.push_back(colour_of(photo.at(static_cast<size_t>(y * row + x))));
    }

    void take_columns(int64_t first, int64_t last, int64_t y) {
        for (int64_t x = first; x <= last; ++x) take(x, y);
    }

    void take_rows(int64_t x, int64_t first, int64_t last) {
        for (int64_t y = first; y <= last; ++y) take(x, y);
    }

    void take_repeatedly(int64_t x, int64_t y, int64_t times) {
        for (int64_t k = 1; k <= times; ++k) take(x, y);
    }

    std::vector<colour> samples;

private:
    const std::vector<uint32_t>& photo;
    const int64_t row;
};

colour colour_when_adding(const corner& c, const block& b, sampler photo) {
    if (c.value != 0) {
        photo.take(b.x0, b.y0);
        if (c.right != 0) photo.take_columns(b.x0 + 1, b.x1, b.y0);
        if (c.below != 0) photo.take_rows(b.x0, b.y0 + 1, b.y1);
        if (c.diagonal != 0) {
            photo.take_repeatedly(b.x1, b.y1, std::min(b.y1 - b.y0, b.x1 - b.x0));
        }
    }
    if (c.right != 0) {
        photo.take(b.x1, b.y0);
        if (c.diagonal != 0) photo.take_rows(b.x1, b.y0 + 1, b.y1);
    }
    if (c.below != 0) {
        photo.take(b.x0, b.y1);
        if (c.diagonal != 0) {
            photo.take_columns(b.x0 + 1, b.x1, b.y1);
            photo.take(b.x1, b.y1);
        }
    }
    if (c.below == 0 && c.diagonal != 0) photo.take(b.x1, b.y1);
    return average(photo.samples);
}

colour colour_when_removing(const corner& c, const block& b, sampler photo) {
    photo.take(b.x0, b.y0);
    if (c.right == c.value) photo.take_columns(b.x0 + 1, b.x1, b.y0);
    if (c.below == c.value) photo.take_rows(b.x0, b.y0 + 1, b.y1);
    if (c.diagonal == c.value) {
        photo.take_repeatedly(b.x1, b.y1, std::min(b.y1 - b.y0, b.x1 - b.x0));
    }
    return average(photo.samples);
}

}  // namespace

void ze_modify_mask(const std::vector<uint8_t>& small_mask, std::vector<uint8_t>& large_mask,
                    const std::vector<uint32_t>& large_pixels, int small_width, int small_height,
                    int large_width, int /*unread*/, float ratio, int left, int right, int top,
                    int bottom, int flag) {
    const auto small_at = [&](int64_t x, int64_t y) {
        return int{small_mask.at(static_cast<size_t>(y * small_width + x))};
    };
    const auto large_index = [&](int64_t x, int64_t y) {
        return static_cast<size_t>(y * large_width + x);
    };

    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const block b = block_of(x, y, ratio);
            const int s = small_at(x, y);

            const bool last = y + 1 >= small_height || x + 1 >= small_width;
            corner c = {s, s, s, s};
            if (!last) c = {s, small_at(x + 1, y), small_at(x, y + 1), small_at(x + 1, y + 1)};
            const bool uniform = c.right == s && c.below == s && c.diagonal == s;

            if (last || uniform) {
                if (last && int64_t{s} != int64_t{1} - flag) continue;
                for (int64_t by = b.y0; by < b.y1; ++by) {
                    for (int64_t bx = b.x0; bx < b.x1; ++bx) {
                        large_mask.at(large_index(bx, by)) = static_cast<uint8_t>(s);
                    }
                }
                continue;
            }

            const sampler photo(large_pixels, large_width);
            const colour wanted =
                flag == 0 ? colour_when_adding(c, b, photo) : colour_when_removing(c, b, photo);
            for (int64_t by = b.y0; by < b.y1; ++by) {
                for (int64_t bx = b.x0; bx < b.x1; ++bx) {
                    const size_t i = large_index(bx, by);
                    const bool match = matches(wanted, colour_of(large_pixels.at(i)));
                    if (flag == 0) {
                        if (match) large_mask.at(i) = 1;
                    } else if ((s == 1 && !match) || (s == 0 && match)) {
                        large_mask.at(i) = 0;
                    }
                }
            }
        }
    }
}

}  // namespace reference
