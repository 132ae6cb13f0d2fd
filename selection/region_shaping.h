// Passes on whole regions of a selection mask. Each traces the contours of the regions inside a box
// and works on what they enclose. region_plain.cpp says pixel by pixel what they do; here the same
// is done on bits (region_bits.h), going over what is new since the region before
// (interior_pass.h).
//
// A pass takes one work buffer and frees it before it returns: three bits for each pixel of the
// box, in words of 64, and five words for each row.
#pragma once

#include "selection/ze_rect.h"
#include "support/ze_api.h"

ZE_BEGIN_FLAT

// Fills the holes of the selection inside a box, with whatever lies in them.
//
//   mask           width * height bytes, 1 is selected; comes back without any 2 inside the box
//   left .. bottom inclusive box; the part of it inside the image counts, pixels outside it are
//                  neither read nor written and are background to the regions inside
//   rect           widened over every pixel that was 0 and becomes selected; not reset
//
// Pixels inside an outer contour become 1, whatever they held. Does nothing when the work buffer
// cannot be had or the box is empty.
//
// Deliberate: a run of the fill ends only beside a marker of the trace, so where a trace ended
// early or never looked in a straight direction, fills reach on to the union of all contours so
// far.
ZE_API void Fill_Region(unsigned char* mask, int width, int height, int left, int right, int top,
                        int bottom, ze_rect* rect);

// Keeps the region of the selection with the largest interior and erases all others inside a box.
//
//   boundary  in: the box, of which the part inside the image counts; out: the box of what is left
//             selected in it, or {width, 0, height, 0}
//   rect      widened over every pixel erased; not reset
//
// With one region nothing is erased. When the work buffer cannot be had the mask stays as it is.
//
// Deliberate:
// - boundary is emptied before anything can fail, and stays so on failure.
// - A region's size is the number of pixels inside its contour. Among equals the one found last
//   survives, the search going row by row. Thin regions all count 0.
ZE_API void Erase_Region(unsigned char* mask, int width, int height, ze_rect* boundary,
                         ze_rect* rect);

// Selects what an adding lasso's outline, together with the selection that it touches, encloses,
// and makes 1 of the outline values 1 and 5 in the box. Box and memory as for Fill_Region.
//
// Returns 0 when the work buffer cannot be had (the mask then stays as it is), otherwise 1.
ZE_API int ze_lasso_add_fill_mask(unsigned char* mask, int width, int height, int left, int right,
                                  int top, int bottom);

// Clears what a removing lasso's outline encloses, and the outline values 3 and 4 in the box.
// Selected pixels outside stay. Result, box and memory as for ze_lasso_add_fill_mask.
ZE_API int ze_lasso_del_fill_mask(unsigned char* mask, int width, int height, int left, int right,
                                  int top, int bottom);

ZE_END_FLAT
