// Slow models of the passes over whole regions of a mask: filling holes, erasing what a shrink cut
// off, and filling or clearing what a lasso encloses.
//
// A box that reaches beyond the image is cut to the image. Sizes of 0 or less leave no pixel.
#pragma once

#include <cstddef>
#include <vector>

#include "tests/reference/basics_reference.h"

namespace reference {

void Fill_Region(std::vector<unsigned char>& mask, int width, int height, int left, int right,
                 int top, int bottom, reference::rect* rect);

// `boundary` is the box to work in and comes back as the box of what is left.
void Erase_Region(std::vector<unsigned char>& mask, int width, int height,
                  reference::rect* boundary, reference::rect* rect);

// Always 1: the models have no allocation that fails.
int ze_lasso_add_fill_mask(std::vector<unsigned char>& mask, int width, int height, int left,
                           int right, int top, int bottom);
int ze_lasso_del_fill_mask(std::vector<unsigned char>& mask, int width, int height, int left,
                           int right, int top, int bottom);

// The markers that a trace leaves beside a contour, one per position from (-1, -1) to
// (width, height).
//
// The library keeps them in rows of `width` bytes, so a position left of a row is the last one of
// the row above, and a position right of a row is the first one of the row below. Here that is said
// in so many words instead of following from an index.
class markers {
public:
    markers(int width, int height);
    void set(int x, int y);
    bool get(int x, int y) const;

private:
    std::size_t place(int x, int y) const;

    int width, height;
    std::vector<bool> marked;
};

}  // namespace reference
