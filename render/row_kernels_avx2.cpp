#include "render/row_kernel_variants.h"

#ifdef DRAVENTA_AVX2

#include "render/row_loops.h"

namespace {

#define AVX2 __attribute__((target("avx2")))

// One instruction multiplies by any number. In place of numbers that it knows a compiler puts
// several shifts and sums, so it must not know these.
const volatile row_loops::grey_factors unknown = {row_loops::THIRD, row_loops::SPREAD};

row_loops::grey_factors factors() { return {unknown.third, unknown.spread}; }

AVX2 void grey(const uint32_t* src, uint32_t* dst, ptrdiff_t n) {
    row_loops::grey(src, dst, n, factors());
}

AVX2 void colour_selection(const uint32_t* src, const uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    row_loops::colour_selection(src, mask, dst, n, factors());
}

AVX2 void invert_and_colour(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    row_loops::invert_and_colour(src, mask, dst, n, factors());
}

AVX2 void invert(uint8_t* mask, ptrdiff_t n) { row_loops::invert(mask, n); }

AVX2 void gather_pixels(const int32_t* from, const int32_t* columns, int32_t* to, ptrdiff_t n) {
    row_loops::gather(from, columns, to, n);
}

AVX2 void gather_bytes(const uint8_t* from, const int32_t* columns, uint8_t* to, ptrdiff_t n) {
    row_loops::gather(from, columns, to, n);
}

AVX2 void double_pixels(const int32_t* from, int32_t* to, ptrdiff_t n) {
    row_loops::double_pixels(from, to, n);
}

AVX2 void classify(const uint8_t* mask, uint8_t* classes, ptrdiff_t n) {
    row_loops::classify(mask, classes, n);
}

AVX2 bool outline(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n) {
    return row_loops::outline(current, around, flags, n);
}

AVX2 bool small_outline(const uint8_t* current, const rows_around& around, uint8_t* flags,
                        ptrdiff_t n) {
    return row_loops::small_outline(current, around, flags, n);
}

AVX2 ptrdiff_t last_selected(const uint8_t* mask, ptrdiff_t n) {
    return row_loops::last_selected(mask, n);
}

}  // namespace

const row_kernels avx2_row_kernels = {"avx2",   grey,          colour_selection, invert_and_colour,
                                      invert,   gather_pixels, gather_bytes,     double_pixels,
                                      classify, outline,       small_outline,    last_selected};

#endif
