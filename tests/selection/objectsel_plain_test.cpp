// The fast mask scans of objectsel.h against their definition.
#include "selection/objectsel_plain.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <string>
#include <vector>

#include "selection/objectsel.h"
#include "tests/differential/random_source.h"
#include "tests/helpers/block_edges.h"
#include "tests/helpers/guarded_buffer.h"
#include "tests/helpers/rect_printing.h"

namespace {

using mask_scan = void (*)(unsigned char*, int, int);

// A mask that is selected nowhere, in few places, or nearly everywhere; with other values too.
std::vector<unsigned char> random_mask(random_source& random, int width, int height) {
    std::vector<unsigned char> mask(static_cast<size_t>(width * height));
    const int rare = random.any_of({2, 30, 1000, 100000});
    const auto common = static_cast<unsigned char>(random.any_of({0, 1, 2, 255}));
    for (unsigned char& value : mask) {
        value = random.one_in(rare) ? static_cast<unsigned char>(random.between(0, 2)) : common;
    }
    return mask;
}

// The object box and the mask after a fast scan and after the plain one.
void compare(mask_scan fast, mask_scan plain, const std::vector<unsigned char>& mask, int width,
             int height, const ze_rect& box) {
    SCOPED_TRACE(std::to_string(width) + " x " + std::to_string(height) + ", box " +
                 testing::PrintToString(box));
    std::vector<unsigned char> plain_mask = mask;
    g_object_boundary = box;
    plain(plain_mask.data(), width, height);
    const ze_rect plain_box = g_object_boundary;
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<unsigned char> fast_mask(mask, side);
        g_object_boundary = box;
        fast(fast_mask.data(), width, height);
        ASSERT_EQ(g_object_boundary, plain_box);
        ASSERT_EQ(fast_mask.values(), plain_mask);
    }
}

}  // namespace

TEST(objectsel_plain, EqualsTheFastInversion) {
    random_source random(1);
    for (int i = 0; i < 300 && !HasFailure(); ++i) {
        const int width = random.size_up_to(400), height = random.size_up_to(30);
        compare(ze_inverse_mask, plain::ze_inverse_mask, random_mask(random, width, height), width,
                height, {5, 6, 7, 8});
    }
}

TEST(objectsel_plain, EqualsTheFastInversionOfNothing) {
    for (const int width : {0, -1, 5, INT_MIN}) {
        for (const int height : {0, -3, INT_MIN}) {
            compare(ze_inverse_mask, plain::ze_inverse_mask, {9}, width, height, {5, 6, 7, 8});
            compare(ze_inverse_mask, plain::ze_inverse_mask, {9}, height, width, {5, 6, 7, 8});
        }
    }
}

TEST(objectsel_plain, EqualsTheFastObjectBox) {
    random_source random(2);
    const auto side = [&](int size) {
        return random.one_in(10) ? random.any_of({INT_MIN, INT_MAX, -1, size})
                                 : random.between(-2, size + 1);
    };
    for (int i = 0; i < 600 && !HasFailure(); ++i) {
        const int width = random.size_up_to(400), height = random.size_up_to(30);
        ze_rect box = {side(width), side(width), side(height), side(height)};
        if (random.one_in(2)) box = {0, width - 1, 0, height - 1};
        compare(ze_update_objectROI, plain::ze_update_objectROI, random_mask(random, width, height),
                width, height, box);
    }
}

TEST(objectsel_plain, EqualsTheFastObjectBoxOfNothing) {
    for (const int width : {0, -1, 1, INT_MIN}) {
        for (const int height : {0, -3, 1, INT_MIN}) {
            compare(ze_update_objectROI, plain::ze_update_objectROI, {1}, width, height,
                    {INT_MIN, INT_MAX, INT_MIN, INT_MAX});
            compare(ze_update_objectROI, plain::ze_update_objectROI, {1}, width, height,
                    {INT_MAX, INT_MIN, INT_MAX, INT_MIN});
        }
    }
}

TEST(objectsel_plain, BoxesASinglePixelInEveryColumn) {
    constexpr int HEIGHT = 3;
    for (const int width : LENGTHS_AROUND_BLOCKS) {
        for (const int x : places_in(width)) {
            const int y = x % HEIGHT;
            const size_t pixel = static_cast<size_t>(y * width + x);
            for (const unsigned char others : {0, 2, 255}) {
                guarded_buffer<unsigned char> mask(
                    std::vector<unsigned char>(static_cast<size_t>(width * HEIGHT), others),
                    guard::BEHIND);
                mask.data()[pixel] = 1;
                g_object_boundary = {0, width - 1, 0, HEIGHT - 1};
                ze_update_objectROI(mask.data(), width, HEIGHT);
                ASSERT_EQ(g_object_boundary, (ze_rect{x, x, y, y})) << "of " << width;
            }
            guarded_buffer<unsigned char> inverted(
                std::vector<unsigned char>(static_cast<size_t>(width * HEIGHT), 1), guard::BEHIND);
            inverted.data()[pixel] = 0;
            ze_inverse_mask(inverted.data(), width, HEIGHT);
            ASSERT_EQ(g_object_boundary, (ze_rect{x, x, y, y})) << "inverted, of " << width;
        }
    }
}

// Of rows between, only what lies left and right of all that has been found is read.
TEST(objectsel_plain, BoxesOnePixelInEachOfThreeRows) {
    constexpr int WIDTH = 193;
    const std::vector<int> columns = {0, 1, 62, 63, 64, 65, 126, 127, 128, 129, 190, 191, 192};
    for (const int first : columns) {
        for (const int second : columns) {
            for (const int third : columns) {
                std::vector<unsigned char> mask(3 * WIDTH, 0);
                for (const int i : {first, WIDTH + second, 2 * WIDTH + third}) {
                    mask[static_cast<size_t>(i)] = 1;
                }
                const auto [left, right] = std::minmax({first, second, third});
                g_object_boundary = {0, WIDTH - 1, 0, 2};
                ze_update_objectROI(mask.data(), WIDTH, 3);
                ASSERT_EQ(g_object_boundary, (ze_rect{left, right, 0, 2}))
                    << first << ", " << second << ", " << third;
            }
        }
    }
}
