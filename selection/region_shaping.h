// Passes on whole regions of a selection mask. Each traces the contours of the regions inside a box
// (contour_tracer.h) and works on what they enclose.
//
// A pass takes one work buffer of about a byte per pixel and frees it before it returns.
#pragma once

#include "selection/ze_rect.h"
#include "support/ze_api.h"

extern "C" {

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

}  // extern "C"
