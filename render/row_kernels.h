// The inner loops of compositing, of view drawing and of mask scans: one row each.
//
// A kernel takes pointers and a count and knows nothing else. Each is one plain loop, which the
// compilers turn into vector code: for the processor that the library is built for, and on x86-64 a
// second time with AVX2, for the machines that have it.
//
// A count may be 0. Where a kernel reads and writes arrays of one type, both may be the same array;
// they may not overlap otherwise, and the gathering ones write to an array of its own.
#pragma once

#include <cstddef>
#include <cstdint>

// What a mask value means to the scaled view's outline. Values of neither kind are 0.
constexpr uint8_t OUTLINE_SELECTED = 1;  // 1 and 3
constexpr uint8_t OUTLINE_OUTSIDE = 2;   // 0, 4 and 5

// Where the neighbours of a row's values are: those of value i at index i of each.
struct rows_around {
    const uint8_t* above;
    const uint8_t* below;
    const uint8_t* left;
    const uint8_t* right;
};

struct row_kernels {
    const char* name;

    // dst = the grey of src (render/compositing.h).
    void (*grey)(const uint32_t* src, uint32_t* dst, ptrdiff_t n);

    // dst = src where the mask is 1, the grey of src elsewhere.
    void (*colour_selection)(const uint32_t* src, const uint8_t* mask, uint32_t* dst, ptrdiff_t n);

    // Inverts the mask, then does as colour_selection.
    void (*invert_and_colour)(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n);

    // Makes 0 of every 1 and 1 of every other value.
    void (*invert)(uint8_t* mask, ptrdiff_t n);

    // to[i] = from[columns[i]]
    void (*gather_pixels)(const int32_t* from, const int32_t* columns, int32_t* to, ptrdiff_t n);
    void (*gather_bytes)(const uint8_t* from, const int32_t* columns, uint8_t* to, ptrdiff_t n);

    // to[i] = from[i / 2]
    void (*double_pixels)(const int32_t* from, int32_t* to, ptrdiff_t n);

    // classes = OUTLINE_SELECTED, OUTLINE_OUTSIDE or 0 for each value of the mask.
    void (*classify)(const uint8_t* mask, uint8_t* classes, ptrdiff_t n);

    // flags[i] = 1 where current[i] is selected and one of the four around it is outside, otherwise
    // 0; all but the flags are classes. Returns whether there is a 1.
    bool (*outline)(const uint8_t* current, const rows_around& around, uint8_t* flags, ptrdiff_t n);

    // The same on a mask itself, where 1 is selected and 0 is outside.
    bool (*small_outline)(const uint8_t* current, const rows_around& around, uint8_t* flags,
                          ptrdiff_t n);

    // Index of the last 1, or -1.
    ptrdiff_t (*last_selected)(const uint8_t* mask, ptrdiff_t n);

    // Makes a word of every 64 values, which must be 0 or 1: bit k is value k. Stops at other
    // values; returns the number of words made, of `count`.
    ptrdiff_t (*pack_bits)(const uint8_t* mask, uint64_t* words, ptrdiff_t count);
};

// The definition first. A processor runs all up to row_kernels_of_this_cpu().
extern const row_kernels* const row_kernel_variants[];

// The last variant that this processor runs.
const row_kernels& row_kernels_of_this_cpu();
