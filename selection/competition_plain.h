// DoSelection and DeSelection as they are defined: pixel by pixel, with D_Queue as it stands.
//
// front_competition.cpp does the same faster. It comes here with what it cannot be sure of, such as
// a list that an earlier stroke left broken.
#pragma once

#include "selection/ER_selection.h"

namespace plain {

// As ER_selection's methods of these names, of `engine`.
void DoSelection(ER_selection* engine, int* image, unsigned char* mask, int width, int height,
                 int x, int y, ze_rect* rect);
void DeSelection(ER_selection* engine, int* image, unsigned char* mask, int width, int height,
                 int x, int y, ze_rect* rect);

}  // namespace plain
