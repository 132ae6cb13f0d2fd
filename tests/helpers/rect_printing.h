// Comparing and printing rectangles in tests.
#pragma once

#include <ostream>

#include "selection/rectangles.h"

inline std::ostream& operator<<(std::ostream& out, const ze_rect& r) {
    return out << '{' << r.left << ", " << r.right << ", " << r.top << ", " << r.bottom << '}';
}
