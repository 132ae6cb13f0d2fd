#include "render/compositing.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "tests/helpers/guarded_buffer.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/sparse_memory.h"

namespace {

constexpr float INFINITE = std::numeric_limits<float>::infinity();

}  // namespace

// ---- ze_argb2gray

TEST(ze_argb2gray, AveragesTheColoursRoundedDownAndKeepsAlpha) {
    struct {
        uint32_t pixel, grey;
    } const cases[] = {
        {0xFF102030, 0xFF202020},  // (0x10 + 0x20 + 0x30) / 3
        {0x80FF0000, 0x80555555}, {0x8000FF00, 0x80555555}, {0x800000FF, 0x80555555},
        {0x00FFFFFF, 0x00FFFFFF}, {0x7F000000, 0x7F000000}, {0x01000001, 0x01000000},
        {0x02010100, 0x02000000}, {0x03010101, 0x03010101}, {0xFFFFFFFE, 0xFFFEFEFE},
        {0xFF0A0B0D, 0xFF0B0B0B},  // 34 / 3
    };
    for (const auto& c : cases) {
        uint32_t pixel = c.pixel;
        uint32_t grey = 0;
        ze_argb2gray(&pixel, 1, 1, &grey);
        EXPECT_EQ(grey, c.grey) << std::hex << c.pixel;
        EXPECT_EQ(pixel, c.pixel) << "the source changed";
    }
}

TEST(ze_argb2gray, DividesEverySumExactly) {
    std::vector<uint32_t> photo;
    for (uint32_t red = 0; red < 256; ++red) photo.push_back(red << 16);
    for (uint32_t green = 0; green < 256; ++green) photo.push_back(0xFF0000 | green << 8);
    for (uint32_t blue = 0; blue < 256; ++blue) photo.push_back(0xFFFF00 | blue);
    std::vector<uint32_t> grey(photo.size());

    ze_argb2gray(photo.data(), 256, 3, grey.data());

    for (uint32_t i = 0; i < photo.size(); ++i) {
        const uint32_t sum =
            i - i / 256;  // the last pixel of a row and the first of the next agree
        EXPECT_LE(grey[i] % 256 * 3, sum);
        EXPECT_GT(grey[i] % 256 * 3 + 3, sum);
        EXPECT_EQ(grey[i], grey[i] % 256 * 0x010101);
    }
}

TEST(ze_argb2gray, GreysWidthTimesHeightPixels) {
    Pixels photo("abcdefgh");
    Pixels grey("........");
    ze_argb2gray(photo.data(), 3, 2, grey.data());
    EXPECT_EQ(grey, Pixels("ABCDEF.."));
}

TEST(ze_argb2gray, GreysTheProductOfTwoNegativeSizes) {
    Pixels photo("abcdefgh");
    Pixels grey("........");
    ze_argb2gray(photo.data(), -2, -3, grey.data());
    EXPECT_EQ(grey, Pixels("ABCDEF.."));
}

TEST(ze_argb2gray, DoesNothingForAProductBelowOne) {
    struct {
        int width, height;
    } const sizes[] = {
        {0, 0}, {0, 4}, {4, 0}, {-2, 3}, {2, -3}, {-1, 0}, {50000, -50000},  // positive in 32 bits
    };
    for (const auto& size : sizes) {
        Pixels photo("abcd");
        Pixels grey("....");
        ze_argb2gray(photo.data(), size.width, size.height, grey.data());
        EXPECT_EQ(grey, Pixels("....")) << size.width << " x " << size.height;
    }
}

TEST(ze_argb2gray, WorksInPlace) {
    Pixels photo("abcd");
    ze_argb2gray(photo.data(), 2, 2, photo.data());
    EXPECT_EQ(photo, Pixels("ABCD"));
}

// ---- ze_draw_withmask, ze_draw_withmask_v2

class draw_withmask : public testing::TestWithParam<decltype(&ze_draw_withmask)> {};

INSTANTIATE_TEST_SUITE_P(both, draw_withmask,
                         testing::Values(&ze_draw_withmask, &ze_draw_withmask_v2),
                         [](const auto& test) { return test.index == 0 ? "first" : "v2"; });

TEST_P(draw_withmask, DrawsTheSelectionInColourAndTheRestGrey) {
    Pixels photo(R"(
        abcd
        efgh)");
    Picture mask(R"(
        #..#
        .##.)");
    Pixels view(4, 2, '.');

    GetParam()(photo.data(), view.data(), mask.data(), 4, 0, 3, 0, 1);

    EXPECT_EQ(view, Pixels(R"(
        aBCd
        EfgH)"));
    EXPECT_EQ(mask, Picture("#..# .##.")) << "the mask changed";
}

TEST_P(draw_withmask, OnlyAOneIsSelected) {
    Pixels photo(256, 1, 'a');
    std::vector<unsigned char> mask(256);
    for (size_t value = 0; value < 256; ++value) mask[value] = static_cast<unsigned char>(value);
    Pixels view(256, 1, '.');

    GetParam()(photo.data(), view.data(), mask.data(), 256, 0, 255, 0, 0);

    Pixels expected(256, 1, 'A');
    expected.cells[1] = Pixels::pixel_of('a');
    EXPECT_EQ(view, expected);
}

TEST_P(draw_withmask, LeavesPixelsOutsideTheRectangle) {
    Pixels photo(R"(
        abcde
        fghij
        klmno
        pqrst)");
    Picture mask(R"(
        #####
        ##.##
        ###.#
        #####)");
    Pixels view(5, 4, '.');

    GetParam()(photo.data(), view.data(), mask.data(), 5, 1, 3, 1, 2);

    EXPECT_EQ(view, Pixels(R"(
        .....
        .gHi.
        .lmN.
        .....)"));
}

TEST_P(draw_withmask, DrawsNothingInAnEmptyRectangle) {
    struct {
        int left, right, top, bottom;
    } const rectangles[] = {{0, 1, 1, 0}, {1, 0, 0, 1}, {1, 0, 1, 0}};
    for (const auto& r : rectangles) {
        Pixels photo("ab cd");
        Picture mask("#. .#");
        Pixels view("zz zz");
        GetParam()(photo.data(), view.data(), mask.data(), 2, r.left, r.right, r.top, r.bottom);
        EXPECT_EQ(view, Pixels("zz zz"));
    }
}

TEST_P(draw_withmask, WorksInPlace) {
    Pixels photo("abc def");
    Picture mask("#.# .#.");
    GetParam()(photo.data(), photo.data(), mask.data(), 3, 0, 2, 0, 1);
    EXPECT_EQ(photo, Pixels("aBc DeF"));
}

#if UINTPTR_MAX > UINT32_MAX  // no room for it on 32-bit machines
TEST_P(draw_withmask, ReachesPixelsBeyondThirtyOneBits) {
    constexpr int WIDTH = 1 << 30;
    constexpr uint64_t PIXELS = 4 * uint64_t{WIDTH}, LAST = 3 * uint64_t{WIDTH} + 5;
    sparse_array<uint32_t> photo(PIXELS), view(PIXELS);
    sparse_array<unsigned char> mask(PIXELS);
    ASSERT_TRUE(photo.data()) << NO_ROOM;
    ASSERT_TRUE(view.data()) << NO_ROOM;
    ASSERT_TRUE(mask.data()) << NO_ROOM;
    photo[LAST] = Pixels::pixel_of('a');
    mask[LAST] = 1;

    GetParam()(photo.data(), view.data(), mask.data(), WIDTH, 5, 5, 3, 3);

    EXPECT_EQ(view[LAST], Pixels::pixel_of('a'));
}
#endif

// ---- ze_draw_reverse_mask

TEST(ze_draw_reverse_mask, DrawsTheSelectionGreyAndInvertsTheMask) {
    Pixels photo(R"(
        abcd
        efgh)");
    Picture mask(R"(
        #..#
        .##.)");
    Pixels view(4, 2, '.');

    ze_draw_reverse_mask(photo.data(), view.data(), mask.data(), 4, 2);

    EXPECT_EQ(view, Pixels(R"(
        AbcD
        eFGh)"));
    EXPECT_EQ(mask, Picture(R"(
        .##.
        #..#)"));
}

TEST(ze_draw_reverse_mask, ASecondCallDrawsTheSelectionInColourAndRestoresTheMask) {
    Pixels photo("abcdef");
    Picture mask("##..#.");
    Pixels view("......");

    ze_draw_reverse_mask(photo.data(), view.data(), mask.data(), 6, 1);
    ze_draw_reverse_mask(photo.data(), view.data(), mask.data(), 6, 1);

    EXPECT_EQ(view, Pixels("abCDeF"));
    EXPECT_EQ(mask, Picture("##..#."));
}

TEST(ze_draw_reverse_mask, TurnsEveryValueOtherThanOneIntoOne) {
    Pixels photo("abcde");
    std::vector<unsigned char> mask = {0, 1, 2, 254, 255};
    Pixels view(".....");

    ze_draw_reverse_mask(photo.data(), view.data(), mask.data(), 5, 1);

    EXPECT_EQ(view, Pixels("aBcde"));
    EXPECT_EQ(mask, (std::vector<unsigned char>{1, 0, 1, 1, 1}));
}

TEST(ze_draw_reverse_mask, DoesNothingForASizeBelowOne) {
    struct {
        int width, height;
    } const sizes[] = {{0, 2}, {2, 0}, {-2, 2}, {2, -2}, {-2, -2}};
    for (const auto& size : sizes) {
        Pixels photo("abcd");
        Picture mask("#.#.");
        Pixels view("....");
        ze_draw_reverse_mask(photo.data(), view.data(), mask.data(), size.width, size.height);
        EXPECT_EQ(view, Pixels("....")) << size.width << " x " << size.height;
        EXPECT_EQ(mask, Picture("#.#.")) << size.width << " x " << size.height;
    }
}

TEST(ze_draw_reverse_mask, WorksInPlace) {
    Pixels photo("abcd");
    Picture mask("#.2#");
    ze_draw_reverse_mask(photo.data(), photo.data(), mask.data(), 2, 2);
    EXPECT_EQ(photo, Pixels("AbcD"));
}

// ---- ze_draw_reverse_mask_v2

TEST(ze_draw_reverse_mask_v2, LooksUpAReducedMaskAfterInvertingIt) {
    Pixels photo(R"(
        abcdef
        ghijkl
        mnopqr)");
    Picture mask(R"(
        #.2
        .#.)");
    Pixels view(6, 3, '.');

    ze_draw_reverse_mask_v2(photo.data(), view.data(), mask.data(), -9, 6, 3, 3, 2, 0.5f);

    EXPECT_EQ(view, Pixels(R"(
        ABcdef
        GHijkl
        mnOPqr)"));
    EXPECT_EQ(mask, Picture(R"(
        .##
        #.#)"));
}

TEST(ze_draw_reverse_mask_v2, MultipliesInSinglePrecision) {
    // 10 * 0.7f is 6.9999998..., which single precision rounds to 7.
    const Pixels expected("ABCDEFGHIJk");
    Pixels photo("abcdefghijk");

    Picture row("#######.");
    Pixels view("...........");
    ze_draw_reverse_mask_v2(photo.data(), view.data(), row.data(), 0, 11, 1, 8, 1, 0.7f);
    EXPECT_EQ(view, expected);

    Picture column("# # # # # # # .");
    view = Pixels("...........");
    ze_draw_reverse_mask_v2(photo.data(), view.data(), column.data(), 0, 1, 11, 1, 8, 0.7f);
    EXPECT_EQ(view, expected);
}

TEST(ze_draw_reverse_mask_v2, AColumnBeyondTheRowReadsTheNextRow) {
    Pixels photo(R"(
        abcd
        efgh)");
    Picture mask(R"(
        ##
        .#)");  // inverted: .. #.
    Pixels view(4, 2, '.');

    ze_draw_reverse_mask_v2(photo.data(), view.data(), mask.data(), 0, 4, 2, 2, 2, 1.0f);

    EXPECT_EQ(view, Pixels(R"(
        ABcD
        eFGH)"));  // g and h look behind the mask
}

TEST(ze_draw_reverse_mask_v2, ALookupOutsideTheMaskCountsAsNotSelected) {
    struct {
        float ratio;
        const char* view;
    } const cases[] = {
        {2.0f, "aB CD"},      // entries 0 and 2, then 4 and 6
        {-0.5f, "ab cd"},     // -0.5 is truncated to 0
        {-1.0f, "aB CD"},     // entries 0 and -1, then -2 and -3
        {INFINITE, "aB CD"},  // 0 * infinity is NaN, which is 0
        {-INFINITE, "aB CD"}, {3e9f, "aB CD"}, {NAN, "ab cd"}, {0.0f, "ab cd"},
    };
    for (const auto& c : cases) {
        for (const guard side : {guard::BEFORE, guard::BEHIND}) {
            Pixels photo("ab cd");
            guarded_buffer<unsigned char> mask({0, 1, 1, 1}, side);  // inverted: # . . .
            Pixels view(".. ..");
            ze_draw_reverse_mask_v2(photo.data(), view.data(), mask.data(), 0, 2, 2, 2, 2, c.ratio);
            EXPECT_EQ(view, Pixels(c.view)) << "ratio " << c.ratio;
        }
    }
}

TEST(ze_draw_reverse_mask_v2, InvertsTheMaskOfAnImageWithoutPixels) {
    for (const int height : {0, -1}) {
        Pixels photo("a");
        Picture mask("#. 2#");
        Pixels view(".");
        ze_draw_reverse_mask_v2(photo.data(), view.data(), mask.data(), 0, 1, height, 2, 2, 1.0f);
        EXPECT_EQ(mask, Picture(".# #."));
        EXPECT_EQ(view, Pixels("."));
    }
    Pixels photo("a");
    Picture mask("#. 2#");
    Pixels view(".");
    ze_draw_reverse_mask_v2(photo.data(), view.data(), mask.data(), 0, 0, 1, 2, 2, 1.0f);
    EXPECT_EQ(mask, Picture(".# #."));
    EXPECT_EQ(view, Pixels("."));
}

TEST(ze_draw_reverse_mask_v2, AMaskWithoutEntriesSelectsNothing) {
    struct {
        int width, height;
    } const sizes[] = {{0, 2}, {2, 0}, {-2, 2}, {2, -2}, {-2, -2}};
    for (const auto& size : sizes) {
        Pixels photo("ab");
        Picture mask("....");
        Pixels view("..");
        ze_draw_reverse_mask_v2(photo.data(), view.data(), mask.data(), 0, 2, 1, size.width,
                                size.height, 1.0f);
        EXPECT_EQ(view, Pixels("AB")) << size.width << " x " << size.height;
        EXPECT_EQ(mask, Picture("....")) << size.width << " x " << size.height;
    }
}

TEST(ze_draw_reverse_mask_v2, WorksInPlace) {
    Pixels photo("abcd efgh");
    Picture mask("#.");
    ze_draw_reverse_mask_v2(photo.data(), photo.data(), mask.data(), 0, 4, 2, 2, 1, 0.5f);
    EXPECT_EQ(photo, Pixels("ABcd EFgh"));
}

// ---- all of them

TEST(compositing, TouchesNothingBeyondItsArrays) {
    const Pixels photo(R"(
        abcde
        fghij
        klmno)");
    const Picture mask(R"(
        #.#.#
        .#.#.
        #.#.#)");
    const Pixels in_colour(R"(
        aBcDe
        FgHiJ
        kLmNo)");
    const Pixels reversed(R"(
        AbCdE
        fGhIj
        KlMnO)");
    for (const guard side : {guard::BEFORE, guard::BEHIND}) {
        guarded_buffer<uint32_t> src(photo.cells, side);
        guarded_buffer<uint32_t> dst(photo.cells, side);
        guarded_buffer<unsigned char> m(mask.cells, side);

        ze_argb2gray(src.data(), 5, 3, dst.data());
        EXPECT_EQ(dst.values(), Pixels("ABCDE FGHIJ KLMNO").cells);
        ze_draw_withmask(src.data(), dst.data(), m.data(), 5, 0, 4, 0, 2);
        EXPECT_EQ(dst.values(), in_colour.cells);
        ze_draw_reverse_mask(src.data(), dst.data(), m.data(), 5, 3);
        EXPECT_EQ(dst.values(), reversed.cells);
        ze_draw_reverse_mask_v2(src.data(), dst.data(), m.data(), 0, 5, 3, 5, 3, 1.0f);
        EXPECT_EQ(dst.values(), in_colour.cells);
        EXPECT_EQ(src.values(), photo.cells);
        EXPECT_EQ(m.values(), mask.cells);
    }
}
