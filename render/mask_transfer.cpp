#include "render/mask_transfer.h"

#include <algorithm>
#include <cstddef>
#include <cstdlib>

#include "support/arithmetic.h"

namespace {

struct colour {
    int red, green, blue;
};

colour channels(uint32_t pixel) {
    return {static_cast<int>(pixel >> 16 & 0xFF), static_cast<int>(pixel >> 8 & 0xFF),
            static_cast<int>(pixel & 0xFF)};
}

// The average of sampled pixels.
class reference_colour {
public:
    reference_colour(const uint32_t* photo, int photo_width) : image(photo), width(photo_width) {}

    void sample(int64_t x, int64_t y, int64_t times = 1) {
        const colour c = channels(image[y * width + x]);
        red += c.red * times;
        green += c.green * times;
        blue += c.blue * times;
        count += times;
    }

    // first_x .. last_x of row y.
    void sample_row(int64_t first_x, int64_t last_x, int64_t y) {
        for (int64_t x = first_x; x <= last_x; ++x) sample(x, y);
    }

    // first_y .. last_y of column x.
    void sample_column(int64_t x, int64_t first_y, int64_t last_y) {
        for (int64_t y = first_y; y <= last_y; ++y) sample(x, y);
    }

    // REQUIRES: a sample was taken. Every edge block takes one: some neighbour differs from it.
    colour average() const {
        const auto mean = [this](int64_t sum) {
            return static_cast<int>(sum / count);  // NOLINT(clang-analyzer-core.DivideZero)
        };
        return {mean(red), mean(green), mean(blue)};
    }

private:
    const uint32_t* image;
    int width;
    int64_t red = 0, green = 0, blue = 0, count = 0;
};

bool matches(const colour& average, uint32_t pixel) {
    constexpr int FARTHEST_CHROMA = 39;
    constexpr int FARTHEST_GREEN = 59;
    const colour c = channels(pixel);
    const int chroma = std::abs((average.red - average.green) - (c.red - c.green)) +
                       std::abs((average.blue - average.green) - (c.blue - c.green));
    return chroma <= FARTHEST_CHROMA && std::abs(average.green - c.green) <= FARTHEST_GREEN;
}

// Large pixels of a small one: columns left .. next_left - 1, rows top .. next_top - 1. next_left
// and next_top belong to the next blocks.
struct block {
    int64_t left, next_left, top, next_top;

    // Pixels on the way down the shorter side.
    int64_t diagonal() const { return std::min(next_top - top, next_left - left); }
};

// The values around a small pixel that lies on the selection's edge.
struct edge {
    unsigned char self, right, below, diagonal;
};

// Samples the block's own pixels towards the neighbours that count. Deliberate: in place of a walk
// along the diagonal, the one pixel at its end is sampled as often as the walk has steps.
void sample_block(reference_colour* reference, const block& b, bool right, bool below,
                  bool diagonal) {
    reference->sample(b.left, b.top);
    if (right) reference->sample_row(b.left + 1, b.next_left, b.top);
    if (below) reference->sample_column(b.left, b.top + 1, b.next_top);
    if (diagonal && b.diagonal() > 0) reference->sample(b.next_left, b.next_top, b.diagonal());
}

// Samples the first pixels of the neighbours that are not 0. Deliberate: with the lower and the
// diagonal neighbour, the diagonal pixel counts twice.
void sample_neighbours(reference_colour* reference, const block& b, const edge& e) {
    const bool diagonal = e.diagonal != 0;
    if (e.right != 0) {
        reference->sample(b.next_left, b.top);
        if (diagonal) reference->sample_column(b.next_left, b.top + 1, b.next_top);
    }
    if (e.below != 0) {
        reference->sample(b.left, b.next_top);
        if (diagonal) {
            reference->sample_row(b.left + 1, b.next_left, b.next_top);
            reference->sample(b.next_left, b.next_top);
        }
    } else if (diagonal) {
        reference->sample(b.next_left, b.next_top);
    }
}

// The large mask with the photo under it.
struct large_picture {
    unsigned char* mask;
    const uint32_t* image;
    int width;

    // Calls visit(mask entry, pixel) for every large pixel of b.
    template <class Visit>
    void for_each(const block& b, Visit visit) const {
        for (int64_t y = b.top; y < b.next_top; ++y) {
            for (int64_t x = b.left; x < b.next_left; ++x) {
                visit(&mask[y * width + x], image[y * width + x]);
            }
        }
    }

    void set_all(const block& b, unsigned char value) const {
        for_each(b, [value](unsigned char* entry, uint32_t) { *entry = value; });
    }

    void add_matching(const block& b, const edge& e) const {
        reference_colour reference(image, width);
        if (e.self != 0) sample_block(&reference, b, e.right != 0, e.below != 0, e.diagonal != 0);
        sample_neighbours(&reference, b, e);
        const colour average = reference.average();
        for_each(b, [&average](unsigned char* entry, uint32_t pixel) {
            if (matches(average, pixel)) *entry = 1;
        });
    }

    void remove_by_match(const block& b, const edge& e) const {
        if (e.self > 1) return;
        reference_colour reference(image, width);
        sample_block(&reference, b, e.right == e.self, e.below == e.self, e.diagonal == e.self);
        const colour average = reference.average();
        const bool removes_matching = e.self == 0;
        for_each(b, [&](unsigned char* entry, uint32_t pixel) {
            if (matches(average, pixel) == removes_matching) *entry = 0;
        });
    }
};

}  // namespace

void ze_modify_mask(unsigned char* small_mask, unsigned char* large_mask, uint32_t* large_image,
                    int small_width, int small_height, int large_width, int, float ratio, int left,
                    int right, int top, int bottom, int flag) {
    if (!(ratio > 0)) return;
    const large_picture large = {large_mask, large_image, large_width};
    const int copied_at_end = wrap_sub(1, flag);
    const auto block_start = [ratio](int64_t small) {
        return saturating_truncate(static_cast<float>(small) / ratio);
    };
    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const block b = {block_start(x), block_start(x + 1), block_start(y),
                             block_start(y + 1)};
            const unsigned char* const small = &small_mask[y * small_width + x];
            if (y + 1 >= small_height || x + 1 >= small_width) {
                if (*small == copied_at_end) large.set_all(b, *small);
                continue;
            }
            const edge e = {small[0], small[1], small[small_width], small[small_width + 1]};
            if (e.right == e.self && e.below == e.self && e.diagonal == e.self) {
                large.set_all(b, e.self);
            } else if (flag == 0) {
                large.add_matching(b, e);
            } else {
                large.remove_by_match(b, e);
            }
        }
    }
}
