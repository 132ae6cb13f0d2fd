#include "tests/reference/lasso_reference.h"

#include <cstdlib>
#include <map>
#include <utility>

namespace reference {
namespace {

// 16.16 fixed point, kept in 32 bits that wrap.
int to_fixed(int x) {
    int value = x;
    for (int doubling = 0; doubling < 16; ++doubling) value = wrap_add(value, value);
    return value;
}

// Nearest integer, halves upwards.
int from_fixed(int value) {
    long long remainder = value % 65536LL;
    if (remainder < 0) remainder += 65536;
    const long long floor = (value - remainder) / 65536;
    return static_cast<int>(remainder >= 32768 ? floor + 1 : floor);
}

int clamped(int value, int size) {
    if (value < 0) return 0;
    if (value >= size) return size - 1;
    return value;
}

// The pixels of a segment in the order of drawing: `major` runs from one end to the other, `minor`
// follows. Each is given as (major, minor).
std::vector<std::pair<int, int>> steps(int major0, int minor0, int major1, int minor1,
                                       int minor_size) {
    const int first = major0 < major1 ? major0 : major1;
    const int last = major0 < major1 ? major1 : major0;
    const int minor_first = major0 < major1 ? minor0 : minor1;
    const int minor_last = major0 < major1 ? minor1 : minor0;
    const int step = wrap_sub(to_fixed(minor_last), to_fixed(minor_first)) / (last - first);
    std::vector<std::pair<int, int>> result;
    int acc = 0;
    for (int major = first; major <= last; ++major) {
        result.emplace_back(major, clamped(wrap_add(from_fixed(acc), minor_first), minor_size));
        acc = wrap_add(acc, step);
    }
    return result;
}

// `becomes` says what a value turns into; a value it does not hold turns into `otherwise`.
void draw(std::vector<unsigned char>& mask, int width, int height, int x0, int y0, int x1, int y1,
          const std::map<int, int>& becomes, int otherwise, rect* grown) {
    if (!in_image(x0, y0, width, height) || !in_image(x1, y1, width, height)) return;

    std::vector<std::pair<int, int>> line;  // as (x, y)
    if (std::abs(x0 - x1) < std::abs(y0 - y1)) {
        for (const auto& [major, minor] : steps(y0, x0, y1, x1, width)) {
            line.emplace_back(minor, major);
        }
    } else if (x0 != x1) {
        line = steps(x0, y0, x1, y1, height);
    } else {
        line.emplace_back(x0, y0);
    }

    for (const auto& [x, y] : line) {
        unsigned char& value = pixel(mask, width, x, y);
        const auto found = becomes.find(value);
        value = static_cast<unsigned char>(found == becomes.end() ? otherwise : found->second);
        unite(*grown, x, y);
    }
}

}  // namespace

void Lasso_Add(std::vector<unsigned char>& mask, int width, int height, int x0, int y0, int x1,
               int y1, reference::rect* rect) {
    draw(mask, width, height, x0, y0, x1, y1, {{0, 1}}, 5, rect);
}

void Lasso_Del(std::vector<unsigned char>& mask, int width, int height, int x0, int y0, int x1,
               int y1, reference::rect* rect) {
    draw(mask, width, height, x0, y0, x1, y1, {{1, 4}}, 3, rect);
}

}  // namespace reference
