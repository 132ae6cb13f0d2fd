// Slow, literal model of ze_modify_mask, which carries a mask made on a reduced copy of a photo
// over to the full-size mask. The library is compared with it.
//
// The sample pixels of an edge block's reference colour are gathered in a list, repetitions
// included, and averaged afterwards. Every index is flat, 64-bit and bounds checked: a block that
// leaves the large buffers throws std::out_of_range.

#pragma once

#include <cstdint>
#include <vector>

namespace reference {

// Transfers the inclusive rectangle of the small mask onto the large mask. `ratio` is small size
// divided by large size. flag 0 adds to the large mask, any other removes from it. The last column
// and row of the rectangle sample one photo column and row beyond their blocks, unless they are the
// small mask's own last.
void ze_modify_mask(const std::vector<uint8_t>& small_mask, std::vector<uint8_t>& large_mask,
                    const std::vector<uint32_t>& large_pixels, int small_width, int small_height,
                    int large_width, int unread, float ratio, int left, int right, int top,
                    int bottom, int flag);

}  // namespace reference
