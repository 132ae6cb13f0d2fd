#include "selection/ER_selection.h"
#include "selection/rectangles.h"
#include "selection/region_shaping.h"
#include "tests/differential/family.h"
#include "tests/differential/placed_vector.h"
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
          model_mask(random_mask(random, width, height)),
          box(random_box(random, width, height)) {
        if (random.one_in(6)) sprinkle(random, &model_mask, 0, 255);
        mask = placed_vector<unsigned char>(model_mask);
    }

    void compare_masks(findings* found) const { found->compare_arrays("mask", mask, model_mask); }

    int width, height;
    std::vector<unsigned char> model_mask;
    placed_vector<unsigned char> mask;
    ze_rect box;
};

void run_fill(random_source& random, findings* found) {
    region_case c(random);
    ze_rect changed = empty_beyond_image(c.width, c.height);
    reference::rect expected = {c.width, 0, c.height, 0};
    Fill_Region(c.mask.data(), c.width, c.height, c.box.left, c.box.right, c.box.top, c.box.bottom,
                &changed);
    reference::Fill_Region(c.model_mask, c.width, c.height, c.box.left, c.box.right, c.box.top,
                           c.box.bottom, &expected);
    found->compare("rectangle", changed, expected);
    c.compare_masks(found);
}

void run_erase(random_source& random, findings* found) {
    region_case c(random);
    ze_rect boundary = c.box;
    reference::rect model_boundary = {c.box.left, c.box.right, c.box.top, c.box.bottom};
    ze_rect changed = empty_beyond_image(c.width, c.height);
    reference::rect expected = {c.width, 0, c.height, 0};
    Erase_Region(c.mask.data(), c.width, c.height, &boundary, &changed);
    reference::Erase_Region(c.model_mask, c.width, c.height, &model_boundary, &expected);
    found->compare("boundary", boundary, model_boundary);
    found->compare("rectangle", changed, expected);
    c.compare_masks(found);
}

// An outline over the mask, mostly closed, then the pass that turns it into a selection.
void run_lasso_fill(random_source& random, findings* found) {
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
    c.model_mask.assign(c.mask.begin(), c.mask.end());
    const auto fill = adds ? ze_lasso_add_fill_mask : ze_lasso_del_fill_mask;
    const auto model_fill =
        adds ? reference::ze_lasso_add_fill_mask : reference::ze_lasso_del_fill_mask;
    const int result =
        fill(c.mask.data(), c.width, c.height, c.box.left, c.box.right, c.box.top, c.box.bottom);
    const int expected = model_fill(c.model_mask, c.width, c.height, c.box.left, c.box.right,
                                    c.box.top, c.box.bottom);
    found->compare("result", result, expected);
    c.compare_masks(found);
}

}  // namespace

const std::vector<family> region_families = {
    {"fill", "Fill_Region on masks up to 200 x 200", 24000, run_fill},
    {"erase", "Erase_Region, likewise", 24000, run_erase},
    {"lasso-fill", "both lasso fills on outlines, likewise", 24000, run_lasso_fill},
};
