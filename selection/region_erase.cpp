#include <cstdint>

#include "selection/contour_tracer.h"
#include "selection/region_shaping.h"

namespace {

constexpr unsigned char SELECTED = 1;
constexpr unsigned char VISITED = 2;  // by the counting scan; erased in the end unless restored

const value_set REGION(SELECTED, VISITED);

// Marks the interior of the region traced last and returns how many pixels that turned from
// selected to visited. Contour pixels are visited already and do not count.
//
// Deliberate: `inside` carries over from the end of a row to the start of the next, and a contour
// pixel with a marker on its left stays inside whatever is on its right, so that counts depend on
// what else lies in the union of the contours.
int64_t count_interior(const region_mask& mask, const marker_buffer& markers) {
    const ze_rect area = mask.contours;
    int64_t count = 0;
    bool inside = false;
    for (int y = area.top; y <= area.bottom; ++y) {
        for (int x = area.left; x <= area.right; ++x) {
            unsigned char& pixel = mask.at(x, y);
            if (pixel == VISITED) {
                if (markers.on_left_of(x, y)) {
                    inside = true;
                } else if (markers.on_right_of(x, y)) {
                    inside = false;
                }
            } else if (inside && pixel == SELECTED) {
                pixel = VISITED;
                ++count;
            }
        }
    }
    return count;
}

// Makes the interior of the survivor, whose contour is SELECTED again, selected again.
//
// Deliberate: `inside` carries over from row to row here too, but a marker on the right ends it.
void restore_interior(const region_mask& mask, const marker_buffer& markers, ze_rect* boundary) {
    const ze_rect area = mask.contours;
    bool inside = false;
    for (int y = area.top; y <= area.bottom; ++y) {
        for (int x = area.left; x <= area.right; ++x) {
            unsigned char& pixel = mask.at(x, y);
            if (pixel == SELECTED) {
                if (markers.on_left_of(x, y)) inside = true;
                if (markers.on_right_of(x, y)) inside = false;
            } else if (inside && pixel == VISITED) {
                pixel = SELECTED;
                include(boundary, x, y);
            }
        }
    }
}

// Gives every visited pixel of the box its final value. Widens `visited` over those, and
// `selected`, where there is one, over the selected.
void settle_visited(const region_mask& mask, unsigned char value, ze_rect* visited,
                    ze_rect* selected) {
    for (int y = mask.box.top; y <= mask.box.bottom; ++y) {
        for (int x = mask.box.left; x <= mask.box.right; ++x) {
            unsigned char& pixel = mask.at(x, y);
            if (pixel == VISITED) {
                pixel = value;
                include(visited, x, y);
            } else if (selected && pixel == SELECTED) {
                include(selected, x, y);
            }
        }
    }
}

}  // namespace

void Erase_Region(unsigned char* cells, int width, int height, ze_rect* boundary, ze_rect* rect) {
    const ze_rect box = clip_to_image(*boundary, width, height);
    *boundary = empty_beyond_image(width, height);
    marker_buffer markers(width, height);
    if (!markers) return;
    region_mask mask(cells, width, height, box);

    int64_t regions = 0;
    int64_t best_count = 0;
    int best_x = -1;
    int best_y = -1;
    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (mask.at(x, y) != SELECTED) continue;
            trace_contour(&mask, &markers, x, y, REGION, VISITED);
            const int64_t count = count_interior(mask, markers);
            if (best_count <= count) {
                best_count = count;
                best_x = x;
                best_y = y;
            }
            ++regions;
        }
    }
    if (regions <= 1) {
        settle_visited(mask, SELECTED, boundary, nullptr);
        return;
    }
    markers.clear();
    trace_contour(&mask, &markers, best_x, best_y, REGION, SELECTED);
    restore_interior(mask, markers, boundary);
    settle_visited(mask, 0, rect, boundary);
}
