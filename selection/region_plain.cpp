#include "selection/region_plain.h"

#include <cstdint>

#include "selection/contour_tracer.h"
#include "selection/lasso_values.h"
#include "selection/rectangles.h"

namespace {

constexpr unsigned char SELECTED = 1;

// Mask value of contour and interior during a pass.
constexpr unsigned char VISITED = 2;

// What sets the filling passes apart.
struct fill_rules {
    value_set starts;           // values at which the scan begins a region
    value_set region;           // values that belong to it
    value_set replaced;         // values that the end of the pass turns into ...
    unsigned char replacement;  // ... this one
};

constexpr fill_rules HOLES = {value_set(SELECTED), value_set(SELECTED, VISITED), value_set(VISITED),
                              SELECTED};

constexpr fill_rules ADDING_LASSO = {value_set(ADDED_NEW, ADDED_OVER),
                                     value_set(ADDED_NEW, ADDED_OVER, VISITED),
                                     value_set(ADDED_OVER, VISITED), 1};

// The selection is no region here: the fill reaches it from the outline around it.
constexpr fill_rules REMOVING_LASSO = {value_set(REMOVED_OTHER, REMOVED_SELECTED),
                                       value_set(REMOVED_OTHER, REMOVED_SELECTED, VISITED),
                                       value_set(REMOVED_OTHER, REMOVED_SELECTED, VISITED), 0};

// Sets what lies between left and right contour pixels to VISITED. Widens `filled`, where there is
// one, over pixels that were 0.
void fill_interiors(const region_mask& mask, const marker_buffer& markers, ze_rect* filled) {
    const ze_rect area = mask.contours;
    for (int y = area.top; y <= area.bottom; ++y) {
        bool inside = false;
        for (int x = area.left; x <= area.right; ++x) {
            unsigned char& pixel = mask.at(x, y);
            if (pixel == VISITED) {
                if (markers.on_left_of(x, y)) inside = true;
                if (markers.on_right_of(x, y)) inside = false;
            } else if (inside) {
                if (filled && pixel == 0) include(filled, x, y);
                pixel = VISITED;
            }
        }
    }
}

void replace_values(const region_mask& mask, value_set replaced, unsigned char replacement) {
    for (int y = mask.box.top; y <= mask.box.bottom; ++y) {
        for (int x = mask.box.left; x <= mask.box.right; ++x) {
            if (replaced.has(mask.at(x, y))) mask.at(x, y) = replacement;
        }
    }
}

// Runs one filling pass. Returns 0 when the work buffer cannot be had, otherwise 1.
int fill_regions(const fill_rules& rules, unsigned char* cells, int width, int height,
                 const ze_rect& box, ze_rect* filled) {
    marker_buffer markers(width, height);
    if (!markers) return 0;
    region_mask mask(cells, width, height, clip_to_image(box, width, height));
    for (int y = mask.box.top; y <= mask.box.bottom; ++y) {
        for (int x = mask.box.left; x <= mask.box.right; ++x) {
            if (!rules.starts.has(mask.at(x, y))) continue;
            trace_contour(&mask, &markers, x, y, rules.region, VISITED);
            fill_interiors(mask, markers, filled);
        }
    }
    replace_values(mask, rules.replaced, rules.replacement);
    return 1;
}

// ---- erasing: VISITED by the counting scan, then restored or erased

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

namespace plain {

void Fill_Region(unsigned char* mask, int width, int height, int left, int right, int top,
                 int bottom, ze_rect* rect) {
    fill_regions(HOLES, mask, width, height, {left, right, top, bottom}, rect);
}

int ze_lasso_add_fill_mask(unsigned char* mask, int width, int height, int left, int right, int top,
                           int bottom) {
    return fill_regions(ADDING_LASSO, mask, width, height, {left, right, top, bottom}, nullptr);
}

int ze_lasso_del_fill_mask(unsigned char* mask, int width, int height, int left, int right, int top,
                           int bottom) {
    return fill_regions(REMOVING_LASSO, mask, width, height, {left, right, top, bottom}, nullptr);
}

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

}  // namespace plain
