// Colour cost of a step between two pixels.
#pragma once

#include <cstdint>

// Squared Euclidean distance in red, green and blue: 0 to MAX_COLOUR_COST. Alpha does not count.
constexpr int MAX_COLOUR_COST = 3 * 255 * 255;

inline int colour_cost(uint32_t a, uint32_t b) {
    const auto squared_difference = [a, b](int shift) {
        const int difference =
            static_cast<int>(a >> shift & 0xFF) - static_cast<int>(b >> shift & 0xFF);
        return difference * difference;
    };
    return squared_difference(16) + squared_difference(8) + squared_difference(0);
}
