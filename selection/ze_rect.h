// Rectangle of the selection family: inclusive pixel coordinates, left and right before top and
// bottom, as the Java side's Rect is read and written field by field.
//
// An empty rectangle has left and top at or beyond the far edge and right = bottom = 0, so that the
// first pixel or rectangle taken in replaces it. Nothing tests for emptiness.
#pragma once

typedef struct ze_rect {
    int left;
    int right;
    int top;
    int bottom;
} ze_rect;
