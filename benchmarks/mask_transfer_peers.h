// Peers of the mask transfer's jobs.
#pragma once

#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

constexpr int SMALL_WIDTH = PHOTO_WIDTH / 4;
constexpr int SMALL_HEIGHT = PHOTO_HEIGHT / 4;

struct transfer {
    mask_buffer small;
    mask_buffer large;
};

void add_transfer_peers(const std::shared_ptr<transfer>& data, job* j);
