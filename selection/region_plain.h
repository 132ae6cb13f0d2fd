// The passes on whole regions, as plainly as they can be said: the definition of those in
// region_shaping.h, which give the same bits sooner. Arguments and results as there.
//
// After each region that it traces, a pass goes over the whole box of all contours so far; on a
// large mask with a thousand specks that takes seconds.
#pragma once

#include "selection/ze_rect.h"

namespace plain {

void Fill_Region(unsigned char* mask, int width, int height, int left, int right, int top,
                 int bottom, ze_rect* rect);

void Erase_Region(unsigned char* mask, int width, int height, ze_rect* boundary, ze_rect* rect);

int ze_lasso_add_fill_mask(unsigned char* mask, int width, int height, int left, int right, int top,
                           int bottom);

int ze_lasso_del_fill_mask(unsigned char* mask, int width, int height, int left, int right, int top,
                           int bottom);

}  // namespace plain
