// Draws a photo into the view, pixel by pixel, alpha included: nothing is blended or filtered.
#pragma once

#include <cstdint>

#include "jni/view_geometry.h"

// Redraws a rectangle of the view from the photo at a scale and offset; positions beyond the photo
// show its nearest edge.
//
//   scale               photo pixels per view pixel; above 1 shrinks
//   offset_x, offset_y  photo column and row that view pixel (0, 0) shows
//
// Deliberate: positions are rounded down, without half a pixel added, unlike the outline's
// (view_outline.h); and the error of the truncated step adds up along a row.
void draw_image(const view_pixels& view, const photo_pixels& photo, float scale, int offset_x,
                int offset_y, const ze_rect& area);

// Draws the photo unscaled with its pixel (0, 0) at the rectangle's left top. A smaller photo
// repeats its last column and row to the edges, a larger one is cut off there.
void draw_small_image(const view_pixels& view, const photo_pixels& photo, const ze_rect& area);

// Writes the photo columns of view columns 0 .. columns - 1 and behind them the photo rows of view
// rows 0 .. rows - 1, as draw_image samples them but not clamped to the photo. A negative count
// writes nothing of its kind; rows then keep their place, and those before points[0] are left out.
//
// REQUIRES: room for the columns, and for the rows behind them.
void set_image_points(int columns, int rows, float scale, int offset_x, int offset_y,
                      int32_t* points);
