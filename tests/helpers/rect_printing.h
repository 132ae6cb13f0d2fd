// Comparing and printing rectangles in tests.
#pragma once

#include <ostream>

#include "selection/ze_rect.h"

inline bool operator==(const ze_rect& a, const ze_rect& b) {
    return a.left == b.left && a.right == b.right && a.top == b.top && a.bottom == b.bottom;
}

inline std::ostream& operator<<(std::ostream& out, const ze_rect& r) {
    return out << '{' << r.left << ", " << r.right << ", " << r.top << ", " << r.bottom << '}';
}
