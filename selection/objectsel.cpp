#include "selection/objectsel.h"

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <new>

#include "render/row_kernels.h"
#include "selection/rectangles.h"
#include "selection/region_shaping.h"
#include "support/log.h"
#include "support/ze_alloc.h"

ER_selection* g_ERBrush = nullptr;
ze_rect g_object_boundary = {0, 0, 0, 0};
ze_rect g_fill_boundary = {0, 0, 0, 0};
int g_Brush_Radius = 10;
int g_Brush_Center = 1;

namespace {

enum stroke_mode { GROW, SHRINK, PAINT, ERASE, LASSO_ADD, LASSO_REMOVE };

// Runs the pass on whole regions that belongs to a mode.
void complete_regions(unsigned char* mask, int width, int height, int mode, ze_rect* rect) {
    const ze_rect box = g_object_boundary;
    switch (mode) {
        case GROW:
        case PAINT:
            Fill_Region(mask, width, height, box.left, box.right, box.top, box.bottom, rect);
            break;
        case SHRINK:
            Erase_Region(mask, width, height, &g_object_boundary, rect);
            break;
        case LASSO_ADD:
            ze_lasso_add_fill_mask(mask, width, height, box.left, box.right, box.top, box.bottom);
            break;
        case LASSO_REMOVE:
            ze_lasso_del_fill_mask(mask, width, height, box.left, box.right, box.top, box.bottom);
            break;
        default:  // ERASE has none
            break;
    }
}

// Index of the first selected one of n pixels, or n.
int first_selected(const unsigned char* pixels, int n) {
    const void* const found = std::memchr(pixels, 1, static_cast<size_t>(n));
    return found ? static_cast<int>(static_cast<const unsigned char*>(found) - pixels) : n;
}

// Widens *box over the selected pixels of a rectangle that lies in the mask.
//
// Rows are read from the top down to one with a selected pixel, and from the bottom up to one; of
// those between, only what lies left and right of all that has been found.
void include_selected(const unsigned char* mask, int width, ze_rect area, ze_rect* box) {
    if (area.left > area.right) return;
    const row_kernels& kernels = row_kernels_of_this_cpu();
    const auto row = [&](int y) { return mask + ptrdiff_t{y} * width + area.left; };
    const int columns = area.right - area.left + 1;
    while (area.top <= area.bottom && first_selected(row(area.top), columns) >= columns) ++area.top;
    if (area.top > area.bottom) return;
    while (kernels.last_selected(row(area.bottom), columns) < 0) --area.bottom;

    int left = columns - 1;
    int right = 0;
    for (int y = area.top; y <= area.bottom; ++y) {
        const unsigned char* const pixels = row(y);
        left = std::min(left, first_selected(pixels, left));
        const ptrdiff_t behind =
            kernels.last_selected(pixels + right + 1, ptrdiff_t{columns} - right - 1);
        right += static_cast<int>(behind + 1);
    }
    unite(box, {area.left + left, area.left + right, area.top, area.bottom});
}

void build_engine() {
    ze_destroy_objectsel();
    g_ERBrush = new (std::nothrow) ER_selection;
    if (g_ERBrush) g_ERBrush->initial(g_Brush_Radius, g_Brush_Center);
}

}  // namespace

int ze_init_objectsel(int width, int height) {
    g_object_boundary = empty_at_last_pixel(width, height);
    build_engine();
    return 1;
}

void ze_destroy_objectsel() {
    delete g_ERBrush;
    g_ERBrush = nullptr;
}

void ze_reset_objectsel(unsigned char* mask, int width, int height) {
    if (!mask || width <= 0 || height <= 0) {
        __android_log_print(ANDROID_LOG_INFO, LOG_TAG, "invalid input parameters\n");
        return;
    }
    ze_memset(mask, 0, static_cast<size_t>(width) * static_cast<size_t>(height));
    g_object_boundary = empty_at_last_pixel(width, height);
}

void ze_reinit_objectsel(unsigned char*, int, int, ze_rect) {}

void ze_set_brush_size(int radius, int center) {
    g_Brush_Radius = radius;
    g_Brush_Center = center;
    build_engine();
}

void ze_modify_objectsel(int* pixels, unsigned char* mask, int width, int height, int x1, int y1,
                         int x2, int y2, int mode, ze_rect* rect, int fill) {
    *rect = empty_beyond_image(width, height);
    if (!g_ERBrush) return;
    switch (mode) {
        case GROW:
            g_ERBrush->DoSelection(pixels, mask, width, height, x1, y1, rect);
            break;
        case SHRINK:
            g_ERBrush->DeSelection(pixels, mask, width, height, x1, y1, rect);
            break;
        case PAINT:
            g_ERBrush->Brush_Add(mask, width, height, x1, y1, rect);
            break;
        case ERASE:
            g_ERBrush->Brush_Del(mask, width, height, x1, y1, rect);
            break;
        case LASSO_ADD:
            g_ERBrush->Lasso_Add(mask, width, height, x1, y1, x2, y2, rect);
            break;
        case LASSO_REMOVE:
            g_ERBrush->Lasso_Del(mask, width, height, x1, y1, x2, y2, rect);
            break;
        default:
            return;
    }
    if (mode != SHRINK && mode != ERASE) unite(&g_object_boundary, *rect);
    if (fill == 1) complete_regions(mask, width, height, mode, rect);
}

void ze_inverse_mask(unsigned char* mask, int width, int height) {
    g_object_boundary = empty_at_last_pixel(width, height);
    if (width < 1 || height < 1) return;
    row_kernels_of_this_cpu().invert(mask, ptrdiff_t{width} * height);
    include_selected(mask, width, {0, width - 1, 0, height - 1}, &g_object_boundary);
}

void ze_set_objectROI(ze_rect roi) { g_object_boundary = roi; }

ze_rect ze_get_objectROI() { return g_object_boundary; }

void ze_update_objectROI(unsigned char* mask, int width, int height) {
    const ze_rect old = clip_to_image(g_object_boundary, width, height);
    g_object_boundary = empty_beyond_image(width, height);
    include_selected(mask, width, old, &g_object_boundary);
}

void ze_reset_fill_boundary(int width, int height) {
    g_fill_boundary = empty_at_last_pixel(width, height);
}

int ze_get_brush_radius() { return g_Brush_Radius; }

int ze_get_brush_center() { return g_Brush_Center; }
