// The definition of the row kernels (render/row_kernels.h), as loops that take on the instructions
// of the function they are called from.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>

#include "render/row_kernels.h"

// No step of the loop reads what another writes. Without that word a compiler would tell disjoint
// arrays from others at run time, and take equal ones for the others. Steps by twos, because the
// time of a short loop depends on where in memory it comes to lie.
#if defined(__clang__)
#pragma clang diagnostic ignored "-Wpass-failed"  // with sanitizers there are no vectors
#define FOR_INDEPENDENT_STEPS _Pragma("clang loop vectorize(assume_safety)") for
#else
#define FOR_INDEPENDENT_STEPS _Pragma("GCC ivdep") _Pragma("GCC unroll 2") for
#endif

#define ROW_LOOP [[gnu::always_inline]] inline

namespace row_loops {

ROW_LOOP uint32_t grey_of(uint32_t pixel) {
    const uint32_t sum = (pixel >> 16 & 0xFF) + (pixel >> 8 & 0xFF) + (pixel & 0xFF);
    const uint32_t third = sum * 0x5556 >> 16;  // sum / 3 up to 765
    return (pixel & 0xFF000000u) | third * 0x010101;
}

ROW_LOOP void grey(const uint32_t* src, uint32_t* dst, ptrdiff_t n) {
    FOR_INDEPENDENT_STEPS(ptrdiff_t i = 0; i < n; ++i) dst[i] = grey_of(src[i]);
}

ROW_LOOP void colour_selection(const uint32_t* src, const uint8_t* mask, uint32_t* dst,
                               ptrdiff_t n) {
    FOR_INDEPENDENT_STEPS(ptrdiff_t i = 0; i < n; ++i) {
        const uint32_t grey = grey_of(src[i]);
        dst[i] = mask[i] == 1 ? src[i] : grey;
    }
}

ROW_LOOP void invert_and_colour(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    FOR_INDEPENDENT_STEPS(ptrdiff_t i = 0; i < n; ++i) {
        const uint32_t grey = grey_of(src[i]);
        dst[i] = mask[i] == 1 ? grey : src[i];
        mask[i] = mask[i] != 1;
    }
}

ROW_LOOP void invert(uint8_t* mask, ptrdiff_t n) {
    FOR_INDEPENDENT_STEPS(ptrdiff_t i = 0; i < n; ++i) mask[i] = mask[i] != 1;
}

template <class T>
ROW_LOOP void gather(const T* __restrict from, const int32_t* __restrict columns, T* __restrict to,
                     ptrdiff_t n) {
#pragma GCC unroll 8
    for (ptrdiff_t i = 0; i < n; ++i) to[i] = from[columns[i]];
}

ROW_LOOP void double_pixels(const int32_t* __restrict from, int32_t* __restrict to, ptrdiff_t n) {
    for (ptrdiff_t i = 0; i < n / 2; ++i) to[2 * i] = to[2 * i + 1] = from[i];
    if (n % 2 != 0) to[n - 1] = from[n / 2];
}

// Here and below, what is told of a byte is a byte again: compilers widen a condition of several
// terms, and vectors then hold a quarter as many.

ROW_LOOP void classify(const uint8_t* mask, uint8_t* classes, ptrdiff_t n) {
    FOR_INDEPENDENT_STEPS(ptrdiff_t i = 0; i < n; ++i) {
        const uint8_t one_or_three = mask[i] | 2, four_or_five = mask[i] | 1;
        const uint8_t selected = one_or_three == 3 ? OUTLINE_SELECTED : 0;
        const uint8_t unselected = mask[i] == 0 ? OUTLINE_OUTSIDE : 0;
        const uint8_t removed = four_or_five == 5 ? OUTLINE_OUTSIDE : 0;
        classes[i] = selected + unselected + removed;
    }
}

ROW_LOOP bool outline(const uint8_t* current, const rows_around& around, uint8_t* __restrict flags,
                      ptrdiff_t n) {
    const auto [above, below, left, right] = around;
    uint8_t any = 0;
    for (ptrdiff_t i = 0; i < n; ++i) {
        const uint8_t neighbours = above[i] | below[i] | left[i] | right[i];
        flags[i] = current[i] & (neighbours / OUTLINE_OUTSIDE);
        any = std::max(any, flags[i]);
    }
    return any != 0;
}

ROW_LOOP bool small_outline(const uint8_t* current, const rows_around& around,
                            uint8_t* __restrict flags, ptrdiff_t n) {
    const auto [above, below, left, right] = around;
    uint8_t any = 0;
    for (ptrdiff_t i = 0; i < n; ++i) {
        const uint8_t least = std::min(std::min(above[i], below[i]), std::min(left[i], right[i]));
        const uint8_t flag = (current[i] == 1) & (least == 0);
        flags[i] = flag;
        any = std::max(any, flag);
    }
    return any != 0;
}

constexpr ptrdiff_t BLOCK = 128;  // bytes looked at together

ROW_LOOP bool block_has_selected(const uint8_t* mask) {
    uint8_t nearest = 255;  // the least difference from 1
    for (ptrdiff_t i = 0; i < BLOCK; ++i) {
        const uint8_t difference = mask[i] ^ 1;
        nearest = std::min(nearest, difference);
    }
    return nearest == 0;
}

ROW_LOOP ptrdiff_t last_selected(const uint8_t* mask, ptrdiff_t n) {
    while (n >= BLOCK && !block_has_selected(mask + n - BLOCK)) n -= BLOCK;
    do {
        --n;
    } while (n >= 0 && mask[n] != 1);
    return n;
}

constexpr uint64_t EIGHT_ONES = 0x0101010101010101;
constexpr ptrdiff_t WORD_BITS = 64;

// Eight bytes, the first lowest on every CPU.
ROW_LOOP uint64_t load_bytes(const uint8_t* bytes) {
    uint64_t loaded;
    std::memcpy(&loaded, bytes, sizeof loaded);
#if __BYTE_ORDER__ == __ORDER_BIG_ENDIAN__
    loaded = __builtin_bswap64(loaded);
#endif
    return loaded;
}

ROW_LOOP ptrdiff_t pack_bits(const uint8_t* mask, uint64_t* words, ptrdiff_t count) {
    for (ptrdiff_t word = 0; word < count; ++word, mask += WORD_BITS) {
        uint64_t some = 0, every = EIGHT_ONES, bits = 0;
        for (ptrdiff_t i = 0; i < WORD_BITS; i += 8) {
            some |= load_bytes(mask + i);
            every &= load_bytes(mask + i);
        }
        if ((some & ~EIGHT_ONES) != 0) return word;
        // Most words are of one value.
        if (every == EIGHT_ONES) {
            bits = ~uint64_t{0};
        } else if (some != 0) {
            // Each product moves bit 8 k to bit 56 + k, for each k; no two bits meet.
            for (ptrdiff_t i = 0; i < WORD_BITS; i += 8) {
                bits |= load_bytes(mask + i) * 0x0102040810204080u >> 56 << i;
            }
        }
        words[word] = bits;
    }
    return count;
}

}  // namespace row_loops
