#include "selection/region_bits.h"

#include <algorithm>
#include <cstring>

#include "render/row_kernels.h"
#include "selection/contour_tracer.h"
#include "selection/rectangles.h"
#include "support/arithmetic.h"
#include "support/ze_alloc.h"

namespace {

int words_for(int bits) { return (bits + WORD_BITS - 1) / WORD_BITS; }

// Pixels from `first` to `last`, none when they are in the other order.
int length(int first, int last) {
    return static_cast<int>(std::max(int64_t{last} - first + 1, int64_t{0}));
}

}  // namespace

region_bits::region_bits(unsigned char* cells, int mask_width, int height, const ze_rect& inside,
                         const region_values& values)
    : contours{1, 0, 1, 0},
      mask(cells),
      width(mask_width),
      box(clip_to_image(inside, mask_width, height)),
      column_count(length(box.left, box.right)),
      row_count(column_count == 0 ? 0 : length(box.top, box.bottom)),
      shared_first(wrap_sub(1, box.left)),  // an empty box may lie anywhere
      shared_last(wrap_sub(mask_width, box.left)) {
    constexpr int MOST = INT32_MAX - 2 * WORD_BITS;
    if (marker_bytes(width, height) == 0 || column_count > MOST || row_count > MOST) return;

    row_words = (column_count + 2) / WORD_BITS + 1;  // column_count + 2 has a bit too
    const int set_words = words_for(row_words);
    const int64_t all_rows = int64_t{row_count} + 2;
    const int64_t all_bits = all_rows * row_words;
    const int64_t all_sets = all_rows * set_words;
    const int64_t bytes = (3 * all_bits + 5 * all_sets + words_for(row_count + 2)) *
                          static_cast<int64_t>(sizeof(bit_word));
    if (bytes > PTRDIFF_MAX) return;
    members = static_cast<bit_word*>(ze_calloc(static_cast<size_t>(bytes), 1));
    if (!members) return;
    visits = members + all_bits;
    markers = visits + all_bits;
    bit_word* sets = markers + all_bits;
    for (word_set* set : {&occupied, &unfinished, &marked, &dirty, &flags}) {
        *set = word_set(sets, set_words);
        sets += all_sets;
    }
    dirty_rows = sets;

    contours = {column_count + 1, 0, row_count + 1, 0};
    read_mask(values);
}

region_bits::~region_bits() { ze_free(members); }

void region_bits::read_mask(const region_values& values) {
    constexpr int TOGETHER = 64;
    bit_word packed[TOGETHER];
    const row_kernels& kernels = row_kernels_of_this_cpu();
    for (int row = 1; row <= row_count; ++row) {
        // Column 0 has no pixel, so the first word holds one fewer.
        read_word({row, 0}, 1, std::min(WORD_BITS - 1, column_count), values);
        for (word_place at = {row, 1}; at.word * WORD_BITS <= column_count;) {
            const int column = at.word * WORD_BITS;
            const int whole_words = (column_count - column + 1) / WORD_BITS;
            const auto read = static_cast<int>(
                kernels.pack_bits(pixel({column, row}), packed, std::min(whole_words, TOGETHER)));
            for (int i = 0; i < read; ++i, ++at.word) set_ones(at, packed[i], values);
            if (read > 0) continue;
            read_word(at, column, std::min(WORD_BITS, column_count - column + 1), values);
            ++at.word;
        }
    }
}

void region_bits::set_ones(word_place at, bit_word ones, const region_values& values) {
    if (values.member.has(1)) set_members(at, ones);
}

void region_bits::set_members(word_place at, bit_word bits) {
    if (bits == 0) return;  // memory that stays 0 is not even touched
    member(at) = bits;
    occupied.insert(at);
    unfinished.insert(at);
}

void region_bits::read_word(word_place at, int column, int count, const region_values& values) {
    unsigned char* const pixels = pixel({column, at.row});
    const int skipped = place_in_word(column);
    unsigned char copy[WORD_BITS] = {};
    std::memcpy(copy + skipped, pixels, static_cast<size_t>(count));
    bit_word ones;
    if (row_kernels_of_this_cpu().pack_bits(copy, &ones, 1) == 1) {
        set_ones(at, ones, values);
        return;
    }
    // Eights of bytes that are in no set are passed over.
    uint64_t eight;
    constexpr int EIGHT = sizeof eight;
    const uint64_t in_no_set = values.member.has(1) ? 0 : 0x0101010101010101;
    bit_word members_here = 0, visited_here = 0;
    for (int first = 0; first < WORD_BITS; first += EIGHT) {
        std::memcpy(&eight, copy + first, sizeof eight);
        if ((eight & ~in_no_set) == 0) continue;
        for (int i = first; i < first + EIGHT; ++i) {
            const unsigned char value = copy[i];
            const bit_word bit = bit_word{1} << i;
            if (values.member.has(value)) members_here |= bit;
            if (value == VISITED_VALUE) visited_here |= bit;
            if (values.replaced.has(value)) pixels[i - skipped] = values.replacement;
        }
    }
    set_members(at, members_here);
    if (visited_here != 0) visited(at) = visited_here;
}

void region_bits::clear_markers() {
    // A marker's own word is always among the marked ones.
    for_each_word(marked, {0, column_count + 1, 0, row_count + 1},
                  [this](word_place at) { markers[offset(at)] = 0; });
}

void region_bits::mark_sharing(cell c) {
    // Further and further cells only in an image one pixel wide.
    const auto set_in_reach = [this](cell sharing) {
        if (sharing.row >= 0 && sharing.row <= row_count + 1) set_marker(sharing);
    };
    for (cell other = {c.column - width, c.row + 1}; other.column >= 0;
         other = {other.column - width, other.row + 1}) {
        set_in_reach(other);
    }
    for (cell other = {c.column + width, c.row - 1}; other.column <= column_count + 1;
         other = {other.column + width, other.row - 1}) {
        set_in_reach(other);
    }
}

bit_word region_bits::with_value(word_place at, bit_word bits, unsigned char value) const {
    bit_word found = 0;
    for_each_run(bits, [&](int first, int count) {
        const unsigned char* const pixels = pixel({at.word * WORD_BITS + first, at.row});
        for (int i = 0; i < count; ++i) {
            if (pixels[i] == value) found |= bit_word{1} << (first + i);
        }
    });
    return found;
}

void region_bits::write(word_place at, bit_word bits, unsigned char value) const {
    for_each_run(bits, [&](int first, int count) {
        ze_memset(pixel({at.word * WORD_BITS + first, at.row}), value, static_cast<size_t>(count));
    });
}
