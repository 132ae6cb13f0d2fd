// Edge-aware strokes: dabs along the edge of the fig in desktop/photos/fig.jpg.

#include <cmath>
#include <cstring>
#include <memory>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"
#include "benchmarks/strokes_peers.h"
#include "selection/ER_selection.h"
#include "selection/competition_plain.h"
#include "selection/rectangles.h"

namespace {

enum direction : unsigned char { GROW = 0, SHRINK = 1 };  // the value under a fresh dab

// The white rind, once around. The photo's left upper corner holds the picture at its own size.
constexpr dab RIND[] = {{912, 530},  {962, 484},  {1010, 457}, {1060, 447}, {1110, 451},
                        {1145, 463}, {1192, 498}, {1232, 550}, {1250, 600}, {1247, 650},
                        {1232, 692}, {1204, 730}, {1194, 785}, {1168, 843}, {1120, 886},
                        {1065, 900}, {1015, 890}, {962, 852},  {922, 808},  {890, 765},
                        {872, 720},  {862, 670},  {858, 610},  {912, 530}};

// Dabs along the rind, `spacing` apart.
std::vector<dab> dabs_along_rind(double spacing) {
    std::vector<dab> dabs;
    double next = 0;  // from the corner looked at to the next dab
    for (size_t i = 0; i + 1 < std::size(RIND); ++i) {
        const double dx = RIND[i + 1].x - RIND[i].x, dy = RIND[i + 1].y - RIND[i].y;
        const double length = std::sqrt(dx * dx + dy * dy);
        while (next < length) {
            dabs.push_back({RIND[i].x + static_cast<int>(dx * next / length),
                            RIND[i].y + static_cast<int>(dy * next / length)});
            next += spacing;
        }
        next -= length;
    }
    return dabs;
}

// Makes the square under each dab new and calls select(dab, where to report the change). The reset
// costs all variants the same, a hundredth of the dab or less.
template <class Select>
void draw(stroke* s, Select select) {
    for (size_t i = 0; i < s->dabs.size(); ++i) {
        const dab& d = s->dabs[i];
        for_each_row(s->mask.data(), PHOTO_WIDTH, s->square(d),
                     [s](void* row, size_t n) { std::memset(row, s->start_value, n); });
        s->changed[i] = empty_beyond_image(PHOTO_WIDTH, PHOTO_HEIGHT);
        select(d, &s->changed[i]);
    }
}

job stroke_job(direction way, int radius) {
    const auto s = std::make_shared<stroke>();
    s->engine.initial(radius, radius * 3 / 10);
    s->plain_engine.initial(radius, radius * 3 / 10);
    s->dabs = dabs_along_rind(radius / 2.0);
    s->mask.resize(PHOTO_PIXELS);
    s->changed.resize(s->dabs.size());
    s->start_value = way;
    int* const image = reinterpret_cast<int*>(photo().data());
    unsigned char* const mask = s->mask.data();

    job j;
    j.cells = static_cast<double>(s->engine.brush_cells) * static_cast<double>(s->dabs.size());
    j.add_result(&s->mask);
    j.add_result(&s->changed);
    j.reset = [=] { std::memset(mask, way, PHOTO_PIXELS); };
    j.add("ours", [=] {
        draw(s.get(), [&](const dab& d, ze_rect* changed) {
            const auto select =
                way == GROW ? &ER_selection::DoSelection : &ER_selection::DeSelection;
            (s->engine.*select)(image, mask, PHOTO_WIDTH, PHOTO_HEIGHT, d.x, d.y, changed);
        });
    });
    j.add("plain", [=] {
        draw(s.get(), [&](const dab& d, ze_rect* changed) {
            const auto select = way == GROW ? plain::DoSelection : plain::DeSelection;
            select(&s->plain_engine, image, mask, PHOTO_WIDTH, PHOTO_HEIGHT, d.x, d.y, changed);
        });
    });
    j.add_uncompared("floor", [=] {
        draw(s.get(), [&](const dab& d, ze_rect*) {
            for_each_row(image, PHOTO_WIDTH, s->square(d), read_bytes);
            for_each_row(mask, PHOTO_WIDTH, s->square(d),
                         [](void* row, size_t n) { std::memset(row, 1, n); });
        });
    });
    if constexpr (WITH_PEERS) add_stroke_peers(s, &j);
    return j;
}

}  // namespace

void list_stroke_jobs(job_list* jobs) {
    for (const direction way : {GROW, SHRINK}) {
        for (const int radius : {10, 20, 40, 80}) {
            jobs->push_back({(way == GROW ? "grow, r = " : "shrink, r = ") + std::to_string(radius),
                             [=] { return stroke_job(way, radius); }});
        }
    }
}
