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
        // Adding a bit to a run of ones carries it through to the run's end, so where ones are what
        // is not cleared, the sum differs from there on, but for further set bits on the way.
        const bit_word start = set | (before ? ~cleared & 1 : 0);
        return (~cleared & ~(~cleared + start)) | start;
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
    int first_word() const { return word_with(area.left); }
    int last_word() const { return word_with(area.right); }

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
            const word_place end = {row, word_with(covered.right)};
            if ((wider || row == covered.bottom) && bits.flags.has(end)) {
                bits.flags.erase(end);  // so that it is handed on again
                bits.touch(end);
            }
        }
        covered = area;
    }

    void touch_members(int row, int first, int last) {
        if (first > last) return;
        for (int word = word_with(first); word <= word_with(last); ++word) {
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
        for (;;) {
            if (flag) at.word = turn_unmarked(at);
            if (at.word <= last_word()) {
                bits.dirty.erase(at);
                if (bits.marked.has(at)) {
                    flag = pass_marked(at, flag);
                } else if (flag) {
                    rules.turn(&bits, at, in_area(at.word));
                }
                const bool as_before = bits.flags.has(at) == flag;
                bits.flags.set(at, flag);
                ++at.word;
                if (as_before) return at;
            }
            if (at.word > last_word()) {
                at = {at.row + 1, first_word()};
                if (!Rules::CROSSES_ROWS || at.row > area.bottom) return at;
            }
        }
    }

    // Passes the words from `at` to the next in its row with a marker or with the flag set already,
    // or to the end of the row, the flag being set throughout. Returns that word.
    int turn_unmarked(word_place at) {
        const int end =
            std::min(bits.marked.next(at, last_word() + 1), bits.flags.next(at, last_word() + 1));
        for (word_place each = at; each.word < end; ++each.word) {
            rules.turn(&bits, each, in_area(each.word));
        }
        bits.flags.insert(at, end);
        bits.unfinished.erase({at.row, std::max(at.word, first_word() + 1)},
                              std::min(end, last_word()));
        return end;
    }

    // Passes a word with markers, and returns the flag behind it.
    bool pass_marked(word_place at, bool flag) {
        const bit_word here = in_area(at.word);
        const bit_word left = bits.marked_left(at);
        const bit_word right = bits.marked_right(at);
        const flag_events events = Rules::events(bits.visited(at) & here, left, right);
        const bit_word turned = rules.turn(&bits, at, events.inside(flag) & here);
        if ((turned & (left | right)) != 0) bits.touch(at);
        return events.none() ? flag : events.last();
    }

    region_bits& bits;
    Rules& rules;
    ze_rect covered;  // the area of the call before
    ze_rect area;
};
