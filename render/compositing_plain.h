// The definition of compositing.h's fast functions: one pixel after another. Tests and benchmarks
// compare with it; the library does not hold it.
//
// What each draws and takes is said there.
#pragma once

#include <cstdint>

namespace plain {

void ze_argb2gray(uint32_t* src, int width, int height, uint32_t* dst);

void ze_draw_withmask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width, int left,
                      int right, int top, int bottom);

void ze_draw_reverse_mask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width, int height);

void ze_draw_reverse_mask_v2(uint32_t* src, uint32_t* dst, unsigned char* mask, int, int width,
                             int height, int mask_width, int mask_height, float ratio);

}  // namespace plain
