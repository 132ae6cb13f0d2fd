#include "render/row_kernel_variants.h"

#ifdef DRAVENTA_NEON

#include <arm_neon.h>

namespace {

constexpr ptrdiff_t PIXELS = 16;  // per step

uint8x16x4_t load(const uint32_t* src) { return vld4q_u8(reinterpret_cast<const uint8_t*>(src)); }

void store(uint32_t* dst, uint8x16x4_t pixels) {
    vst4q_u8(reinterpret_cast<uint8_t*>(dst), pixels);
}

// The doubling product's upper half, (sum * 0x5556) >> 16, is sum / 3 up to 765.
uint8x8_t third(uint16x8_t sum) {
    return vqmovun_s16(vqdmulhq_n_s16(vreinterpretq_s16_u16(sum), 0x5556 / 2));
}

uint8x16_t grey_of(uint8x16x4_t p) {
    const uint8x16_t b = p.val[0], g = p.val[1], r = p.val[2];
    const uint16x8_t low = vaddw_u8(vaddl_u8(vget_low_u8(b), vget_low_u8(g)), vget_low_u8(r));
    const uint16x8_t high = vaddw_u8(vaddl_u8(vget_high_u8(b), vget_high_u8(g)), vget_high_u8(r));
    return vcombine_u8(third(low), third(high));
}

// Grey where all bits are set.
uint8x16x4_t greyed(uint8x16x4_t p, uint8x16_t where) {
    const uint8x16_t grey = grey_of(p);
    for (int channel = 0; channel < 3; ++channel) {
        p.val[channel] = vbslq_u8(where, grey, p.val[channel]);
    }
    return p;
}

void grey(const uint32_t* src, uint32_t* dst, ptrdiff_t n) {
    ptrdiff_t x = 0;
    for (; x + PIXELS <= n; x += PIXELS) {
        uint8x16x4_t p = load(src + x);
        p.val[0] = p.val[1] = p.val[2] = grey_of(p);
        store(dst + x, p);
    }
    scalar::grey(src + x, dst + x, n - x);
}

void colour_selection(const uint32_t* src, const uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    ptrdiff_t x = 0;
    for (; x + PIXELS <= n; x += PIXELS) {
        const uint8x16_t selected = vceqq_u8(vld1q_u8(mask + x), vdupq_n_u8(1));
        store(dst + x, greyed(load(src + x), vmvnq_u8(selected)));
    }
    scalar::colour_selection(src + x, mask + x, dst + x, n - x);
}

void invert_and_colour(const uint32_t* src, uint8_t* mask, uint32_t* dst, ptrdiff_t n) {
    ptrdiff_t x = 0;
    for (; x + PIXELS <= n; x += PIXELS) {
        const uint8x16_t selected = vceqq_u8(vld1q_u8(mask + x), vdupq_n_u8(1));
        store(dst + x, greyed(load(src + x), selected));
        vst1q_u8(mask + x, vaddq_u8(selected, vdupq_n_u8(1)));  // -1 or 0, plus 1
    }
    scalar::invert_and_colour(src + x, mask + x, dst + x, n - x);
}

}  // namespace

const row_kernels neon_row_kernels = {
    "neon",
    grey,
    colour_selection,
    invert_and_colour,
    scalar::invert,
    scalar::gather_pixels,
    scalar::gather_bytes,
    scalar::double_pixels,
    scalar::classify,
    scalar::outline,
    scalar::small_outline,
    scalar::last_selected,
    scalar::pack_bits,
};

#endif
