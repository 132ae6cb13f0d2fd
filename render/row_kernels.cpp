#include "render/row_kernels.h"

#include "render/row_kernel_variants.h"
#include "render/row_loops.h"

namespace scalar {

void grey(const uint32_t* src, uint32_t* dst, ptrdiff_t n) { row_loops::grey(src, dst, n); }

void colour_selection(const uint32_t* src, const uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    row_loops::colour_selection(src, mask, dst, n);
}

void invert_and_colour(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    row_loops::invert_and_colour(src, mask, dst, n);
}

void invert(uint8_t* mask, ptrdiff_t n) { row_loops::invert(mask, n); }

void gather_pixels(const int32_t* from, const int32_t* columns, int32_t* to, ptrdiff_t n) {
    row_loops::gather(from, columns, to, n);
}

void gather_bytes(const uint8_t* from, const int32_t* columns, uint8_t* to, ptrdiff_t n) {
    row_loops::gather(from, columns, to, n);
}

void double_pixels(const int32_t* from, int32_t* to, ptrdiff_t n) {
    row_loops::double_pixels(from, to, n);
}

void classify(const uint8_t* mask, uint8_t* classes, ptrdiff_t n) {
    row_loops::classify(mask, classes, n);
}

bool outline(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n) {
    return row_loops::outline(current, around, flags, n);
}

bool small_outline(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n) {
    return row_loops::small_outline(current, around, flags, n);
}

ptrdiff_t last_selected(const uint8_t* mask, ptrdiff_t n) {
    return row_loops::last_selected(mask, n);
}

ptrdiff_t pack_bits(const uint8_t* mask, uint64_t* words, ptrdiff_t count) {
    return row_loops::pack_bits(mask, words, count);
}

}  // namespace scalar

const row_kernels scalar_row_kernels = {
    "scalar",          scalar::grey,          scalar::colour_selection, scalar::invert_and_colour,
    scalar::invert,    scalar::gather_pixels, scalar::gather_bytes,     scalar::double_pixels,
    scalar::classify,  scalar::outline,       scalar::small_outline,    scalar::last_selected,
    scalar::pack_bits,
};

const row_kernels* const row_kernel_variants[] = {
    &scalar_row_kernels,
#ifdef DRAVENTA_AVX2
    &avx2_row_kernels,
#endif
#ifdef DRAVENTA_NEON
    &neon_row_kernels,
#endif
};

const row_kernels& row_kernels_of_this_cpu() {
#if defined(DRAVENTA_AVX2)
    return *row_kernel_variants[__builtin_cpu_supports("avx2") != 0];
#elif defined(DRAVENTA_NEON)
    return neon_row_kernels;
#else
    return scalar_row_kernels;
#endif
}
