// The selection engine: a brush, working buffers of the brush's size, and the strokes.
#pragma once

#include "selection/D_Queue.h"
#include "selection/ze_rect.h"
#include "support/ze_api.h"

// Classes of brush cells, d being the cell's distance from the centre rounded half up. Tested in
// the order rim, core, inner, outside.
//
// Deliberate: a cell at d = radius is rim even when the core reaches that far, and cells at
// radius < d <= core radius are core. With core radius >= radius nothing is inner.
enum brush_class : unsigned char {
    BRUSH_OUTSIDE = 0,  // d > radius: never touched
    BRUSH_RIM = 1,      // d = radius: seeds of the front that keeps pixels as they are
    BRUSH_INNER = 2,    // d < radius: where the fronts compete
    BRUSH_CORE = 3,     // d <= core radius: seeds of the stroke's own front
};

// The brush is a square of (2 * radius + 1)^2 cells around the stroke point, each classed by its
// rounded distance from the centre. Every per-cell array is row-major: cell (dx, dy), both within
// -radius .. radius, is entry (dy + radius) * (2 * radius + 1) + dx + radius.
//
// The engine knows no image. Each stroke gets photo, mask and size, and keeps no pointer to them.
// What does outlive a stroke: the cost arrays, and whatever a broken list left in the queue.
class ZE_API ER_selection {
public:
    // An engine without buffers. Every stroke but the lasso's does nothing until initial().
    ER_selection();
    ~ER_selection();
    ER_selection(const ER_selection&) = delete;
    ER_selection& operator=(const ER_selection&) = delete;

    // Frees and forgets every buffer.
    void destroyResource();

    // Builds the brush and its buffers anew.
    //
    //   radius       in pixels; below 0 the square is empty
    //   core_radius  in pixels; below 0 there is no core
    //
    // When an allocation fails, or the square has more cells than memory can have, the buffers from
    // that one on stay null, nothing is reported, and brush strokes do nothing. More cells than an
    // int can count are not asked for.
    void initial(int radius, int core_radius);

    // As initial(), but returns at once when both values are the current ones, and leaves
    // `nodes_used` as it is.
    void set_brush(int radius, int core_radius);

    // Squared Euclidean distance of two pixels in red, green and blue: 0 to 195075. Alpha does not
    // count. REQUIRES: both pixels lie in `image`, whose rows are `width` apart.
    int cal_cost(int* image, int width, int x1, int y1, int x2, int y2);

    // Grows the selection from the brush core at (x, y) along the photo's edges.
    //
    //   image   width * height pixels 0xAARRGGBB
    //   mask    width * height bytes, 1 is selected; the brush square comes back as 0 and 1 only
    //   rect    widened over every selected pixel of the square, changed or not
    //
    // A front that starts on the core competes with one that starts on the rim's unselected pixels;
    // see front_competition.cpp. Nothing happens with (x, y) on the image's outermost rows and
    // columns or beyond.
    void DoSelection(int* image, unsigned char* mask, int width, int height, int x, int y,
                     ze_rect* rect);

    // Shrinks the selection from the brush core at (x, y) along the photo's edges: DoSelection with
    // the roles of selected and not selected exchanged, as far as front_competition.cpp's two rule
    // types say. Arguments as there; rect is widened over every pixel that comes out 0 from a mark.
    //
    // Nothing happens when the point lies outside the image or is not selected.
    void DeSelection(int* image, unsigned char* mask, int width, int height, int x, int y,
                     ze_rect* rect);

    // Paints the brush at (x, y): makes 1 of 0, or 0 of 1, in every cell of the brush inside the
    // image. Other values stay. rect is widened over the pixels that changed. The point may lie
    // anywhere.
    //
    // Deliberate: the last row and column of the square are never painted, so the disc lacks its
    // right and lower rim; a radius of 0 paints nothing.
    void Brush_Add(unsigned char* mask, int width, int height, int x, int y, ze_rect* rect);
    void Brush_Del(unsigned char* mask, int width, int height, int x, int y, ze_rect* rect);

    // Draws a segment of a lasso's outline between (x0, y0) and (x1, y1), in either direction the
    // same: one pixel for each step along its longer axis, the ends' steps included. The value
    // drawn remembers the pixel: adding makes 1 of 0 and 5 of anything else, removing makes 4 of 1
    // and 3 of anything else. ze_lasso_add_fill_mask and ze_lasso_del_fill_mask turn them back.
    // rect is widened over every pixel drawn.
    //
    // Nothing happens when an end lies outside the image. No brush is needed: both work on an
    // engine without buffers too.
    //
    // Deliberate:
    // - A pixel drawn twice, such as the joint of two segments, ends as 5 or 3, whatever it held at
    //   first.
    // - The slope is cut off after 16 binary digits and wraps where the ends lie more than 32767
    //   apart across, so a segment of tens of thousands of pixels may end beside its end point.
    void Lasso_Add(unsigned char* mask, int width, int height, int x0, int y0, int x1, int y1,
                   ze_rect* rect);
    void Lasso_Del(unsigned char* mask, int width, int height, int x0, int y0, int x1, int y1,
                   ze_rect* rect);

    // Public, in a fixed order. All arrays but node_pool have one entry per cell of the square.
    unsigned char* brush_map;  // owned; brush_class of each cell
    node* node_pool;           // owned; brush_cells + 1 records, handed out in order by a stroke
    node** node_map;           // owned; the node of each cell during a stroke, else null
    int* cost_h;               // owned; colour cost from each cell's pixel to the one on its left
    int* cost_v;               // owned; colour cost from each cell's pixel to the one above
    int radius;
    int core_radius;
    int brush_cells;  // cells of the brush that are not BRUSH_OUTSIDE
    int nodes_used;   // records of node_pool taken by the current stroke
    D_Queue* queue;   // owned
};
