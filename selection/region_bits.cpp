#include "selection/region_bits.h"

#include <algorithm>
#include <cstring>

#include "selection/contour_tracer.h"
#include "support/arithmetic.h"
#include "support/ze_alloc.h"

namespace {

constexpr bit_word EIGHT_ONES = 0x0101010101010101;

// Eight bytes of 0 or 1 as bits 0 to 7, the first byte lowest.
bit_word pack(bit_word bytes) {
    // Moves bit 8 k to bit 56 + k, for each k; no two products meet.
    return bytes * 0x0102040810204080u >> 56;
}

// Eight bytes, the first lowest on every CPU.
bit_word load_bytes(const unsigned char* bytes) {
    bit_word loaded;
    std::memcpy(&loaded, bytes, sizeof loaded);
#if __BYTE_ORDER__ == __ORDER_BIG_ENDIAN__
    loaded = __builtin_bswap64(loaded);
#endif
    return loaded;
}

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
    for (int row = 1; row <= row_count; ++row) {
        unsigned char* const pixels = pixel({1, row});
        // Column 0 has no pixel, so the first word holds one fewer.
        for (int word = 0, read = 0; read < column_count; ++word) {
            const int skipped = word == 0 ? 1 : 0;
            const int count = std::min(WORD_BITS - skipped, column_count - read);
            bit_word visited_bits = 0;
            const bit_word bits = read_word(pixels + read, count, values, &visited_bits);
            // Memory that stays 0 is not even touched.
            if (bits != 0) {
                member({row, word}) = bits << skipped;
                occupied.insert({row, word});
                unfinished.insert({row, word});
            }
            if (visited_bits != 0) visited({row, word}) = visited_bits << skipped;
            read += count;
        }
    }
}

bit_word region_bits::read_word(unsigned char* pixels, int count, const region_values& values,
                                bit_word* is_visited) {
    unsigned char copy[WORD_BITS] = {};
    const unsigned char* from = pixels;
    if (count < WORD_BITS) {
        std::memcpy(copy, pixels, static_cast<size_t>(count));
        from = copy;
    }
    // Nearly all words hold only 0 or only 1, and nearly all others both; none of these has visited
    // pixels or some to replace.
    bit_word some = 0;
    for (int i = 0; i < WORD_BITS; i += 8) some |= load_bytes(from + i);
    if (some == 0) return 0;
    if ((some & ~EIGHT_ONES) == 0) {
        if (!values.member.has(1)) return 0;
        bit_word every = some;
        for (int i = 0; i < WORD_BITS; i += 8) every &= load_bytes(from + i);
        if (every == EIGHT_ONES) return ~bit_word{0};
        bit_word ones = 0;
        for (int i = 0; i < WORD_BITS; i += 8) ones |= pack(load_bytes(from + i)) << i;
        return ones;
    }

    bit_word members_here = 0;
    for (int i = 0; i < count; ++i) {
        const unsigned char value = pixels[i];
        if (values.member.has(value)) members_here |= bit_word{1} << i;
        if (value == VISITED_VALUE) *is_visited |= bit_word{1} << i;
        if (values.replaced.has(value)) pixels[i] = values.replacement;
    }
    return members_here;
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
