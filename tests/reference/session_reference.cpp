#include "tests/reference/session_reference.h"

#include <algorithm>
#include <cstddef>

#include "tests/reference/lasso_reference.h"
#include "tests/reference/regions_reference.h"

namespace reference {
namespace {

// One of the two ways in which an empty rectangle is written; the other one holds the plain sizes.
rect empty_inside(int width, int height) { return {wrap_sub(width, 1), 0, wrap_sub(height, 1), 0}; }

}  // namespace

void session::build_engine() {
    g_ERBrush = std::make_unique<engine>();
    g_ERBrush->initial(g_Brush_Radius, g_Brush_Center);
    ++engines_built;
}

int session::ze_init_objectsel(int width, int height) {
    ze_destroy_objectsel();
    g_object_boundary = empty_inside(width, height);
    build_engine();
    return 1;
}

void session::ze_destroy_objectsel() { g_ERBrush.reset(); }

void session::ze_reset_objectsel(std::vector<unsigned char>* mask, int width, int height) {
    if (mask == nullptr || width <= 0 || height <= 0) {
        log.push_back("invalid input parameters\n");
        return;
    }
    const std::size_t bytes = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
    for (std::size_t i = 0; i < bytes; ++i) mask->at(i) = 0;
    g_object_boundary = empty_inside(width, height);
}

void session::ze_reinit_objectsel(std::vector<unsigned char>*, int, int, reference::rect) {}

void session::ze_set_brush_size(int radius, int center) {
    g_Brush_Radius = radius;
    g_Brush_Center = center;
    g_ERBrush.reset();
    build_engine();
}

void session::ze_modify_objectsel(const std::vector<int>& pixels, std::vector<unsigned char>& mask,
                                  int width, int height, int x1, int y1, int x2, int y2, int mode,
                                  reference::rect* rect, int fill) {
    *rect = {width, 0, height, 0};
    if (g_ERBrush == nullptr) return;
    if (mode < 0 || mode > 5 || supported_modes.count(mode) == 0) return;

    if (mode == 0) g_ERBrush->DoSelection(pixels, mask, width, height, x1, y1, rect);
    if (mode == 1) g_ERBrush->DeSelection(pixels, mask, width, height, x1, y1, rect);
    if (mode == 2) g_ERBrush->Brush_Add(mask, width, height, x1, y1, rect);
    if (mode == 3) g_ERBrush->Brush_Del(mask, width, height, x1, y1, rect);
    if (mode == 4) Lasso_Add(mask, width, height, x1, y1, x2, y2, rect);
    if (mode == 5) Lasso_Del(mask, width, height, x1, y1, x2, y2, rect);

    const bool merges = mode != 1 && mode != 3;
    if (merges) unite(g_object_boundary, *rect);

    if (fill != 1) return;
    const reference::rect box = g_object_boundary;
    if (mode == 0 || mode == 2) {
        Fill_Region(mask, width, height, box.left, box.right, box.top, box.bottom, rect);
    }
    if (mode == 1) Erase_Region(mask, width, height, &g_object_boundary, rect);
    if (mode == 4) {
        ze_lasso_add_fill_mask(mask, width, height, box.left, box.right, box.top, box.bottom);
    }
    if (mode == 5) {
        ze_lasso_del_fill_mask(mask, width, height, box.left, box.right, box.top, box.bottom);
    }
}

void session::ze_inverse_mask(std::vector<unsigned char>& mask, int width, int height) {
    g_object_boundary = empty_inside(width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            unsigned char& value = pixel(mask, width, x, y);
            value = value != 1 ? 1 : 0;
            if (value == 1) unite(g_object_boundary, x, y);
        }
    }
}

void session::ze_set_objectROI(reference::rect roi) { g_object_boundary = roi; }

reference::rect session::ze_get_objectROI() const { return g_object_boundary; }

void session::ze_update_objectROI(std::vector<unsigned char>& mask, int width, int height) {
    const reference::rect old = g_object_boundary;
    const int top = std::max(old.top, 0);
    const int bottom = std::min(old.bottom, wrap_sub(height, 1));
    const int left = std::max(old.left, 0);
    const int right = std::min(old.right, wrap_sub(width, 1));
    g_object_boundary = {width, 0, height, 0};
    if (top > bottom) return;
    for (int y = top; y <= bottom; ++y) {
        for (int x = left; x <= right; ++x) {
            if (pixel(mask, width, x, y) == 1) unite(g_object_boundary, x, y);
        }
    }
}

void session::ze_reset_fill_boundary(int width, int height) {
    g_fill_boundary = empty_inside(width, height);
}

int session::ze_get_brush_radius() const { return g_Brush_Radius; }

int session::ze_get_brush_center() const { return g_Brush_Center; }

}  // namespace reference
