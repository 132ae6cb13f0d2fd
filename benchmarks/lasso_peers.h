// Peers of the lasso's jobs.
#pragma once

#include <memory>
#include <vector>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

// A closed outline in a mask, as the lasso's strokes leave it.
struct lasso_input {
    mask_buffer fresh;
    mask_buffer mask;
    std::vector<int> corners;  // x and y in turn
    ze_rect box;               // of the outline
};

void add_lasso_adding_peers(const std::shared_ptr<lasso_input>& data, job* j);
void add_lasso_removing_peers(const std::shared_ptr<lasso_input>& data, job* j);
