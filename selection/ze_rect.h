// Rectangle of the selection family.
#pragma once

// Inclusive pixel coordinates, left and right before top and bottom, as the Java side's Rect is
// read and written field by field.
//
// An empty rectangle has left and top at or beyond the far edge and right = bottom = 0, so that the
// first pixel or rectangle taken in replaces it. Nothing tests for emptiness.
typedef struct ze_rect {
    int left;    // column of the leftmost pixel
    int right;   // column of the rightmost pixel
    int top;     // row of the topmost pixel
    int bottom;  // row of the bottommost pixel
} ze_rect;
