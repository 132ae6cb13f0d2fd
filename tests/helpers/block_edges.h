// Lengths and places at which loops over words of 64 and blocks of 128 begin, end, or have a rest.
#pragma once

#include <vector>

constexpr int LENGTHS_AROUND_BLOCKS[] = {1,   2,   63,  64,  65,  127, 128,
                                         129, 191, 192, 193, 255, 256, 257};

// Every place of a length of 129; of other lengths those beside multiples of 64, the first and the
// last ones.
inline std::vector<int> places_in(int length) {
    std::vector<int> places;
    for (int i = 0; i < length; ++i) {
        const bool beside_block = (i + 2) % 64 < 4;
        if (length == 129 || beside_block || i + 2 >= length) places.push_back(i);
    }
    return places;
}
