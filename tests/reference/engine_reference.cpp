#include "tests/reference/engine_reference.h"

#include <array>
#include <cmath>

namespace reference {
namespace {

constexpr unsigned char RIM = 1, INNER = 2, CORE = 3;

enum direction { LEFT = 0, RIGHT = 1, UP = 2, DOWN = 3 };
constexpr std::array<int, 4> DX = {-1, 1, 0, 0};
constexpr std::array<int, 4> DY = {0, 0, -1, 1};

}  // namespace

engine::engine()
    : radius(0),
      core_radius(0),
      brush_cells(0),
      nodes_used(0),
      complete(false),
      abandoned_seedings(0),
      cut_growths(0),
      reused_popped(0) {}

void engine::initial(int r, int c) {
    radius = r;
    core_radius = c;
    nodes_used = 0;
    build();
}

void engine::set_brush(int r, int c) {
    if (r == radius && c == core_radius) return;
    radius = r;
    core_radius = c;
    build();
}

void engine::build() {
    brush_cells = 0;
    complete = false;
    queue.reset();
    node_pool.clear();
    node_map.clear();
    brush_map.clear();
    cost_h.clear();
    cost_v.clear();

    queue = std::make_unique<reference::queue>(node_pool);

    const long long side = 2LL * radius + 1;
    const unsigned long long positive_side =
        static_cast<unsigned long long>(side < 0 ? -side : side);
    if (positive_side * positive_side > MOST_CELLS) return;  // below 2^64, since side is below 2^32
    const std::size_t cells = static_cast<std::size_t>(positive_side * positive_side);
    brush_map.assign(cells, 0);
    node_map.assign(cells, NO_NODE);
    cost_h.assign(cells, 0);
    cost_v.assign(cells, 0);

    for (int dy = -radius; dy <= radius; ++dy) {
        for (int dx = -radius; dx <= radius; ++dx) {
            const double distance =
                std::sqrt(static_cast<double>(dx) * dx + static_cast<double>(dy) * dy);
            const int d = static_cast<int>(distance + 0.5);
            unsigned char shade = 0;
            if (d == radius) {
                shade = RIM;
            } else if (d <= core_radius) {
                shade = CORE;
            } else if (d < radius) {
                shade = INNER;
            }
            brush_map.at(cell(dx, dy, 0, 0)) = shade;
            if (shade != 0) ++brush_cells;
        }
    }

    queue->step = brush_cells / 100;
    if (queue->step < 1) queue->step = 1;

    node_pool.assign(static_cast<std::size_t>(brush_cells) + 1, node{0, 0, 0, 0, NO_NODE, NO_NODE});
    complete = true;
}

// Number of the cell that lies over pixel (px, py) when the brush is centred on (x, y).
std::size_t engine::cell(int px, int py, int x, int y) const {
    const long long side = 2LL * radius + 1;
    return static_cast<std::size_t>((static_cast<long long>(py) - y + radius) * side +
                                    (static_cast<long long>(px) - x + radius));
}

int engine::cal_cost(const std::vector<int>& image, int width, int x1, int y1, int x2, int y2) {
    const auto colour = [&](int x, int y) {
        return static_cast<unsigned>(
            image.at(static_cast<std::size_t>(static_cast<long long>(y) * width + x)));
    };
    const unsigned a = colour(x1, y1);
    const unsigned b = colour(x2, y2);
    int sum = 0;
    for (int channel = 0; channel < 3; ++channel) {
        const int shift = 16 - 8 * channel;
        const int difference =
            static_cast<int>((a >> shift) % 256) - static_cast<int>((b >> shift) % 256);
        sum += difference * difference;
    }
    return sum;
}

void engine::price_and_seed_pixel(const std::vector<int>& image, std::vector<unsigned char>& mask,
                                  int width, int height, int x, int y, int px, int py, kind stroke,
                                  bool* failed) {
    if (px < 0) return;
    const std::size_t here = cell(px, py, x, y);
    const unsigned char shade = brush_map.at(here);
    if (0 < px && px < width && 0 < py && py < height && shade != 0) {
        cost_h.at(here) = cal_cost(image, width, px, py, px - 1, py);
        cost_v.at(here) = cal_cost(image, width, px, py, px, py - 1);
    }
    if (!(px < width && 0 <= py && py < height)) return;

    const unsigned char rim_seeds_on = stroke == kind::grow ? 0 : 1;
    int label = -1;
    if (shade == CORE) label = 1;
    if (shade == RIM && pixel(mask, width, px, py) == rim_seeds_on) label = 0;
    if (label == -1) return;

    node_pool.at(static_cast<std::size_t>(nodes_used)) = node{px, py, 0, label, NO_NODE, NO_NODE};
    if (queue->push(nodes_used) == 0) {
        *failed = true;
        return;
    }
    node_map.at(here) = nodes_used;
    ++nodes_used;
}

// False when a push failed.
bool engine::price_and_seed(const std::vector<int>& image, std::vector<unsigned char>& mask,
                            int width, int height, int x, int y, kind stroke) {
    if (stroke == kind::shrink && radius <= 0) return true;
    const int last = stroke == kind::grow ? radius : radius - 1;
    bool failed = false;
    for (int dy = -radius; dy <= last; ++dy) {
        for (int dx = -radius; dx <= last; ++dx) {
            price_and_seed_pixel(image, mask, width, height, x, y, x + dx, y + dy, stroke, &failed);
            if (failed) return false;
        }
    }
    return true;
}

void engine::unlink(int m) {
    const auto at = [this](int n) -> node& { return node_pool.at(static_cast<std::size_t>(n)); };
    const int before = at(m).prev;
    const int behind = at(m).next;
    if (m == queue->tail) {
        queue->tail = before;
        if (before != NO_NODE) at(before).next = NO_NODE;
    } else if (m == queue->head) {
        queue->head = behind;  // which keeps its prev
    } else {
        if (behind != NO_NODE) at(behind).prev = before;
        if (before != NO_NODE) at(before).next = behind;
    }
}

// A pixel that no front has won yet.
static bool open_pixel(unsigned char value, bool growing) {
    if (growing) return value == 0 || value == 1;
    return value != 2 && value != 3 && value != 4;
}

// Offers the step from the popped node in one direction. False when a push failed.
bool engine::reach(int popped_number, const node& popped, int direction,
                   std::vector<unsigned char>& mask, int width, int height, int x, int y,
                   kind stroke) {
    const int nx = popped.x + DX.at(static_cast<std::size_t>(direction));
    const int ny = popped.y + DY.at(static_cast<std::size_t>(direction));
    if (!in_image(nx, ny, width, height)) return true;
    if (nx - x > radius || x - nx > radius || ny - y > radius || y - ny > radius) return true;
    const std::size_t there = cell(nx, ny, x, y);
    if (brush_map.at(there) != INNER) return true;
    if (!open_pixel(pixel(mask, width, nx, ny), stroke == kind::grow)) return true;

    const std::size_t here = cell(popped.x, popped.y, x, y);
    int e = 0;
    switch (direction) {
        case UP:
            e = cost_v.at(here);
            break;
        case LEFT:
            e = cost_h.at(here);
            break;
        case RIGHT:
            e = cost_h.at(there);
            break;
        default:
            e = cost_v.at(there);
            break;
    }
    const int new_cost = wrap_add(popped.cost, e);

    const int m = node_map.at(there);
    if (m == NO_NODE) {
        if (nodes_used == popped_number) ++reused_popped;
        node_pool.at(static_cast<std::size_t>(nodes_used)) =
            node{nx, ny, new_cost, popped.label, NO_NODE, NO_NODE};
        if (queue->push(nodes_used) == 0) return false;
        node_map.at(there) = nodes_used;
        ++nodes_used;
        return true;
    }

    node& reached = node_pool.at(static_cast<std::size_t>(m));
    if (!(new_cost < reached.cost)) return true;
    reached.cost = new_cost;
    reached.label = popped.label;
    if (queue->count == 1) return true;
    unlink(m);
    --queue->count;
    return queue->push(m) != 0;
}

void engine::compete(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                     kind stroke) {
    const bool growing = stroke == kind::grow;
    while (!queue->empty()) {
        const int popped_number = queue->pop();
        const node popped = node_pool.at(static_cast<std::size_t>(popped_number));
        if (!in_image(popped.x, popped.y, width, height)) continue;
        unsigned char& value = pixel(mask, width, popped.x, popped.y);
        if (!open_pixel(value, growing)) continue;

        if (popped.label == 1) {
            value = 2;
        } else if (growing) {
            value = value != 0 ? 4 : 3;
        } else {
            value = value == 1 ? 3 : 4;
        }

        for (int direction : {LEFT, RIGHT, UP, DOWN}) {
            if (!reach(popped_number, popped, direction, mask, width, height, x, y, stroke)) {
                ++cut_growths;
                return;
            }
        }
    }
}

void engine::forget_nodes() {
    for (int& entry : node_map) entry = NO_NODE;
}

void engine::DoSelection(const std::vector<int>& image, std::vector<unsigned char>& mask, int width,
                         int height, int x, int y, reference::rect* rect) {
    if (!complete) return;
    if (x < 1 || y < 1 || x > width - 2LL || y > height - 2LL) return;

    queue->count = 0;
    queue->index.fill(NO_NODE);
    queue->spare = 0;
    nodes_used = 0;

    if (!price_and_seed(image, mask, width, height, x, y, kind::grow)) {
        ++abandoned_seedings;
        return;
    }
    compete(mask, width, height, x, y, kind::grow);

    for (int py = y - radius; py <= y + radius; ++py) {
        for (int px = x - radius; px <= x + radius; ++px) {
            if (!in_image(px, py, width, height)) continue;
            unsigned char& value = pixel(mask, width, px, py);
            if (value == 1 || value == 2 || value == 4) {
                value = 1;
                unite(*rect, px, py);
            } else {
                value = 0;
            }
        }
    }
    forget_nodes();
}

void engine::DeSelection(const std::vector<int>& image, std::vector<unsigned char>& mask, int width,
                         int height, int x, int y, reference::rect* rect) {
    if (!complete) return;
    if (!in_image(x, y, width, height)) return;
    if (pixel(mask, width, x, y) != 1) return;

    queue->index.fill(NO_NODE);
    queue->count = 0;
    nodes_used = 0;

    if (!price_and_seed(image, mask, width, height, x, y, kind::shrink)) {
        ++abandoned_seedings;
        return;
    }
    compete(mask, width, height, x, y, kind::shrink);

    for (int py = y - radius; py <= y + radius; ++py) {
        for (int px = x - radius; px <= x + radius; ++px) {
            if (!in_image(px, py, width, height)) continue;
            unsigned char& value = pixel(mask, width, px, py);
            if (value == 2 || value == 4) {
                value = 0;
                unite(*rect, px, py);
            } else if (value == 3) {
                value = 1;
            }
        }
    }
    forget_nodes();
}

void engine::paint(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                   unsigned char from, unsigned char to, reference::rect* rect) {
    if (!complete) return;
    if (radius <= 0) return;
    for (int dy = -radius; dy <= radius - 1; ++dy) {
        for (int dx = -radius; dx <= radius - 1; ++dx) {
            const long long px = static_cast<long long>(x) + dx;
            const long long py = static_cast<long long>(y) + dy;
            if (!in_image(px, py, width, height)) continue;
            if (brush_map.at(cell(dx, dy, 0, 0)) == 0) continue;
            unsigned char& value = pixel(mask, width, static_cast<int>(px), static_cast<int>(py));
            if (value != from) continue;
            value = to;
            unite(*rect, static_cast<int>(px), static_cast<int>(py));
        }
    }
}

void engine::Brush_Add(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                       reference::rect* rect) {
    paint(mask, width, height, x, y, 0, 1, rect);
}

void engine::Brush_Del(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                       reference::rect* rect) {
    paint(mask, width, height, x, y, 1, 0, rect);
}

}  // namespace reference
