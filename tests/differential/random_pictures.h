// Random photos and masks of the kinds that the library's algorithms tell apart.
#pragma once

#include <vector>

#include "tests/differential/random_source.h"

// width * height pixels: uniform, two colours, pure noise, blocks with sharp edges and a little
// noise, or a small palette that makes many ties.
std::vector<int> random_photo(random_source& random, int width, int height);

// width * height bytes of 0 and 1: empty, full, noise, specks, rings in rings, a spiral, a comb,
// diagonal chains, rectangles (also beyond the edges), one-pixel lines.
std::vector<unsigned char> random_mask(random_source& random, int width, int height);

// Overwrites some pixels with values from `first` to `last`.
void sprinkle(random_source& random, std::vector<unsigned char>* mask, int first, int last);
