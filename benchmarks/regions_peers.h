// Peers of the jobs on whole regions.
#pragma once

#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

// A mask that each run changes.
struct region_input {
    mask_buffer fresh;
    mask_buffer mask;
    std::vector<ze_rect> changed = std::vector<ze_rect>(1);
    std::vector<ze_rect> boundary = std::vector<ze_rect>(1);
};

void add_fill_peers(const std::shared_ptr<region_input>& data, job* j);
void add_largest_peers(const std::shared_ptr<region_input>& data, job* j);
