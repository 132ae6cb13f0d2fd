#include "selection/objectsel_plain.h"

#include <cstddef>

#include "selection/objectsel.h"
#include "selection/rectangles.h"

namespace plain {

void ze_inverse_mask(unsigned char* mask, int width, int height) {
    g_object_boundary = empty_at_last_pixel(width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            unsigned char& pixel = mask[ptrdiff_t{y} * width + x];
            pixel = pixel != 1;
            if (pixel == 1) include(&g_object_boundary, x, y);
        }
    }
}

void ze_update_objectROI(unsigned char* mask, int width, int height) {
    const ze_rect old = clip_to_image(g_object_boundary, width, height);
    g_object_boundary = empty_beyond_image(width, height);
    for (int y = old.top; y <= old.bottom; ++y) {
        for (int x = old.left; x <= old.right; ++x) {
            if (mask[ptrdiff_t{y} * width + x] == 1) include(&g_object_boundary, x, y);
        }
    }
}

}  // namespace plain
