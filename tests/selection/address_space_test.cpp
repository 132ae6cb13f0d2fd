// Arrays of more bytes than a 32-bit process can count. On a 64-bit machine memory alone limits
// them.

#include <gtest/gtest.h>

#include <climits>
#include <cstddef>
#include <cstdint>

#include "selection/ER_selection.h"
#include "selection/brush_cells.h"
#include "selection/contour_tracer.h"
#include "selection/region_bits.h"
#include "tests/helpers/failing_allocations.h"

namespace {

constexpr bool HAS_32_BITS = PTRDIFF_MAX == INT32_MAX;

}  // namespace

TEST(marker_bytes, AreNoneBeyondWhatTheProcessCanCount) {
    EXPECT_EQ(marker_bytes(46338, 46339), 46340u * 46341u) << "less than 2^31";
    EXPECT_EQ(marker_bytes(46339, 46339), HAS_32_BITS ? 0 : size_t{46341} * 46341);
    EXPECT_EQ(marker_bytes(-1, -3), 0u) << "-1 byte";
    EXPECT_EQ(marker_bytes(50000, 50000), HAS_32_BITS ? 0 : size_t{50002} * 50002);
}

TEST(region_bits, AskForNoMoreBytesThanTheProcessCanCount) {
    const region_values selection = {value_set(1), value_set(), 1};
    unsigned char pixel = 1;
    failing_allocations out_of_memory(1);
    // 64 bytes a row.
    EXPECT_FALSE(region_bits(&pixel, 1, 1 << 26, {0, 0, 0, (1 << 26) - 1}, selection));
    EXPECT_EQ(out_of_memory.asked(), HAS_32_BITS ? 0 : 1);
}

TEST(region_bits, AskForNoMoreCellsThanAnIntCanCountAroundTheBox) {
    const region_values selection = {value_set(1), value_set(), 1};
    unsigned char pixel = 1;
    constexpr int MOST = INT_MAX - 2 * WORD_BITS;
    for (const int more : {0, 1}) {
        failing_allocations out_of_memory(1, failing_allocations::FROM_THEN_ON);
        const int n = MOST + more;
        EXPECT_FALSE(region_bits(&pixel, n, 1, {0, n - 1, 0, 0}, selection));
        EXPECT_FALSE(region_bits(&pixel, 1, n, {0, 0, 0, n - 1}, selection));
        EXPECT_EQ(out_of_memory.asked(), HAS_32_BITS || more ? 0 : 2);
    }
}

// On a 64-bit machine such a brush takes many gigabytes.
#if PTRDIFF_MAX == INT32_MAX
TEST(ER_selection_initial, AsksForNoArrayOfMoreBytesThanTheProcessCanCount) {
    ER_selection engine;
    failing_allocations counted(0);
    engine.initial(11586, 1);  // 537 million cells, each with a pointer
    EXPECT_FALSE(has_buffers(engine));
    EXPECT_EQ(counted.asked(), 3) << "queue, its index, map; no nodes of cells";
}
#endif
