// Carrying a selection from a copy of the photo at a quarter of its size over to the photo.

#include "render/mask_transfer.h"

#include <cstring>
#include <memory>

#include "benchmarks/mask_transfer_peers.h"

namespace {

job mask_transfer(int flag) {
    const auto data = std::make_shared<transfer>();
    const mask_buffer object = object_mask();
    for (int y = 0; y < SMALL_HEIGHT; ++y) {
        for (int x = 0; x < SMALL_WIDTH; ++x) {
            data->small.push_back(object[size_t(4 * y) * PHOTO_WIDTH + size_t(4 * x)]);
        }
    }
    data->large.resize(PHOTO_PIXELS);
    job j;
    j.add_result(&data->large);
    j.reset = [=] { std::memset(data->large.data(), flag, PHOTO_PIXELS); };
    j.add("ours", [=] {
        ze_modify_mask(data->small.data(), data->large.data(), photo().data(), SMALL_WIDTH,
                       SMALL_HEIGHT, PHOTO_WIDTH, 0, 0.25f, 0, SMALL_WIDTH - 1, 0, SMALL_HEIGHT - 1,
                       flag);
    });
    j.add_uncompared("floor", [=] {
        read_bytes(data->small.data(), data->small.size());
        std::memset(data->large.data(), 1, PHOTO_PIXELS);
    });
    if constexpr (WITH_PEERS) add_transfer_peers(data, &j);
    return j;
}

}  // namespace

void list_mask_transfer_jobs(job_list* jobs) {
    jobs->push_back({"mask transfer, adding", [] { return mask_transfer(0); }});
    jobs->push_back({"mask transfer, removing", [] { return mask_transfer(1); }});
}
