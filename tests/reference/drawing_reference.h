// Slow, literal models of what the view-drawing methods compute. The library is compared with
// them.
//
// Plain functions on buffers, without Java: the argument lists are the methods', unread arguments
// included, with a vector for each array and the rectangle as left, right, top, bottom. The
// position under a view pixel is computed for that pixel alone, in 64 bits, and then wrapped to
// 32: no accumulator runs along. Every index is flat and bounds checked; a view index outside the
// view throws std::out_of_range. Photo and mask hold at least one element even where a size is 0
// or less, for the clamps then lead to element 0.

#pragma once

#include <cstdint>
#include <vector>

namespace reference {

// Each drawing method returns 1.
int native_drawImage(std::vector<int32_t>& view, int view_width, int view_height,
                     const std::vector<int32_t>& photo, int photo_width, int photo_height,
                     float scale, int offset_x, int offset_y, int left, int right, int top,
                     int bottom);

int native_drawSmallImage(std::vector<int32_t>& view, int view_width, int view_height,
                          const std::vector<int32_t>& photo, int photo_width, int photo_height,
                          int left, int right, int top, int bottom);

void native_setImagePoints(int columns, int rows, int unread_3, int unread_4, float scale,
                           int offset_x, int offset_y, std::vector<int32_t>& points);

int native_drawImageWithMaskContour(std::vector<int32_t>& view, int view_width, int view_height,
                                    const std::vector<int32_t>& photo, int photo_width,
                                    int photo_height, const std::vector<int8_t>& mask, float scale,
                                    int offset_x, int offset_y, int32_t first_colour,
                                    int32_t second_colour, int left, int right, int top,
                                    int bottom);

int native_drawSmallImageWithMaskContour(std::vector<int32_t>& view, int view_width,
                                         int view_height, const std::vector<int32_t>& photo,
                                         int photo_width, int photo_height,
                                         const std::vector<int8_t>& mask, int32_t first_colour,
                                         int32_t second_colour, int left, int right, int top,
                                         int bottom);

}  // namespace reference
