// Pictures as large as the photo: grey copies, and selections in colour on grey.

#include "render/compositing.h"

#include <algorithm>
#include <cstring>
#include <memory>

#include "benchmarks/compositing_peers.h"
#include "benchmarks/job.h"
#include "render/compositing_plain.h"

namespace {

using std::make_shared;

job grey_copy(int width, int height) {
    const auto data = make_shared<composition>(width, height);
    uint32_t* const src = photo().data();
    uint32_t* const dst = data->drawn.data();
    job j;
    j.add_result(&data->drawn);
    j.add("ours", [=] { ze_argb2gray(src, width, height, dst); });
    j.add("plain", [=] { plain::ze_argb2gray(src, width, height, dst); });
    j.add_uncompared("floor", [=] { std::memcpy(dst, src, data->drawn.size() * 4); });
    if constexpr (WITH_PEERS) add_grey_peers(data, &j);
    return j;
}

job colour_on_grey() {
    const auto data = make_shared<composition>(PHOTO_WIDTH, PHOTO_HEIGHT);
    data->mask = object_mask();
    uint32_t* const src = photo().data();
    uint32_t* const dst = data->drawn.data();
    unsigned char* const mask = data->mask.data();
    const ze_rect all = whole_photo();
    job j;
    j.add_result(&data->drawn);
    j.add("ours", [=] {
        ze_draw_withmask(src, dst, mask, PHOTO_WIDTH, all.left, all.right, all.top, all.bottom);
    });
    j.add("plain", [=] {
        plain::ze_draw_withmask(src, dst, mask, PHOTO_WIDTH, all.left, all.right, all.top,
                                all.bottom);
    });
    j.add_uncompared("floor", [=] {
        std::memcpy(dst, src, PHOTO_PIXELS * 4);
        read_bytes(mask, PHOTO_PIXELS);
    });
    if constexpr (WITH_PEERS) add_colour_on_grey_peers(data, &j);
    return j;
}

// Each run turns the mask over, so every second one draws the opposite picture.
job reverse_mask() {
    const auto data = make_shared<composition>(PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto fresh = make_shared<const mask_buffer>(object_mask());
    data->mask = *fresh;
    uint32_t* const src = photo().data();
    uint32_t* const dst = data->drawn.data();
    unsigned char* const mask = data->mask.data();
    job j;
    j.add_result(&data->drawn);
    j.add_result(&data->mask);
    j.reset = [=] { std::copy(fresh->begin(), fresh->end(), data->mask.begin()); };
    j.add("ours", [=] { ze_draw_reverse_mask(src, dst, mask, PHOTO_WIDTH, PHOTO_HEIGHT); });
    j.add("plain", [=] { plain::ze_draw_reverse_mask(src, dst, mask, PHOTO_WIDTH, PHOTO_HEIGHT); });
    j.add_uncompared("floor", [=] {
        std::memcpy(dst, src, PHOTO_PIXELS * 4);
        std::memmove(mask, mask + 64, PHOTO_PIXELS - 64);
    });
    if constexpr (WITH_PEERS) add_reverse_peers(data, &j);
    return j;
}

// The mask is half as wide and high as the photo.
job scaled_reverse_mask() {
    constexpr int MASK_WIDTH = PHOTO_WIDTH / 2;
    constexpr int MASK_HEIGHT = PHOTO_HEIGHT / 2;
    const auto data = make_shared<composition>(PHOTO_WIDTH, PHOTO_HEIGHT);
    const auto fresh = make_shared<mask_buffer>();
    const mask_buffer large = object_mask();
    for (int y = 0; y < MASK_HEIGHT; ++y) {
        for (int x = 0; x < MASK_WIDTH; ++x) {
            fresh->push_back(large[size_t(2 * y) * PHOTO_WIDTH + size_t(2 * x)]);
        }
    }
    data->mask = *fresh;
    uint32_t* const src = photo().data();
    uint32_t* const dst = data->drawn.data();
    unsigned char* const mask = data->mask.data();
    job j;
    j.add_result(&data->drawn);
    j.add_result(&data->mask);
    j.reset = [=] { std::copy(fresh->begin(), fresh->end(), data->mask.begin()); };
    j.add("ours", [=] {
        ze_draw_reverse_mask_v2(src, dst, mask, 0, PHOTO_WIDTH, PHOTO_HEIGHT, MASK_WIDTH,
                                MASK_HEIGHT, 0.5f);
    });
    j.add("plain", [=] {
        plain::ze_draw_reverse_mask_v2(src, dst, mask, 0, PHOTO_WIDTH, PHOTO_HEIGHT, MASK_WIDTH,
                                       MASK_HEIGHT, 0.5f);
    });
    j.add_uncompared("floor", [=] {
        std::memcpy(dst, src, PHOTO_PIXELS * 4);
        std::memmove(mask, mask + 64, PHOTO_PIXELS / 4 - 64);
    });
    if constexpr (WITH_PEERS) add_scaled_reverse_peers(data, MASK_WIDTH, MASK_HEIGHT, &j);
    return j;
}

}  // namespace

void list_compositing_jobs(job_list* jobs) {
    jobs->push_back({"grey copy", [] { return grey_copy(PHOTO_WIDTH, PHOTO_HEIGHT); }});
    jobs->push_back({"grey copy, 256 x 256", [] { return grey_copy(256, 256); }});
    jobs->push_back({"selection in colour, rest grey", colour_on_grey});
    jobs->push_back({"selection in colour, mask inverted", reverse_mask});
    jobs->push_back({"selection in colour, half-size mask", scaled_reverse_mask});
}
