#include "support/fixed_point.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>
#include <ostream>
#include <utility>

namespace {

constexpr int32_t ONE = 0x10000;
constexpr int32_t HIGHEST = 0x7FFFFFFF;
constexpr int32_t LOWEST = -0x7FFFFFFF;
constexpr int32_t QUARTER_TURN = 0x400000;
constexpr int32_t HALF_TURN = 0x800000;
constexpr int32_t FULL_TURN = 0x1000000;

const double INFINITE = std::numeric_limits<double>::infinity();
const double NOT_A_NUMBER = std::numeric_limits<double>::quiet_NaN();

const int32_t error_at_program_start = g_fix_errno;

// What a function returns, with the error that it leaves behind.
struct outcome {
    int32_t result;
    int32_t error;
};

bool operator==(const outcome& a, const outcome& b) {
    return a.result == b.result && a.error == b.error;
}

std::ostream& operator<<(std::ostream& out, const outcome& o) {
    return out << o.result << " with error " << o.error;
}

outcome ok(int32_t result) { return {result, 0}; }
outcome domain_error(int32_t result) { return {result, 33}; }
outcome range_error(int32_t result) { return {result, 34}; }

template <class Function, class... Arguments>
outcome call(Function function, Arguments... arguments) {
    g_fix_errno = 0;
    const int32_t result = function(arguments...);
    return {result, std::exchange(g_fix_errno, 0)};
}

struct binary_case {
    int32_t x, y;
    outcome expected;
};

template <class Function, size_t N>
void check(Function function, const binary_case (&cases)[N]) {
    for (const binary_case& c : cases) {
        EXPECT_EQ(call(function, c.x, c.y), c.expected) << "of " << c.x << " and " << c.y;
    }
}

const long double PI = std::acos(-1.0L);

int32_t rounded(long double value) { return static_cast<int32_t>(std::lround(value)); }

}  // namespace

// ---- tables, constants and the error cell

TEST(fixed_point_tables, HoldTheCosineOfEvery512thOfATurn) {
    for (int i = 0; i < 512; ++i) {
        EXPECT_EQ(_cos_tbl[i], rounded(std::cos(2 * PI * i / 512) * 65536)) << i;
    }
    EXPECT_EQ(_cos_tbl[0], 65536);
    EXPECT_EQ(_cos_tbl[1], 65531);
    EXPECT_EQ(_cos_tbl[128], 0);
    EXPECT_EQ(_cos_tbl[256], -65536);
}

TEST(fixed_point_tables, HoldTheTangentOfEvery256thOfAHalfTurn) {
    for (int i = 0; i < 256; ++i) {
        if (i == 128) continue;
        EXPECT_EQ(_tan_tbl[i], rounded(std::tan(PI * i / 256) * 65536)) << i;
    }
    EXPECT_EQ(_tan_tbl[1], 804);
    EXPECT_EQ(_tan_tbl[64], 65536);
    EXPECT_EQ(_tan_tbl[127], 5340086);
    EXPECT_EQ(_tan_tbl[129], -5340086);
    EXPECT_EQ(_tan_tbl[255], -804);
}

TEST(fixed_point_tables, HoldTheLowestNumberAtTheTangentsPole) {
    EXPECT_EQ(_tan_tbl[128], -0x7FFFFFFF);
}

TEST(fixed_point_tables, HoldTheBinaryAngleOfEvery256thOfACosine) {
    for (int i = 0; i <= 512; ++i) {
        const long double angle = std::acos(i / 256.0L - 1) * (256 / (2 * PI));
        EXPECT_EQ(_acos_tbl[i], rounded(angle * 65536)) << i;
    }
    EXPECT_EQ(_acos_tbl[0], HALF_TURN);
    EXPECT_EQ(_acos_tbl[256], QUARTER_TURN);
    EXPECT_EQ(_acos_tbl[512], 0);
}

TEST(fixed_point_tables, AreReadByTheFunctionsAtEachCall) {
    const int32_t cosine = std::exchange(_cos_tbl[0], 1111);
    EXPECT_EQ(fixcos(0), 1111);
    EXPECT_EQ(fixsin(QUARTER_TURN), 1111);
    _cos_tbl[0] = cosine;

    const int32_t tangent = std::exchange(_tan_tbl[64], 65537);
    EXPECT_EQ(fixtan(0x200000), 65537);
    EXPECT_EQ(fixatan(65537), 0x200000);
    _tan_tbl[64] = tangent;

    const int32_t arc = std::exchange(_acos_tbl[256], 3333);
    EXPECT_EQ(fixacos(0), 3333);
    EXPECT_EQ(fixasin(0), QUARTER_TURN - 3333);
    _acos_tbl[256] = arc;
}

TEST(fixed_point_constants, TurnRadiansIntoBinaryAnglesAndBack) {
    EXPECT_EQ(radtofix_r, 0x28BE61);
    EXPECT_EQ(radtofix_r, rounded(256 / (2 * PI) * 65536));
    EXPECT_EQ(fixtorad_r, 0x648);
    EXPECT_EQ(fixtorad_r, rounded(2 * PI / 256 * 65536));
}

TEST(g_fix_errno, IsZeroAtFirst) { EXPECT_EQ(error_at_program_start, 0); }

TEST(g_fix_errno, StaysUntilTheNextErrorWhateverSucceeds) {
    g_fix_errno = 0;
    fixdiv(1, 0);
    EXPECT_EQ(g_fix_errno, 34);

    fixceil(ONE);
    ftofix(1.0);
    fixadd(ONE, ONE);
    fixsub(ONE, ONE);
    fixmul(ONE, ONE);
    fixdiv(ONE, ONE);
    fixdiv(0, 0);
    fixatan(ONE);
    fixacos(0);
    fixasin(0);
    idiv(5, 3);
    idiv(0, 0);
    iidiv(5, 3);
    EXPECT_EQ(g_fix_errno, 34);

    fixacos(2 * ONE);
    EXPECT_EQ(g_fix_errno, 33);
    g_fix_errno = 0;
}

// ---- conversions

TEST(itofix, ShiftsLeftBy16AndLosesTheUpperBits) {
    EXPECT_EQ(call(itofix, 0), ok(0));
    EXPECT_EQ(call(itofix, 1), ok(0x10000));
    EXPECT_EQ(call(itofix, -1), ok(-0x10000));
    EXPECT_EQ(call(itofix, 32767), ok(0x7FFF0000));
    EXPECT_EQ(call(itofix, 32768), ok(INT_MIN));
    EXPECT_EQ(call(itofix, -32769), ok(0x7FFF0000));
    EXPECT_EQ(call(itofix, 0x12345), ok(0x23450000));
    EXPECT_EQ(call(itofix, INT_MAX), ok(-0x10000));
    EXPECT_EQ(call(itofix, INT_MIN), ok(0));
}

TEST(fixfloor, RoundsTowardsMinusInfinity) {
    EXPECT_EQ(fixfloor(0x18000), 1);
    EXPECT_EQ(fixfloor(0x1FFFF), 1);
    EXPECT_EQ(fixfloor(0), 0);
    EXPECT_EQ(fixfloor(-1), -1);
    EXPECT_EQ(fixfloor(-0x10000), -1);
    EXPECT_EQ(fixfloor(-0x10001), -2);
    EXPECT_EQ(fixfloor(INT_MAX), 32767);
    EXPECT_EQ(fixfloor(INT_MIN), -32768);
}

TEST(fixtoi, RoundsToTheNearestWithHalvesUpwards) {
    EXPECT_EQ(fixtoi(0x18000), 2);
    EXPECT_EQ(fixtoi(0x17FFF), 1);
    EXPECT_EQ(fixtoi(-0x18000), -1);
    EXPECT_EQ(fixtoi(-0x18001), -2);
    EXPECT_EQ(fixtoi(-0x8000), 0);
    EXPECT_EQ(fixtoi(-0x8001), -1);
    EXPECT_EQ(fixtoi(0x7FFF7FFF), 32767);
    EXPECT_EQ(fixtoi(INT_MAX), 32768);
    EXPECT_EQ(fixtoi(INT_MIN), -32768);
}

TEST(fixceil, RoundsTowardsPlusInfinity) {
    EXPECT_EQ(call(fixceil, 0x10001), ok(2));
    EXPECT_EQ(call(fixceil, 0x10000), ok(1));
    EXPECT_EQ(call(fixceil, 1), ok(1));
    EXPECT_EQ(call(fixceil, 0), ok(0));
    EXPECT_EQ(call(fixceil, -1), ok(0));
    EXPECT_EQ(call(fixceil, -0x10000), ok(-1));
    EXPECT_EQ(call(fixceil, -0x1FFFF), ok(-1));
    EXPECT_EQ(call(fixceil, INT_MIN), ok(-32768));
}

TEST(fixceil, OverflowsAbove32767) {
    EXPECT_EQ(call(fixceil, 0x7FFF0000), ok(32767));
    EXPECT_EQ(call(fixceil, 0x7FFF0001), range_error(32767));
    EXPECT_EQ(call(fixceil, INT_MAX), range_error(32767));
}

TEST(ftofix, RoundsHalvesAwayFromZero) {
    EXPECT_EQ(call(ftofix, 1.5), ok(0x18000));
    EXPECT_EQ(call(ftofix, -1.5), ok(-0x18000));
    EXPECT_EQ(call(ftofix, 0.5 / 65536), ok(1));
    EXPECT_EQ(call(ftofix, -0.5 / 65536), ok(-1));
    EXPECT_EQ(call(ftofix, 0.49 / 65536), ok(0));
    EXPECT_EQ(call(ftofix, -0.49 / 65536), ok(0));
    EXPECT_EQ(call(ftofix, -0.0), ok(0));
}

TEST(ftofix, SaturatesBeyond32767OnBothSides) {
    EXPECT_EQ(call(ftofix, 32767.0), ok(0x7FFF0000));
    EXPECT_EQ(call(ftofix, -32767.0), ok(-0x7FFF0000));
    EXPECT_EQ(call(ftofix, 32767.5), range_error(HIGHEST));
    EXPECT_EQ(call(ftofix, -32767.5), range_error(LOWEST));
    EXPECT_EQ(call(ftofix, std::nextafter(32767.0, 40000.0)), range_error(HIGHEST));
    EXPECT_EQ(call(ftofix, std::nextafter(-32767.0, -40000.0)), range_error(LOWEST));
    EXPECT_EQ(call(ftofix, INFINITE), range_error(HIGHEST));
    EXPECT_EQ(call(ftofix, -INFINITE), range_error(LOWEST));
}

TEST(ftofix, MakesZeroOfNaN) { EXPECT_EQ(call(ftofix, NOT_A_NUMBER), ok(0)); }

TEST(fixtof, IsExact) {
    EXPECT_EQ(fixtof(0x18000), 1.5);
    EXPECT_EQ(fixtof(-0x18000), -1.5);
    EXPECT_EQ(fixtof(1), 1.0 / 65536);
    EXPECT_EQ(fixtof(INT_MIN), -32768.0);
    EXPECT_EQ(fixtof(INT_MAX), 32768.0 - 1.0 / 65536);
}

// ---- the four operations

TEST(fixadd, AddsAndSaturates) {
    const binary_case cases[] = {
        {0x18000, -0x8000, ok(ONE)},
        {-0x8000, 0x18000, ok(ONE)},
        {HIGHEST, 0, ok(HIGHEST)},
        {HIGHEST, 1, range_error(HIGHEST)},
        {1, HIGHEST, range_error(HIGHEST)},
        {0x40000000, 0x40000000, range_error(HIGHEST)},
        {HIGHEST, HIGHEST, range_error(HIGHEST)},
        {LOWEST, -1, ok(INT_MIN)},  // one below what an overflow gives
        {LOWEST, -2, range_error(LOWEST)},
        {-1, INT_MIN, range_error(LOWEST)},
        {INT_MIN, -1, range_error(LOWEST)},
        {INT_MIN, INT_MIN, range_error(LOWEST)},  // the sum wraps to 0
        {HIGHEST, INT_MIN, ok(-1)},
    };
    check(fixadd, cases);
}

TEST(fixsub, SubtractsAndSaturates) {
    const binary_case cases[] = {
        {0x18000, 0x8000, ok(ONE)},
        {0x8000, 0x18000, ok(-ONE)},
        {0x40000000, -0x3FFFFFFF, ok(HIGHEST)},
        {0x40000000, -0x40000000, range_error(HIGHEST)},
        {1, INT_MIN, range_error(HIGHEST)},
        {HIGHEST, -1, range_error(HIGHEST)},
        {-0x40000000, 0x40000000, ok(INT_MIN)},
        {-0x40000001, 0x40000000, range_error(LOWEST)},
        {INT_MIN, 1, range_error(LOWEST)},
        {-1, HIGHEST, ok(INT_MIN)},
        {-2, HIGHEST, range_error(LOWEST)},
        {INT_MIN, INT_MIN, ok(0)},
    };
    check(fixsub, cases);
}

TEST(fixsub, TestsNoOverflowOfAZero) {
    EXPECT_EQ(call(fixsub, 0, INT_MIN), ok(INT_MIN));
    EXPECT_EQ(call(fixadd, 0, INT_MIN), ok(INT_MIN));
}

TEST(fixmul, MultipliesRoundingHalvesAwayFromZero) {
    const binary_case cases[] = {
        {0x18000, 0x20000, ok(0x30000)},
        {-0x18000, 0x20000, ok(-0x30000)},
        {1, 0x8000, ok(1)},
        {-1, 0x8000, ok(-1)},
        {1, 0x7FFF, ok(0)},
        {-1, 0x7FFF, ok(0)},
        {0, INT_MIN, ok(0)},
    };
    check(fixmul, cases);
}

TEST(fixmul, SaturatesBeyond32767) {
    const binary_case cases[] = {
        {32767 * ONE, ONE, ok(32767 * ONE)},          {32767 * ONE + 1, ONE, range_error(HIGHEST)},
        {200 * ONE, 200 * ONE, range_error(HIGHEST)}, {200 * ONE, -200 * ONE, range_error(LOWEST)},
        {INT_MIN, ONE, range_error(LOWEST)},          {INT_MIN, INT_MIN, range_error(HIGHEST)},
    };
    check(fixmul, cases);
}

TEST(fixdiv, DividesTowardsZeroBelowOneHalf) {
    const binary_case cases[] = {
        {0x4000, 0x20000, ok(0x2000)}, {-0x4000, 0x20000, ok(-0x2000)},
        {0x4000, 0x30000, ok(5461)},  // 5461.33
        {-0x4000, 0x30000, ok(-5461)}, {-0x4000, -0x30000, ok(5461)},
        {0x7FFF, 0x10000, ok(0x7FFF)}, {-0x8000, 0x10000, ok(-0x8000)},
    };
    check(fixdiv, cases);
}

TEST(fixdiv, LosesTheUpperBitsOfTheDividend) {
    const binary_case cases[] = {
        {0x8000, ONE, ok(-0x8000)},      // a half is shifted into the sign
        {ONE, ONE, ok(0)},               // one is shifted out
        {0x14000, 0x20000, ok(0x2000)},  // as 0x4000
        {0x8000, -1, ok(INT_MIN)},       // -2^31 / -1
    };
    check(fixdiv, cases);
}

TEST(fixdiv, TellsADivisionByZeroUnlessOfZero) {
    const binary_case cases[] = {
        {0, 0, ok(0)},
        {1, 0, range_error(HIGHEST)},
        {-1, 0, range_error(LOWEST)},
        {INT_MIN, 0, range_error(LOWEST)},
    };
    check(fixdiv, cases);
}

// ---- trigonometry

TEST(fixcos, LooksUpTheNearest512thOfATurn) {
    EXPECT_EQ(fixcos(0), 65536);
    EXPECT_EQ(fixcos(0x3FFF), 65536);
    EXPECT_EQ(fixcos(0x4000), 65531);
    EXPECT_EQ(fixcos(-0x4000), 65536);
    EXPECT_EQ(fixcos(-0x4001), 65531);
    EXPECT_EQ(fixcos(QUARTER_TURN), 0);
    EXPECT_EQ(fixcos(HALF_TURN), -65536);
    EXPECT_EQ(fixcos(-HALF_TURN), -65536);
}

TEST(fixsin, IsTheCosineAQuarterTurnEarlier) {
    EXPECT_EQ(fixsin(0), 0);
    EXPECT_EQ(fixsin(QUARTER_TURN), 65536);
    EXPECT_EQ(fixsin(-QUARTER_TURN), -65536);
    EXPECT_EQ(fixsin(HALF_TURN), 0);
    EXPECT_EQ(fixsin(0x3FFF), 0);
    EXPECT_EQ(fixsin(0x4000), 804);
    EXPECT_EQ(fixsin(-0x4000), 0);
    EXPECT_EQ(fixsin(-0x4001), -804);
}

TEST(fixtan, LooksUpTheNearest256thOfAHalfTurn) {
    EXPECT_EQ(fixtan(0), 0);
    EXPECT_EQ(fixtan(0x200000), 65536);
    EXPECT_EQ(fixtan(-0x200000), -65536);
    EXPECT_EQ(fixtan(HALF_TURN), 0);
    EXPECT_EQ(fixtan(QUARTER_TURN), -0x7FFFFFFF);
    EXPECT_EQ(fixtan(-QUARTER_TURN), -0x7FFFFFFF);
    EXPECT_EQ(fixtan(0x3FFF), 0);
    EXPECT_EQ(fixtan(0x4000), 804);
}

TEST(fixed_point_trigonometry, RepeatsAfterEveryFullTurn) {
    for (int i = 0; i < 512; ++i) {
        for (int turn = -128; turn < 128; ++turn) {
            const int32_t angle = turn * FULL_TURN + i * 0x8000;
            ASSERT_EQ(fixcos(angle), _cos_tbl[i]) << angle;
            ASSERT_EQ(fixsin(angle), _cos_tbl[(i + 384) % 512]) << angle;
            ASSERT_EQ(fixtan(angle), _tan_tbl[i % 256]) << angle;
        }
    }
}

TEST(fixed_point_trigonometry, WrapsAtBothEndsOfTheRange) {
    EXPECT_EQ(fixcos(INT_MAX), 65536);
    EXPECT_EQ(fixcos(INT_MIN), 65536);
    EXPECT_EQ(fixsin(INT_MIN), 0);
    EXPECT_EQ(fixsin(INT_MIN + QUARTER_TURN), 65536);
    EXPECT_EQ(fixtan(INT_MAX), 0);
}

TEST(fixatan, GivesTheAngleOfAnEntryOfTheTable) {
    for (int i = 0; i < 128; ++i) {
        EXPECT_EQ(fixatan(_tan_tbl[i]), i * 0x8000) << i;
        EXPECT_EQ(fixatan(_tan_tbl[i + 128]), (i + 128) * 0x8000 - HALF_TURN) << i + 128;
    }
}

TEST(fixatan, GivesTheLastEntryLookedAtAndNotTheNearest) {
    EXPECT_EQ(fixatan(1), 0);
    EXPECT_EQ(fixatan(803), 0);                      // though entry 1 holds 804
    EXPECT_EQ(fixatan(_tan_tbl[63] + 1), 0x200000);  // though entry 63 is nearer than 64
    EXPECT_EQ(fixatan(16384), 20 * 0x8000);          // between entries 19 and 20
    EXPECT_EQ(fixatan(-1), -0x8000);                 // unlike fixatan(1)
}

TEST(fixatan, LooksForZeroInTheFirstHalfOfTheTable) {
    const int32_t middle = _tan_tbl[127];
    _tan_tbl[127] = 0;  // where a search of the whole table would begin
    EXPECT_EQ(fixatan(0), 0);
    _tan_tbl[127] = middle;
}

TEST(fixatan, EndsOneEntryShortOfAQuarterTurnOnOneSideOnly) {
    EXPECT_EQ(fixatan(HIGHEST), QUARTER_TURN - 0x8000);
    EXPECT_EQ(fixatan(LOWEST), -QUARTER_TURN);
    EXPECT_EQ(fixatan(INT_MIN), -QUARTER_TURN);
}

TEST(fixatan2, FindsTheQuadrant) {
    // The search for 16384 ends on entry 20, the one for -16384 on entry 236.
    const binary_case cases[] = {
        {0x4000, ONE, ok(20 * 0x8000)},
        {0x4000, -ONE, ok(236 * 0x8000)},
        {-0x4000, -ONE, ok(20 * 0x8000 - HALF_TURN)},
        {-0x4000, ONE, ok(236 * 0x8000 - HALF_TURN)},
        {0, ONE, ok(0)},
        {0, -ONE, ok(HALF_TURN)},
    };
    check(fixatan2, cases);
    EXPECT_GT(fixatan2(0x4000, -ONE), QUARTER_TURN);
    EXPECT_LT(fixatan2(0x4000, -ONE), HALF_TURN);
}

TEST(fixatan2, GivesAQuarterTurnOnTheAxis) {
    const binary_case cases[] = {
        {ONE, 0, ok(QUARTER_TURN)},      {1, 0, ok(QUARTER_TURN)}, {-1, 0, ok(-QUARTER_TURN)},
        {INT_MIN, 0, ok(-QUARTER_TURN)}, {0, 0, domain_error(0)},
    };
    check(fixatan2, cases);
}

TEST(fixatan2, SharesTheLimitsOfFixdiv) {
    EXPECT_EQ(call(fixatan2, ONE, ONE), ok(0));  // not an eighth of a turn
    EXPECT_EQ(call(fixatan2, 0x8000, ONE), ok(218 * 0x8000 - HALF_TURN));  // of -0x8000
    EXPECT_EQ(call(fixatan2, 0x8000, -1), ok(QUARTER_TURN));
}

TEST(fixatan2, ClearsTheErrorOnlyOffTheAxis) {
    g_fix_errno = 99;
    fixatan2(ONE, 0);
    EXPECT_EQ(g_fix_errno, 99);
    fixatan2(0, 0);
    EXPECT_EQ(g_fix_errno, 33);
    fixatan2(0, ONE);
    EXPECT_EQ(g_fix_errno, 0);
}

TEST(fixacos, LooksUpTheNearest256thWithHalvesDownwards) {
    EXPECT_EQ(call(fixacos, 0), ok(QUARTER_TURN));
    EXPECT_EQ(call(fixacos, ONE), ok(0));
    EXPECT_EQ(call(fixacos, -ONE), ok(HALF_TURN));
    EXPECT_EQ(call(fixacos, -ONE + 128), ok(HALF_TURN));
    EXPECT_EQ(call(fixacos, -ONE + 129), ok(_acos_tbl[1]));
    EXPECT_EQ(call(fixacos, ONE - 128), ok(_acos_tbl[511]));
    EXPECT_EQ(call(fixacos, ONE - 127), ok(0));
}

TEST(fixasin, IsAQuarterTurnLessTheArcCosine) {
    EXPECT_EQ(call(fixasin, 0), ok(0));
    EXPECT_EQ(call(fixasin, ONE), ok(QUARTER_TURN));
    EXPECT_EQ(call(fixasin, -ONE), ok(-QUARTER_TURN));
    EXPECT_EQ(call(fixasin, -ONE + 129), ok(QUARTER_TURN - _acos_tbl[1]));
}

TEST(fixacos, IsADomainErrorBeyondOne) {
    for (const int32_t x : {ONE + 1, -ONE - 1, INT_MAX, INT_MIN}) {
        EXPECT_EQ(call(fixacos, x), domain_error(0)) << x;
        EXPECT_EQ(call(fixasin, x), domain_error(0)) << x;
    }
}

// ---- integers

TEST(isqrt, RoundsToTheNearest) {
    EXPECT_EQ(isqrt_(0), 0);
    EXPECT_EQ(isqrt_(1), 1);
    EXPECT_EQ(isqrt_(2), 1);
    EXPECT_EQ(isqrt_(3), 2);
    EXPECT_EQ(isqrt_(INT_MAX), 46341);
    // The square of n + 1/2 is n * n + n + 1/4.
    for (int32_t n = 1; n <= 46340; ++n) {
        ASSERT_EQ(isqrt_(n * n - n + 1), n);
        ASSERT_EQ(isqrt_(n * n), n);
        ASSERT_EQ(isqrt_(n * n + n), n);
    }
    EXPECT_EQ(isqrt_(46340 * 46340 + 46341), 46341);
}

TEST(isqrt, IsZeroBelowZero) {
    EXPECT_EQ(isqrt_(-1), 0);
    EXPECT_EQ(isqrt_(INT_MIN), 0);
}

TEST(idiv, MovesAwayFromZeroFromHalfADivisorRoundedDown) {
    const binary_case cases[] = {
        {7, 2, ok(4)},   {6, 2, ok(3)},   {5, 4, ok(1)}, {6, 4, ok(2)}, {-7, 2, ok(-4)},
        {-5, 4, ok(-1)}, {-6, 4, ok(-2)}, {0, 3, ok(0)}, {7, 3, ok(3)},  // half of 3 counts as 1
        {-7, 3, ok(-3)}, {6, 3, ok(2)},
    };
    check(idiv, cases);
}

TEST(idiv, AlwaysMovesAwayFromZeroByOneAndByNegatives) {
    const binary_case cases[] = {
        {5, 1, ok(6)},   {-5, 1, ok(-6)},      {4, -2, ok(-3)}, {-4, -2, ok(3)},
        {5, -4, ok(-2)}, {-5, -4, ok(2)},      {5, -1, ok(-6)}, {INT_MIN, INT_MIN, ok(2)},
        {1, -9, ok(-1)}, {1, INT_MIN, ok(-1)},
    };
    check(idiv, cases);
}

TEST(idiv, TakesTheSignFromTheProductIn32Bits) {
    const binary_case cases[] = {
        {0x8000, 0x10000, ok(-1)},                             // 2^31 wraps below 0
        {0xC000, 0x10000, ok(-1)}, {0x18000, 0x10000, ok(0)},  // 1.5: quotient 1, then down
        {0x28000, 0x10000, ok(1)}, {-0xC000, 0x10000, ok(1)},  // -0xC0000000 wraps above 0
        {0x10000, 0x10000, ok(1)},  // 2^32 wraps to 0, which is no negative
    };
    check(idiv, cases);
}

TEST(idiv, WrapsAtTheEndsOfTheRange) {
    const binary_case cases[] = {
        {INT_MAX, 1, ok(INT_MIN)},
        {INT_MIN, 1, ok(INT_MAX)},
        {INT_MIN, -1, ok(INT_MAX)},
    };
    check(idiv, cases);
}

TEST(iidiv, GoesDownByOneBelowZeroWhateverIsLeftOver) {
    const binary_case cases[] = {
        {7, 2, ok(3)},   {-7, 2, ok(-4)}, {7, -2, ok(-4)}, {-7, -2, ok(3)}, {-4, 2, ok(-3)},
        {4, -2, ok(-3)}, {-4, -2, ok(2)}, {0, -5, ok(0)},  {-1, 9, ok(-1)},
    };
    check(iidiv, cases);
}

TEST(iidiv, TakesTheSignFromTheProductIn32BitsAndWraps) {
    const binary_case cases[] = {
        {0x8000, 0x10000, ok(-1)},     {0x18000, 0x10000, ok(0)},  {0x10000, 0x10000, ok(1)},
        {-0xC000, 0x10000, ok(0)},     {INT_MIN, -1, ok(INT_MAX)}, {INT_MIN, 1, ok(INT_MAX)},
        {INT_MIN, 2, ok(-1073741824)},  // the product wraps to 0
    };
    check(iidiv, cases);
}

TEST(idiv, TellsADivisionByZeroUnlessOfZero) {
    const binary_case cases[] = {
        {0, 0, ok(0)},
        {7, 0, range_error(HIGHEST)},
        {-7, 0, range_error(LOWEST)},
    };
    check(idiv, cases);
    check(iidiv, cases);
}

TEST(round, RoundsHalvesAwayFromZero) {
    EXPECT_EQ(round__(2.5), 3);
    EXPECT_EQ(round__(-2.5), -3);
    EXPECT_EQ(round__(2.4), 2);
    EXPECT_EQ(round__(-0.4), 0);
    EXPECT_EQ(round__(-0.5), -1);
    EXPECT_EQ(round__(0.0), 0);
}

TEST(round, AddsTheHalfBeforeItTruncates) {
    EXPECT_EQ(round__(std::nextafter(0.5, 0.0)), 1);  // the sum rounds up to 1
}

TEST(round, Saturates) {
    EXPECT_EQ(round__(2147483646.75), INT_MAX);
    EXPECT_EQ(round__(3e9), INT_MAX);
    EXPECT_EQ(round__(-3e9), INT_MIN);
    EXPECT_EQ(round__(INFINITE), INT_MAX);
    EXPECT_EQ(round__(-INFINITE), INT_MIN);
    EXPECT_EQ(round__(NOT_A_NUMBER), 0);
}
