// The interior pass on whole regions, as it goes over what is new since the one before.
//
// After each region that it traces, a pass goes through all cells of the area that its traces have
// covered so far, row by row, with a flag that says whether a cell is inside (region_plain.cpp has
// the loops). The flag follows from *events*, visited cells with a marker beside them: each sets it
// or clears it, whatever it was before, and it holds to the next event. Inside cells are turned,
// and stay so. Hence a pass changes nothing but
//
// - behind an event that is new since the pass before, as far as the flag is other than it was
// then;
// - in cells that are new to the area.
//
// So the pass here starts at words that changed, which are dirty (region_bits.h), goes on until the
// flag behind a word is the one that it kept of the last time, and ends with the same cells turned.
//
// A cell that a pass turns is no event to the same pass, which looks at each cell before it turns
// it; it is to the next. A word in which that matters is dirty again.
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
        if (covered.left <= covered.right && !(area == covered)) take_in_new_area();
        covered = area;
        word_place at = bits.next_dirty({area.top - 1, last_word() + 1}, area);
        while (at.row <= area.bottom) at = bits.next_dirty(go_on_from(at), area);
    }

private:
    int first_word() const { return word_with(area.left); }
    int last_word() const { return word_with(area.right); }

    // The bits of a word's cells in the area.
    bit_word in_area(int word) const { return bits_between(area.left, area.right, word); }

    // Sees to the cells that are new to the area. Words of them that have changed are dirty, so it
    // is enough to go on from where the flag was set at the area's edge, and to look again at words
    // that were seen to while a part of them lay outside.
    void take_in_new_area() {
        const bool wider = area.left < covered.left || area.right > covered.right;
        const int first_row = wider ? covered.top : covered.bottom;
        for (const int column : {covered.left, covered.right}) {
            const int word = word_with(column);
            const bit_word seen = bits_between(covered.left, covered.right, word);
            const bit_word new_cells = in_area(word) & ~seen;
            for (int row = first_row; new_cells != 0 && row <= covered.bottom; ++row) {
                if ((bits.visited({row, word}) & new_cells) != 0) bits.touch({row, word});
            }
        }
        for (int row = first_row; row <= covered.bottom; ++row) {
            hand_on_flag(word_of({covered.right, row}));
        }
        bits.look_again_at(first_row, covered.bottom);
    }

    // Has a flag that is set passed on to the cells behind.
    void hand_on_flag(word_place at) {
        if (!bits.flags.has(at)) return;
        bits.flags.erase(at);
        bits.touch(at);
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
                if constexpr (!Rules::CROSSES_ROWS) return at;
                if (at.row > area.bottom) return at;
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
