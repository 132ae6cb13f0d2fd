// The interior pass on whole regions, as it goes over what is new since the one before.
//
// After each region that it traces, a pass goes through all cells of the area that its traces have
// covered so far, row by row, with a flag that says whether a cell is inside (region_plain.cpp has
// the loops). What it finds follows from *events*, visited cells with a marker beside them: each
// sets the flag or clears it, whatever was before; the cells from there to the next event are
// inside or are not. So a pass that looks only at these cells comes to the same:
//
// - behind an event that is new since the pass before, up to the next event;
// - in the part of the area that is new.
//
// All else the pass before has seen in the same state, and left as this one would: a cell once
// turned stays. Nothing that a pass turns is an event to the same pass, which looks at a cell
// before it turns it; it is to the next. Words with new visited cells or markers are dirty
// (region_bits.h).
#pragma once

#include "selection/region_bits.h"
#include "selection/ze_rect.h"

// Where the flag changes within a word. No cell is in both.
struct flag_events {
    bit_word set;
    bit_word cleared;

    bool none() const { return (set | cleared) == 0; }

    // The flag behind the last event. REQUIRES: !none().
    bool last() const { return set > cleared; }

    // The cells with the flag set, when it was `before` in front of the word.
    bit_word inside(bool before) const {
        if (none()) return before ? ~bit_word{0} : 0;
        // Each cell takes over from those below it what none between has cleared; twice as far at
        // every step.
        bit_word flags = set | (before ? ~cleared & 1 : 0);
        bit_word keeps = ~cleared;
        for (int distance = 1; distance < WORD_BITS; distance *= 2) {
            flags |= keeps & flags << distance;
            keeps &= keeps << distance;
        }
        return flags;
    }
};

// Rules have
//
//   CROSSES_ROWS   true: the flag goes on from the end of a row to the start of the next;
//                  false: every row starts with it cleared
//   events(visited, marked_left, marked_right)
//                  the flag_events among the visited cells of a word
//   turn(region_bits*, word_place, inside)
//                  makes visited what has to be so among the inside cells, and returns their bits
template <class Rules>
class interior_pass {
public:
    interior_pass(region_bits* region, Rules* pass_rules)
        : bits(*region), rules(*pass_rules), covered(region->contours), area(region->contours) {}

    // Goes over what is new since the last call.
    void run() {
        area = bits.contours;
        if (area.left > area.right) return;
        touch_new_area();
        word_place at = bits.next_dirty({area.top - 1, last_word() + 1}, area);
        while (at.row <= area.bottom) at = bits.next_dirty(go_on_from(at), area);
    }

private:
    int first_word() const { return area.left / WORD_BITS; }
    int last_word() const { return area.right / WORD_BITS; }

    // The bits of a word's cells in the area.
    bit_word in_area(int word) const { return cells_between(area.left, area.right, word); }

    // Makes the words dirty in which cells are new to the area, as far as they can matter: those
    // with members, and those behind a flag that was set at the end of a row.
    void touch_new_area() {
        if (area == covered) return;
        const bool wider = area.left < covered.left || area.right > covered.right;
        for (int row = area.top; row <= area.bottom; ++row) {
            if (row < covered.top || row > covered.bottom) {
                touch_members(row, area.left, area.right);
                continue;
            }
            touch_members(row, area.left, covered.left - 1);
            touch_members(row, covered.right + 1, area.right);
            const word_place end = {row, covered.right / WORD_BITS};
            if ((wider || row == covered.bottom) && bits.flags.has(end)) {
                bits.flags.erase(end);  // so that it is handed on again
                bits.touch(end);
            }
        }
        covered = area;
    }

    void touch_members(int row, int first, int last) {
        if (first > last) return;
        for (int word = first / WORD_BITS; word <= last / WORD_BITS; ++word) {
            const bit_word members = bits.member({row, word}) & cells_between(first, last, word);
            if (members != 0) bits.touch({row, word});
        }
    }

    bool flag_before(word_place at) const {
        if (at.word > first_word()) return bits.flags.has({at.row, at.word - 1});
        if constexpr (Rules::CROSSES_ROWS) {
            if (at.row > area.top) return bits.flags.has({at.row - 1, last_word()});
        }
        return false;
    }

    // Passes `at` and the words behind it until the flag is what it was when they were passed
    // before. Returns the word behind.
    word_place go_on_from(word_place at) {
        bool flag = flag_before(at);
        for (bool changed = true; changed && at.row <= area.bottom;) {
            bits.dirty.erase(at);
            if (bits.marked.has(at)) {
                const flag_events events =
                    Rules::events(bits.visited(at) & in_area(at.word), bits.marked_left(at),
                                  bits.marked_right(at));
                const bit_word turned =
                    rules.turn(&bits, at, events.inside(flag) & in_area(at.word));
                if ((turned & (bits.marked_left(at) | bits.marked_right(at))) != 0) bits.touch(at);
                if (!events.none()) flag = events.last();
            } else if (flag) {
                rules.turn(&bits, at, in_area(at.word));
            }
            changed = bits.flags.has(at) != flag;
            if (flag) {
                bits.flags.insert(at);
            } else {
                bits.flags.erase(at);
            }
            if (++at.word > last_word()) {
                at = {at.row + 1, first_word()};
                if constexpr (!Rules::CROSSES_ROWS) return at;
            }
        }
        return at;
    }

    region_bits& bits;
    Rules& rules;
    ze_rect covered;  // the area of the call before
    ze_rect area;
};
