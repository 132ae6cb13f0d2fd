// A job: one piece of work on one input, and several ways to do it.
//
// The ways are "ours", "plain" (the definition that ours must equal), the peers by name, and
// "floor": the same bytes moved without arithmetic. Before anything is timed, main.cpp runs each
// way once and compares its result with that of "plain".
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>
#include <vector>

constexpr bool WITH_PEERS = DRAVENTA_BENCHMARK_PEERS != 0;

struct variant {
    std::string name;
    std::function<void()> run;
    std::function<void()> reset;   // makes its own input new, untimed; may be empty
    std::function<void()> finish;  // puts its own result into the job's, untimed; may be empty
    bool compared = true;
};

// A part of a job's result, which every way writes: `count` elements of `size` bytes.
struct result_part {
    void* data;
    size_t count;
    size_t size;
};

struct job {
    // A peer that was never meant to equal plain is compared all the same; the table says how much
    // it differs.
    void add(std::string name, std::function<void()> run, std::function<void()> reset_own = {},
             std::function<void()> finish = {}) {
        variants.push_back(
            {std::move(name), std::move(run), std::move(reset_own), std::move(finish)});
    }

    // A way whose result is of another kind or stays elsewhere.
    void add_uncompared(std::string name, std::function<void()> run,
                        std::function<void()> reset_own = {}) {
        add(std::move(name), std::move(run), std::move(reset_own));
        variants.back().compared = false;
    }

    template <class Element>
    void add_result(std::vector<Element>* elements) {
        results.push_back({elements->data(), elements->size(), sizeof(Element)});
    }

    std::vector<variant> variants;

    // Ours must equal plain in all parts; of a peer, the first part is compared.
    std::vector<result_part> results;

    // Makes the input new, untimed: before the comparison of each way and, where one run spoils the
    // input for the next, before each timed run.
    std::function<void()> reset;
    bool reset_before_each_run = false;

    double cells = 0;  // brush cells of one run; 0 where that means nothing

    std::string omitted;  // why the job is not run at all; usually empty
};

// Jobs are made one at a time: the inputs of all would not fit into memory.
struct named_job {
    std::string name;
    std::function<job()> make;
};
using job_list = std::vector<named_job>;

void list_compositing_jobs(job_list* jobs);
void list_lasso_jobs(job_list* jobs);
void list_mask_transfer_jobs(job_list* jobs);
void list_object_box_jobs(job_list* jobs);
void list_region_jobs(job_list* jobs);
void list_stroke_jobs(job_list* jobs);
void list_view_jobs(job_list* jobs);
