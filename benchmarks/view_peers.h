// Peers of the jobs that draw into the view.
#pragma once

#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

// A rectangle of the photo shown in the left top corner of a view.
struct scene {
    int view_width;
    float scale;   // photo pixels per view pixel
    ze_rect area;  // of the view
    int offset_x;  // photo pixel at the view's left top corner
    int offset_y;
    int shown_width;  // of the photo
    int shown_height;
    pixel_buffer drawn;  // the view
    mask_buffer mask;    // of the photo; empty where none is drawn

    int columns() const { return area.right + 1; }
    int rows() const { return area.bottom + 1; }
};

void add_draw_peers(const std::shared_ptr<scene>& data, job* j);
void add_outline_peers(const std::shared_ptr<scene>& data, job* j);
