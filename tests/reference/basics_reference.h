// What the slow models of the selection have in common: the rectangle, sums that wrap, and access
// to a mask that throws when it is asked for a pixel outside of the picture.
#pragma once

#include <ostream>
#include <vector>

namespace reference {

// Inclusive pixel coordinates, signed and unordered: a rectangle with left > right is a valid
// value.
struct rect {
    int left, right, top, bottom;
};

bool operator==(const rect& a, const rect& b);
bool operator!=(const rect& a, const rect& b);
std::ostream& operator<<(std::ostream& out, const rect& r);

// Widens `a` so that it covers `b`: smaller left and top, larger right and bottom.
void unite(rect& a, const rect& b);
void unite(rect& a, int x, int y);

// Sum and difference modulo 2^32, read as signed.
int wrap_add(int a, int b);
int wrap_sub(int a, int b);

bool in_image(long long x, long long y, int width, int height);

// The byte of (x, y). Throws std::out_of_range for a column beyond the row, also when the flat
// index would still lie in the mask, and for an index beyond the mask.
unsigned char& pixel(std::vector<unsigned char>& mask, int width, int x, int y);

}  // namespace reference
