// Peers of the compositing jobs.
#pragma once

#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

// A picture of the photo, or of its first width * height pixels.
struct composition {
    composition(int w, int h) : width(w), height(h), drawn(size_t(w) * size_t(h)) {}

    const int width;
    const int height;
    pixel_buffer drawn;
    mask_buffer mask;
};

void add_grey_peers(const std::shared_ptr<composition>& data, job* j);
void add_colour_on_grey_peers(const std::shared_ptr<composition>& data, job* j);
void add_reverse_peers(const std::shared_ptr<composition>& data, job* j);
void add_scaled_reverse_peers(const std::shared_ptr<composition>& data, int mask_width,
                              int mask_height, job* j);
