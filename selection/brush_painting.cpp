// The plain brushes: they paint the brush into the mask without a look at the photo.

#include <algorithm>
#include <cstdint>

#include "selection/ER_selection.h"
#include "selection/brush_cells.h"
#include "selection/rectangles.h"

namespace {

// Turns `from` into `to` under the brush at (x, y).
void paint(const ER_selection& engine, unsigned char* mask, int width, int height, int x, int y,
           unsigned char from, unsigned char to, ze_rect* rect) {
    if (!has_buffers(engine)) return;
    const int64_t r = engine.radius;
    const int64_t top = std::max<int64_t>(y - r, 0);
    const int64_t bottom = std::min<int64_t>(y + r - 1, height - int64_t{1});
    const int64_t left = std::max<int64_t>(x - r, 0);
    const int64_t right = std::min<int64_t>(x + r - 1, width - int64_t{1});
    for (int64_t py = top; py <= bottom; ++py) {
        for (int64_t px = left; px <= right; ++px) {
            const auto cell =
                brush_cell(engine, static_cast<ptrdiff_t>(px - x), static_cast<ptrdiff_t>(py - y));
            unsigned char& pixel = mask[py * width + px];
            if (engine.brush_map[cell] == BRUSH_OUTSIDE || pixel != from) continue;
            pixel = to;
            include(rect, static_cast<int>(px), static_cast<int>(py));
        }
    }
}

}  // namespace

void ER_selection::Brush_Add(unsigned char* mask, int width, int height, int x, int y,
                             ze_rect* rect) {
    paint(*this, mask, width, height, x, y, 0, 1, rect);
}

void ER_selection::Brush_Del(unsigned char* mask, int width, int height, int x, int y,
                             ze_rect* rect) {
    paint(*this, mask, width, height, x, y, 1, 0, rect);
}
