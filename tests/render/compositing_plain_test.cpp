// The fast functions of compositing.h against their definition.
#include "render/compositing_plain.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "render/compositing.h"
#include "tests/differential/random_source.h"
#include "tests/helpers/block_edges.h"
#include "tests/helpers/guarded_buffer.h"

namespace {

constexpr float INFINITE = std::numeric_limits<float>::infinity();

// A photo, a destination and a mask for the fast function, and the same for the plain one.
struct picture {
    picture(random_source& random, int width, int height, int mask_width, int mask_height)
        : src(static_cast<size_t>(width * height)),
          dst(src.size(), 7),
          mask(static_cast<size_t>(mask_width * mask_height)) {
        for (uint32_t& pixel : src) pixel = static_cast<uint32_t>(random.any_int());
        for (unsigned char& value : mask) {
            value = static_cast<unsigned char>(random.one_in(5) ? random.between(0, 255)
                                                                : random.between(0, 1));
        }
    }

    // Runs draw(src, dst, mask) fast and plain, into another array and in place.
    template <class Fast, class Plain>
    void compare(Fast fast, Plain plain) {
        for (const bool in_place : {false, true}) {
            SCOPED_TRACE(in_place ? "in place" : "into another array");
            guarded_buffer<uint32_t> fast_src(src, guard::BEHIND), fast_dst(dst, guard::BEHIND);
            guarded_buffer<unsigned char> fast_mask(mask, guard::BEHIND);
            std::vector<uint32_t> plain_src = src, plain_dst = dst;
            std::vector<unsigned char> plain_mask = mask;
            fast(fast_src.data(), in_place ? fast_src.data() : fast_dst.data(), fast_mask.data());
            plain(plain_src.data(), in_place ? plain_src.data() : plain_dst.data(),
                  plain_mask.data());
            ASSERT_EQ(fast_src.values(), plain_src);
            ASSERT_EQ(fast_dst.values(), plain_dst);
            ASSERT_EQ(fast_mask.values(), plain_mask);
        }
    }

    std::vector<uint32_t> src, dst;
    std::vector<unsigned char> mask;
};

std::string size_text(int width, int height) {
    return std::to_string(width) + " x " + std::to_string(height);
}

}  // namespace

TEST(compositing_plain, EqualsTheFastGreyAndReverse) {
    random_source random(1);
    for (int i = 0; i < 200 && !HasFailure(); ++i) {
        const int width = random.size_up_to(70), height = random.size_up_to(30);
        SCOPED_TRACE(size_text(width, height));
        picture p(random, width, height, width, height);
        p.compare([&](auto src, auto dst, auto) { ze_argb2gray(src, width, height, dst); },
                  [&](auto src, auto dst, auto) { plain::ze_argb2gray(src, width, height, dst); });
        p.compare([&](auto src, auto dst,
                      auto mask) { ze_draw_reverse_mask(src, dst, mask, width, height); },
                  [&](auto src, auto dst, auto mask) {
                      plain::ze_draw_reverse_mask(src, dst, mask, width, height);
                  });
    }
}

TEST(compositing_plain, EqualsTheFastReverseOfNothing) {
    random_source random(4);
    for (const auto& [width, height] : {std::pair(0, 3), {3, 0}, {-3, 3}, {3, -3}, {-3, -3}}) {
        SCOPED_TRACE(size_text(width, height));
        picture p(random, 3, 3, 3, 3);
        p.compare(
            [&, w = width, h = height](auto src, auto dst, auto mask) {
                ze_draw_reverse_mask(src, dst, mask, w, h);
            },
            [&, w = width, h = height](auto src, auto dst, auto mask) {
                plain::ze_draw_reverse_mask(src, dst, mask, w, h);
            });
    }
}

TEST(compositing_plain, EqualsTheFastSelectionInARectangle) {
    random_source random(2);
    for (int i = 0; i < 300 && !HasFailure(); ++i) {
        const int width = random.size_up_to(70), height = random.size_up_to(30);
        const int left = random.between(0, width - 1), right = random.between(0, width - 1);
        const int top = random.between(0, height - 1), bottom = random.between(0, height - 1);
        SCOPED_TRACE(size_text(width, height) + ", columns " + size_text(left, right) + ", rows " +
                     size_text(top, bottom));
        picture p(random, width, height, width, height);
        p.compare(
            [&](auto src, auto dst, auto mask) {
                ze_draw_withmask(src, dst, mask, width, left, right, top, bottom);
            },
            [&](auto src, auto dst, auto mask) {
                plain::ze_draw_withmask(src, dst, mask, width, left, right, top, bottom);
            });
    }
}

TEST(compositing_plain, EqualsTheFastLookupInAScaledMask) {
    random_source random(3);
    for (int i = 0; i < 300 && !HasFailure(); ++i) {
        const bool wide = random.one_in(10);  // than what is looked up together
        const int width = wide ? random.between(2040, 4100) : random.size_up_to(70);
        const int height = wide ? random.between(1, 4) : random.size_up_to(30);
        const int mask_width = random.between(0, 40), mask_height = random.between(0, 30);
        const float ratio =
            random.one_in(3)
                ? random.any_of({0.0f, 0.25f, 1.0f, -0.5f, 1e9f, -1e9f, INFINITE, -INFINITE, NAN})
                : static_cast<float>(random.between(1, 2000)) / 1000.0f;
        SCOPED_TRACE(size_text(width, height) + ", mask " + size_text(mask_width, mask_height) +
                     ", ratio " + std::to_string(ratio));
        picture p(random, width, height, mask_width, mask_height);
        p.compare(
            [&](auto src, auto dst, auto mask) {
                ze_draw_reverse_mask_v2(src, dst, mask, 0, width, height, mask_width, mask_height,
                                        ratio);
            },
            [&](auto src, auto dst, auto mask) {
                plain::ze_draw_reverse_mask_v2(src, dst, mask, 0, width, height, mask_width,
                                               mask_height, ratio);
            });
    }
}

TEST(compositing_plain, EqualsTheFastDrawingOfASinglePixelInEveryColumn) {
    constexpr int HEIGHT = 2;
    random_source random(5);
    for (const int width : LENGTHS_AROUND_BLOCKS) {
        picture p(random, width, HEIGHT, width, HEIGHT);
        for (const int x : places_in(width)) {
            SCOPED_TRACE("column " + std::to_string(x) + " of " + std::to_string(width));
            for (const unsigned char value : {0, 1}) {
                p.mask.assign(p.mask.size(), static_cast<unsigned char>(1 - value));
                p.mask[static_cast<size_t>(x + width)] = value;
                p.compare([&](auto src, auto dst,
                              auto mask) { ze_draw_reverse_mask(src, dst, mask, width, HEIGHT); },
                          [&](auto src, auto dst, auto mask) {
                              plain::ze_draw_reverse_mask(src, dst, mask, width, HEIGHT);
                          });
                for (const int left : {0, x / 2}) {
                    p.compare(
                        [&](auto src, auto dst, auto mask) {
                            ze_draw_withmask(src, dst, mask, width, left, width - 1, 0, 1);
                        },
                        [&](auto src, auto dst, auto mask) {
                            plain::ze_draw_withmask(src, dst, mask, width, left, width - 1, 0, 1);
                        });
                }
                p.compare(
                    [&](auto src, auto dst, auto mask) {
                        ze_draw_reverse_mask_v2(src, dst, mask, 0, width, HEIGHT, width, HEIGHT, 1);
                    },
                    [&](auto src, auto dst, auto mask) {
                        plain::ze_draw_reverse_mask_v2(src, dst, mask, 0, width, HEIGHT, width,
                                                       HEIGHT, 1);
                    });
                if (HasFatalFailure()) return;
            }
        }
    }
}
