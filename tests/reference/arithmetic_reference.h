// The 32-bit arithmetic that the slow models share.
//
// The models compute with numbers wide enough to hold every exact result and come back to 32 bits
// here, in one step, where the library keeps 32-bit values all along.

#pragma once

#include <cfloat>
#include <cstdint>

// The models' float expressions must round to single precision at each operation.
static_assert(FLT_EVAL_METHOD == 0, "float and double expressions must not carry extra precision");

namespace reference {

// v modulo 2^32, as the signed number that two's complement gives its bits.
inline int32_t wrapped(int64_t v) {
    const int64_t turn = int64_t{1} << 32;
    int64_t residue = v % turn;
    if (residue < 0) residue += turn;
    return static_cast<int32_t>(residue < turn / 2 ? residue : residue - turn);
}

// v / divisor, rounded toward minus infinity; divisor > 0. Dividing by 2^n is an arithmetic shift
// right by n.
inline int64_t floor_divided(int64_t v, int64_t divisor) {
    const int64_t quotient = v / divisor;
    return v % divisor < 0 ? quotient - 1 : quotient;
}

// v rounded toward zero, held at the ends of the 32-bit range; NaN gives 0. A float converts to
// double without loss, so this serves both.
inline int32_t truncated(double v) {
    if (v != v) return 0;
    if (v <= -2147483648.0) return INT32_MIN;
    if (v >= 2147483647.0) return INT32_MAX;
    return static_cast<int32_t>(v);
}

}  // namespace reference
