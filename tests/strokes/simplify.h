// Makes a stroke case as simple as it can be while something stays true of it.
#pragma once

#include <functional>

#include "tests/strokes/stroke_cases.h"

// Fewer strokes, a smaller brush, smaller pictures, fewer foreign and selected pixels, fewer
// colours, as long as `is_kept` is true of the result. REQUIRES: it is true of `c`.
stroke_case simplified(const stroke_case& c,
                       const std::function<bool(const stroke_case&)>& is_kept);
