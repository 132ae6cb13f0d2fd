#include "selection/contour_tracer.h"
#include "selection/interior_pass.h"
#include "selection/lasso_values.h"
#include "selection/region_bits.h"
#include "selection/region_shaping.h"

// The filling passes; region_plain.cpp has them pixel by pixel.

namespace {

// A visited pixel is never looked at as a pixel again, so its final value is written to the mask as
// soon as it is known: for those that the mask starts with, when the bits are made, and for those
// filled, when they are. Contour pixels of a selection hold it already.
constexpr region_values HOLES = {value_set(1, VISITED_VALUE), value_set(VISITED_VALUE), 1};

constexpr region_values ADDING_LASSO = {value_set(ADDED_NEW, ADDED_OVER, VISITED_VALUE),
                                        value_set(ADDED_OVER, VISITED_VALUE), 1};

// The selection is no region here: the fill reaches it from the outline around it.
constexpr region_values REMOVING_LASSO = {value_set(REMOVED_OTHER, REMOVED_SELECTED, VISITED_VALUE),
                                          value_set(REMOVED_OTHER, REMOVED_SELECTED, VISITED_VALUE),
                                          0};

// Makes visited what lies between left and right contour pixels.
struct filling {
    static constexpr bool CROSSES_ROWS = false;

    static flag_events events(bit_word visited, bit_word marked_left, bit_word marked_right) {
        return {visited & marked_left & ~marked_right, visited & marked_right};
    }

    bit_word turn(region_bits* bits, word_place at, bit_word inside) const {
        const bit_word filled = inside & ~bits->visited(at);
        if (filled == 0) return filled;
        const bit_word joining = filled & ~bits->member(at);
        bits->visited(at) |= filled;
        if (joining == 0) return filled;
        bits->member(at) |= joining;
        if (changed && !bits->includes_bits(*changed, at, joining)) {
            bits->include_bits(changed, at, bits->with_value(at, joining, 0));
        }
        bits->write(at, joining, value);
        return filled;
    }

    unsigned char value;
    ze_rect* changed;  // widened over pixels that were 0; may be null
};

// Runs one filling pass. Returns 0 when the work buffer cannot be had, otherwise 1.
int fill_regions(const region_values& values, unsigned char* mask, int width, int height,
                 const ze_rect& box, ze_rect* changed) {
    region_bits bits(mask, width, height, box, values);
    if (!bits) return 0;
    filling rules = {values.replacement, changed};
    interior_pass<filling> interiors(&bits, &rules);
    bits.for_each_unvisited([&](cell start) {
        bits.trace(start, [&bits](cell c) { bits.set_visited(c); });
        interiors.run();
    });
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
