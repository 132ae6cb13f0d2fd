// The fast mask scans of objectsel.h against their definition.
#include "selection/objectsel_plain.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <vector>

#include "selection/objectsel.h"
#include "tests/differential/random_source.h"
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
