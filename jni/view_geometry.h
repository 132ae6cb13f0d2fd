// What the view-drawing loops share: their buffers, and the fixed-point walk from view to photo.
//
// A rectangle of the view is an inclusive ze_rect. REQUIRES: it lies in the view wherever a loop
// draws it; nothing is clipped against the view.
#pragma once

#include <algorithm>
#include <cstdint>

#include "selection/ze_rect.h"
#include "support/arithmetic.h"

// The view's pixels 0xAARRGGBB, rows `width` apart. Its height is never asked for.
struct view_pixels {
    int32_t* pixels;
    int width;

    int32_t* row(int64_t y) const { return pixels + y * width; }
};

// A photo of width * height pixels 0xAARRGGBB.
struct photo_pixels {
    const int32_t* pixels;
    int width;
    int height;

    const int32_t* row(int y) const { return pixels + int64_t{y} * width; }
};

// What view column (or row) 0 shows, and how far one view pixel goes, along one axis of the photo.
struct view_axis {
    int32_t origin;  // photo position of view position 0, 16.16
    int32_t step;    // photo pixels per view pixel, 16.16

    // Photo position of a view position, 16.16. Wraps in 32 bits, like every sum of positions.
    int32_t at(int position) const { return wrap_add(origin, wrap_mul(position, step)); }
};

constexpr int32_t ONE_PIXEL = 0x10000;  // 1 in 16.16
constexpr int32_t HALF_PIXEL = 0x8000;

// The axis for `offset`, the photo column or row that view position 0 shows, and a scale in photo
// pixels per view pixel. The scale loses what lies below 1/65536; beyond 16.16 it saturates.
inline view_axis axis_of(float scale, int offset, int32_t rounding = 0) {
    return {wrap_add(wrap_mul(offset, ONE_PIXEL), rounding), saturating_truncate(scale * 65536.0f)};
}

// Whole photo pixels of a 16.16 position, rounded towards minus infinity.
inline int whole(int32_t position) { return position >> 16; }

// Deliberate: the far end first, so that a photo without pixels gives 0.
inline int clamp_to_photo(int64_t position, int size) {
    return static_cast<int>(std::max<int64_t>(std::min<int64_t>(position, int64_t{size} - 1), 0));
}
