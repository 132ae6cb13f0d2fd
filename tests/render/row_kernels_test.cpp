#include "render/row_kernels.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>
#include <utility>
#include <vector>

#include "tests/differential/random_source.h"
#include "tests/helpers/guarded_buffer.h"

namespace {

using bytes = std::vector<uint8_t>;
using pixels = std::vector<uint32_t>;
using ints = std::vector<int32_t>;

// Every length around the vectors of any variant, and lengths with whole blocks of the longest loop
// steps and blocks, with a rest and without.
std::vector<int> lengths() {
    std::vector<int> all;
    for (int n = 0; n <= 40; ++n) all.push_back(n);
    for (const int n : {63, 64, 65, 127, 128, 129, 130, 255, 256, 257, 300, 511, 700}) {
        all.push_back(n);
    }
    return all;
}

pixels random_pixels(random_source& random, int n) {
    pixels p;
    for (int i = 0; i < n; ++i) p.push_back(static_cast<uint32_t>(random.any_int()));
    return p;
}

// Bytes that mostly mean something to a kernel.
bytes random_bytes(random_source& random, int n) {
    bytes b;
    for (int i = 0; i < n; ++i) {
        b.push_back(
            static_cast<uint8_t>(random.one_in(4) ? random.between(0, 255) : random.between(0, 6)));
    }
    return b;
}

bytes random_classes(random_source& random, int n) {
    bytes b;
    for (int i = 0; i < n; ++i) b.push_back(static_cast<uint8_t>(random.between(0, 2)));
    return b;
}

uint32_t grey_of(uint32_t pixel) {
    const uint32_t grey = ((pixel >> 16) % 256 + (pixel >> 8) % 256 + pixel % 256) / 3;
    return pixel / 0x1000000 * 0x1000000 + grey * 0x10000 + grey * 0x100 + grey;
}

// Runs a test for every length, in arrays that begin or end at a page that cannot be touched.
template <class Test>
void at_every_length(Test test) {
    random_source random(1);
    for (const int n : lengths()) {
        for (const guard side : {guard::BEFORE, guard::BEHIND}) {
            SCOPED_TRACE("length " + std::to_string(n));
            test(random, n, side);
            if (testing::Test::HasFailure()) return;
        }
    }
}

std::vector<const row_kernels*> variants_that_run() {
    std::vector<const row_kernels*> all;
    do {
        all.push_back(row_kernel_variants[all.size()]);
    } while (all.back() != &row_kernels_of_this_cpu());
    return all;
}

}  // namespace

TEST(row_kernels_of_this_cpu, IsTheLastVariantThatTheProcessorRuns) {
    EXPECT_STREQ(row_kernel_variants[0]->name, "scalar");
#if defined(__x86_64__)
    EXPECT_STREQ(row_kernels_of_this_cpu().name,
                 __builtin_cpu_supports("avx2") ? "avx2" : "scalar");
#elif defined(__ARM_NEON)
    EXPECT_STREQ(row_kernels_of_this_cpu().name, "neon");
#else
    EXPECT_STREQ(row_kernels_of_this_cpu().name, "scalar");
#endif
}

class row_kernel : public testing::TestWithParam<const row_kernels*> {
protected:
    const row_kernels& kernels = *GetParam();
};

INSTANTIATE_TEST_SUITE_P(variants, row_kernel, testing::ValuesIn(variants_that_run()),
                         [](const auto& test) { return test.param->name; });

TEST_P(row_kernel, GreysPixels) {
    at_every_length([&](random_source& random, int n, guard side) {
        const pixels src = random_pixels(random, n);
        pixels expected;
        for (const uint32_t pixel : src) expected.push_back(grey_of(pixel));

        guarded_buffer<uint32_t> from(src, side), to(pixels(src.size(), 7), side);
        kernels.grey(from.data(), to.data(), n);
        EXPECT_EQ(to.values(), expected);
        EXPECT_EQ(from.values(), src) << "the source changed";

        kernels.grey(from.data(), from.data(), n);
        EXPECT_EQ(from.values(), expected) << "in place";
    });
}

TEST_P(row_kernel, GreysEverySumOfColours) {
    pixels src;
    for (uint32_t sum = 0; sum <= 3 * 255; ++sum) {
        const uint32_t red = std::min(sum, 255u), green = std::min(sum - red, 255u);
        src.push_back(0x80000000 | red << 16 | green << 8 | (sum - red - green));
    }
    pixels grey(src.size());
    kernels.grey(src.data(), grey.data(), static_cast<ptrdiff_t>(src.size()));
    for (size_t sum = 0; sum < src.size(); ++sum) {
        EXPECT_EQ(grey[sum], 0x80000000 | sum / 3 * 0x010101) << sum;
    }
}

TEST_P(row_kernel, ColoursTheSelection) {
    at_every_length([&](random_source& random, int n, guard side) {
        const pixels src = random_pixels(random, n);
        const bytes mask = random_bytes(random, n);
        pixels expected;
        for (size_t i = 0; i < src.size(); ++i) {
            expected.push_back(mask[i] == 1 ? src[i] : grey_of(src[i]));
        }

        guarded_buffer<uint32_t> from(src, side), to(pixels(src.size(), 7), side);
        guarded_buffer<uint8_t> selection(mask, side);
        kernels.colour_selection(from.data(), selection.data(), to.data(), n);
        EXPECT_EQ(to.values(), expected);
        EXPECT_EQ(from.values(), src) << "the source changed";
        EXPECT_EQ(selection.values(), mask) << "the mask changed";

        kernels.colour_selection(from.data(), selection.data(), from.data(), n);
        EXPECT_EQ(from.values(), expected) << "in place";
    });
}

TEST_P(row_kernel, InvertsTheMaskAndColoursWhatItSelectsThen) {
    at_every_length([&](random_source& random, int n, guard side) {
        const pixels src = random_pixels(random, n);
        const bytes mask = random_bytes(random, n);
        pixels expected;
        bytes inverted;
        for (size_t i = 0; i < src.size(); ++i) {
            expected.push_back(mask[i] == 1 ? grey_of(src[i]) : src[i]);
            inverted.push_back(mask[i] == 1 ? 0 : 1);
        }

        guarded_buffer<uint32_t> from(src, side), to(pixels(src.size(), 7), side);
        guarded_buffer<uint8_t> selection(mask, side), same_selection(mask, side);
        kernels.invert_and_colour(from.data(), selection.data(), to.data(), n);
        EXPECT_EQ(to.values(), expected);
        EXPECT_EQ(from.values(), src) << "the source changed";
        EXPECT_EQ(selection.values(), inverted);

        kernels.invert_and_colour(from.data(), same_selection.data(), from.data(), n);
        EXPECT_EQ(from.values(), expected) << "in place";
        EXPECT_EQ(same_selection.values(), inverted) << "in place";
    });
}

TEST_P(row_kernel, InvertsAMask) {
    at_every_length([&](random_source& random, int n, guard side) {
        const bytes mask = random_bytes(random, n);
        bytes inverted;
        for (const uint8_t value : mask) inverted.push_back(value == 1 ? 0 : 1);

        guarded_buffer<uint8_t> selection(mask, side);
        kernels.invert(selection.data(), n);
        EXPECT_EQ(selection.values(), inverted);
    });
}

namespace {

// The values of a larger array: some others, again and again.
template <class T>
std::vector<T> repeated(const std::vector<T>& values, size_t n) {
    std::vector<T> all(n);
    for (size_t i = 0; i < n; ++i) all[i] = values[i % values.size()];
    return all;
}

}  // namespace

// A variant may treat images of millions of pixels in a way of its own.
TEST_P(row_kernel, ComposesLargeImagesAsSmallOnes) {
    constexpr size_t MEGAPIXEL = 1 << 20;
    random_source random(1);
    const pixels few_pixels = random_pixels(random, 5003);
    const bytes few_bytes = random_bytes(random, 4099);
    for (const size_t n : {MEGAPIXEL, MEGAPIXEL + 4113}) {
        SCOPED_TRACE("length " + std::to_string(n));
        const pixels src = repeated(few_pixels, n);
        const bytes mask = repeated(few_bytes, n);
        pixels grey, coloured, inverted_coloured;
        bytes inverted;
        for (size_t i = 0; i < n; ++i) {
            const bool selected = mask[i] == 1;
            grey.push_back(grey_of(src[i]));
            coloured.push_back(selected ? src[i] : grey[i]);
            inverted_coloured.push_back(selected ? grey[i] : src[i]);
            inverted.push_back(!selected);
        }
        const auto count = static_cast<ptrdiff_t>(n);
        // They lie otherwise in memory's lines.
        guarded_buffer<uint32_t> from(src, guard::BEFORE), to(pixels(n, 7), guard::BEHIND);
        guarded_buffer<uint8_t> selection(mask, guard::BEHIND);
        kernels.grey(from.data(), to.data(), count);
        EXPECT_TRUE(to.values() == grey);
        kernels.colour_selection(from.data(), selection.data(), to.data(), count);
        EXPECT_TRUE(to.values() == coloured);
        EXPECT_TRUE(selection.values() == mask) << "the mask changed";
        EXPECT_TRUE(from.values() == src) << "the source changed";
        kernels.invert_and_colour(from.data(), selection.data(), from.data(), count);
        EXPECT_TRUE(from.values() == inverted_coloured) << "in place";
        EXPECT_TRUE(selection.values() == inverted);
    }
}

TEST_P(row_kernel, GathersPixelsAndBytes) {
    at_every_length([&](random_source& random, int n, guard side) {
        const int columns = random.between(1, 50);
        const bytes byte_row = random_bytes(random, columns);
        const pixels colours = random_pixels(random, columns);
        const ints pixel_row(colours.begin(), colours.end());
        ints chosen, expected_pixels;
        bytes expected_bytes;
        for (int i = 0; i < n; ++i) {
            chosen.push_back(random.any_of({0, columns - 1, random.between(0, columns - 1)}));
            expected_pixels.push_back(pixel_row[static_cast<size_t>(chosen.back())]);
            expected_bytes.push_back(byte_row[static_cast<size_t>(chosen.back())]);
        }

        guarded_buffer<int32_t> from(pixel_row, side), indices(chosen, side);
        guarded_buffer<int32_t> to(ints(chosen.size(), 7), side);
        kernels.gather_pixels(from.data(), indices.data(), to.data(), n);
        EXPECT_EQ(to.values(), expected_pixels);

        guarded_buffer<uint8_t> bytes_from(byte_row, side), bytes_to(bytes(chosen.size(), 7), side);
        kernels.gather_bytes(bytes_from.data(), indices.data(), bytes_to.data(), n);
        EXPECT_EQ(bytes_to.values(), expected_bytes);
    });
}

TEST_P(row_kernel, DoublesPixels) {
    at_every_length([&](random_source& random, int n, guard side) {
        const pixels colours = random_pixels(random, (n + 1) / 2);
        const ints row(colours.begin(), colours.end());
        ints expected;
        for (int i = 0; i < n; ++i) expected.push_back(row[static_cast<size_t>(i / 2)]);

        guarded_buffer<int32_t> from(row, side), to(ints(expected.size(), 7), side);
        kernels.double_pixels(from.data(), to.data(), n);
        EXPECT_EQ(to.values(), expected);
    });
}

TEST_P(row_kernel, ClassifiesEveryMaskValue) {
    bytes mask(256), expected(256, 0);
    for (size_t value = 0; value < 256; ++value) mask[value] = static_cast<uint8_t>(value);
    expected[1] = expected[3] = OUTLINE_SELECTED;
    expected[0] = expected[4] = expected[5] = OUTLINE_OUTSIDE;
    bytes classes(256, 77);
    kernels.classify(mask.data(), classes.data(), 256);
    EXPECT_EQ(classes, expected);

    at_every_length([&](random_source& random, int n, guard side) {
        const bytes row = random_bytes(random, n);
        bytes expected_row;
        for (const uint8_t value : row) expected_row.push_back(expected[value]);
        guarded_buffer<uint8_t> from(row, side), to(bytes(row.size(), 7), side);
        kernels.classify(from.data(), to.data(), n);
        EXPECT_EQ(to.values(), expected_row);
        kernels.classify(from.data(), from.data(), n);
        EXPECT_EQ(from.values(), expected_row) << "in place";
    });
}

namespace {

using outline_kernel = bool (*)(const uint8_t*, const rows_around&, uint8_t*, ptrdiff_t);

// Compares an outline kernel with its rule, on three rows of which the middle one is longer by its
// own neighbours. Few selected or few outside values leave some rows without an outline.
template <class RandomRow, class Selected, class Outside>
void expect_outline(outline_kernel outline, RandomRow random_row, Selected selected,
                    Outside outside) {
    at_every_length([&](random_source& random, int n, guard side) {
        const bytes above = random_row(random, n), below = random_row(random, n);
        const bytes current = random_row(random, n + 2);
        bytes expected;
        bool any = false;
        for (size_t i = 0; i < above.size(); ++i) {
            const bool flag =
                selected(current[i + 1]) && (outside(above[i]) || outside(below[i]) ||
                                             outside(current[i]) || outside(current[i + 2]));
            expected.push_back(flag);
            any = any || flag;
        }

        guarded_buffer<uint8_t> a(above, side), b(below, side), c(current, side);
        guarded_buffer<uint8_t> flags(bytes(above.size(), 77), side);
        EXPECT_EQ(
            outline(c.data() + 1, {a.data(), b.data(), c.data(), c.data() + 2}, flags.data(), n),
            any);
        EXPECT_EQ(flags.values(), expected);
    });
}

// Rows of one value all over but for a few others.
template <class RandomRow>
auto mostly(uint8_t value, RandomRow random_row) {
    return [=](random_source& random, int n) {
        bytes row = random_row(random, n);
        for (uint8_t& v : row) {
            if (!random.one_in(60)) v = value;
        }
        return row;
    };
}

}  // namespace

TEST_P(row_kernel, FlagsSelectedClassesBesideOutsideOnes) {
    const auto selected = [](uint8_t c) { return c == OUTLINE_SELECTED; };
    const auto outside = [](uint8_t c) { return c == OUTLINE_OUTSIDE; };
    expect_outline(kernels.outline, random_classes, selected, outside);
    for (const uint8_t value : {OUTLINE_SELECTED, OUTLINE_OUTSIDE, uint8_t{0}}) {
        expect_outline(kernels.outline, mostly(value, random_classes), selected, outside);
    }
}

TEST_P(row_kernel, AClassMayBeBothSelectedAndOutsideToItsNeighbours) {
    const uint8_t both = OUTLINE_SELECTED | OUTLINE_OUTSIDE;
    const bytes current = {both, OUTLINE_SELECTED, 0}, none = {0};
    uint8_t flag = 77;
    EXPECT_TRUE(kernels.outline(&current[1], {none.data(), none.data(), &current[0], &current[2]},
                                &flag, 1));
    EXPECT_EQ(flag, 1);
}

TEST_P(row_kernel, FlagsSelectedPixelsBesideOutsideOnes) {
    const auto selected = [](uint8_t v) { return v == 1; };
    const auto outside = [](uint8_t v) { return v == 0; };
    expect_outline(kernels.small_outline, random_bytes, selected, outside);
    for (const uint8_t value : {uint8_t{1}, uint8_t{0}, uint8_t{255}}) {
        expect_outline(kernels.small_outline, mostly(value, random_bytes), selected, outside);
    }
}

TEST_P(row_kernel, PacksZeroesAndOnesIntoWords) {
    random_source random(1);
    for (const int words : {0, 1, 2, 5}) {
        for (const guard side : {guard::BEFORE, guard::BEHIND}) {
            for (int times = 0; times < 20; ++times) {
                bytes row;
                std::vector<uint64_t> expected(static_cast<size_t>(words), 0);
                for (uint64_t& word : expected) {
                    // Some words are of one value.
                    const int value = random.between(0, 5);
                    for (int bit = 0; bit < 64; ++bit) {
                        row.push_back(
                            static_cast<uint8_t>(value < 2 ? value : random.between(0, 1)));
                        word |= uint64_t{row.back()} << bit;
                    }
                }
                guarded_buffer<uint8_t> from(row, side);
                guarded_buffer<uint64_t> to(std::vector<uint64_t>(expected.size(), 7), side);
                EXPECT_EQ(kernels.pack_bits(from.data(), to.data(), words), words);
                EXPECT_EQ(to.values(), expected);
            }
        }
    }
}

TEST_P(row_kernel, PacksASingleOneAndASingleZeroAtEveryPlace) {
    for (size_t count = 1; count <= 6; ++count) {
        for (size_t place = 0; place < 64 * count; ++place) {
            for (const uint8_t lone : {0, 1}) {
                bytes row(64 * count, 1 - lone);
                row[place] = lone;
                std::vector<uint64_t> words(count, 7);
                std::vector<uint64_t> expected(count, lone == 1 ? 0 : ~uint64_t{0});
                expected[place / 64] ^= uint64_t{1} << place % 64;
                ASSERT_EQ(kernels.pack_bits(row.data(), words.data(), count), count);
                ASSERT_EQ(words, expected) << int{lone} << " at " << place << " of " << row.size();
            }
        }
    }
}

TEST_P(row_kernel, PacksNoWordWithAnotherValue) {
    for (const uint8_t value : {2, 3, 4, 5, 128, 254, 255}) {
        for (const uint8_t others : {0, 1}) {
            for (size_t place = 0; place < 192; ++place) {
                bytes row(192, others);
                row[place] = value;
                std::vector<uint64_t> words(3, 7), expected(3, 7);
                const size_t whole = place / 64;
                std::fill_n(expected.begin(), whole, others == 1 ? ~uint64_t{0} : 0);
                ASSERT_EQ(kernels.pack_bits(row.data(), words.data(), 3), whole);
                ASSERT_EQ(words, expected) << int{value} << " at " << place;
            }
        }
    }
}

TEST_P(row_kernel, FindsTheLastSelectedPixel) {
    at_every_length([&](random_source& random, int n, guard side) {
        bytes row = random_bytes(random, n);
        for (uint8_t& value : row) value = value == 1 ? 2 : value;
        guarded_buffer<uint8_t> unselected(row, side);
        EXPECT_EQ(kernels.last_selected(unselected.data(), n), -1);
        for (int k = 0; k < n; k += random.between(1, 9)) {
            row[static_cast<size_t>(k)] = 1;  // and those before it
            guarded_buffer<uint8_t> selected(row, side);
            EXPECT_EQ(kernels.last_selected(selected.data(), n), k);
        }
    });
}

TEST_P(row_kernel, FindsTheOnlySelectedPixelAtEveryPlaceOfEveryLength) {
    constexpr size_t LONGEST = 3 * 128 + 1;  // blocks of 128 bytes, and a byte more
    for (const uint8_t others : {0, 2, 3, 5, 255}) {
        bytes row(LONGEST, others);
        for (size_t n = 0; n <= LONGEST; ++n) {
            ASSERT_EQ(kernels.last_selected(row.data(), n), -1) << n << " times " << int{others};
            for (size_t place = 0; place < n; ++place) {
                row[place] = 1;
                ASSERT_EQ(kernels.last_selected(row.data(), n), place)
                    << "of " << n << ", among " << int{others};
                row[place] = others;
            }
        }
    }
}

namespace {

// A row of n values that are alike but for one.
struct lone_value {
    size_t n, place;
    uint8_t lone, others;

    // The row with each value replaced by what it stands for.
    template <class ValueOf>
    auto row(ValueOf value_of) const {
        std::vector<decltype(value_of(lone))> values(n, value_of(others));
        values[place] = value_of(lone);
        return values;
    }
};

uint8_t same(uint8_t value) { return value; }

// Runs a test for every place in every length up to three times the bytes that any variant handles
// in a step, and one more.
template <class Test>
void at_every_place(Test test) {
    using values = std::pair<uint8_t, uint8_t>;  // one, the others
    const std::vector<values> zero_and_one = {{1, 0}, {0, 1}};
    const std::vector<values> all = {{2, 0}, {3, 0}, {4, 0}, {5, 0}, {255, 0}, {2, 1},
                                     {3, 1}, {5, 1}, {1, 2}, {1, 3}, {1, 5},   {1, 255}};
    for (size_t n = 1; n <= 3 * 64 + 1; ++n) {
        const bool all_values = n == 7 || n == 33 || n == 65;
        for (const auto& [lone, others] : all_values ? all : zero_and_one) {
            for (size_t place = 0; place < n; ++place) {
                test(lone_value{n, place, lone, others});
                ASSERT_FALSE(testing::Test::HasFailure())
                    << int{lone} << " at " << place << " of " << n << " times " << int{others};
            }
        }
    }
}

constexpr uint32_t COLOUR = 0x87A04521, ITS_GREY = 0x87575757;

}  // namespace

TEST_P(row_kernel, GreysASingleColourAtEveryPlace) {
    at_every_place([&](const lone_value& values) {
        const pixels src = values.row([](uint8_t v) { return v == 1 ? COLOUR : 0x12000000; });
        const pixels grey = values.row([](uint8_t v) { return v == 1 ? ITS_GREY : 0x12000000; });
        pixels to(values.n, 7);
        kernels.grey(src.data(), to.data(), values.n);
        EXPECT_EQ(to, grey);
    });
}

TEST_P(row_kernel, ColoursAndInvertsASinglePixelAtEveryPlace) {
    at_every_place([&](const lone_value& values) {
        const size_t n = values.n;
        const bytes mask = values.row(same);
        const bytes inverse = values.row([](uint8_t v) { return uint8_t{v != 1}; });
        const pixels src(n, COLOUR);
        pixels to(n, 7);
        kernels.colour_selection(src.data(), mask.data(), to.data(), n);
        EXPECT_EQ(to, values.row([](uint8_t v) { return v == 1 ? COLOUR : ITS_GREY; }));

        bytes inverted = mask;
        kernels.invert_and_colour(src.data(), inverted.data(), to.data(), n);
        EXPECT_EQ(to, values.row([](uint8_t v) { return v == 1 ? ITS_GREY : COLOUR; }));
        EXPECT_EQ(inverted, inverse);

        inverted = mask;
        kernels.invert(inverted.data(), n);
        EXPECT_EQ(inverted, inverse);
    });
}

TEST_P(row_kernel, ClassifiesASingleValueAtEveryPlace) {
    const auto class_of = [](uint8_t v) {
        if (v == 1 || v == 3) return OUTLINE_SELECTED;
        return v == 0 || v == 4 || v == 5 ? OUTLINE_OUTSIDE : uint8_t{0};
    };
    at_every_place([&](const lone_value& values) {
        const bytes mask = values.row(same);
        bytes classes(values.n, 77);
        kernels.classify(mask.data(), classes.data(), values.n);
        EXPECT_EQ(classes, values.row(class_of));
    });
}

TEST_P(row_kernel, GathersASinglePixelAtEveryPlace) {
    bytes byte_row(256);
    for (size_t i = 0; i < 256; ++i) byte_row[i] = static_cast<uint8_t>(255 - i);
    const ints pixel_row(byte_row.begin(), byte_row.end());
    at_every_place([&](const lone_value& values) {
        const ints columns = values.row([](uint8_t v) { return int32_t{v}; });
        bytes gathered_bytes(values.n, 77);
        kernels.gather_bytes(byte_row.data(), columns.data(), gathered_bytes.data(), values.n);
        EXPECT_EQ(gathered_bytes, values.row([&](uint8_t v) { return byte_row[v]; }));

        ints gathered_pixels(values.n, 77);
        kernels.gather_pixels(pixel_row.data(), columns.data(), gathered_pixels.data(), values.n);
        EXPECT_EQ(gathered_pixels, values.row([&](uint8_t v) { return pixel_row[v]; }));
    });
}

TEST_P(row_kernel, DoublesASinglePixelAtEveryPlace) {
    at_every_place([&](const lone_value& values) {
        const ints row = values.row([](uint8_t v) { return int32_t{v}; });
        const size_t i = 2 * values.place;
        for (const size_t n : {2 * values.n - 1, 2 * values.n}) {
            ints expected(n, values.others), doubled(n, 77);
            expected[i] = values.lone;
            if (i + 1 < n) expected[i + 1] = values.lone;
            kernels.double_pixels(row.data(), doubled.data(), n);
            EXPECT_EQ(doubled, expected);
        }
    });
}

namespace {

// One value that differs from the others of its row, or of one of the rows around it, is all that
// makes a flag, or all that prevents one.
template <class ValueOf, class Selected, class Outside>
void expect_single_flags(outline_kernel outline, ValueOf value_of, Selected selected,
                         Outside outside) {
    at_every_place([&](const lone_value& values) {
        const size_t n = values.n;
        const bytes row = values.row(value_of);
        const bytes all_selected(n, value_of(1)), all_outside(n, value_of(0));
        bytes flags(n, 77);
        const uint8_t* const surroundings = all_outside.data();
        const bool any = outline(
            row.data(), {surroundings, surroundings, surroundings, surroundings}, flags.data(), n);
        EXPECT_EQ(flags, values.row([&](uint8_t v) { return uint8_t{selected(value_of(v))}; }));
        EXPECT_EQ(any, std::memchr(flags.data(), 1, n) != nullptr);

        for (int neighbour = 0; neighbour < 4; ++neighbour) {
            const uint8_t* rows[4];
            std::fill_n(rows, 4, all_selected.data());
            rows[neighbour] = row.data();
            const bool any_beside =
                outline(all_selected.data(), {rows[0], rows[1], rows[2], rows[3]}, flags.data(), n);
            EXPECT_EQ(flags, values.row([&](uint8_t v) { return uint8_t{outside(value_of(v))}; }))
                << "neighbour " << neighbour;
            EXPECT_EQ(any_beside, std::memchr(flags.data(), 1, n) != nullptr);
        }
    });
}

}  // namespace

TEST_P(row_kernel, FlagsASingleClassAtEveryPlace) {
    const auto class_of = [](uint8_t v) {
        if (v == 0) return OUTLINE_OUTSIDE;
        return v == 1 ? OUTLINE_SELECTED : uint8_t{0};
    };
    expect_single_flags(
        kernels.outline, class_of, [](uint8_t c) { return c == OUTLINE_SELECTED; },
        [](uint8_t c) { return c == OUTLINE_OUTSIDE; });
}

TEST_P(row_kernel, FlagsASinglePixelAtEveryPlace) {
    expect_single_flags(
        kernels.small_outline, same, [](uint8_t v) { return v == 1; },
        [](uint8_t v) { return v == 0; });
}
