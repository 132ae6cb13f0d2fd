#include "support/fixed_point.h"

#include <algorithm>
#include <cstdlib>

#include "support/arithmetic.h"

int32_t g_fix_errno = 0;

extern const int32_t radtofix_r = 0x28BE61;
extern const int32_t fixtorad_r = 0x648;

namespace {

constexpr int32_t DOMAIN_ERROR = 33;  // EDOM
constexpr int32_t RANGE_ERROR = 34;   // ERANGE

constexpr int32_t ONE = 0x10000;
constexpr int32_t HIGHEST = 0x7FFFFFFF;
constexpr int32_t LOWEST = -HIGHEST;

constexpr int32_t QUARTER_TURN = 64 * ONE;
constexpr int32_t HALF_TURN = 128 * ONE;

int32_t fail(int32_t error, int32_t result) {
    g_fix_errno = error;
    return result;
}

int32_t divided_by_zero(int32_t x) { return fail(RANGE_ERROR, x > 0 ? HIGHEST : LOWEST); }

// Truncated, in 32 bits: -2^31 / -1 is -2^31. REQUIRES: y is not 0.
int32_t wrap_div(int32_t x, int32_t y) { return y == -1 ? wrap_sub(0, x) : x / y; }

// Index of a binary angle in a table of 512 entries a full turn, rounded to the nearest.
int32_t table_angle(int32_t x) { return wrap_add(x, 0x4000) >> 15; }

// Index of x, -1.0 .. 1.0, in _acos_tbl.
int32_t acos_index(int32_t x) { return (x + ONE + 127) >> 8; }

bool is_cosine(int32_t x) { return x >= -ONE && x <= ONE; }

}  // namespace

int32_t itofix(int32_t x) { return wrap_mul(x, ONE); }

int32_t fixtoi(int32_t x) { return fixfloor(x) + (x >> 15 & 1); }

int32_t fixfloor(int32_t x) { return x >> 16; }

int32_t fixceil(int32_t x) {
    if (x >= 0x7FFF0001) return fail(RANGE_ERROR, 0x7FFF);
    return fixfloor(x + 0xFFFF);
}

int32_t ftofix(double x) {
    if (x > 32767.0) return fail(RANGE_ERROR, HIGHEST);
    if (x < -32767.0) return fail(RANGE_ERROR, LOWEST);
    return round__(x * 65536.0);
}

double fixtof(int32_t x) { return x / 65536.0; }

int32_t fixadd(int32_t x, int32_t y) {
    const int32_t sum = wrap_add(x, y);
    if (x > 0 && y > 0 && sum < 0) return fail(RANGE_ERROR, HIGHEST);
    if (x < 0 && y < 0 && sum >= 0) return fail(RANGE_ERROR, LOWEST);
    return sum;
}

int32_t fixsub(int32_t x, int32_t y) {
    const int32_t difference = wrap_sub(x, y);
    if (difference < 0 && x > 0 && y < 0) return fail(RANGE_ERROR, HIGHEST);
    if (difference >= 0 && x < 0 && y > 0) return fail(RANGE_ERROR, LOWEST);
    return difference;
}

int32_t fixmul(int32_t x, int32_t y) { return ftofix(fixtof(x) * fixtof(y)); }

int32_t fixdiv(int32_t x, int32_t y) {
    if (x == 0) return 0;
    if (y == 0) return divided_by_zero(x);
    return wrap_div(itofix(x), y);
}

int32_t fixatan(int32_t x) {
    int32_t low = x >= 0 ? 0 : 128;
    int32_t high = x >= 0 ? 127 : 255;
    int32_t middle = low;
    while (low <= high) {
        middle = (low + high) >> 1;
        if (x == _tan_tbl[middle]) break;
        if (x > _tan_tbl[middle]) {
            low = middle + 1;
        } else {
            high = middle - 1;
        }
    }
    const int32_t angle = middle * 0x8000;
    return x >= 0 ? angle : angle - HALF_TURN;
}

int32_t fixatan2(int32_t y, int32_t x) {
    if (x == 0) {
        if (y == 0) return fail(DOMAIN_ERROR, 0);
        return y > 0 ? QUARTER_TURN : -QUARTER_TURN;
    }
    g_fix_errno = 0;
    const int32_t angle = fixatan(fixdiv(y, x));
    if (x > 0) return angle;
    return y >= 0 ? angle + HALF_TURN : angle - HALF_TURN;
}

int32_t fixcos(int32_t x) { return _cos_tbl[table_angle(x) & 511]; }

int32_t fixsin(int32_t x) { return _cos_tbl[table_angle(wrap_sub(x, QUARTER_TURN)) & 511]; }

int32_t fixtan(int32_t x) { return _tan_tbl[table_angle(x) & 255]; }

int32_t fixacos(int32_t x) {
    return is_cosine(x) ? _acos_tbl[acos_index(x)] : fail(DOMAIN_ERROR, 0);
}

int32_t fixasin(int32_t x) {
    return is_cosine(x) ? wrap_sub(QUARTER_TURN, _acos_tbl[acos_index(x)]) : fail(DOMAIN_ERROR, 0);
}

// Digit by digit: from the highest bit pair down, a bit belongs to the root when its square, with
// what the root has so far, still fits.
int32_t isqrt_(int32_t x) {
    uint32_t remainder = static_cast<uint32_t>(std::max(x, 0));
    uint32_t root = 0;
    const auto decide = [&remainder, &root](uint32_t bit) {
        const bool fits = remainder >= root + bit;
        if (fits) remainder -= root + bit;
        root = root >> 1 | (fits ? bit : 0);
    };
    decide(1u << 30), decide(1u << 28), decide(1u << 26), decide(1u << 24);
    decide(1u << 22), decide(1u << 20), decide(1u << 18), decide(1u << 16);
    decide(1u << 14), decide(1u << 12), decide(1u << 10), decide(1u << 8);
    decide(1u << 6), decide(1u << 4), decide(1u << 2), decide(1u << 0);
    return static_cast<int32_t>(remainder > root ? root + 1 : root);
}

int32_t idiv(int32_t x, int32_t y) {
    if (x == 0) return 0;
    if (y == 0) return divided_by_zero(x);
    const int32_t quotient = wrap_div(x, y);
    const int32_t remainder = y == -1 ? 0 : x % y;
    const int32_t step = std::abs(remainder) >= y >> 1 ? 1 : 0;
    return wrap_add(quotient, wrap_mul(x, y) < 0 ? -step : step);
}

int32_t iidiv(int32_t x, int32_t y) {
    if (x == 0) return 0;
    if (y == 0) return divided_by_zero(x);
    return wrap_sub(wrap_div(x, y), wrap_mul(x, y) < 0 ? 1 : 0);
}

int32_t round__(double x) { return saturating_truncate(x < 0 ? x - 0.5 : x + 0.5); }
