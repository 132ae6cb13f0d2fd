#include "tests/reference/regions_reference.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <set>
#include <stdexcept>
#include <utility>

namespace reference {

markers::markers(int width_of_image, int height_of_image)
    : width(width_of_image),
      height(height_of_image),
      marked(static_cast<std::size_t>(std::max(width, 0)) *
                 (static_cast<std::size_t>(std::max(height, 0)) + 4),
             false) {}

// Two further rows above and below the image hold every position that a shift by one row leads to.
std::size_t markers::place(int x, int y) const {
    if (x < -1 || x > width || y < -1 || y > height) throw std::out_of_range("marker");
    if (x == -1) {
        x = width - 1;
        y = y - 1;
    } else if (x == width) {
        x = 0;
        y = y + 1;
    }
    return static_cast<std::size_t>(y + 2) * static_cast<std::size_t>(width) +
           static_cast<std::size_t>(x);
}

void markers::set(int x, int y) { marked.at(place(x, y)) = true; }

bool markers::get(int x, int y) const { return marked.at(place(x, y)); }

namespace {

constexpr unsigned char VISITED = 2;

struct point {
    int x, y;
};

bool operator==(const point& a, const point& b) { return a.x == b.x && a.y == b.y; }

// The ring of the eight neighbours, clockwise from the upper left, as positions of a 3 x 3 table.
constexpr std::array<int, 8> RING = {0, 1, 2, 5, 8, 7, 6, 3};

point offset(int direction) {
    const int position = RING.at(static_cast<std::size_t>(direction));
    return {position % 3 - 1, position / 3 - 1};
}

int direction_of(const point& wanted) {
    for (int d = 0; d < 8; ++d) {
        if (offset(d) == wanted) return d;
    }
    throw std::logic_error("no direction");
}

rect cut_to_image(const rect& box, int width, int height) {
    if (width <= 0 || height <= 0) return {0, -1, 0, -1};
    return {std::max(box.left, 0), std::min(box.right, width - 1), std::max(box.top, 0),
            std::min(box.bottom, height - 1)};
}

// One call of a pass: the mask, the box, the markers, and the running contour box that starts
// empty and then only grows.
class pass {
public:
    pass(std::vector<unsigned char>& mask_of_call, int width_of_call, int height_of_call,
         const rect& box_of_call, std::set<int> region_values)
        : box(box_of_call),
          contour{width_of_call, -1, height_of_call, -1},
          mask(mask_of_call),
          width(width_of_call),
          height(height_of_call),
          beside(width_of_call, height_of_call),
          region(std::move(region_values)) {}

    unsigned char& at(int x, int y) { return pixel(mask, width, x, y); }
    bool marked_left(int x, int y) const { return beside.get(x - 1, y); }
    bool marked_right(int x, int y) const { return beside.get(x + 1, y); }
    void clear_markers() { beside = markers(width, height); }

    void trace(const point& s, unsigned char visited) {
        at(s.x, s.y) = visited;
        point p = s;
        int d = 7;
        int looked_at = 0;
        while (looked_at < 8) {
            const point n = {p.x + offset(d).x, p.y + offset(d).y};
            if (n == s) return;
            ++looked_at;
            if (is_region(n)) {
                at(n.x, n.y) = visited;
                unite(contour, n.x, n.y);
                d = (direction_of({p.x - n.x, p.y - n.y}) + 1) % 8;
                p = n;
                looked_at = 0;
            } else {
                if (d % 2 == 1) beside.set(n.x, n.y);
                d = (d + 1) % 8;
            }
        }
    }

    // Turns the interior of the contours into VISITED. With a rectangle, it is widened by what was
    // 0.
    void fill_interior(rect* grown) {
        for (int y = contour.top; y <= contour.bottom; ++y) {
            bool inside = false;
            for (int x = contour.left; x <= contour.right; ++x) {
                const int v = at(x, y);
                if (marked_left(x, y) && v == VISITED) inside = true;
                if (v == VISITED && marked_right(x, y)) {
                    inside = false;
                    continue;
                }
                if (!inside) continue;
                if (v == 0 && grown != nullptr) unite(*grown, x, y);
                at(x, y) = VISITED;
            }
        }
    }

    const rect box;
    rect contour;

private:
    bool is_region(const point& n) {
        if (n.x < box.left || n.x > box.right || n.y < box.top || n.y > box.bottom) return false;
        return region.count(at(n.x, n.y)) != 0;
    }

    std::vector<unsigned char>& mask;
    const int width, height;
    markers beside;
    const std::set<int> region;
};

// Traces and fills every region of the box that starts at one of the values, then turns the values
// of `ends` into `final_value`.
void fill(std::vector<unsigned char>& mask, int width, int height, const rect& asked,
          const std::set<int>& starts, const std::set<int>& region, const std::set<int>& ends,
          unsigned char final_value, rect* grown) {
    const rect box = cut_to_image(asked, width, height);
    if (box.top > box.bottom || box.left > box.right) return;

    pass call(mask, width, height, box, region);
    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (starts.count(call.at(x, y)) == 0) continue;
            call.trace({x, y}, VISITED);
            call.fill_interior(grown);
        }
    }
    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (ends.count(call.at(x, y)) != 0) call.at(x, y) = final_value;
        }
    }
}

// Pixels of value 1 inside of the contours, all turned into VISITED.
int count_interior(pass& call) {
    int count = 0;
    bool inside = false;  // carried over from row to row
    for (int y = call.contour.top; y <= call.contour.bottom; ++y) {
        for (int x = call.contour.left; x <= call.contour.right; ++x) {
            const int v = call.at(x, y);
            if (call.marked_left(x, y) && v == VISITED) {
                inside = true;
                continue;
            }
            if (v == VISITED) {
                if (call.marked_right(x, y)) inside = false;
            } else if (inside && v == 1) {
                call.at(x, y) = VISITED;
                ++count;
            }
        }
    }
    return count;
}

void restore_interior(pass& call, rect* boundary) {
    bool inside = false;  // carried over from row to row
    for (int y = call.contour.top; y <= call.contour.bottom; ++y) {
        for (int x = call.contour.left; x <= call.contour.right; ++x) {
            const int v = call.at(x, y);
            if (v == 1) {
                if (call.marked_left(x, y)) inside = true;
                if (call.marked_right(x, y)) inside = false;
            } else if (inside && v == VISITED) {
                call.at(x, y) = 1;
                unite(*boundary, x, y);
            }
        }
    }
}

}  // namespace

void Fill_Region(std::vector<unsigned char>& mask, int width, int height, int left, int right,
                 int top, int bottom, reference::rect* rect) {
    fill(mask, width, height, {left, right, top, bottom}, {1}, {1, 2}, {2}, 1, rect);
}

int ze_lasso_add_fill_mask(std::vector<unsigned char>& mask, int width, int height, int left,
                           int right, int top, int bottom) {
    fill(mask, width, height, {left, right, top, bottom}, {1, 5}, {1, 5, 2}, {2, 5}, 1, nullptr);
    return 1;
}

int ze_lasso_del_fill_mask(std::vector<unsigned char>& mask, int width, int height, int left,
                           int right, int top, int bottom) {
    fill(mask, width, height, {left, right, top, bottom}, {3, 4}, {2, 3, 4}, {2, 3, 4}, 0, nullptr);
    return 1;
}

void Erase_Region(std::vector<unsigned char>& mask, int width, int height,
                  reference::rect* boundary, reference::rect* rect) {
    const reference::rect box = cut_to_image(*boundary, width, height);
    *boundary = {width, 0, height, 0};
    if (box.top > box.bottom || box.left > box.right) return;

    pass call(mask, width, height, box, {1, 2});
    int regions = 0;
    point best = {-1, -1};
    int best_count = 0;
    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (call.at(x, y) != 1) continue;
            call.trace({x, y}, VISITED);
            const int count = count_interior(call);
            if (best_count <= count) {
                best = {x, y};
                best_count = count;
            }
            ++regions;
        }
    }
    call.clear_markers();

    if (regions <= 1 || best.x == -1 || best.y == -1) {
        for (int y = box.top; y <= box.bottom; ++y) {
            for (int x = box.left; x <= box.right; ++x) {
                if (call.at(x, y) != VISITED) continue;
                call.at(x, y) = 1;
                unite(*boundary, x, y);
            }
        }
        return;
    }

    call.trace(best, 1);
    restore_interior(call, boundary);

    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (call.at(x, y) == VISITED) {
                call.at(x, y) = 0;
                unite(*rect, x, y);
            } else if (call.at(x, y) == 1) {
                unite(*boundary, x, y);
            }
        }
    }
}

}  // namespace reference
