// Where the competition of fronts works: in the memory of the engine's node_pool.
//
//     | records of D_Queue's nodes, for competition_plain.cpp      | slots of costs |
//     | or cells and what became of them, for front_competition.cpp |                |
//
// A stroke uses the first part in one way or the other and finds nothing there. The slots are
// unused between strokes.
#pragma once

#include <algorithm>
#include <cstdint>

#include "selection/D_Queue.h"
#include "selection/colour_cost.h"

// A cell of the brush square. Cells are known by number: first come two of the queue's own, then
// the square's, row by row, with a closed row before and one behind.
struct front_cell {
    int cost;   // of its path; CLOSED or UNREACHED
    int front;  // who brought it there: front_mark
    uint32_t previous;
    uint32_t next;
};

// Costs to which every step's cost compares as it should: a closed cell never gets a lower one, an
// unreached cell always.
constexpr int CLOSED = INT32_MIN;
constexpr int UNREACHED = INT32_MAX;

enum front_mark : unsigned char {
    NOT_POPPED,
    STROKE_FRONT,
    KEEP_FRONT,
    BLOCKED_SEED,  // queued and popped, and never won: its pixel has a foreign value
};

// Costs in the queue lie no further apart than one step costs, so modulo this none share a slot.
constexpr uint32_t COST_SLOTS = 1u << 18;
static_assert(COST_SLOTS > MAX_COLOUR_COST);

// What the queue knows of each cost: is it used, and by which cell first. Three levels, each bit
// saying that a word of the level below is not zero; the highest is the queue's own.
struct cost_slots {
    uint64_t used[COST_SLOTS / 64];
    uint64_t used_words[COST_SLOTS / 64 / 64];
    uint32_t first[COST_SLOTS];  // of used slots only
};

// The queue's own cells, so that no link needs a condition.
constexpr uint32_t LIST_END = 0;    // behind the tail, which is its `previous`; also for null
constexpr uint32_t LIST_START = 1;  // before the head, which is its `next`
constexpr uint32_t QUEUE_CELLS = 2;

inline uint64_t first_of_square(uint64_t side) { return QUEUE_CELLS + side; }
inline uint64_t front_cells(uint64_t side) { return first_of_square(side) + side * side + side; }

inline uint64_t nodes_that_hold(uint64_t bytes) {
    return (bytes + sizeof(node) - 1) / sizeof(node);
}

// Entries of node_pool before the slots.
inline uint64_t nodes_before_slots(uint64_t side, int brush_cells) {
    const uint64_t cells = front_cells(side);
    return std::max(static_cast<uint64_t>(brush_cells) + 1,
                    nodes_that_hold(cells * (sizeof(front_cell) + sizeof(front_mark))));
}

// Entries of node_pool.
inline uint64_t nodes_of_pool(uint64_t side, int brush_cells) {
    return nodes_before_slots(side, brush_cells) + nodes_that_hold(sizeof(cost_slots));
}

inline cost_slots* slots_of_pool(node* pool, uint64_t side, int brush_cells) {
    static_assert(alignof(node) >= alignof(front_cell) && sizeof(node) % alignof(cost_slots) == 0);
    return reinterpret_cast<cost_slots*>(pool + nodes_before_slots(side, brush_cells));
}
