#include "selection/objectsel.h"
#include "tests/differential/family.h"
#include "tests/differential/placed_vector.h"
#include "tests/differential/random_pictures.h"
#include "tests/reference/session_reference.h"

namespace {

ze_rect to_library(const reference::rect& r) { return {r.left, r.right, r.top, r.bottom}; }
reference::rect to_model(const ze_rect& r) { return {r.left, r.right, r.top, r.bottom}; }

// One user's session on one photo, in the library and in the model.
class session_pair {
public:
    session_pair(random_source& r, findings* f)
        : random(r),
          found(f),
          width(r.size_up_to(90)),
          height(r.size_up_to(90)),
          photo(random_photo(r, width, height)),
          library_photo(photo),
          model_mask(random_mask(r, width, height)),
          mask(model_mask) {
        ze_destroy_objectsel();
        g_object_boundary = g_fill_boundary = {0, 0, 0, 0};
        g_Brush_Radius = 10;
        g_Brush_Center = 1;
    }

    void call() {
        switch (random.between(0, 19)) {
            case 0:
                ze_init_objectsel(width, height);
                model.ze_init_objectsel(width, height);
                break;
            case 1: {
                const int radius = random.one_in(15) ? random.any_of({-1, -7, 2147483647})
                                                     : random.size_up_to(25) - 1;
                const int core = random.one_in(15) ? random.any_int() : random.size_up_to(8) - 1;
                ze_set_brush_size(radius, core);
                model.ze_set_brush_size(radius, core);
                break;
            }
            case 2:
                if (!random.one_in(3)) break;
                ze_destroy_objectsel();
                model.ze_destroy_objectsel();
                break;
            case 3:
                ze_inverse_mask(mask.data(), width, height);
                model.ze_inverse_mask(model_mask, width, height);
                break;
            case 4:
                if (!random.one_in(3)) break;
                ze_reset_objectsel(mask.data(), width, height);
                model.ze_reset_objectsel(&model_mask, width, height);
                break;
            case 5:
                ze_update_objectROI(mask.data(), width, height);
                model.ze_update_objectROI(model_mask, width, height);
                break;
            case 6: {
                const ze_rect roi = {random.between(-9, width + 9), random.between(-9, width + 9),
                                     random.between(-9, height + 9),
                                     random.between(-9, height + 9)};
                ze_set_objectROI(roi);
                model.ze_set_objectROI(to_model(roi));
                break;
            }
            case 7:
                ze_reset_fill_boundary(width, height);
                model.ze_reset_fill_boundary(width, height);
                ze_reinit_objectsel(mask.data(), width, height, to_library({1, 2, 3, 4}));
                model.ze_reinit_objectsel(&model_mask, width, height, {1, 2, 3, 4});
                break;
            default:
                stroke();
                break;
        }
        compare();
    }

private:
    void stroke() {
        const int mode =
            random.one_in(12) ? random.any_of({-1, 6, 7, random.any_int()}) : random.between(0, 5);
        const int fill = random.one_in(8) ? random.any_of({2, -1, 256}) : random.between(0, 1);
        const int x1 = random.between(-1, width), y1 = random.between(-1, height);
        const int x2 = random.between(-1, width), y2 = random.between(-1, height);
        ze_rect changed = {5, 6, 7, 8};
        reference::rect expected = {5, 6, 7, 8};
        ze_modify_objectsel(library_photo.data(), mask.data(), width, height, x1, y1, x2, y2, mode,
                            &changed, fill);
        model.ze_modify_objectsel(photo, model_mask, width, height, x1, y1, x2, y2, mode, &expected,
                                  fill);
        found->compare("stroke rectangle", changed, expected);
    }

    void compare() const {
        found->compare("object box", g_object_boundary, model.g_object_boundary);
        found->compare("ROI", ze_get_objectROI(), model.ze_get_objectROI());
        found->compare("fill box", g_fill_boundary, model.g_fill_boundary);
        found->compare("brush radius", ze_get_brush_radius(), model.g_Brush_Radius);
        found->compare("brush core", ze_get_brush_center(), model.g_Brush_Center);
        found->compare("engine", int64_t{g_ERBrush != nullptr},
                       int64_t{model.g_ERBrush != nullptr});
        found->compare_arrays("mask", mask, model_mask);
    }

    random_source& random;
    findings* found;
    int width, height;
    std::vector<int> photo;
    placed_vector<int> library_photo;
    std::vector<unsigned char> model_mask;
    placed_vector<unsigned char> mask;
    reference::session model;
};

void run_session(random_source& random, findings* found) {
    session_pair session(random, found);
    for (int calls = random.between(1, 40); calls > 0 && found->agree(); --calls) {
        session.call();
        found->count("calls");
    }
}

}  // namespace

const std::vector<family> session_families = {
    {"session", "strokes, brushes, ROI calls, inversions and resets, compared after each", 16000,
     run_session, RARE_FAULTS},
};
