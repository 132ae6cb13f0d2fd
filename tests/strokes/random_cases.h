// Random stroke cases of the kinds in which the queue of fronts has much to decide.
#pragma once

#include <cstdint>
#include <vector>

#include "tests/strokes/stroke_cases.h"

// The case of a seed, without a name and without what it comes to: a new one or, when there are
// known ones, one of them with a few changes. What is rare is mostly near what is rare.
stroke_case random_case(uint64_t seed, const std::vector<stroke_case>& known);
