// The edge-aware strokes, and how they were carried out. See ER_selection for the arguments.
#pragma once

#include "selection/ER_selection.h"

enum class stroke_run {
    NONE,    // nothing to do
    FIRST,   // with the queue that knows one entry of D_Queue's index
    SECOND,  // with the queue that knows four, because the first was in doubt
    PLAIN,   // as competition_plain.cpp does it
};

stroke_run run_growing(ER_selection* engine, int* image, unsigned char* mask, int width, int height,
                       int x, int y, ze_rect* rect);
stroke_run run_shrinking(ER_selection* engine, int* image, unsigned char* mask, int width,
                         int height, int x, int y, ze_rect* rect);
