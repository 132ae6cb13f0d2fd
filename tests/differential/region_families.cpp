#include "selection/region_shaping.h"
#include "tests/differential/family.h"
#include "tests/differential/random_pictures.h"
#include "tests/reference/regions_reference.h"

namespace {

ze_rect random_box(random_source& random, int width, int height) {
    if (random.one_in(2)) return {0, width - 1, 0, height - 1};
    return {random.between(-2, width), random.between(-2, width + 2), random.between(-2, height),
            random.between(-2, height + 2)};
}

std::string run_fill(random_source& random, tally*) {
    const int width = random.size_up_to(200);
    const int height = random.size_up_to(200);
    std::vector<unsigned char> mask = random_mask(random, width, height);
    if (random.one_in(6)) sprinkle(random, &mask, 0, 255);
    std::vector<unsigned char> model_mask = mask;
    const ze_rect box = random_box(random, width, height);
    ze_rect changed = empty_beyond_image(width, height);
    reference::rect expected = {width, 0, height, 0};

    Fill_Region(mask.data(), width, height, box.left, box.right, box.top, box.bottom, &changed);
    reference::Fill_Region(model_mask, width, height, box.left, box.right, box.top, box.bottom,
                           &expected);

    if (expected != reference::rect{changed.left, changed.right, changed.top, changed.bottom}) {
        return "another rectangle";
    }
    return first_difference("mask", mask, model_mask);
}

}  // namespace

const std::vector<family> region_families = {
    {"fill", "Fill_Region on masks up to 200 x 200", run_fill},
};
