#include "tests/reference/basics_reference.h"

#include <algorithm>
#include <cstddef>
#include <stdexcept>

namespace reference {
namespace {

int wrapped(long long value) {
    const long long modulus = 1LL << 32;
    long long rest = value % modulus;
    if (rest < 0) rest += modulus;
    return static_cast<int>(rest < modulus / 2 ? rest : rest - modulus);
}

}  // namespace

bool operator==(const rect& a, const rect& b) {
    return a.left == b.left && a.right == b.right && a.top == b.top && a.bottom == b.bottom;
}

bool operator!=(const rect& a, const rect& b) { return !(a == b); }

std::ostream& operator<<(std::ostream& out, const rect& r) {
    return out << '{' << r.left << ", " << r.right << ", " << r.top << ", " << r.bottom << '}';
}

void unite(rect& a, const rect& b) {
    a.left = std::min(a.left, b.left);
    a.right = std::max(a.right, b.right);
    a.top = std::min(a.top, b.top);
    a.bottom = std::max(a.bottom, b.bottom);
}

void unite(rect& a, int x, int y) { unite(a, rect{x, x, y, y}); }

int wrap_add(int a, int b) { return wrapped(static_cast<long long>(a) + b); }

int wrap_sub(int a, int b) { return wrapped(static_cast<long long>(a) - b); }

bool in_image(long long x, long long y, int width, int height) {
    return 0 <= x && x < width && 0 <= y && y < height;
}

unsigned char& pixel(std::vector<unsigned char>& mask, int width, int x, int y) {
    if (x < 0 || x >= width || y < 0) throw std::out_of_range("mask pixel");
    return mask.at(static_cast<std::size_t>(y) * static_cast<std::size_t>(width) +
                   static_cast<std::size_t>(x));
}

}  // namespace reference
