// D_Queue for the competition of fronts, as fast for many cells as for few.
//
// The order of cells is D_Queue's to the last tie. A queue with more than `step` cells puts a new
// one before its equals, a shorter one behind them. D_Queue finds the place by walking from an
// anchor that its index names; here a table finds the first cell of each cost, so that neither
// `step` nor the length of the queue matters.
//
// Walk and table agree as long as the walk starts at the head or at another queued cell: the list
// is sorted, so wherever it starts below the new cost, it ends at the first cell of at least that
// cost. But D_Queue's index may name a cell that has been popped. This happens when an entry
// becomes null (at the tail, or moved before the head), so that the entries behind it are no longer
// used nor moved, and is set again later. A walk from there follows the links that popped cells
// keep, each to what was the head right after it had been popped, until it comes to a cell X that
// is still queued. From there it is right again if X is cheaper than the new cell. If not, the new
// cell is put right before X, and so behind what has been put before X since X was the head.
//
// So a new cost above dearest_head, the dearest cell that was ever head after a pop, is found by
// the walk and by the table alike, whatever the index holds. For the rare lower cost the queue
// keeps the first KNOWN entries of the index as D_Queue would, links and all. Among them is nearly
// always one that ends D_Queue's scan, null or not cheaper, and the one before it, if any, is the
// anchor. Only when none does, or the anchor has been popped, is the queue in doubt, and its user
// has to ask D_Queue itself.
//
// What else D_Queue allows for cannot come up: the list is empty when a stroke begins, `count` is
// the number of cells queued, and every link is made by the rules below.
#pragma once

#include <algorithm>
#include <cstdint>

#include "selection/competition_memory.h"
#include "support/ze_alloc.h"

template <int KNOWN>
class front_queue {
public:
    // An empty queue. `popped_cells` says which cells have been: any value but NOT_POPPED.
    // REQUIRES: no slot is used.
    front_queue(front_cell* all_cells, const unsigned char* popped_cells, cost_slots* all_slots,
                int index_step)
        : cells(all_cells), popped(popped_cells), slots(*all_slots), step(index_step) {
        cells[LIST_END] = {INT32_MAX, 0, LIST_START, LIST_END};
        cells[LIST_START] = {CLOSED, 0, LIST_START, LIST_END};
        for (int k = 0; k < KNOWN; ++k) {
            known[k] = LIST_END;
            // A count that does not fit is never reached.
            marks[k] = static_cast<int>(std::min(int64_t{step} * (k + 1), int64_t{INT32_MAX}));
        }
    }

    bool empty() const { return count == 0; }

    // The order of cells may not have been D_Queue's.
    bool in_doubt() const { return doubt; }

    // Cells ever pushed.
    int taken() const { return pushed; }

    // Queues a cell that is UNREACHED, or moves one that is queued to where a lower cost belongs.
    [[gnu::always_inline]] void reach(uint32_t cell, int cost) {
        const bool is_new = cells[cell].cost == UNREACHED;
        const bool was_alone = count == 1;
        if (is_new) {
            ++pushed;
            cells[cell].previous = LIST_END;
        } else {
            unlink(cell);
        }
        insert(cell, cost);
        for (int k = 0; k < KNOWN; ++k) {
            // One alone is lowered where it is, and the index does not hear of it.
            if (count == marks[k] && (is_new || !was_alone)) known[k] = cells[LIST_END].previous;
        }
    }

    // Removes and returns the cheapest cell. REQUIRES: !empty().
    [[gnu::always_inline]] uint32_t pop() {
        const uint32_t cheapest = cells[LIST_START].next;
        const uint32_t head = cells[cheapest].next;
        cells[LIST_START].next = head;
        cells[head].previous = LIST_END;
        const int cost = cells[cheapest].cost;
        slots.first[slot_of(cost)] = head;
        free_slot(slot_of(cost), cells[head].cost != cost);
        --count;
        bool used = true;  // an entry behind a null one is not
        for (uint32_t& entry : known) {
            used &= entry != LIST_END;
            entry = used ? cells[entry].next : entry;
        }
        // With no head, the walk from a popped cell would end nowhere; LIST_END is dearer than any.
        dearest_head = std::max(dearest_head, cells[head].cost);
        return cheapest;
    }

    // Gives up what is queued, so that no slot is used.
    void clear() {
        ze_memset(slots.used, 0, sizeof slots.used);
        ze_memset(slots.used_words, 0, sizeof slots.used_words);
    }

private:
    static uint32_t slot_of(int cost) { return static_cast<uint32_t>(cost) % COST_SLOTS; }

    // Deliberate: the next head keeps its `previous`, as in D_Queue.
    void unlink(uint32_t cell) {
        const bool is_head = cells[LIST_START].next == cell;
        const uint32_t next = cells[cell].next;
        const uint32_t ahead = is_head ? LIST_START : cells[cell].previous;
        cells[ahead].next = next;
        cells[is_head ? LIST_START : next].previous = ahead;
        const int cost = cells[cell].cost;
        uint32_t& first = slots.first[slot_of(cost)];
        const bool was_first = first == cell;
        first = was_first ? next : first;
        free_slot(slot_of(cost), was_first & (cells[next].cost != cost));
        --count;
    }

    [[gnu::always_inline]] void insert(uint32_t cell, int cost) {
        cells[cell].cost = cost;
        uint32_t behind;
        if (count > step) {
            pass_index(cost);
            behind = first_from(cost);
            enter_slot(cell);
        } else {
            behind = LIST_END;
            if (count > 0) {
                behind = first_from(cost + 1);
            } else if (pushed <= int64_t{2} * step) {
                dearest_head = CLOSED;  // none but the first entry was ever set
            }
            if (!is_used(slot_of(cost))) enter_slot(cell);
            // Deliberate: a new head of two or more becomes its own `previous`, as in D_Queue.
            if (count >= 2 && behind == cells[LIST_START].next) cells[cell].previous = cell;
        }
        // A new head keeps its `previous`.
        const bool is_head = behind == cells[LIST_START].next;
        const uint32_t ahead = is_head ? LIST_START : cells[behind].previous;
        cells[ahead].next = cell;
        cells[cell].next = behind;
        cells[behind].previous = cell;
        cells[cell].previous = is_head ? cells[cell].previous : ahead;
        ++count;
    }

    // Does with the known entries of the index what D_Queue does when it looks for an anchor.
    void pass_index(int cost) {
        bool used = true;
        bool passed = false;  // an entry that is null or not cheaper
        uint32_t anchor = LIST_END;
        for (uint32_t& entry : known) {
            used &= entry != LIST_END;
            passed |= cells[entry].cost >= cost;
            anchor = passed ? anchor : entry;
            entry = (used & passed) ? cells[entry].previous : entry;
        }
        if (cost > dearest_head) return;
        doubt |= !passed;
        // The first entry is never hidden by another, so its cell is never a popped one.
        if constexpr (KNOWN > 1) doubt |= popped[anchor] != NOT_POPPED;
    }

    // The first cell of at least this cost, or LIST_END. REQUIRES: !empty().
    uint32_t first_from(int cost) const {
        const uint32_t found = slots.first[next_used(slot_of(cost))];
        return cells[found].cost < cost ? LIST_END : found;
    }

    // The first used slot from `slot` on, going round.
    uint32_t next_used(uint32_t slot) const {
        const uint64_t here = slots.used[slot / 64] >> slot % 64;
        if (here) return slot + lowest_bit(here);
        uint32_t word = slot / 64;
        const uint64_t after = slots.used_words[word / 64] >> word % 64 >> 1;
        if (after) {
            word += 1 + lowest_bit(after);
        } else {
            uint32_t group = word / 64;
            do group = (group + 1) % 64;
            while (!slots.used_words[group]);
            word = group * 64 + lowest_bit(slots.used_words[group]);
        }
        return word * 64 + lowest_bit(slots.used[word]);
    }

    static uint32_t lowest_bit(uint64_t bits) {
        return static_cast<uint32_t>(__builtin_ctzll(bits));
    }

    bool is_used(uint32_t slot) const { return slots.used[slot / 64] >> slot % 64 & 1; }

    // Makes `cell` the first of its cost.
    void enter_slot(uint32_t cell) {
        const uint32_t slot = slot_of(cells[cell].cost);
        slots.first[slot] = cell;
        slots.used[slot / 64] |= uint64_t{1} << slot % 64;
        slots.used_words[slot / 64 / 64] |= uint64_t{1} << slot / 64 % 64;
    }

    // Marks a slot as unused, if so it is. No branches: which way they would go is anybody's guess.
    void free_slot(uint32_t slot, bool is_unused) {
        const uint64_t word = slots.used[slot / 64] &= ~(uint64_t{is_unused} << slot % 64);
        slots.used_words[slot / 64 / 64] &= ~(uint64_t{word == 0} << slot / 64 % 64);
    }

    front_cell* const cells;
    const unsigned char* const popped;
    cost_slots& slots;
    const int step;
    int count = 0;
    int pushed = 0;
    int dearest_head = CLOSED;  // none yet
    bool doubt = false;
    uint32_t known[KNOWN];  // of D_Queue's index, the first entries; LIST_END is null
    int marks[KNOWN];       // the counts at which they are set
};
