// Draws a photo into the view with the outline of a selection over it, in two colours that take
// turns in cells of 5 x 5 view pixels. Inside and outside the outline the photo shows unchanged.
//
// The two ways to draw differ in what counts as selected, as outside, and as an edge; each of these
// differences is deliberate.
#pragma once

#include <cstdint>

#include "jni/view_geometry.h"

// A selection mask of the photo's size.
struct outlined_photo {
    photo_pixels photo;
    const uint8_t* mask;
};

// The colour of an outline pixel depends on where it lies in the view, not on the photo.
struct dash_colours {
    int32_t first;
    int32_t second;

    // Deliberate: cells are counted with division towards zero, so those on both sides of 0 are
    // one.
    int32_t at(int x, int y) const { return ((x / 5) ^ (y / 5)) & 1 ? second : first; }
};

// Redraws a rectangle of the view at a scale and offset (see draw_image), the outline one view
// pixel wide at any scale.
//
// Selected are mask values 1 and 3; outside are 0, 4 and 5; any other value is neither. A selected
// pixel is outline when the mask under one of the four neighbouring view pixels is outside.
//
// Deliberate:
// - Positions are rounded to the nearest photo pixel.
// - Selected pixels on the photo's own outer rows and columns show the photo.
// - On the first and last row and column of the rectangle every selected pixel is outline.
// - With top > bottom, rows top and bottom are drawn; with left > right, columns left and right of
//   the rows between.
// - Neighbours are not clamped to the photo: beyond its last column they are read in the next row,
//   and one outside the mask makes no outline.
void draw_image_with_outline(const view_pixels& view, const outlined_photo& outlined, float scale,
                             int offset_x, int offset_y, const dash_colours& dashes,
                             const ze_rect& area);

// Draws the photo unscaled (see draw_small_image), the outline one photo pixel wide.
//
// Selected is mask value 1, outside is 0. A selected pixel is outline when one of its four
// neighbours in the photo is outside, and on the photo's outer rows and columns.
void draw_small_image_with_outline(const view_pixels& view, const outlined_photo& outlined,
                                   const dash_colours& dashes, const ze_rect& area);
