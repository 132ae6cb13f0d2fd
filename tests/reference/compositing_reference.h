// Slow, literal models of the functions that combine a photo with its mask. The library is
// compared with them.
//
// Every pixel is looked up by its own 64-bit index, bounds checked: a call that leaves one of its
// buffers throws std::out_of_range. The argument lists are the library's, unread arguments
// included, with a vector for each pointer. Source and destination may be the same vector.

#pragma once

#include <cstdint>
#include <vector>

namespace reference {

// dst[i] = grey of src[i] for every i below width * height, by the sign of the product: two
// negative sizes count as two positive ones.
void ze_argb2gray(const std::vector<uint32_t>& src, int width, int height,
                  std::vector<uint32_t>& dst);

// In the inclusive rectangle, copies the pixels whose mask entry is 1 and greys the others. Model
// of ze_draw_withmask_v2 too.
void ze_draw_withmask(const std::vector<uint32_t>& src, std::vector<uint32_t>& dst,
                      const std::vector<uint8_t>& mask, int width, int left, int right, int top,
                      int bottom);

// Greys the pixels whose mask entry is 1, copies the others, and inverts the mask.
void ze_draw_reverse_mask(const std::vector<uint32_t>& src, std::vector<uint32_t>& dst,
                          std::vector<uint8_t>& mask, int width, int height);

// Inverts a mask of mask_width * mask_height entries, then draws the photo through it: copies the
// pixels whose entry, at `ratio` mask pixels per photo pixel, is 1 and greys the others. The lookup
// is not clamped: a flat index inside the mask reads what is there, one outside counts as not
// selected.
void ze_draw_reverse_mask_v2(const std::vector<uint32_t>& src, std::vector<uint32_t>& dst,
                             std::vector<uint8_t>& mask, int unread, int width, int height,
                             int mask_width, int mask_height, float ratio);

}  // namespace reference
