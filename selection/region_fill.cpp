#include "selection/contour_tracer.h"
#include "selection/lasso_values.h"
#include "selection/region_shaping.h"

namespace {

// Mask value of contour and interior during a pass.
constexpr unsigned char VISITED = 2;

// What sets the filling passes apart.
struct fill_rules {
    value_set starts;           // values at which the scan begins a region
    value_set region;           // values that belong to it
    value_set replaced;         // values that the end of the pass turns into ...
    unsigned char replacement;  // ... this one
};

constexpr fill_rules HOLES = {value_set(1), value_set(1, VISITED), value_set(VISITED), 1};

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

}  // namespace

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
