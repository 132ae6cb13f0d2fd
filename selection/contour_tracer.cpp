#include "selection/contour_tracer.h"

#include <cstdint>

#include "selection/rectangles.h"
#include "support/ze_alloc.h"

namespace {

// The eight neighbours, clockwise from the upper left; y grows downwards. Odd directions are
// straight: up, right, down, left.
constexpr int DIRECTIONS = 8;
constexpr int LEFT = 7;
constexpr int DX[DIRECTIONS] = {-1, 0, 1, 1, 1, 0, -1, -1};
constexpr int DY[DIRECTIONS] = {-1, -1, -1, 0, 1, 1, 1, 0};

constexpr int next_clockwise(int direction) { return (direction + 1) % DIRECTIONS; }
constexpr int opposite(int direction) { return (direction + DIRECTIONS / 2) % DIRECTIONS; }
constexpr bool is_straight(int direction) { return direction % 2 == 1; }

bool contains(const ze_rect& box, int x, int y) {
    return x >= box.left && x <= box.right && y >= box.top && y <= box.bottom;
}

}  // namespace

size_t marker_bytes(int width, int height) {
    const int64_t bytes = (int64_t{width} + 2) * (int64_t{height} + 2);
    return bytes < 0 || bytes > PTRDIFF_MAX ? 0 : static_cast<size_t>(bytes);
}

marker_buffer::marker_buffer(int mask_width, int mask_height)
    : width(mask_width),
      size(marker_bytes(mask_width, mask_height)),
      bytes(size == 0 ? nullptr : static_cast<unsigned char*>(ze_calloc(size, 1))) {}

marker_buffer::~marker_buffer() { ze_free(bytes); }

void marker_buffer::clear() { ze_memset(bytes, 0, size); }

region_mask::region_mask(unsigned char* mask, int mask_width, int mask_height,
                         const ze_rect& inside)
    : cells(mask), width(mask_width), box(inside), contours{mask_width, -1, mask_height, -1} {}

void trace_contour(region_mask* mask, marker_buffer* markers, int start_x, int start_y,
                   value_set region, unsigned char visited) {
    mask->at(start_x, start_y) = visited;
    int x = start_x;
    int y = start_y;
    int direction = LEFT;
    for (int looked_at = 0; looked_at < DIRECTIONS;) {
        const int nx = x + DX[direction];
        const int ny = y + DY[direction];
        if (nx == start_x && ny == start_y) return;
        if (contains(mask->box, nx, ny) && region.has(mask->at(nx, ny))) {
            mask->at(nx, ny) = visited;
            include(&mask->contours, nx, ny);
            x = nx;
            y = ny;
            direction = next_clockwise(opposite(direction));
            looked_at = 0;
        } else {
            if (is_straight(direction)) markers->set(nx, ny);
            direction = next_clockwise(direction);
            ++looked_at;
        }
    }
}
