// 16.16 fixed-point arithmetic with table-driven trigonometry, and three integer functions.
//
//   fixed         a 32-bit integer; its value is the integer / 65536
//   binary angle  a fixed in which 256.0 is a full turn
//
// Errors go to g_fix_errno, 34 for an overflow or a division by zero and 33 for an argument outside
// the domain, beside the result named here. Nothing but fixatan2 clears it. Sums and shifts wrap in
// 32 bits unless a function says that it saturates; conversions from double saturate.
//
// The functions read the exported tables: whoever changes an entry changes the function. The
// library itself uses itofix and fixtoi only.
#pragma once

#include <stdint.h>

#include "support/ze_api.h"

ZE_BEGIN_FLAT

ZE_API extern int32_t g_fix_errno;  // 0 at first

ZE_API extern int32_t _cos_tbl[512];   // cos(2 pi i / 512)
ZE_API extern int32_t _tan_tbl[256];   // tan(pi i / 256); -0x7FFFFFFF at the pole, i = 128
ZE_API extern int32_t _acos_tbl[513];  // binary angle of acos(i / 256 - 1)

// Radians to binary angle and back, for fixmul. The library does not use them.
ZE_API extern const int32_t radtofix_r;  // 256 / (2 pi)
ZE_API extern const int32_t fixtorad_r;  // 2 pi / 256

// x as a fixed; the upper 16 bits are lost.
ZE_API int32_t itofix(int32_t x);

// x as an integer: to the nearest with halves upwards, towards -infinity, towards +infinity.
// fixceil above 32767.0 is an error 34 with 32767.
ZE_API int32_t fixtoi(int32_t x);
ZE_API int32_t fixfloor(int32_t x);
ZE_API int32_t fixceil(int32_t x);

// x as a fixed, rounded to the nearest with halves away from 0. Beyond +-32767.0 an error 34 with
// +-0x7FFFFFFF. NaN gives 0.
ZE_API int32_t ftofix(double x);
ZE_API double fixtof(int32_t x);

// Sum and difference; beyond the range an error 34 with 0x7FFFFFFF or -0x7FFFFFFF.
//
// Deliberate: operands 0 take no part in the overflow test, so 0 - (-2^31) is -2^31.
ZE_API int32_t fixadd(int32_t x, int32_t y);
ZE_API int32_t fixsub(int32_t x, int32_t y);

// Product by way of double; saturates as ftofix does.
ZE_API int32_t fixmul(int32_t x, int32_t y);

// Quotient, rounded towards 0. 0 for x = 0; otherwise y = 0 is an error 34 with +-0x7FFFFFFF by the
// sign of x.
//
// Deliberate: x is shifted left by 16 in 32 bits first, so the result is right for |x| < 0.5 only.
ZE_API int32_t fixdiv(int32_t x, int32_t y);

// Binary angle of x, between -64.0 and 64.0.
//
// Deliberate: of the last table entry looked at in a binary search, not of the nearest.
ZE_API int32_t fixatan(int32_t x);

// Binary angle of the point (x, y), between -128.0 and 128.0. (0, 0) is an error 33 with 0.
//
// Deliberate: with x not 0, g_fix_errno is cleared. The quotient is fixdiv's, with its limits.
ZE_API int32_t fixatan2(int32_t y, int32_t x);

// Cosine, sine and tangent of a binary angle, of the nearest table entry.
ZE_API int32_t fixcos(int32_t x);
ZE_API int32_t fixsin(int32_t x);
ZE_API int32_t fixtan(int32_t x);

// Binary angles of a cosine or sine x. Beyond +-1.0 an error 33 with 0.
ZE_API int32_t fixacos(int32_t x);
ZE_API int32_t fixasin(int32_t x);

// Square root of an integer, rounded to the nearest; 0 for x below 0.
ZE_API int32_t isqrt_(int32_t x);

// Quotients of integers: idiv rounds to the nearest, iidiv towards -infinity. 0 for x = 0;
// otherwise y = 0 is an error 34 with +-0x7FFFFFFF by the sign of x.
//
// Deliberate: idiv compares the remainder with y / 2 rounded down, so y = 1 and every y below 0
// always move away from 0: idiv(5, 1) is 6. iidiv goes down by one where nothing is left over too:
// iidiv(-4, 2) is -3. The sign is that of the product in 32 bits, also where it wraps.
ZE_API int32_t idiv(int32_t x, int32_t y);
ZE_API int32_t iidiv(int32_t x, int32_t y);

// x rounded to the nearest integer, halves away from 0; saturates.
ZE_API int32_t round__(double x);

ZE_END_FLAT
