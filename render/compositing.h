// Pictures of a photo and its selection, as tall and wide as the photo.
//
//   src, dst  pixels 0xAARRGGBB, rows `width` apart; both may be the same buffer
//   mask      one byte per pixel, unless a function says otherwise; 1 is selected, others are not
//
// The grey of a pixel keeps its alpha and has (red + green + blue) / 3, rounded down, in all three
// channels. Pointers, lengths and rectangles are not checked.
#pragma once

#include <stdint.h>

#include "support/ze_api.h"

ZE_BEGIN_FLAT

// Greys width * height pixels of src into dst.
//
// Deliberate: the product decides; two negative sizes grey their product of pixels, any other
// product below 1 none.
ZE_API void ze_argb2gray(uint32_t* src, int width, int height, uint32_t* dst);

// Draws the selection in colour and the rest grey, inside an inclusive rectangle. dst outside it
// stays. REQUIRES: the rectangle lies in the image, or is empty.
ZE_API void ze_draw_withmask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width, int left,
                             int right, int top, int bottom);

// The same as ze_draw_withmask.
ZE_API void ze_draw_withmask_v2(uint32_t* src, uint32_t* dst, unsigned char* mask, int width,
                                int left, int right, int top, int bottom);

// Draws the selection grey and the rest in colour. A size below 1 does nothing.
//
// Deliberate: the mask comes back inverted (1 becomes 0, any other value 1), so a second call draws
// the opposite picture.
ZE_API void ze_draw_reverse_mask(uint32_t* src, uint32_t* dst, unsigned char* mask, int width,
                                 int height);

// Inverts a mask of mask_width * mask_height bytes, then draws the image through it: in colour
// where the inverted mask is selected, otherwise grey. Image pixel (x, y) looks at column trunc(x *
// ratio), row trunc(y * ratio) of the mask, in single precision.
//
//   ratio  mask pixels per image pixel
//
// The fourth argument is not read. Deliberate: the lookup is not clamped to the row; one that runs
// past it reads on in the next, and one outside the mask counts as not selected.
ZE_API void ze_draw_reverse_mask_v2(uint32_t* src, uint32_t* dst, unsigned char* mask, int,
                                    int width, int height, int mask_width, int mask_height,
                                    float ratio);

ZE_END_FLAT
