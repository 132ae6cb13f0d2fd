#include "tests/reference/fixed_point_reference.h"

#include <cmath>
#include <cstddef>
#include <cstdlib>
#include <stdexcept>

#include "tests/reference/arithmetic_reference.h"

namespace reference {
namespace {

constexpr int32_t DOMAIN_ERROR = 33;
constexpr int32_t RANGE_ERROR = 34;
constexpr int32_t HIGHEST = 0x7FFFFFFF;
constexpr int32_t LOWEST = -0x7FFFFFFF;  // not -2^31
constexpr int32_t QUARTER_TURN = 0x400000;
constexpr int32_t HALF_TURN = 0x800000;
constexpr int64_t ONE = 65536;

int32_t nearest_fixed(long double value) {
    return static_cast<int32_t>(std::llround(value * 65536.0L));
}

size_t cell(int64_t position, int64_t cells) {
    return static_cast<size_t>(position - floor_divided(position, cells) * cells);
}

bool in_acos_domain(int32_t x) { return x >= -65536 && x <= 65536; }

size_t acos_cell(int32_t x) {
    return static_cast<size_t>(floor_divided(int64_t{x} + 65536 + 127, 256));
}

// Binary search for x between two indices of the tangent table. The answer is the index looked at
// last, be it the nearest or not.
int64_t last_probe(const std::vector<int32_t>& tangents, int64_t x, int64_t low, int64_t high) {
    const int64_t middle = (low + high) / 2;
    const int64_t tangent = tangents.at(static_cast<size_t>(middle));
    if (x > tangent && middle + 1 <= high) return last_probe(tangents, x, middle + 1, high);
    if (x < tangent && low <= middle - 1) return last_probe(tangents, x, low, middle - 1);
    return middle;
}

}  // namespace

fixed_point::fixed_point() {
    const long double pi = std::acos(-1.0L);
    for (int i = 0; i < 512; ++i) cos_tbl.push_back(nearest_fixed(std::cos(2 * pi * i / 512)));
    for (int i = 0; i < 256; ++i) {
        const bool pole = i == 128;
        tan_tbl.push_back(pole ? LOWEST : nearest_fixed(std::tan(pi * i / 256)));
    }
    for (int i = 0; i <= 512; ++i) {
        acos_tbl.push_back(nearest_fixed(std::acos(i / 256.0L - 1) * (256 / (2 * pi))));
    }
    radtofix_r = nearest_fixed(256 / (2 * pi));
    fixtorad_r = nearest_fixed(2 * pi / 256);
}

int32_t fixed_point::itofix(int32_t x) { return wrapped(x * ONE); }

int32_t fixed_point::fixfloor(int32_t x) { return static_cast<int32_t>(floor_divided(x, ONE)); }

int32_t fixed_point::fixtoi(int32_t x) {
    return static_cast<int32_t>(floor_divided(int64_t{x} + 32768, ONE));
}

int32_t fixed_point::fixceil(int32_t x) {
    if (x >= 0x7FFF0001) {
        g_fix_errno = RANGE_ERROR;
        return 32767;
    }
    return static_cast<int32_t>(floor_divided(int64_t{x} + 0xFFFF, ONE));
}

int32_t fixed_point::ftofix(double x) {
    if (x > 32767.0) {
        g_fix_errno = RANGE_ERROR;
        return HIGHEST;
    }
    if (x < -32767.0) {
        g_fix_errno = RANGE_ERROR;
        return LOWEST;
    }
    // In double, not exactly: the sum of a value just below one half and one half rounds up to 1.
    const double scaled = x * 65536.0;
    const double moved = x < 0 ? scaled - 0.5 : scaled + 0.5;
    return truncated(moved);
}

double fixed_point::fixtof(int32_t x) { return std::ldexp(static_cast<double>(x), -16); }

int32_t fixed_point::fixadd(int32_t x, int32_t y) {
    const int64_t sum = int64_t{x} + y;
    if (x > 0 && y > 0 && sum > INT32_MAX) {
        g_fix_errno = RANGE_ERROR;
        return HIGHEST;
    }
    if (x < 0 && y < 0 && sum < INT32_MIN) {
        g_fix_errno = RANGE_ERROR;
        return LOWEST;
    }
    return wrapped(sum);
}

int32_t fixed_point::fixsub(int32_t x, int32_t y) {
    const int64_t difference = int64_t{x} - y;
    if (x > 0 && y < 0 && difference > INT32_MAX) {
        g_fix_errno = RANGE_ERROR;
        return HIGHEST;
    }
    if (x < 0 && y > 0 && difference < INT32_MIN) {
        g_fix_errno = RANGE_ERROR;
        return LOWEST;
    }
    return wrapped(difference);  // 0 - (-2^31) comes here and wraps without an error
}

int32_t fixed_point::fixmul(int32_t x, int32_t y) {
    // Up to the limit the product has at most 47 bits, so the library's doubles hold it exactly.
    const int64_t product = int64_t{x} * y;  // in units of 2^-32
    const int64_t limit = int64_t{32767} * ONE * ONE;
    if (product > limit) {
        g_fix_errno = RANGE_ERROR;
        return HIGHEST;
    }
    if (product < -limit) {
        g_fix_errno = RANGE_ERROR;
        return LOWEST;
    }
    const int64_t half = ONE / 2;  // of a unit of the result
    return static_cast<int32_t>((product < 0 ? product - half : product + half) / ONE);
}

int32_t fixed_point::fixdiv(int32_t x, int32_t y) {
    if (x == 0) return 0;
    if (y == 0) {
        g_fix_errno = RANGE_ERROR;
        return x > 0 ? HIGHEST : LOWEST;
    }
    // The shift drops the upper half of x before the division.
    return wrapped(int64_t{itofix(x)} / y);
}

int32_t fixed_point::fixatan(int32_t x) {
    const int64_t probe =
        x >= 0 ? last_probe(tan_tbl, x, 0, 127) : last_probe(tan_tbl, x, 128, 255);
    const int64_t angle = probe * 32768;
    return static_cast<int32_t>(x >= 0 ? angle : angle - HALF_TURN);
}

int32_t fixed_point::fixatan2(int32_t y, int32_t x) {
    if (x == 0) {
        if (y == 0) {
            g_fix_errno = DOMAIN_ERROR;
            return 0;
        }
        return y > 0 ? QUARTER_TURN : -QUARTER_TURN;
    }
    g_fix_errno = 0;
    const int32_t quotient = fixdiv(y, x);
    if (g_fix_errno != 0) {
        g_fix_errno = 0;
        return y >= 0 ? QUARTER_TURN : -QUARTER_TURN;
    }
    const int32_t angle = fixatan(quotient);
    if (x > 0) return angle;
    return y >= 0 ? angle + HALF_TURN : angle - HALF_TURN;
}

// Wrapping the argument's sum changes no index: 2^32 is a whole number of turns of each table.
int32_t fixed_point::fixcos(int32_t x) {
    return cos_tbl.at(cell(floor_divided(int64_t{x} + 0x4000, 32768), 512));
}

int32_t fixed_point::fixsin(int32_t x) {
    return cos_tbl.at(cell(floor_divided(int64_t{x} - 0x3FC000, 32768), 512));
}

int32_t fixed_point::fixtan(int32_t x) {
    return tan_tbl.at(cell(floor_divided(int64_t{x} + 0x4000, 32768), 256));
}

int32_t fixed_point::fixacos(int32_t x) {
    if (!in_acos_domain(x)) {
        g_fix_errno = DOMAIN_ERROR;
        return 0;
    }
    return acos_tbl.at(acos_cell(x));
}

int32_t fixed_point::fixasin(int32_t x) {
    if (!in_acos_domain(x)) {
        g_fix_errno = DOMAIN_ERROR;
        return 0;
    }
    return wrapped(int64_t{QUARTER_TURN} - acos_tbl.at(acos_cell(x)));
}

int32_t fixed_point::isqrt_(int32_t x) {
    if (x < 0) throw std::domain_error("isqrt_ of a negative number");
    // Rounding up to n means x >= (n - 1/2)^2; between integers that is x > n * (n - 1).
    int64_t root = 0;
    int64_t beyond = 65536;
    while (beyond - root > 1) {
        const int64_t n = (root + beyond) / 2;
        (n * (n - 1) < x ? root : beyond) = n;
    }
    return static_cast<int32_t>(root);
}

int32_t fixed_point::idiv(int32_t x, int32_t y) {
    if (x == 0) return 0;
    if (y == 0) {
        g_fix_errno = RANGE_ERROR;
        return x > 0 ? HIGHEST : LOWEST;
    }
    const int64_t quotient = wrapped(int64_t{x} / y);
    const int64_t remainder = int64_t{x} % y;
    // The threshold is half of y, not of |y|: a negative y always corrects.
    int64_t correction = std::abs(remainder) >= floor_divided(y, 2) ? 1 : 0;
    if (wrapped(int64_t{x} * y) < 0) correction = -correction;
    return wrapped(quotient + correction);
}

int32_t fixed_point::iidiv(int32_t x, int32_t y) {
    if (x == 0) return 0;
    if (y == 0) {
        g_fix_errno = RANGE_ERROR;
        return x > 0 ? HIGHEST : LOWEST;
    }
    const int64_t quotient = wrapped(int64_t{x} / y);
    return wrapped(wrapped(int64_t{x} * y) < 0 ? quotient - 1 : quotient);
}

int32_t fixed_point::round_(double x) {
    const double moved = x < 0 ? x - 0.5 : x + 0.5;  // in double, as in ftofix
    return truncated(moved);
}

}  // namespace reference
