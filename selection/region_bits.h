// A box of a selection mask as bits: what the passes on whole regions work on.
//
// One bit of a word is one pixel, so that 64 pixels of a row are handled by a few operations, and a
// pixel's eight neighbours are read out of three words. The mask itself is read once, when the
// bits are made; what a pass decides goes to the bits and, where it is final, to the mask.
//
// Positions are cells of the box, its left upper one column 1 of row 1. The cells around the box,
// in column and row 0 and one beyond the last, have bits too; no region reaches them, markers do.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "selection/rectangles.h"
#include "selection/value_set.h"

using bit_word = uint64_t;
constexpr int WORD_BITS = 64;

// The word that holds a bit of a row of words, and its place there.
constexpr int word_with(int bit) {
    return static_cast<int>(static_cast<unsigned>(bit) / WORD_BITS);
}
constexpr int place_in_word(int bit) {
    return static_cast<int>(static_cast<unsigned>(bit) % WORD_BITS);
}

constexpr int lowest_bit(bit_word bits) { return __builtin_ctzll(bits); }
constexpr int highest_bit(bit_word bits) { return WORD_BITS - 1 - __builtin_clzll(bits); }
constexpr int count_bits(bit_word bits) {
    // Not every processor counts in one instruction, and most words are full.
    return bits == ~bit_word{0} ? WORD_BITS : __builtin_popcountll(bits);
}
constexpr bit_word bits_from(int bit) { return ~bit_word{0} << bit; }
constexpr bit_word bits_up_to(int bit) { return ~bit_word{0} >> (WORD_BITS - 1 - bit); }

// Those of bits first .. last of a row of words that word number `word` holds. REQUIRES: it holds
// some.
constexpr bit_word bits_between(int first, int last, int word) {
    return (word == word_with(first) ? bits_from(place_in_word(first)) : ~bit_word{0}) &
           (word == word_with(last) ? bits_up_to(place_in_word(last)) : ~bit_word{0});
}

// Calls visit(first bit, length) for each run of ones.
template <class Visit>
void for_each_run(bit_word bits, Visit visit) {
    while (bits != 0) {
        const int first = lowest_bit(bits);
        const bit_word behind = ~bits & bits_from(first);
        const int end = behind == 0 ? WORD_BITS : lowest_bit(behind);
        visit(first, end - first);
        if (end == WORD_BITS) return;
        bits &= bits_from(end);
    }
}

// The first one at or behind `from` among bits 0 .. end - 1 of a row of words, or `end`.
inline int next_bit(const bit_word* bits, int from, int end) {
    for (int bit = from; bit < end; bit += WORD_BITS - place_in_word(bit)) {
        const bit_word ahead = bits[word_with(bit)] >> place_in_word(bit);
        if (ahead != 0) return std::min(bit + lowest_bit(ahead), end);
    }
    return end;
}

// The last one at or before `from` in a row of words, or -1.
inline int previous_bit(const bit_word* bits, int from) {
    for (int bit = from; bit >= 0; bit -= place_in_word(bit) + 1) {
        const bit_word before = bits[word_with(bit)] & bits_up_to(place_in_word(bit));
        if (before != 0) return bit - place_in_word(bit) + highest_bit(before);
    }
    return -1;
}

struct cell {
    int column;
    int row;

    bool operator==(const cell& other) const { return column == other.column && row == other.row; }
};

// A word of a row: columns word * WORD_BITS and on.
struct word_place {
    int row;
    int word;
};

inline word_place word_of(cell c) { return {c.row, word_with(c.column)}; }
inline bit_word bit_of(cell c) { return bit_word{1} << place_in_word(c.column); }

// A set of words of a box, one bit a word; its memory is the box's.
class word_set {
public:
    word_set() = default;
    word_set(bit_word* memory, int words_per_row) : sets(memory), row_words(words_per_row) {}

    bool has(word_place at) const { return (set_of(at) & bit_of(at)) != 0; }
    void insert(word_place at) { set_of(at) |= bit_of(at); }
    void erase(word_place at) { set_of(at) &= ~bit_of(at); }
    void set(word_place at, bool in_set) { in_set ? insert(at) : erase(at); }

    // Words from `at` to before `end` in its row.
    void insert(word_place at, int end) {
        for_each_set(at, end, [](bit_word* set, bit_word words) { *set |= words; });
    }
    void erase(word_place at, int end) {
        for_each_set(at, end, [](bit_word* set, bit_word words) { *set &= ~words; });
    }

    // The first word of the set at or behind `at` in its row, or `end` when none is before that.
    int next(word_place at, int end) const {
        return next_bit(sets + ptrdiff_t{at.row} * row_words, at.word, end);
    }

    // The last word of the set at or before `at` in its row, or -1.
    int previous(word_place at) const {
        return previous_bit(sets + ptrdiff_t{at.row} * row_words, at.word);
    }

    // Calls visit(word_place) for each word of the set from `at` to before `end` in its row. Visits
    // may change the set ahead of them. REQUIRES: at.word < end.
    template <class Visit>
    void for_each(word_place at, int end, Visit visit) const {
        for (int i = word_with(at.word); i <= word_with(end - 1); ++i) {
            const bit_word& set = sets[ptrdiff_t{at.row} * row_words + i];
            bit_word ahead = bits_between(at.word, end - 1, i);
            while (const bit_word left = set & ahead) {
                const int place = lowest_bit(left);
                visit(word_place{at.row, i * WORD_BITS + place});
                ahead &= ~bit_word{1} << place;
            }
        }
    }

private:
    static bit_word bit_of(word_place at) { return bit_word{1} << place_in_word(at.word); }
    bit_word& set_of(word_place at) const {
        return sets[ptrdiff_t{at.row} * row_words + word_with(at.word)];
    }

    template <class Visit>
    void for_each_set(word_place at, int end, Visit visit) {
        if (at.word >= end) return;
        for (int i = word_with(at.word); i <= word_with(end - 1); ++i) {
            visit(&sets[ptrdiff_t{at.row} * row_words + i], bits_between(at.word, end - 1, i));
        }
    }

    bit_word* sets = nullptr;
    int row_words = 0;
};

// Which values of the mask mean what to a pass. 0 is in no set.
struct region_values {
    value_set member;           // belong to regions
    value_set replaced;         // do not stay: the mask holds ...
    unsigned char replacement;  // ... this in their place, once the bits are made
};

constexpr unsigned char VISITED_VALUE = 2;  // a pixel that counts as visited from the start

class region_bits {
public:
    // Takes the pass's one work buffer, of about three bits for each pixel of the box, or none when
    // it cannot be had; the mask then stays as it is. Image sizes that make no marker_buffer make
    // none here either, nor does a box of more than 2^31 - 129 columns or rows.
    //
    //   box  the part of it inside the image counts
    region_bits(unsigned char* mask, int width, int height, const ze_rect& box,
                const region_values& values);
    ~region_bits();
    region_bits(const region_bits&) = delete;
    region_bits& operator=(const region_bits&) = delete;

    explicit operator bool() const { return members != nullptr; }

    // The words of members, of those of them that are visited, and of markers.
    bit_word& member(word_place at) const { return members[offset(at)]; }
    bit_word& visited(word_place at) const { return visits[offset(at)]; }

    // Bits of the cells that have a marker on their left, and on their right. Bits around the box
    // mean nothing.
    bit_word marked_left(word_place at) const {
        const bit_word* const m = markers + offset(at);
        return m[0] << 1 | m[-1] >> (WORD_BITS - 1);
    }
    bit_word marked_right(word_place at) const {
        const bit_word* const m = markers + offset(at);
        return m[0] >> 1 | m[1] << (WORD_BITS - 1);
    }
    void clear_markers();

    // Traces the contour of the region that holds `start`, as trace_contour does pixel by pixel:
    // calls visit(cell) for the start and every cell moved to, widens `contours` over the latter,
    // and leaves markers.
    template <class Visit>
    void trace(cell start, Visit visit) {
        visit(start);
        cell at = start;
        unsigned direction = LEFT;
        for (;;) {
            const unsigned ahead = looking_from(direction, neighbours(at));
            const unsigned background =
                ahead == 0 ? DIRECTIONS : static_cast<unsigned>(lowest_bit(ahead));
            mark_straight(at, direction, background);
            if (ahead == 0) return;
            direction = (direction + background) % DIRECTIONS;
            at = {at.column + DX[direction], at.row + DY[direction]};
            if (at == start) return;
            visit(at);
            include(&contours, at.column, at.row);
            direction = (direction + DIRECTIONS / 2 + 1) % DIRECTIONS;
        }
    }

    void set_visited(cell c) {
        bit_word& word = visited(word_of(c));
        if ((word & bit_of(c)) != 0) return;
        word |= bit_of(c);
        touch(word_of(c));
    }
    void set_unvisited(cell c) { visited(word_of(c)) &= ~bit_of(c); }

    // Calls visit(word_place), row by row, for each word of the cells in `area` that is in `words`
    // when its turn comes.
    template <class Visit>
    static void for_each_word(const word_set& words, const ze_rect& area, Visit visit) {
        for (int row = area.top; row <= area.bottom; ++row) {
            words.for_each({row, word_with(area.left)}, word_with(area.right) + 1, visit);
        }
    }

    // Calls visit(cell) for each member that is not visited, row by row. REQUIRES: visit makes the
    // cell visited; it may make others so too, and more members of visited cells.
    template <class Visit>
    void for_each_unvisited(Visit visit) const {
        for_each_word(unfinished, all_cells(), [&](word_place at) {
            while (const bit_word left = member(at) & ~visited(at)) {
                visit(cell{at.word * WORD_BITS + lowest_bit(left), at.row});
            }
        });
    }

    ze_rect all_cells() const { return {1, column_count, 1, row_count}; }

    word_set occupied;    // words that the mask began with members in
    word_set unfinished;  // those of them that can have members that are not visited

    // ---- words that changed

    // Notes a change of a visited cell, or of a marker beside a cell, in a word.
    void touch(word_place at) {
        dirty.insert(at);
        dirty_rows[word_with(at.row)] |= row_bit(at.row);
    }

    // The first dirty word of the cells in `area` at or behind `at`: in its row, or else in a later
    // one. Below the area when there is none.
    //
    // A row gone into for its dirty words, of which some may lie outside the area, is not looked at
    // again before one is touched anew or look_again_at() says so.
    word_place next_dirty(word_place at, const ze_rect& area) {
        const int first = word_with(area.left);
        const int end = word_with(area.right) + 1;
        for (;;) {
            at.word = dirty.next(at, end);
            if (at.word < end) return at;
            at = {next_bit(dirty_rows, at.row + 1, area.bottom + 1), first};
            if (at.row > area.bottom) return at;
            dirty_rows[word_with(at.row)] &= ~row_bit(at.row);
        }
    }

    void look_again_at(int first_row, int last_row) {
        for (int i = word_with(first_row); i <= word_with(last_row); ++i) {
            dirty_rows[i] |= bits_between(first_row, last_row, i);
        }
    }

    word_set dirty;   // touched; whoever has seen to a word erases it
    word_set marked;  // words in which a cell has a marker beside it; left by clear_markers() too
    word_set flags;   // the interior pass's own, empty at first

    // ---- the mask under the bits

    // The mask's pixel in a cell of the box.
    unsigned char* pixel(cell c) const {
        return mask + (ptrdiff_t{box.top} + c.row - 1) * width + box.left + c.column - 1;
    }

    // Those of `bits` whose pixel holds `value`.
    bit_word with_value(word_place at, bit_word bits, unsigned char value) const;

    // Writes `value` to the pixels of `bits`.
    void write(word_place at, bit_word bits, unsigned char value) const;

    // Widens r, a rectangle of the image, over the cells of `bits`.
    void include_bits(ze_rect* r, word_place at, bit_word bits) const {
        if (bits == 0) return;
        const int x = box.left - 1 + at.word * WORD_BITS;
        const int y = box.top - 1 + at.row;
        unite(r, {x + lowest_bit(bits), x + highest_bit(bits), y, y});
    }

    // Whether include_bits(&r, at, bits) would leave r as it is.
    bool includes_bits(const ze_rect& r, word_place at, bit_word bits) const {
        ze_rect widened = r;
        include_bits(&widened, at, bits);
        return widened == r;
    }

    // Widens r over the cells of all bits_of(word_place), of which only occupied words have some.
    template <class BitsOf>
    void include_all(ze_rect* r, BitsOf bits_of) const {
        for (int row = 1; row <= row_count; ++row) {
            word_place at = {row, occupied.next({row, 0}, row_words)};
            while (at.word < row_words && bits_of(at) == 0) {
                at.word = occupied.next({row, at.word + 1}, row_words);
            }
            if (at.word == row_words) continue;
            include_bits(r, at, bits_of(at));
            at.word = occupied.previous({row, row_words - 1});
            while (bits_of(at) == 0) at.word = occupied.previous({row, at.word - 1});
            include_bits(r, at, bits_of(at));
        }
    }

    // Covers, in cells, every cell that a trace has moved to; left > right at first.
    //
    // Deliberate: never reset, and starts are not taken in; see region_mask.
    ze_rect contours;

private:
    static constexpr unsigned DIRECTIONS = 8;
    static constexpr unsigned LEFT = 7;
    static constexpr unsigned STRAIGHT = 0xAA;  // the set of the odd directions
    static constexpr int DX[DIRECTIONS] = {-1, 0, 1, 1, 1, 0, -1, -1};
    static constexpr int DY[DIRECTIONS] = {-1, -1, -1, 0, 1, 1, 1, 0};

    // A set of directions turned so that bit 0 is `direction` and bit 1 the one clockwise from it.
    static unsigned looking_from(unsigned direction, unsigned directions) {
        return (directions >> direction | directions << (DIRECTIONS - direction)) & 0xFF;
    }

    // Bits 0 to 2: the members left of `column`, in it and right of it.
    static unsigned three_bits(const bit_word* row, int column) {
        const bit_word* const word = row + word_with(column - 1);
        const int first = place_in_word(column - 1);
        bit_word bits = word[0] >> first;
        if (first > WORD_BITS - 3) bits |= word[1] << (WORD_BITS - first);
        return bits & 7;
    }

    // The directions in which c has member neighbours, as bits.
    unsigned neighbours(cell c) const {
        static constexpr unsigned char REVERSED[8] = {0, 4, 2, 6, 1, 5, 3, 7};
        const bit_word* const row = members + offset({c.row, 0});
        const unsigned above = three_bits(row - row_words, c.column);
        const unsigned beside = three_bits(row, c.column);
        const unsigned below = three_bits(row + row_words, c.column);
        return above | (beside & 4) << 1 | REVERSED[below] << 4 | (beside & 1) << 7;
    }

    // Marks the straight neighbours of c among `count` ones clockwise from `direction`.
    void mark_straight(cell c, unsigned direction, unsigned count) {
        const unsigned looked_at = ((1u << count) - 1) << direction;
        for (unsigned left = (looked_at | looked_at >> DIRECTIONS) & STRAIGHT; left != 0;
             left &= left - 1) {
            const int d = lowest_bit(left);
            mark({c.column + DX[d], c.row + DY[d]});
        }
    }

    // Deliberate: where the box reaches both sides of the image, some cells share their marker:
    // those of (-1, y) and (width - 1, y - 1) in the image are one, and so are those of (width, y)
    // and (0, y + 1).
    void mark(cell c) {
        set_marker(c);
        if (c.column <= shared_first || c.column >= shared_last) mark_sharing(c);
    }
    void mark_sharing(cell c);

    void set_marker(cell c) {
        bit_word& word = markers[offset(word_of(c))];
        if ((word & bit_of(c)) != 0) return;
        word |= bit_of(c);
        note_marker(word_of(c));
        // The cell beside it may lie in the next word. There is none before the first.
        const int place = place_in_word(c.column);
        if (place == 0 && c.column != 0) note_marker(word_of({c.column - 1, c.row}));
        if (place == WORD_BITS - 1) note_marker(word_of({c.column + 1, c.row}));
    }
    void note_marker(word_place beside) {
        marked.insert(beside);
        touch(beside);
    }

    static bit_word row_bit(int row) { return bit_word{1} << place_in_word(row); }
    ptrdiff_t offset(word_place at) const { return ptrdiff_t{at.row} * row_words + at.word; }
    void read_mask(const region_values& values);
    void read_word(word_place at, int column, int count, const region_values& values);
    void set_ones(word_place at, bit_word ones, const region_values& values);
    void set_members(word_place at, bit_word bits);

    unsigned char* const mask;
    const int width;    // of the image
    const ze_rect box;  // in the image
    const int column_count;
    const int row_count;
    const int shared_first;  // a marker at or left of this column is another cell's too
    const int shared_last;   // and so is one at or right of this
    int row_words = 0;
    bit_word* members = nullptr;  // where the work buffer starts
    bit_word* visits = nullptr;
    bit_word* markers = nullptr;
    bit_word* dirty_rows = nullptr;  // a set of rows
};
