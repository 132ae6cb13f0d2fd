// Mask values of a lasso's outline, between its segments and the pass that fills or clears it.
#pragma once

constexpr unsigned char ADDED_NEW = 1;         // adding, over 0
constexpr unsigned char ADDED_OVER = 5;        // adding, over anything else
constexpr unsigned char REMOVED_SELECTED = 4;  // removing, over 1
constexpr unsigned char REMOVED_OTHER = 3;     // removing, over anything else
