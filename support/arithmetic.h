// Integer arithmetic with one meaning on every CPU: 32-bit sums that wrap, and conversions from
// floating point that saturate. C++ leaves both undefined; the library's results do not.
#pragma once

#include <cstdint>
#include <limits>

// a + b, a - b and a * b modulo 2^32.
inline int32_t wrap_add(int32_t a, int32_t b) {
    return static_cast<int32_t>(static_cast<uint32_t>(a) + static_cast<uint32_t>(b));
}
inline int32_t wrap_sub(int32_t a, int32_t b) {
    return static_cast<int32_t>(static_cast<uint32_t>(a) - static_cast<uint32_t>(b));
}
inline int32_t wrap_mul(int32_t a, int32_t b) {
    return static_cast<int32_t>(static_cast<uint32_t>(a) * static_cast<uint32_t>(b));
}

// v without its fraction, as a 32-bit integer. Beyond the range it is the nearest end and NaN is 0,
// which is what ARM's conversion instructions do.
inline int32_t saturating_truncate(double v) {
    constexpr double LIMIT = 2147483648.0;  // 2^31
    if (v >= LIMIT) return std::numeric_limits<int32_t>::max();
    if (v <= -LIMIT) return std::numeric_limits<int32_t>::min();
    return v == v ? static_cast<int32_t>(v) : 0;
}
