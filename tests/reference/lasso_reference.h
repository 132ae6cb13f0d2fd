// Slow model of the lasso outline: one segment, one pixel thick, drawn into a mask.
#pragma once

#include <vector>

#include "tests/reference/basics_reference.h"

namespace reference {

// Writes 1 over 0 and 5 over everything else. `rect` is widened by every pixel written.
void Lasso_Add(std::vector<unsigned char>& mask, int width, int height, int x0, int y0, int x1,
               int y1, reference::rect* rect);

// Writes 4 over 1 and 3 over everything else.
void Lasso_Del(std::vector<unsigned char>& mask, int width, int height, int x0, int y0, int x1,
               int y1, reference::rect* rect);

}  // namespace reference
