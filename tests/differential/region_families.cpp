#include "selection/ER_selection.h"
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

// A mask with a box, for the library and for the model.
struct region_case {
    explicit region_case(random_source& random)
        : width(random.size_up_to(200)),
          height(random.size_up_to(200)),
          mask(random_mask(random, width, height)),
          box(random_box(random, width, height)) {
        if (random.one_in(6)) sprinkle(random, &mask, 0, 255);
        model_mask = mask;
    }

    std::string compare(const ze_rect& found, const reference::rect& expected) const {
        if (expected != reference::rect{found.left, found.right, found.top, found.bottom}) {
            return "another rectangle";
        }
        return first_difference("mask", mask, model_mask);
    }

    int width, height;
    std::vector<unsigned char> mask, model_mask;
    ze_rect box;
};

std::string run_fill(random_source& random, tally*) {
    region_case c(random);
    ze_rect changed = empty_beyond_image(c.width, c.height);
    reference::rect expected = {c.width, 0, c.height, 0};
    Fill_Region(c.mask.data(), c.width, c.height, c.box.left, c.box.right, c.box.top, c.box.bottom,
                &changed);
    reference::Fill_Region(c.model_mask, c.width, c.height, c.box.left, c.box.right, c.box.top,
                           c.box.bottom, &expected);
    return c.compare(changed, expected);
}

std::string run_erase(random_source& random, tally*) {
    region_case c(random);
    ze_rect boundary = c.box;
    reference::rect model_boundary = {c.box.left, c.box.right, c.box.top, c.box.bottom};
    ze_rect changed = empty_beyond_image(c.width, c.height);
    reference::rect expected = {c.width, 0, c.height, 0};
    Erase_Region(c.mask.data(), c.width, c.height, &boundary, &changed);
    reference::Erase_Region(c.model_mask, c.width, c.height, &model_boundary, &expected);
    std::string difference = c.compare(boundary, model_boundary);
    return difference.empty() ? c.compare(changed, expected) : difference;
}

// An outline over the mask, mostly closed, then the pass that turns it into a selection.
std::string run_lasso_fill(random_source& random, tally*) {
    region_case c(random);
    const bool adds = random.one_in(2);
    ER_selection engine;
    ze_rect drawn = empty_beyond_image(c.width, c.height);
    const int first_x = random.between(0, c.width - 1), first_y = random.between(0, c.height - 1);
    int x0 = first_x, y0 = first_y;
    for (int segments = random.between(1, 6); segments > 0; --segments) {
        const bool closes = segments == 1 && !random.one_in(4);
        const int x1 = closes ? first_x : random.between(0, c.width - 1);
        const int y1 = closes ? first_y : random.between(0, c.height - 1);
        const auto draw = adds ? &ER_selection::Lasso_Add : &ER_selection::Lasso_Del;
        (engine.*draw)(c.mask.data(), c.width, c.height, x0, y0, x1, y1, &drawn);
        x0 = x1;
        y0 = y1;
    }
    c.model_mask = c.mask;
    const auto fill = adds ? ze_lasso_add_fill_mask : ze_lasso_del_fill_mask;
    const auto model_fill =
        adds ? reference::ze_lasso_add_fill_mask : reference::ze_lasso_del_fill_mask;
    const int result =
        fill(c.mask.data(), c.width, c.height, c.box.left, c.box.right, c.box.top, c.box.bottom);
    const int expected = model_fill(c.model_mask, c.width, c.height, c.box.left, c.box.right,
                                    c.box.top, c.box.bottom);
    if (result != expected) return "another result";
    return first_difference("mask", c.mask, c.model_mask);
}

}  // namespace

const std::vector<family> region_families = {
    {"fill", "Fill_Region on masks up to 200 x 200", run_fill},
    {"erase", "Erase_Region, likewise", run_erase},
    {"lasso-fill", "both lasso fills on outlines, likewise", run_lasso_fill},
};
