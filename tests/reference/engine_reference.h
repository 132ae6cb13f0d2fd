// Slow model of the selection engine: brush square, colour costs, and the four brush strokes.
//
// The library is compared with it stroke after stroke on one engine, because a stroke leaves things
// behind that later strokes see: colour costs of cells in the first row and column of the photo,
// the list of a growth that was cut short, and recorded seeds of a stroke that was abandoned.
#pragma once

#include <cstddef>
#include <memory>
#include <vector>

#include "tests/reference/basics_reference.h"
#include "tests/reference/queue_reference.h"

namespace reference {

// A brush square of more cells counts as an allocation that failed: brushes up to radius 4095 fit.
constexpr std::size_t MOST_CELLS = std::size_t{1} << 26;

class engine {
public:
    engine();
    engine(const engine&) = delete;
    engine& operator=(const engine&) = delete;

    void initial(int r, int c);
    void set_brush(int r, int c);

    static int cal_cost(const std::vector<int>& image, int width, int x1, int y1, int x2, int y2);

    // `rect` is widened, never reset.
    void DoSelection(const std::vector<int>& image, std::vector<unsigned char>& mask, int width,
                     int height, int x, int y, reference::rect* rect);
    void DeSelection(const std::vector<int>& image, std::vector<unsigned char>& mask, int width,
                     int height, int x, int y, reference::rect* rect);
    void Brush_Add(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                   reference::rect* rect);
    void Brush_Del(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                   reference::rect* rect);

    // Per cell of the brush square, row by row from the upper left.
    std::vector<unsigned char> brush_map;  // 0 outside, 1 rim, 2 inner, 3 core
    std::vector<node> node_pool;
    std::vector<int> node_map;  // numbers into node_pool, NO_NODE for none
    std::vector<int> cost_h;
    std::vector<int> cost_v;
    int radius;
    int core_radius;
    int brush_cells;
    int nodes_used;
    std::unique_ptr<reference::queue> queue;  // null until a brush is built

    // What follows is no field of the library's engine. It tells a test what its strokes reached.
    bool complete;           // every buffer is there
    int abandoned_seedings;  // strokes that a failed push ended before the growth
    int cut_growths;         // growths that a failed push ended

    // Growths in which a popped node's own record was handed out again while its neighbours were
    // being looked at. Only a list left over by a cut growth leads there. The model goes on with
    // the values that the node had when it was popped.
    int reused_popped;

private:
    enum class kind { grow, shrink };

    void build();
    std::size_t cell(int px, int py, int x, int y) const;
    void price_and_seed_pixel(const std::vector<int>& image, std::vector<unsigned char>& mask,
                              int width, int height, int x, int y, int px, int py, kind stroke,
                              bool* failed);
    bool price_and_seed(const std::vector<int>& image, std::vector<unsigned char>& mask, int width,
                        int height, int x, int y, kind stroke);
    void compete(std::vector<unsigned char>& mask, int width, int height, int x, int y,
                 kind stroke);
    bool reach(int popped_number, const node& popped, int direction,
               std::vector<unsigned char>& mask, int width, int height, int x, int y, kind stroke);
    void unlink(int m);
    void paint(std::vector<unsigned char>& mask, int width, int height, int x, int y,
               unsigned char from, unsigned char to, reference::rect* rect);
    void forget_nodes();
};

}  // namespace reference
