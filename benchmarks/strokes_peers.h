// Peers of the strokes.
#pragma once

#include <memory>
#include <vector>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"
#include "selection/ER_selection.h"

struct dab {
    int x;
    int y;
};

// A stroke with one brush. Each dab starts on a square where all is unselected (growing) or
// selected (shrinking).
struct stroke {
    ER_selection engine;
    ER_selection plain_engine;
    std::vector<dab> dabs;
    mask_buffer mask;
    std::vector<ze_rect> changed;  // by each dab
    unsigned char start_value;

    // The brush's square around a dab.
    ze_rect square(const dab& d) const {
        const int r = engine.radius;
        return {d.x - r, d.x + r, d.y - r, d.y + r};
    }
};

void add_stroke_peers(const std::shared_ptr<stroke>& data, job* j);
