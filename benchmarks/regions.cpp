// Filling holes and keeping the largest region, on masks of the photo's size.

#include <chrono>
#include <cstring>
#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"
#include "benchmarks/regions_peers.h"
#include "selection/rectangles.h"
#include "selection/region_plain.h"
#include "selection/region_shaping.h"

namespace {

using std::make_shared;
using std::shared_ptr;

using fill_function = decltype(&Fill_Region);
using erase_function = decltype(&Erase_Region);

// One of the two passes, over a whole mask.
struct pass {
    const char* name;
    void (*ours)(region_input*, int width, int height);
    void (*plain)(region_input*, int width, int height);
    void (*add_peers)(const shared_ptr<region_input>&, job*);
};

void fill(fill_function run, region_input* in, int width, int height) {
    in->boundary[0] = {0, width - 1, 0, height - 1};
    in->changed[0] = empty_beyond_image(width, height);
    run(in->mask.data(), width, height, 0, width - 1, 0, height - 1, in->changed.data());
}

void erase(erase_function run, region_input* in, int width, int height) {
    in->boundary[0] = {0, width - 1, 0, height - 1};
    in->changed[0] = empty_beyond_image(width, height);
    run(in->mask.data(), width, height, in->boundary.data(), in->changed.data());
}

constexpr pass FILL = {"fill holes",
                       [](region_input* in, int w, int h) { fill(Fill_Region, in, w, h); },
                       [](region_input* in, int w, int h) { fill(plain::Fill_Region, in, w, h); },
                       [](const shared_ptr<region_input>& in, job* j) {
                           if constexpr (WITH_PEERS) add_fill_peers(in, j);
                       }};

constexpr pass KEEP_LARGEST = {
    "keep the largest", [](region_input* in, int w, int h) { erase(Erase_Region, in, w, h); },
    [](region_input* in, int w, int h) { erase(plain::Erase_Region, in, w, h); },
    [](const shared_ptr<region_input>& in, job* j) {
        if constexpr (WITH_PEERS) add_largest_peers(in, j);
    }};

enum plain_version { COMPARED, TOO_SLOW };

job region_job(const pass& p, mask_buffer mask, int width, int height, plain_version with_plain) {
    const auto in = make_shared<region_input>();
    in->fresh = std::move(mask);
    in->mask = in->fresh;
    job j;
    j.add_result(&in->mask);
    j.add_result(&in->changed);
    j.add_result(&in->boundary);
    j.reset = [in] { std::memcpy(in->mask.data(), in->fresh.data(), in->fresh.size()); };
    j.reset_before_each_run = true;
    j.add("ours", [=] { p.ours(in.get(), width, height); });
    if (with_plain == COMPARED) j.add("plain", [=] { p.plain(in.get(), width, height); });
    // The mask is read and written, and so is the work buffer.
    const auto work = make_shared<mask_buffer>(in->mask.size());
    j.add_uncompared("floor", [=] {
        std::memcpy(work->data(), in->mask.data(), work->size());
        std::memcpy(in->mask.data(), work->data(), work->size());
    });
    if (width == PHOTO_WIDTH && with_plain == COMPARED) p.add_peers(in, &j);
    return j;
}

mask_buffer object_and_specks(int count) {
    mask_buffer mask = object_with_holes();
    scatter_specks(count, &mask);
    return mask;
}

double seconds_of_ours(const pass& p, mask_buffer mask, int width, int height) {
    region_input in;
    in.mask = std::move(mask);
    const auto start = std::chrono::steady_clock::now();
    p.ours(&in, width, height);
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

// Work that plain would need minutes for. A slow library is noticed on smaller inputs.
constexpr double SLOW_PROBE = 0.5;
constexpr char TOO_LONG[] = "takes more than a minute";

job many_specks(const pass& p, int count) {
    if (seconds_of_ours(p, object_and_specks(count / 100), PHOTO_WIDTH, PHOTO_HEIGHT) >
        SLOW_PROBE) {
        job j;
        j.omitted = TOO_LONG;
        return j;
    }
    return region_job(p, object_and_specks(count), PHOTO_WIDTH, PHOTO_HEIGHT, TOO_SLOW);
}

job noise(const pass& p) {
    for (const int part : {16, 8, 4, 2}) {
        const int width = PHOTO_WIDTH / part, height = PHOTO_HEIGHT / part;
        if (seconds_of_ours(p, noise_mask(width, height), width, height) > SLOW_PROBE) {
            job j;
            j.omitted = TOO_LONG;
            return j;
        }
    }
    return region_job(p, noise_mask(PHOTO_WIDTH, PHOTO_HEIGHT), PHOTO_WIDTH, PHOTO_HEIGHT,
                      TOO_SLOW);
}

std::string specks(int count) {
    return std::to_string(count) + (count == 1 ? " speck" : " specks");
}

}  // namespace

void list_region_jobs(job_list* jobs) {
    for (const pass& p : {FILL, KEEP_LARGEST}) {
        const std::string name = p.name;
        for (const int count : {0, 1, 10, 100, 1000}) {
            jobs->push_back({name + ", " + specks(count), [=] {
                                 return region_job(p, object_and_specks(count), PHOTO_WIDTH,
                                                   PHOTO_HEIGHT, COMPARED);
                             }});
        }
        jobs->push_back({name + ", " + specks(10000), [=] { return many_specks(p, 10000); }});
        for (const int count : {1, 10, 100, 1000}) {
            jobs->push_back({name + ", " + specks(count) + " on a diagonal", [=] {
                                 return region_job(p, diagonal_specks(count), PHOTO_WIDTH,
                                                   PHOTO_HEIGHT, COMPARED);
                             }});
        }
        jobs->push_back({name + ", noise", [=] { return noise(p); }});
        jobs->push_back({name + ", noise of 200 x 150",
                         [=] { return region_job(p, noise_mask(200, 150), 200, 150, COMPARED); }});
    }
}
