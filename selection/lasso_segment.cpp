// Segments of a lasso's outline.

#include <algorithm>
#include <cstdlib>
#include <utility>

#include "selection/ER_selection.h"
#include "selection/lasso_values.h"
#include "selection/rectangles.h"
#include "support/arithmetic.h"
#include "support/fixed_point.h"

namespace {

// One axis of a segment's two ends.
struct ends {
    int first;
    int last;
};

// Calls visit(along, across) for each step along a segment's longer axis, from the lower end to the
// higher one. `across` stays below `size`.
template <class Visit>
void walk(ends along, ends across, int size, Visit visit) {
    if (along.first > along.last) {
        std::swap(along.first, along.last);
        std::swap(across.first, across.last);
    }
    const int step = wrap_sub(itofix(across.last), itofix(across.first)) /
                     std::max(along.last - along.first, 1);  // a point takes no step
    int offset = 0;
    for (int i = along.first; i <= along.last; ++i) {
        visit(i, std::clamp(wrap_add(fixtoi(offset), across.first), 0, size - 1));
        offset = wrap_add(offset, step);
    }
}

// Draws a segment, each pixel becoming outline_value(pixel).
template <class OutlineValue>
void draw_segment(unsigned char* mask, int width, int height, int x0, int y0, int x1, int y1,
                  ze_rect* rect, OutlineValue outline_value) {
    const auto outside = [](int position, int size) { return position < 0 || position >= size; };
    if (outside(x0, width) || outside(x1, width) || outside(y0, height) || outside(y1, height)) {
        return;
    }
    const auto draw = [&](int x, int y) {
        unsigned char& pixel = mask[x + ptrdiff_t{y} * width];
        pixel = outline_value(pixel);
        include(rect, x, y);
    };
    if (std::abs(x0 - x1) < std::abs(y0 - y1)) {
        walk({y0, y1}, {x0, x1}, width, [&draw](int y, int x) { draw(x, y); });
    } else {
        walk({x0, x1}, {y0, y1}, height, draw);
    }
}

}  // namespace

void ER_selection::Lasso_Add(unsigned char* mask, int width, int height, int x0, int y0, int x1,
                             int y1, ze_rect* rect) {
    draw_segment(mask, width, height, x0, y0, x1, y1, rect,
                 [](unsigned char pixel) { return pixel == 0 ? ADDED_NEW : ADDED_OVER; });
}

void ER_selection::Lasso_Del(unsigned char* mask, int width, int height, int x0, int y0, int x1,
                             int y1, ze_rect* rect) {
    draw_segment(mask, width, height, x0, y0, x1, y1, rect,
                 [](unsigned char pixel) { return pixel == 1 ? REMOVED_SELECTED : REMOVED_OTHER; });
}
