// Peers of the object box's jobs.
#pragma once

#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

struct boxed_mask {
    mask_buffer fresh;
    mask_buffer mask;
    std::vector<ze_rect> box = std::vector<ze_rect>(1);
};

void add_box_peers(const std::shared_ptr<boxed_mask>& data, job* j);
void add_inversion_peers(const std::shared_ptr<boxed_mask>& data, job* j);
