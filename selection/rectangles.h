// What the library does with a ze_rect: empty forms, union, clipping.
#pragma once

#include <algorithm>
#include <cstddef>

#include "selection/ze_rect.h"
#include "support/arithmetic.h"

static_assert(sizeof(ze_rect) == 4 * sizeof(int) && offsetof(ze_rect, right) == sizeof(int) &&
                  offsetof(ze_rect, top) == 2 * sizeof(int),
              "callers lay the rectangle out as left, right, top, bottom");

inline bool operator==(const ze_rect& a, const ze_rect& b) {
    return a.left == b.left && a.right == b.right && a.top == b.top && a.bottom == b.bottom;
}

// The two empty forms.
//
// Deliberate: object and fill box start at the last column and row, stroke rectangles and rebuilt
// object boxes one beyond, and the caller sees the difference.
inline ze_rect empty_at_last_pixel(int width, int height) {
    return {wrap_sub(width, 1), 0, wrap_sub(height, 1), 0};
}
inline ze_rect empty_beyond_image(int width, int height) { return {width, 0, height, 0}; }

// Widens r to cover `other`.
inline void unite(ze_rect* r, const ze_rect& other) {
    r->left = std::min(r->left, other.left);
    r->right = std::max(r->right, other.right);
    r->top = std::min(r->top, other.top);
    r->bottom = std::max(r->bottom, other.bottom);
}

// Widens r to cover the pixel (x, y).
inline void include(ze_rect* r, int x, int y) { unite(r, {x, x, y, y}); }

// The part of r inside an image; left > right or top > bottom when there is none.
inline ze_rect clip_to_image(const ze_rect& r, int width, int height) {
    return {std::max(r.left, 0), std::min(r.right, std::max(width, 0) - 1), std::max(r.top, 0),
            std::min(r.bottom, std::max(height, 0) - 1)};
}
