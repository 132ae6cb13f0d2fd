#include "support/arithmetic.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>

TEST(wrap_add, GoesRoundAtBothEnds) {
    EXPECT_EQ(wrap_add(40, 2), 42);
    EXPECT_EQ(wrap_add(INT_MAX, 1), INT_MIN);
    EXPECT_EQ(wrap_add(INT_MIN, -1), INT_MAX);
    EXPECT_EQ(wrap_add(INT_MIN, INT_MIN), 0);
    EXPECT_EQ(wrap_add(INT_MAX, INT_MAX), -2);
}

TEST(wrap_sub, GoesRoundAtBothEnds) {
    EXPECT_EQ(wrap_sub(40, -2), 42);
    EXPECT_EQ(wrap_sub(INT_MIN, 1), INT_MAX);
    EXPECT_EQ(wrap_sub(INT_MAX, -1), INT_MIN);
    EXPECT_EQ(wrap_sub(0, INT_MIN), INT_MIN);
}

TEST(wrap_mul, KeepsTheLow32Bits) {
    EXPECT_EQ(wrap_mul(-6, 7), -42);
    EXPECT_EQ(wrap_mul(0x10000, 0x10000), 0);
    EXPECT_EQ(wrap_mul(0x10001, 0x10000), 0x10000);
    EXPECT_EQ(wrap_mul(0x8000, 0x10000), INT_MIN);
    EXPECT_EQ(wrap_mul(INT_MIN, -1), INT_MIN);
    EXPECT_EQ(wrap_mul(INT_MAX, INT_MAX), 1);
}

TEST(saturating_truncate, DropsTheFraction) {
    EXPECT_EQ(saturating_truncate(1.999), 1);
    EXPECT_EQ(saturating_truncate(-1.999), -1);
    EXPECT_EQ(saturating_truncate(0.5), 0);
    EXPECT_EQ(saturating_truncate(-0.999), 0);
    EXPECT_EQ(saturating_truncate(-0.0), 0);
}

TEST(saturating_truncate, IsExactUpToTheEndsOfTheRange) {
    EXPECT_EQ(saturating_truncate(2147483646.0), INT_MAX - 1);
    EXPECT_EQ(saturating_truncate(2147483647.0), INT_MAX);
    EXPECT_EQ(saturating_truncate(2147483647.75), INT_MAX);
    EXPECT_EQ(saturating_truncate(-2147483647.0), INT_MIN + 1);
    EXPECT_EQ(saturating_truncate(-2147483647.75), INT_MIN + 1);
    EXPECT_EQ(saturating_truncate(-2147483648.0), INT_MIN);
    EXPECT_EQ(saturating_truncate(-2147483648.75), INT_MIN);
}

TEST(saturating_truncate, GivesTheNearestEndBeyondTheRange) {
    EXPECT_EQ(saturating_truncate(2147483648.0), INT_MAX);
    EXPECT_EQ(saturating_truncate(4294967297.0), INT_MAX);  // not 1
    EXPECT_EQ(saturating_truncate(1e300), INT_MAX);
    EXPECT_EQ(saturating_truncate(std::numeric_limits<double>::infinity()), INT_MAX);
    EXPECT_EQ(saturating_truncate(-2147483649.0), INT_MIN);
    EXPECT_EQ(saturating_truncate(-4294967297.0), INT_MIN);
    EXPECT_EQ(saturating_truncate(-std::numeric_limits<float>::infinity()), INT_MIN);
}

TEST(saturating_truncate, MakesZeroOfNaN) {
    EXPECT_EQ(saturating_truncate(std::numeric_limits<double>::quiet_NaN()), 0);
    EXPECT_EQ(saturating_truncate(-std::numeric_limits<float>::quiet_NaN()), 0);
}
