// Filling what a lasso encloses: a small piece of a large photo, or much of it.

#include <cmath>
#include <cstring>
#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"
#include "benchmarks/lasso_peers.h"
#include "selection/ER_selection.h"
#include "selection/rectangles.h"
#include "selection/region_plain.h"
#include "selection/region_shaping.h"

namespace {

using std::shared_ptr;

using segment = decltype(&ER_selection::Lasso_Add);
using lasso_fill = decltype(&ze_lasso_add_fill_mask);

// A circle of 72 segments in the middle of the photo.
shared_ptr<lasso_input> draw_circle(int radius, mask_buffer mask, segment draw) {
    constexpr int CORNERS = 72;
    constexpr double PI = 3.14159265358979;
    auto in = std::make_shared<lasso_input>();
    for (int i = 0; i < CORNERS; ++i) {
        const double angle = 2 * PI * i / CORNERS;
        in->corners.push_back(PHOTO_WIDTH / 2 + static_cast<int>(radius * std::cos(angle)));
        in->corners.push_back(PHOTO_HEIGHT / 2 + static_cast<int>(radius * std::sin(angle)));
    }
    in->box = empty_beyond_image(PHOTO_WIDTH, PHOTO_HEIGHT);
    in->fresh = std::move(mask);
    ER_selection engine;
    for (size_t i = 0; i < in->corners.size(); i += 2) {
        const size_t next = (i + 2) % in->corners.size();
        (engine.*draw)(in->fresh.data(), PHOTO_WIDTH, PHOTO_HEIGHT, in->corners[i],
                       in->corners[i + 1], in->corners[next], in->corners[next + 1], &in->box);
    }
    in->mask = in->fresh;
    return in;
}

job lasso_job(const shared_ptr<lasso_input>& in, lasso_fill ours, lasso_fill plain) {
    const auto run = [in](lasso_fill fill) {
        fill(in->mask.data(), PHOTO_WIDTH, PHOTO_HEIGHT, in->box.left, in->box.right, in->box.top,
             in->box.bottom);
    };
    // For each row of the box: visit(row of the mask, row of another one, bytes).
    const auto for_both = [in](mask_buffer* other, auto visit) {
        for_each_row(in->mask.data(), PHOTO_WIDTH, in->box, [&](unsigned char* row, size_t bytes) {
            visit(row, other->data() + (row - in->mask.data()), bytes);
        });
    };
    job j;
    j.add_result(&in->mask);
    // The comparison spoils the whole mask, a run no more than the box.
    j.reset = [=] {
        if (in->mask[0] == in->fresh[0]) {
            for_both(&in->fresh, std::memcpy);
        } else {
            in->mask = in->fresh;
        }
    };
    j.reset_before_each_run = true;
    j.add("ours", [=] { run(ours); });
    j.add("plain", [=] { run(plain); });
    // The mask is read and written, and so is the work buffer.
    const auto work = std::make_shared<mask_buffer>(PHOTO_PIXELS);
    j.add_uncompared("floor", [=] {
        for_both(work.get(),
                 [](void* mask, void* other, size_t n) { std::memcpy(other, mask, n); });
        for_both(work.get(), std::memcpy);
    });
    return j;
}

job adding_lasso(int radius) {
    const auto in = draw_circle(radius, mask_buffer(PHOTO_PIXELS), &ER_selection::Lasso_Add);
    job j = lasso_job(in, ze_lasso_add_fill_mask, plain::ze_lasso_add_fill_mask);
    if constexpr (WITH_PEERS) add_lasso_adding_peers(in, &j);
    return j;
}

job removing_lasso(int radius) {
    const auto in = draw_circle(radius, object_mask(), &ER_selection::Lasso_Del);
    job j = lasso_job(in, ze_lasso_del_fill_mask, plain::ze_lasso_del_fill_mask);
    if constexpr (WITH_PEERS) add_lasso_removing_peers(in, &j);
    return j;
}

}  // namespace

void list_lasso_jobs(job_list* jobs) {
    for (const int radius : {1000, 50}) {
        const std::string size = ", radius " + std::to_string(radius);
        jobs->push_back({"lasso fill" + size, [radius] { return adding_lasso(radius); }});
        jobs->push_back({"lasso removal" + size, [radius] { return removing_lasso(radius); }});
    }
}
