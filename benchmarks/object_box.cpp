// The box of the selected object, and the inverted mask with its box.

#include <cstring>
#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"
#include "benchmarks/object_box_peers.h"
#include "selection/objectsel.h"
#include "selection/objectsel_plain.h"

namespace {

using std::shared_ptr;

using mask_function = decltype(&ze_inverse_mask);

shared_ptr<boxed_mask> boxed_object() {
    auto data = std::make_shared<boxed_mask>();
    data->fresh = object_with_holes();
    data->mask = data->fresh;
    return data;
}

void run(mask_function function, boxed_mask* data) {
    g_object_boundary = whole_photo();
    function(data->mask.data(), PHOTO_WIDTH, PHOTO_HEIGHT);
    data->box[0] = g_object_boundary;
}

job object_box() {
    const auto data = boxed_object();
    job j;
    j.add_result(&data->box);
    j.add("ours", [=] { run(ze_update_objectROI, data.get()); });
    j.add("plain", [=] { run(plain::ze_update_objectROI, data.get()); });
    j.add_uncompared("floor", [=] { read_bytes(data->mask.data(), PHOTO_PIXELS); });
    if constexpr (WITH_PEERS) add_box_peers(data, &j);
    return j;
}

// Each run turns the mask over; every second one finds the box of the whole photo.
job inversion() {
    const auto data = boxed_object();
    job j;
    j.add_result(&data->mask);
    j.add_result(&data->box);
    j.reset = [=] { std::memcpy(data->mask.data(), data->fresh.data(), PHOTO_PIXELS); };
    j.add("ours", [=] { run(ze_inverse_mask, data.get()); });
    j.add("plain", [=] { run(plain::ze_inverse_mask, data.get()); });
    j.add_uncompared("floor", [=] {
        std::memmove(data->mask.data(), data->mask.data() + 64, PHOTO_PIXELS - 64);
    });
    if constexpr (WITH_PEERS) add_inversion_peers(data, &j);
    return j;
}

}  // namespace

void list_object_box_jobs(job_list* jobs) {
    jobs->push_back({"object box", object_box});
    jobs->push_back({"inversion with box", inversion});
}
