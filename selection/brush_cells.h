// The engine's buffers and the cells of its brush, as the sources of the engine see them.
#pragma once

#include <cstddef>

#include "selection/ER_selection.h"

// Every buffer that initial() takes is there.
bool has_buffers(const ER_selection& engine);

// Side of the brush square in cells; 0 for a negative radius.
inline ptrdiff_t brush_side(const ER_selection& engine) {
    return engine.radius < 0 ? 0 : 2 * static_cast<ptrdiff_t>(engine.radius) + 1;
}

// The cell of `engine`'s brush at (dx, dy) from its centre.
inline ptrdiff_t brush_cell(const ER_selection& engine, ptrdiff_t dx, ptrdiff_t dy) {
    return (dy + engine.radius) * brush_side(engine) + dx + engine.radius;
}
