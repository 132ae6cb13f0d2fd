// Drawing the photo into the view, with and without the outline of a selection.

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"
#include "benchmarks/view_peers.h"
#include "jni/view_image.h"
#include "jni/view_outline.h"
#include "jni/view_plain.h"

namespace {

using std::shared_ptr;

struct view_size {
    int width;
    int height;
};

constexpr view_size VIEW = {1440, 3088};
constexpr view_size SMALL_VIEW = {1080, 1920};

// In the middle of the object's left edge.
constexpr int EDGE_X = PHOTO_WIDTH / 2 - 1110;
constexpr int EDGE_Y = PHOTO_HEIGHT / 2;

// The first photo position shown: `centre` in the middle, as far as the photo goes.
int offset_around(int centre, int shown, int photo_size) {
    return std::clamp(centre - shown / 2, 0, photo_size - shown);
}

// The scene around the object's left edge. The area ends where the photo does.
shared_ptr<scene> scene_at(float scale, const view_size& view) {
    auto s = std::make_shared<scene>();
    const auto fitting = [scale](int view_pixels, int photo_pixels) {
        return std::min(view_pixels, static_cast<int>(static_cast<float>(photo_pixels) / scale));
    };
    const int columns = fitting(view.width, PHOTO_WIDTH);
    const int rows = fitting(view.height, PHOTO_HEIGHT);
    s->view_width = view.width;
    s->scale = scale;
    s->area = {0, columns - 1, 0, rows - 1};
    s->shown_width = static_cast<int>(std::ceil(static_cast<float>(columns) * scale));
    s->shown_height = static_cast<int>(std::ceil(static_cast<float>(rows) * scale));
    s->offset_x = offset_around(EDGE_X, s->shown_width, PHOTO_WIDTH);
    s->offset_y = offset_around(EDGE_Y, s->shown_height, PHOTO_HEIGHT);
    s->drawn.resize(size_t(view.width) * size_t(view.height));
    return s;
}

view_pixels view_of(scene* s) {
    return {reinterpret_cast<int32_t*>(s->drawn.data()), s->view_width};
}

photo_pixels the_photo() {
    return {reinterpret_cast<const int32_t*>(photo().data()), PHOTO_WIDTH, PHOTO_HEIGHT};
}

// Reads every photo row that is shown once, and writes the view: copies as far as both go.
void move_bytes(scene* s) {
    const size_t shown = size_t(s->shown_width);
    int last_read = -1;
    int y = 0;
    for_each_row(s->drawn.data(), s->view_width, s->area, [&](uint32_t* to, size_t size) {
        const int row = s->offset_y + static_cast<int>(s->scale * static_cast<float>(y++));
        const size_t first = size_t(row) * PHOTO_WIDTH + size_t(s->offset_x);
        const auto* const from = reinterpret_cast<const unsigned char*>(&photo()[first]);
        const size_t copied = row == last_read ? 0 : std::min(size, shown * sizeof(uint32_t));
        std::memcpy(to, from, copied);
        std::memset(reinterpret_cast<unsigned char*>(to) + copied, 0x55, size - copied);
        if (row == last_read) return;
        read_bytes(from + copied, shown * sizeof(uint32_t) - copied);
        if (!s->mask.empty()) read_bytes(&s->mask[first], shown);
        last_read = row;
    });
}

void add_floor(const shared_ptr<scene>& s, job* j) {
    j->add_uncompared("floor", [s] { move_bytes(s.get()); });
}

job draw(float scale, const view_size& view) {
    const auto s = scene_at(scale, view);
    job j;
    j.add_result(&s->drawn);
    j.add("ours", [s] {
        draw_image(view_of(s.get()), the_photo(), s->scale, s->offset_x, s->offset_y, s->area);
    });
    j.add("plain", [s] {
        plain::draw_image(view_of(s.get()), the_photo(), s->scale, s->offset_x, s->offset_y,
                          s->area);
    });
    add_floor(s, &j);
    if constexpr (WITH_PEERS) add_draw_peers(s, &j);
    return j;
}

job draw_unscaled() {
    const auto s = scene_at(1, VIEW);
    s->offset_x = s->offset_y = 0;
    job j;
    j.add_result(&s->drawn);
    j.add("ours", [s] { draw_small_image(view_of(s.get()), the_photo(), s->area); });
    j.add("plain", [s] { plain::draw_small_image(view_of(s.get()), the_photo(), s->area); });
    add_floor(s, &j);
    if constexpr (WITH_PEERS) add_draw_peers(s, &j);
    return j;
}

constexpr dash_colours DASHES = {static_cast<int32_t>(0xFFFFFFFF),
                                 static_cast<int32_t>(0xFF000000)};

job draw_with_outline(float scale) {
    const auto s = scene_at(scale, VIEW);
    s->mask = object_with_holes();
    job j;
    j.add_result(&s->drawn);
    j.add("ours", [s] {
        draw_image_with_outline(view_of(s.get()), {the_photo(), s->mask.data()}, s->scale,
                                s->offset_x, s->offset_y, DASHES, s->area);
    });
    j.add("plain", [s] {
        plain::draw_image_with_outline(view_of(s.get()), {the_photo(), s->mask.data()}, s->scale,
                                       s->offset_x, s->offset_y, DASHES, s->area);
    });
    add_floor(s, &j);
    if constexpr (WITH_PEERS) add_outline_peers(s, &j);
    return j;
}

job draw_unscaled_with_outline() {
    const auto s = scene_at(1, VIEW);
    s->offset_x = s->offset_y = 0;
    s->mask = object_with_holes();
    job j;
    j.add_result(&s->drawn);
    j.add("ours", [s] {
        draw_small_image_with_outline(view_of(s.get()), {the_photo(), s->mask.data()}, DASHES,
                                      s->area);
    });
    j.add("plain", [s] {
        plain::draw_small_image_with_outline(view_of(s.get()), {the_photo(), s->mask.data()},
                                             DASHES, s->area);
    });
    add_floor(s, &j);
    if constexpr (WITH_PEERS) add_outline_peers(s, &j);
    return j;
}

std::string named(const char* what, float scale) {
    char text[40];
    std::snprintf(text, sizeof(text), "%s at %g", what, double{scale});
    return text;
}

}  // namespace

void list_view_jobs(job_list* jobs) {
    for (const float scale : {0.25f, 0.5f, 1.0f, 1.7f, 2.7f, 4.0f}) {
        jobs->push_back({named("draw", scale), [scale] { return draw(scale, VIEW); }});
    }
    jobs->push_back({"draw at 0.25, small view", [] { return draw(0.25f, SMALL_VIEW); }});
    jobs->push_back({"draw unscaled", draw_unscaled});
    for (const float scale : {0.25f, 1.0f, 1.7f, 2.7f}) {
        jobs->push_back(
            {named("draw with outline", scale), [scale] { return draw_with_outline(scale); }});
    }
    jobs->push_back({"draw with outline, unscaled", draw_unscaled_with_outline});
}
