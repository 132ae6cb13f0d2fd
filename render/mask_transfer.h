// Carries a selection made on a reduced copy of a photo over to the photo itself.
#pragma once

#include <stdint.h>

#include "support/ze_api.h"

ZE_BEGIN_FLAT

// Transfers a rectangle of the small mask onto the large one. Each small pixel covers a block of
// large ones. A block whose small pixel equals its right, lower and diagonal neighbour takes that
// value; any other lies on the selection's edge, and its pixels are decided one by one by how near
// they are in colour to the selected (flag 0) or equal (any other flag) pixels around.
//
//   small_mask    small_width * small_height bytes, rows small_width apart
//   large_mask    rows large_width apart
//   large_image   the photo under large_mask, pixels 0xAARRGGBB
//   ratio         small size / large size; does nothing unless above 0
//   left .. bottom  inclusive rectangle of the small mask
//   flag          0 adds: edge blocks only gain 1s; any other value removes: they only gain 0s
//
// The seventh argument is not read. REQUIRES: the rectangle lies in the small mask; every block
// lies in the photo, and of an edge block one column and row beyond it too.
//
// Deliberate:
// - Mask bytes are compared whole. Foreign values count as selected when adding; when removing, a
//   block under one stays as it is.
// - Block positions are single-precision quotients, and positions beyond a row reach into the next.
// - On the small mask's last row and column only values equal to 1 - flag are copied.
// - A uniform block is overwritten whatever the flag.
ZE_API void ze_modify_mask(unsigned char* small_mask, unsigned char* large_mask,
                           uint32_t* large_image, int small_width, int small_height,
                           int large_width, int, float ratio, int left, int right, int top,
                           int bottom, int flag);

ZE_END_FLAT
