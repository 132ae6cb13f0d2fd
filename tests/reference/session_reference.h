// Slow model of the selection session: the flat functions as methods, the process-wide variables as
// fields, and the log as a list. A new session is a process that has just started.
#pragma once

#include <memory>
#include <set>
#include <string>
#include <vector>

#include "tests/reference/basics_reference.h"
#include "tests/reference/engine_reference.h"

namespace reference {

class session {
public:
    int ze_init_objectsel(int width, int height);
    void ze_destroy_objectsel();
    void ze_reset_objectsel(std::vector<unsigned char>* mask, int width, int height);
    void ze_reinit_objectsel(std::vector<unsigned char>* mask, int width, int height,
                             reference::rect roi);
    void ze_set_brush_size(int radius, int center);

    // `pixels` is looked at by modes 0 and 1 only and may be empty for the others.
    void ze_modify_objectsel(const std::vector<int>& pixels, std::vector<unsigned char>& mask,
                             int width, int height, int x1, int y1, int x2, int y2, int mode,
                             reference::rect* rect, int fill);

    void ze_inverse_mask(std::vector<unsigned char>& mask, int width, int height);
    void ze_set_objectROI(reference::rect roi);
    reference::rect ze_get_objectROI() const;
    void ze_update_objectROI(std::vector<unsigned char>& mask, int width, int height);
    void ze_reset_fill_boundary(int width, int height);
    int ze_get_brush_radius() const;
    int ze_get_brush_center() const;

    std::unique_ptr<engine> g_ERBrush;
    reference::rect g_object_boundary = {0, 0, 0, 0};
    reference::rect g_fill_boundary = {0, 0, 0, 0};
    int g_Brush_Radius = 10;
    int g_Brush_Center = 1;

    std::vector<std::string> log;  // every line written, with its line break

    // Strokes of another mode are unknown to the session.
    std::set<int> supported_modes = {0, 1, 2, 3, 4, 5};

    int engines_built = 0;

private:
    void build_engine();
};

}  // namespace reference
