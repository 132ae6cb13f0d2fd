// Contour tracing in a selection mask: the mechanism under every pass on whole regions.
//
// A trace walks around one region of the mask, marks its contour pixels, and leaves a marker beside
// it on every background pixel that it looked at in a straight direction. The passes then fill,
// from row to row, between a contour pixel with a marker on its left and one with a marker on its
// right.
#pragma once

#include <cstddef>

#include "selection/value_set.h"
#include "selection/ze_rect.h"

constexpr unsigned char BACKGROUND_MARKER = 5;

// Bytes of the markers of an image, or 0 for sizes that make no buffer.
size_t marker_bytes(int width, int height);

// The markers of one pass: a byte for each pixel position (x, y) with x from -1 to width and y from
// -1 to height, zero at first.
//
// Deliberate: rows are width apart, so (-1, y) and (width - 1, y - 1) share a byte, and so do
// (width, y) and (0, y + 1); a contour on the image's last column is seen beside its first.
class marker_buffer {
public:
    // Takes the pass's one work buffer, or none when it cannot be had.
    marker_buffer(int width, int height);
    ~marker_buffer();
    marker_buffer(const marker_buffer&) = delete;
    marker_buffer& operator=(const marker_buffer&) = delete;

    explicit operator bool() const { return bytes != nullptr; }

    void set(int x, int y) { bytes[index(x, y)] = BACKGROUND_MARKER; }
    bool on_left_of(int x, int y) const { return bytes[index(x, y) - 1] == BACKGROUND_MARKER; }
    bool on_right_of(int x, int y) const { return bytes[index(x, y) + 1] == BACKGROUND_MARKER; }
    void clear();

private:
    ptrdiff_t index(int x, int y) const { return (ptrdiff_t{y} + 1) * width + x + 1; }

    const int width;
    const size_t size;
    unsigned char* const bytes;
};

// A mask as a pass on regions sees it.
struct region_mask {
    // REQUIRES: `inside` lies in the image or is empty.
    region_mask(unsigned char* mask, int mask_width, int mask_height, const ze_rect& inside);

    unsigned char& at(int x, int y) const { return cells[x + ptrdiff_t{y} * width]; }

    unsigned char* const cells;
    const int width;
    const ze_rect box;  // inclusive; everything beyond is background and never touched

    // Covers every pixel that a trace of this pass has moved to.
    //
    // Deliberate: never reset between regions, so the passes over it scan the union of all contours
    // traced so far, where the markers of earlier regions still stand. The start pixel of a trace
    // is not taken in: a region of one pixel adds nothing.
    ze_rect contours;
};

// Traces the contour of the region that holds (x, y), entering from the left, and sets the start
// and every pixel moved to to `visited`. Values in `region` belong to the region; `visited` is one.
//
// Deliberate: the trace ends when the start is first looked at again, even if contour is left over;
// where a region hangs together by one pixel, the rest stays untraced.
void trace_contour(region_mask* mask, marker_buffer* markers, int x, int y, value_set region,
                   unsigned char visited);
