#include <cstdint>

#include "selection/interior_pass.h"
#include "selection/rectangles.h"
#include "selection/region_bits.h"
#include "selection/region_shaping.h"

// The erasing pass; region_plain.cpp has it pixel by pixel.

namespace {

constexpr unsigned char SELECTED = 1;

// In the end a pixel that the mask starts with as visited is selected or erased like any other.
constexpr region_values SELECTION = {value_set(SELECTED, VISITED_VALUE), value_set(VISITED_VALUE),
                                     SELECTED};

// Makes visited what lies inside the region traced last, and counts it.
struct counting {
    // Deliberate: so counts depend on what else lies in the area of the contours.
    static constexpr bool CROSSES_ROWS = true;

    // Deliberate: a contour pixel with a marker on its left stays inside whatever is on its right.
    static flag_events events(bit_word visited, bit_word marked_left, bit_word marked_right) {
        return {visited & marked_left, visited & ~marked_left & marked_right};
    }

    bit_word turn(region_bits* bits, word_place at, bit_word inside) {
        const bit_word turned = inside & bits->member(at) & ~bits->visited(at);
        if (turned == 0) return turned;
        bits->visited(at) |= turned;
        count += count_bits(turned);
        return turned;
    }

    int64_t count = 0;
};

// Makes the interior of the survivor, whose contour is unvisited again, unvisited.
//
// Deliberate: the flag goes on from row to row here too, but a marker on the right clears it.
void restore_interior(region_bits* bits) {
    const ze_rect area = bits->contours;
    bool inside = false;
    region_bits::for_each_word(bits->occupied, area, [&](word_place at) {
        const bit_word here = bits_between(area.left, area.right, at.word);
        if (!bits->marked.has(at)) {
            if (inside) bits->visited(at) &= ~here;
            return;
        }
        const bit_word contour = bits->member(at) & ~bits->visited(at) & here;
        const bit_word right = bits->marked_right(at);
        const flag_events events = {contour & bits->marked_left(at) & ~right, contour & right};
        bits->visited(at) &= ~(events.inside(inside) & here);
        if (!events.none()) inside = events.last();
    });
}

}  // namespace

void Erase_Region(unsigned char* mask, int width, int height, ze_rect* boundary, ze_rect* rect) {
    const ze_rect box = *boundary;
    *boundary = empty_beyond_image(width, height);
    region_bits bits(mask, width, height, box, SELECTION);
    if (!bits) return;

    counting counted;
    interior_pass<counting> interiors(&bits, &counted);
    int64_t regions = 0;
    int64_t best_count = 0;
    cell best = {};
    bits.for_each_unvisited([&](cell start) {
        bits.trace(start, [&bits](cell c) { bits.set_visited(c); });
        counted.count = 0;
        interiors.run();
        if (best_count <= counted.count) {
            best_count = counted.count;
            best = start;
        }
        ++regions;
    });
    if (regions <= 1) {
        bits.include_all(boundary, [&bits](word_place at) { return bits.member(at); });
        return;
    }
    bits.clear_markers();
    bits.trace(best, [&bits](cell c) { bits.set_unvisited(c); });
    restore_interior(&bits);
    region_bits::for_each_word(bits.occupied, bits.all_cells(), [&](word_place at) {
        const bit_word erased = bits.visited(at);
        if (erased == 0) return;
        bits.include_bits(rect, at, erased);
        bits.write(at, erased, 0);
    });
    bits.include_all(boundary,
                     [&bits](word_place at) { return bits.member(at) & ~bits.visited(at); });
}
