// What the jobs work on: a real photo of 12 megapixels and masks of its size. The same in each run.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "selection/ze_rect.h"

constexpr int PHOTO_WIDTH = 4000;
constexpr int PHOTO_HEIGHT = 3000;
constexpr size_t PHOTO_PIXELS = size_t{PHOTO_WIDTH} * PHOTO_HEIGHT;

using pixel_buffer = std::vector<uint32_t>;      // 0xAARRGGBB
using mask_buffer = std::vector<unsigned char>;  // 1 is selected

// Reads the photo that report.py makes: blue, green, red, alpha of each pixel. False when the file
// is not that.
bool read_photo(const std::string& path);

// The photo. REQUIRES: read_photo was called. Not const, like the library's arguments; no job
// changes it.
pixel_buffer& photo();

// An object with a smooth outline that covers a third of the photo.
mask_buffer object_mask();

// The same with 40 round holes.
mask_buffer object_with_holes();

// Adds `count` specks of 3 to 12 pixels all over the mask, apart from the object and one another.
void scatter_specks(int count, mask_buffer* mask);

// `count` <= 1000 specks of 3 to 6 pixels on the way from the left top corner to the right bottom
// one, nothing else. A scan of the rows meets them in that order, so each widens the box around
// those before it.
mask_buffer diagonal_specks(int count);

// Each pixel selected or not by chance.
mask_buffer noise_mask(int width, int height);

// The whole photo as an inclusive rectangle.
inline ze_rect whole_photo() { return {0, PHOTO_WIDTH - 1, 0, PHOTO_HEIGHT - 1}; }

// --- floors ------------------------------------------------------------------------------------

// Reads bytes and does next to nothing with them, but for the last few.
void read_bytes(const void* bytes, size_t size);

// The rows of a box in a buffer with `stride` elements a row, as bytes to copy or read.
template <class Element, class Visit>
void for_each_row(Element* elements, int stride, const ze_rect& box, Visit visit) {
    const size_t bytes = static_cast<size_t>(box.right - box.left + 1) * sizeof(Element);
    for (int y = box.top; y <= box.bottom; ++y) {
        visit(elements + size_t(y) * size_t(stride) + size_t(box.left), bytes);
    }
}
