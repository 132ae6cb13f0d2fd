// Which variants of the row kernels there are for a processor, each in a source of its own.
#pragma once

#include "render/row_kernels.h"

// The plain loops (render/row_loops.h) for any processor.
namespace scalar {

void grey(const uint32_t* src, uint32_t* dst, ptrdiff_t n);
void colour_selection(const uint32_t* src, const uint8_t* mask, uint32_t* dst, ptrdiff_t n);
void invert_and_colour(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n);
void invert(uint8_t* mask, ptrdiff_t n);
void gather_pixels(const int32_t* from, const int32_t* columns, int32_t* to, ptrdiff_t n);
void gather_bytes(const uint8_t* from, const int32_t* columns, uint8_t* to, ptrdiff_t n);
void double_pixels(const int32_t* from, int32_t* to, ptrdiff_t n);
void classify(const uint8_t* mask, uint8_t* classes, ptrdiff_t n);
bool outline(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n);
bool small_outline(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n);
ptrdiff_t last_selected(const uint8_t* mask, ptrdiff_t n);
ptrdiff_t pack_bits(const uint8_t* mask, uint64_t* words, ptrdiff_t count);

}  // namespace scalar

extern const row_kernels scalar_row_kernels;

// The same loops with AVX2, for desktops; not every processor has it.
#if defined(__x86_64__) && !defined(__ANDROID__)
#define DRAVENTA_AVX2 1
extern const row_kernels avx2_row_kernels;
#endif

// Compositing by hand for 64-bit and 32-bit ARM, in half the time that the compilers' vectors take;
// otherwise the plain loops. It takes pixels apart into bytes B, G, R, A.
#if defined(__ARM_NEON) && __BYTE_ORDER__ == __ORDER_LITTLE_ENDIAN__
#define DRAVENTA_NEON 1
extern const row_kernels neon_row_kernels;
#endif
