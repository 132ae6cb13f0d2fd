// The definition of the view-drawing loops of view_image.h and view_outline.h: one view pixel after
// another. What each draws is said there.
//
// The fast loops leave to these what they have no stretches for: views and photos that share their
// pixels, photos without pixels, and positions that run backwards or wrap.
#pragma once

#include "jni/view_geometry.h"
#include "jni/view_outline.h"

namespace plain {

void draw_image(const view_pixels& view, const photo_pixels& photo, float scale, int offset_x,
                int offset_y, const ze_rect& area);

void draw_small_image(const view_pixels& view, const photo_pixels& photo, const ze_rect& area);

void draw_image_with_outline(const view_pixels& view, const outlined_photo& outlined, float scale,
                             int offset_x, int offset_y, const dash_colours& dashes,
                             const ze_rect& area);

void draw_small_image_with_outline(const view_pixels& view, const outlined_photo& outlined,
                                   const dash_colours& dashes, const ze_rect& area);

}  // namespace plain
