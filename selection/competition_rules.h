// What growing and shrinking differ in, and nothing else sets them apart; and what the two versions
// of the competition share: front_competition.cpp, which the library runs, and
// competition_plain.cpp, which defines what comes out.
#pragma once

#include <algorithm>
#include <cstdint>

#include "selection/ER_selection.h"

// Mask values during a stroke, of pixels already won. A pixel that holds one of them is never
// reached again.
constexpr unsigned char WON_BY_STROKE = 2;
constexpr unsigned char KEPT_LIKE_SEEDS = 3;  // won by the keep front, held the value of its seeds
constexpr unsigned char KEPT_OTHER = 4;       // won by the keep front, held another value

// Growing: pixels won by the stroke become selected.
struct growing {
    // The keep front starts on unselected rim pixels.
    static constexpr unsigned char SEED_VALUE = 0;

    // Rows and columns at the far side of the square that are neither priced nor seeded.
    static constexpr int UNSEEDED_EDGE = 0;

    // Only growing clears the queue's spare field.
    static constexpr bool CLEARS_SPARE = true;

    // The point may not lie on the image's outermost rows and columns.
    static bool may_start(const unsigned char*, int width, int height, int x, int y) {
        return x >= 1 && x < width - int64_t{1} && y >= 1 && y < height - int64_t{1};
    }

    // Values that a front may still win. Deliberate: any other value blocks both fronts.
    static bool is_open(unsigned char value) { return value <= 1; }

    // Turns what the competition left in a pixel into its final value; true when rect takes it in.
    //
    // Deliberate: foreign values in the square become 0, and rect covers pixels that were selected
    // all along.
    static bool settle(unsigned char* pixel) {
        *pixel = *pixel == 1 || *pixel == WON_BY_STROKE || *pixel == KEPT_OTHER;
        return *pixel == 1;
    }
};

// Shrinking: pixels won by the stroke become unselected.
struct shrinking {
    // The keep front starts on selected rim pixels.
    static constexpr unsigned char SEED_VALUE = 1;

    // Deliberate: so keep seeds are missing at the right and at the bottom of the brush.
    static constexpr int UNSEEDED_EDGE = 1;

    static constexpr bool CLEARS_SPARE = false;

    // The point must be selected.
    static bool may_start(const unsigned char* mask, int width, int height, int x, int y) {
        return x >= 0 && x < width && y >= 0 && y < height && mask[x + ptrdiff_t{y} * width] == 1;
    }

    // Deliberate: foreign values are won like any other and then count as not selected.
    static bool is_open(unsigned char value) { return value < WON_BY_STROKE || value > KEPT_OTHER; }

    // Deliberate: values above 4 that no front reached stay. 2, 3 and 4 are taken for marks
    // wherever they come from, so a lasso value 3 left in the square comes out selected. rect
    // covers pixels that the keep front reached and that were unselected all along.
    static bool settle(unsigned char* pixel) {
        if (*pixel == KEPT_LIKE_SEEDS) *pixel = 1;
        if (*pixel != WON_BY_STROKE && *pixel != KEPT_OTHER) return false;
        *pixel = 0;
        return true;
    }
};

// The mask value that marks a pixel of `value` as won by the stroke's front (label 1) or by the
// keep front (label 0).
template <class Rules>
unsigned char mark_of(int label, unsigned char value) {
    if (label == 1) return WON_BY_STROKE;
    return value == Rules::SEED_VALUE ? KEPT_LIKE_SEEDS : KEPT_OTHER;
}

// The brush square around (x, y) without its last `omitted` rows and columns, clipped to the image;
// empty for a negative radius.
inline ze_rect square_in_image(const ER_selection& engine, int width, int height, int x, int y,
                               int omitted) {
    const int64_t r = engine.radius;
    const auto first = [r](int centre, int size) {
        return static_cast<int>(std::clamp<int64_t>(centre - r, 0, size));
    };
    const auto last = [r, omitted](int centre, int size) {
        return static_cast<int>(std::clamp<int64_t>(centre + r - omitted, -1, size - 1));
    };
    return {first(x, width), last(x, width), first(y, height), last(y, height)};
}
