// What the selection family does with Java's arrays and objects, call by call, and what it refuses.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "selection/objectsel.h"
#include "tests/helpers/java_pictures.h"
#include "tests/helpers/log_lines.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/recording_env.h"
#include "tests/helpers/rect_printing.h"
#include "tests/helpers/util_methods.h"

using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace {

// A session without an engine. Whatever a test does not take from the log is a failure.
class Util_selection : public testing::Test {
protected:
    explicit Util_selection(array_access access = array_access::direct) : env(access) {
        ze_destroy_objectsel();
        g_object_boundary = UNTOUCHED;
        g_fill_boundary = UNTOUCHED;
        g_Brush_Radius = 10;
        g_Brush_Center = 1;
        take_log_lines();
    }
    ~Util_selection() override {
        ze_destroy_objectsel();
        EXPECT_THAT(take_log_lines(), IsEmpty());
    }

    // Takes what was logged: exactly one rejection.
    static void expect_rejection() {
        EXPECT_THAT(take_log_lines(),
                    ElementsAre(log_line{4, "KOVA_RM", "Invalid Input Parameters\n"}));
    }

    static constexpr ze_rect UNTOUCHED = {11, 12, 13, 14};

    recording_env env;
};

// The same with both ways in which a virtual machine hands out arrays.
class Util_selection_arrays : public Util_selection,
                              public testing::WithParamInterface<array_access> {
protected:
    Util_selection_arrays() : Util_selection(GetParam()) {}

    // Copies that come back from an array pinned once.
    static int one_copy() { return GetParam() == array_access::copy ? 1 : 0; }
};

INSTANTIATE_TEST_SUITE_P(access, Util_selection_arrays,
                         testing::Values(array_access::direct, array_access::copy),
                         testing::PrintToStringParamName());

}  // namespace

// ---- init_objectsel, destroy_objectsel

TEST_F(Util_selection, InitBuildsAnEngineWithoutTouchingJava) {
    EXPECT_EQ(UTIL_METHOD(init_1objectsel)(&env, nullptr, 1, 1), 1);

    EXPECT_NE(g_ERBrush, nullptr);
    EXPECT_EQ(g_object_boundary, (ze_rect{0, 0, 0, 0}));
    EXPECT_THAT(env.take_calls(), IsEmpty());
}

TEST_F(Util_selection, InitPassesWidthAndHeight) {
    EXPECT_EQ(UTIL_METHOD(init_1objectsel)(&env, nullptr, 640, 480), 1);

    EXPECT_EQ(g_object_boundary, (ze_rect{639, 0, 479, 0}));
}

TEST_F(Util_selection, InitRejectsSizesBelowOneAndKeepsTheSession) {
    ze_set_brush_size(3, 1);
    const ER_selection* const engine = g_ERBrush;
    const struct {
        jint width, height;
    } sizes[] = {{0, 100}, {100, -1}, {100, 0}, {-1, 100}, {0, 0}};

    for (const auto& size : sizes) {
        SCOPED_TRACE(testing::Message() << size.width << " x " << size.height);
        EXPECT_EQ(UTIL_METHOD(init_1objectsel)(&env, nullptr, size.width, size.height), 0);
        expect_rejection();
        EXPECT_EQ(g_ERBrush, engine);
        EXPECT_EQ(g_object_boundary, UNTOUCHED);
        EXPECT_THAT(env.take_calls(), IsEmpty());
    }
}

TEST_F(Util_selection, DestroyReleasesTheEngineWithoutTouchingJava) {
    ze_set_brush_size(3, 1);

    UTIL_METHOD(destroy_1objectsel)(&env, nullptr);

    EXPECT_EQ(g_ERBrush, nullptr);
    EXPECT_THAT(env.take_calls(), IsEmpty());
}

// ---- modify_objectsel

// A brush of radius 1 with core 0 selects its centre and nothing else.
TEST_P(Util_selection_arrays, ModifyPinsReadsStrokesWritesBackAndReleasesInReverse) {
    ze_set_brush_size(1, 0);
    g_object_boundary = {5, 0, 4, 0};
    fake_ints pixels("pixels", Pixels(6, 5, 'a').cells);
    fake_bytes mask("mask", Picture(6, 5, 0).cells);
    fake_point p1("p1", 4, 1), p2("p2", 1, 2);
    fake_rect rect("rect", {5, 6, 7, 8});

    UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 6, 5, p1, p2, 0, rect, 0);

    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetIntArrayElements(pixels, null)", "GetByteArrayElements(mask, null)",
                    "GetObjectClass(p1)", "GetFieldID(class of p1, x, I)",
                    "GetFieldID(class of p1, y, I)", "GetIntField(p1, x)", "GetIntField(p1, y)",
                    "GetObjectClass(p2)", "GetFieldID(class of p2, x, I)",
                    "GetFieldID(class of p2, y, I)", "GetIntField(p2, x)", "GetIntField(p2, y)",
                    "GetObjectClass(rect)", "GetFieldID(class of rect, left, I)",
                    "GetFieldID(class of rect, right, I)", "GetFieldID(class of rect, top, I)",
                    "GetFieldID(class of rect, bottom, I)", "GetIntField(rect, left)",
                    "GetIntField(rect, right)", "GetIntField(rect, top)",
                    "GetIntField(rect, bottom)", "SetIntField(rect, left, 4)",
                    "SetIntField(rect, right, 4)", "SetIntField(rect, top, 1)",
                    "SetIntField(rect, bottom, 1)", "ReleaseByteArrayElements(mask, elements, 0)",
                    "ReleaseIntArrayElements(pixels, elements, 0)"));
    EXPECT_EQ(picture_of(mask, 6, 5), Picture(R"(
        ......
        ....#.
        ......
        ......
        ......)"));
    EXPECT_EQ(rect.value(), (ze_rect{4, 4, 1, 1}));
    EXPECT_EQ(g_object_boundary, (ze_rect{4, 4, 1, 1}));
}

TEST_P(Util_selection_arrays, ModifyRewritesThePixelsWithoutAChange) {
    ze_set_brush_size(1, 0);
    const Pixels photo("abcd efgh ijkl");
    fake_ints pixels("pixels", photo.cells);
    fake_bytes mask("mask", Picture(4, 3, 0).cells);
    fake_point p1("p1", 1, 1), p2("p2", 0, 0);
    fake_rect rect("rect", {0, 0, 0, 0});

    UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 4, 3, p1, p2, 0, rect, 1);

    EXPECT_EQ(pixels_of(pixels, 4, 3), photo);
    EXPECT_EQ(pixels.times_copied_back(), one_copy());
}

// Deliberate: what the rectangle held before does not matter.
TEST_P(Util_selection_arrays, ModifyWithoutAnEngineEmptiesTheRectangle) {
    fake_ints pixels("pixels", Pixels(6, 5, 'a').cells);
    fake_bytes mask("mask", Picture(6, 5, 0).cells);
    fake_point p1("p1", 4, 1), p2("p2", 1, 2);
    fake_rect rect("rect", {5, 6, 7, 8});

    UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 6, 5, p1, p2, 0, rect, 1);

    EXPECT_EQ(rect.value(), (ze_rect{6, 0, 5, 0}));
    EXPECT_EQ(picture_of(mask, 6, 5), Picture(6, 5, 0));
    EXPECT_EQ(g_object_boundary, UNTOUCHED);
    EXPECT_EQ(env.pins(), 2);
    EXPECT_EQ(env.releases(), 2);
}

TEST_P(Util_selection_arrays, ModifyPassesTheMode) {
    ze_set_brush_size(1, 0);
    fake_ints pixels("pixels", Pixels(6, 5, 'a').cells);
    fake_bytes mask("mask", Picture(6, 5, 0).cells);
    fake_point p1("p1", 4, 1), p2("p2", 1, 2);
    fake_rect rect("rect", {5, 6, 7, 8});

    UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 6, 5, p1, p2, 6, rect, 0);

    EXPECT_EQ(rect.value(), (ze_rect{6, 0, 5, 0}));
    EXPECT_EQ(picture_of(mask, 6, 5), Picture(6, 5, 0));
}

// A lasso segment from the first point to the second.
TEST_P(Util_selection_arrays, ModifyPassesBothPoints) {
    ze_set_brush_size(1, 0);
    fake_ints pixels("pixels", Pixels(6, 5, 'a').cells);
    fake_bytes mask("mask", Picture(6, 5, 0).cells);
    fake_point p1("p1", 4, 1), p2("p2", 1, 2);
    fake_rect rect("rect", {0, 0, 0, 0});

    UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 6, 5, p1, p2, 4, rect, 0);

    EXPECT_EQ(picture_of(mask, 6, 5), Picture(R"(
        ......
        ...##.
        .##...
        ......
        ......)"));
    EXPECT_EQ(rect.value(), (ze_rect{1, 4, 1, 2}));
}

TEST_P(Util_selection_arrays, ModifyPassesFill) {
    const Picture ring(R"(
        .......
        .###...
        .#.#...
        .###...
        .......)");
    Picture with_point = ring;
    with_point.at(5, 1) = 1;
    Picture filled = with_point;
    filled.at(2, 2) = 1;
    const struct {
        jint fill;
        Picture mask;
        ze_rect rect;
    } cases[] = {
        {0, with_point, {5, 5, 1, 1}}, {1, filled, {2, 5, 1, 2}}, {2, with_point, {5, 5, 1, 1}}};

    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << "fill " << c.fill);
        ze_set_brush_size(1, 0);
        g_object_boundary = {1, 3, 1, 3};
        fake_ints pixels("pixels", Pixels(7, 5, 'a').cells);
        fake_bytes mask("mask", ring.cells);
        fake_point p1("p1", 5, 1), p2("p2", 0, 0);
        fake_rect rect("rect", {0, 0, 0, 0});

        UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 7, 5, p1, p2, 0, rect, c.fill);

        EXPECT_EQ(picture_of(mask, 7, 5), c.mask);
        EXPECT_EQ(rect.value(), c.rect);
    }
}

// ---- inverse_objectsel, reset_objectsel

TEST_P(Util_selection_arrays, InversePinsInvertsAndReleases) {
    fake_bytes mask("mask", Picture("#.2 ..#").cells);

    UTIL_METHOD(inverse_1objectsel)(&env, nullptr, mask, 3, 2);

    EXPECT_THAT(env.take_calls(), ElementsAre("GetByteArrayElements(mask, null)",
                                              "ReleaseByteArrayElements(mask, elements, 0)"));
    EXPECT_EQ(picture_of(mask, 3, 2), Picture(".## ##."));
    EXPECT_EQ(g_object_boundary, (ze_rect{0, 2, 0, 1}));
}

TEST_P(Util_selection_arrays, ResetPinsClearsAndReleases) {
    fake_bytes mask("mask", Picture("########").cells);  // two more than 3 x 2

    UTIL_METHOD(reset_1objectsel)(&env, nullptr, mask, 3, 2);

    EXPECT_THAT(env.take_calls(), ElementsAre("GetByteArrayElements(mask, null)",
                                              "ReleaseByteArrayElements(mask, elements, 0)"));
    EXPECT_EQ(picture_of(mask, 8, 1), Picture("......##"));
    EXPECT_EQ(g_object_boundary, (ze_rect{2, 0, 1, 0}));
}

TEST_P(Util_selection_arrays, InverseAndResetTakeAMaskOfOnePixel) {
    fake_bytes mask("mask", {0});

    UTIL_METHOD(inverse_1objectsel)(&env, nullptr, mask, 1, 1);
    EXPECT_EQ(picture_of(mask, 1, 1), Picture("#"));

    UTIL_METHOD(reset_1objectsel)(&env, nullptr, mask, 1, 1);
    EXPECT_EQ(picture_of(mask, 1, 1), Picture("."));
}

// One line each: the one that ze_reset_objectsel would write itself never comes.
TEST_F(Util_selection, InverseAndResetRejectNoMaskAndSizesBelowOneBeforePinning) {
    const Picture before(10, 10, 1);
    fake_bytes mask("mask", before.cells);
    const struct {
        jbyteArray mask;
        jint width, height;
    } cases[] = {{nullptr, 10, 10}, {mask, 0, 10},  {mask, -1, 10},  {mask, 10, 0},
                 {mask, 10, -1},    {mask, -2, -2}, {nullptr, 0, -1}};

    for (const auto& method : {UTIL_METHOD(inverse_1objectsel), UTIL_METHOD(reset_1objectsel)}) {
        for (const auto& c : cases) {
            SCOPED_TRACE(testing::Message()
                         << (method == UTIL_METHOD(inverse_1objectsel) ? "inverse" : "reset") << ' '
                         << (c.mask ? "mask" : "null") << ", " << c.width << " x " << c.height);
            method(&env, nullptr, c.mask, c.width, c.height);
            expect_rejection();
            EXPECT_THAT(env.take_calls(), IsEmpty());
            EXPECT_EQ(g_object_boundary, UNTOUCHED);
            EXPECT_EQ(picture_of(mask, 10, 10), before);
        }
    }
}

// ---- the brush

TEST_F(Util_selection, SetBrushSizeTakesAnyValuesWithoutTouchingJava) {
    UTIL_METHOD(set_1brush_1size)(&env, nullptr, 20, 3);

    EXPECT_NE(g_ERBrush, nullptr);
    EXPECT_EQ(g_Brush_Radius, 20);
    EXPECT_EQ(g_Brush_Center, 3);

    UTIL_METHOD(set_1brush_1size)(&env, nullptr, -1, -2);

    EXPECT_EQ(g_Brush_Radius, -1);
    EXPECT_EQ(g_Brush_Center, -2);
    EXPECT_THAT(env.take_calls(), IsEmpty());
}

TEST_F(Util_selection, GetBrushRadiusAndCenterReturnTheBrushWithoutTouchingJava) {
    g_Brush_Radius = 7;
    g_Brush_Center = 2;

    EXPECT_EQ(UTIL_METHOD(get_1brush_1radius)(&env, nullptr), 7);
    EXPECT_EQ(UTIL_METHOD(get_1brush_1center)(&env, nullptr), 2);
    EXPECT_THAT(env.take_calls(), IsEmpty());
}

// ---- draw_withmask, draw_reversemask

TEST_P(Util_selection_arrays, DrawWithmaskPinsReadsTheRectangleAndReleasesInPinOrder) {
    const Pixels photo("abc def");
    const Picture selection("#.# .#2");
    fake_ints src("src", photo.cells), dst("dst", Pixels(3, 2, '.').cells);
    fake_bytes mask("mask", selection.cells);
    fake_rect roi("roi", {1, 2, 0, 1});

    UTIL_METHOD(draw_1withmask)(&env, nullptr, src, dst, mask, 3, roi);

    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetIntArrayElements(src, null)", "GetIntArrayElements(dst, null)",
                    "GetByteArrayElements(mask, null)", "GetObjectClass(roi)",
                    "GetFieldID(class of roi, left, I)", "GetFieldID(class of roi, right, I)",
                    "GetFieldID(class of roi, top, I)", "GetFieldID(class of roi, bottom, I)",
                    "GetIntField(roi, left)", "GetIntField(roi, right)", "GetIntField(roi, top)",
                    "GetIntField(roi, bottom)", "ReleaseIntArrayElements(src, elements, 0)",
                    "ReleaseIntArrayElements(dst, elements, 0)",
                    "ReleaseByteArrayElements(mask, elements, 0)"));
    EXPECT_EQ(pixels_of(dst, 3, 2), Pixels(".Bc .eF"));
    EXPECT_EQ(pixels_of(src, 3, 2), photo);
    EXPECT_EQ(src.times_copied_back(), one_copy());
    EXPECT_EQ(picture_of(mask, 3, 2), selection);
    EXPECT_EQ(mask.times_copied_back(), one_copy());
}

TEST_P(Util_selection_arrays, DrawReversemaskPinsDrawsAndReleasesInPinOrder) {
    const Pixels photo("abc def");
    fake_ints src("src", photo.cells), dst("dst", Pixels(3, 2, '.').cells);
    fake_bytes mask("mask", Picture("#.. .#2").cells);

    UTIL_METHOD(draw_1reversemask)(&env, nullptr, src, dst, mask, 3, 2);

    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetIntArrayElements(src, null)", "GetIntArrayElements(dst, null)",
                    "GetByteArrayElements(mask, null)", "ReleaseIntArrayElements(src, elements, 0)",
                    "ReleaseIntArrayElements(dst, elements, 0)",
                    "ReleaseByteArrayElements(mask, elements, 0)"));
    EXPECT_EQ(pixels_of(dst, 3, 2), Pixels("Abc dEf"));
    EXPECT_EQ(picture_of(mask, 3, 2), Picture(".## #.#"));
    EXPECT_EQ(pixels_of(src, 3, 2), photo);
    EXPECT_EQ(src.times_copied_back(), one_copy());
}

// Of two copies of one array the one released last stays: the destination's.
TEST_P(Util_selection_arrays, DrawingAnArrayOntoItselfShowsTheResult) {
    fake_ints photo("photo", Pixels("abc def").cells);
    fake_bytes mask("mask", Picture("#.. .#.").cells);
    fake_rect roi("roi", {0, 2, 0, 1});

    UTIL_METHOD(draw_1withmask)(&env, nullptr, photo, photo, mask, 3, roi);
    EXPECT_EQ(pixels_of(photo, 3, 2), Pixels("aBC DeF"));

    UTIL_METHOD(draw_1reversemask)(&env, nullptr, photo, photo, mask, 3, 2);
    EXPECT_EQ(pixels_of(photo, 3, 2), Pixels("ABC DEF"));
}

// ---- the object box

TEST_F(Util_selection, GetObjectROILooksUpAndWritesTheFields) {
    g_object_boundary = {3, 9, -4, 2};
    fake_rect roi("roi", {0, 0, 0, 0});

    UTIL_METHOD(get_1objectROI)(&env, nullptr, roi);

    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetObjectClass(roi)", "GetFieldID(class of roi, left, I)",
                    "GetFieldID(class of roi, right, I)", "GetFieldID(class of roi, top, I)",
                    "GetFieldID(class of roi, bottom, I)", "SetIntField(roi, left, 3)",
                    "SetIntField(roi, right, 9)", "SetIntField(roi, top, -4)",
                    "SetIntField(roi, bottom, 2)"));
    EXPECT_EQ(roi.value(), (ze_rect{3, 9, -4, 2}));
    EXPECT_EQ(g_object_boundary, (ze_rect{3, 9, -4, 2}));
}

TEST_F(Util_selection, SetObjectROILooksUpAndReadsTheFields) {
    fake_rect roi("roi", {3, 9, -4, 2});

    UTIL_METHOD(set_1objectROI)(&env, nullptr, roi);

    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetObjectClass(roi)", "GetFieldID(class of roi, left, I)",
                    "GetFieldID(class of roi, right, I)", "GetFieldID(class of roi, top, I)",
                    "GetFieldID(class of roi, bottom, I)", "GetIntField(roi, left)",
                    "GetIntField(roi, right)", "GetIntField(roi, top)",
                    "GetIntField(roi, bottom)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{3, 9, -4, 2}));
    EXPECT_EQ(roi.value(), (ze_rect{3, 9, -4, 2}));
}

TEST_F(Util_selection, GetObjectROIAfterInitIsEmptyAtTheLastPixel) {
    fake_rect roi("roi", {1, 2, 3, 4});

    EXPECT_EQ(UTIL_METHOD(init_1objectsel)(&env, nullptr, 640, 480), 1);
    UTIL_METHOD(get_1objectROI)(&env, nullptr, roi);

    EXPECT_EQ(roi.value(), (ze_rect{639, 0, 479, 0}));
}

TEST_F(Util_selection, GetObjectROIReturnsWhatWasSetUnorderedToo) {
    for (const ze_rect& r : {ze_rect{10, 20, 30, 40}, ze_rect{20, 10, 40, 30},
                             ze_rect{-7, -9, 2147483647, -2147483647 - 1}}) {
        fake_rect set("set", r), got("got", {0, 0, 0, 0});
        UTIL_METHOD(set_1objectROI)(&env, nullptr, set);
        UTIL_METHOD(get_1objectROI)(&env, nullptr, got);
        EXPECT_EQ(got.value(), r);
    }
}

TEST_P(Util_selection_arrays, UpdateObjectROIPinsScansAndReleases) {
    g_object_boundary = {-5, 10, -5, 10};
    const Picture selection(R"(
        ....
        ...#
        ..#.)");
    fake_bytes mask("mask", selection.cells);

    UTIL_METHOD(update_1objectROI)(&env, nullptr, mask, 4, 3);

    EXPECT_THAT(env.take_calls(), ElementsAre("GetByteArrayElements(mask, null)",
                                              "ReleaseByteArrayElements(mask, elements, 0)"));
    EXPECT_EQ(g_object_boundary, (ze_rect{2, 3, 1, 2}));
    EXPECT_EQ(picture_of(mask, 4, 3), selection);
    EXPECT_EQ(mask.times_copied_back(), one_copy());
}

TEST_P(Util_selection_arrays, UpdateObjectROIReadsAllRowsOfAnUprightMask) {
    g_object_boundary = {0, 1, 0, 3};
    fake_bytes mask("mask", Picture(R"(
        ..
        ..
        ..
        .#)")
                                .cells);

    UTIL_METHOD(update_1objectROI)(&env, nullptr, mask, 2, 4);

    EXPECT_EQ(g_object_boundary, (ze_rect{1, 1, 3, 3}));
}

TEST_F(Util_selection, ResetFillROISetsTheFillBoxWithoutTouchingJava) {
    UTIL_METHOD(reset_1fill_1ROI)(&env, nullptr, 640, 480);

    EXPECT_EQ(g_fill_boundary, (ze_rect{639, 0, 479, 0}));
    EXPECT_EQ(g_object_boundary, UNTOUCHED);
    EXPECT_THAT(env.take_calls(), IsEmpty());
}

// Deliberate: it does nothing but these calls.
TEST_P(Util_selection_arrays, ReinitReadsTheRectanglePinsAndReleases) {
    ze_set_brush_size(1, 0);
    const ER_selection* const engine = g_ERBrush;
    const Picture selection("#.2 ..#");
    fake_bytes mask("mask", selection.cells);
    fake_rect roi("roi", {1, 2, 0, 1});

    UTIL_METHOD(reinit_1objectsel)(&env, nullptr, mask, 3, 2, roi);

    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetObjectClass(roi)", "GetFieldID(class of roi, left, I)",
                    "GetFieldID(class of roi, right, I)", "GetFieldID(class of roi, top, I)",
                    "GetFieldID(class of roi, bottom, I)", "GetIntField(roi, left)",
                    "GetIntField(roi, right)", "GetIntField(roi, top)", "GetIntField(roi, bottom)",
                    "GetByteArrayElements(mask, null)",
                    "ReleaseByteArrayElements(mask, elements, 0)"));
    EXPECT_EQ(picture_of(mask, 3, 2), selection);
    EXPECT_EQ(mask.times_copied_back(), one_copy());
    EXPECT_EQ(roi.value(), (ze_rect{1, 2, 0, 1}));
    EXPECT_EQ(g_ERBrush, engine);
    EXPECT_EQ(g_object_boundary, UNTOUCHED);
}

// ---- nativeIntAlloc, nativeIntRelease

TEST_F(Util_selection, NativeIntAllocReturnsANewArray) {
    for (const jint length : {5, 0}) {
        const jintArray made = UTIL_METHOD(nativeIntAlloc)(&env, nullptr, length);

        EXPECT_THAT(env.take_calls(), ElementsAre("NewIntArray(" + std::to_string(length) + ")"));
        const auto* const array = java_thing::behind<fake_ints>(made);
        ASSERT_TRUE(array);
        EXPECT_THAT(array->elements(), SizeIs(length));
        EXPECT_THAT(array->elements(), Each(0));
    }
}

TEST_F(Util_selection, NativeIntAllocReturnsNullForARefusedLengthAndAsksNothingMore) {
    for (const jint length : {-1, 2147483647}) {
        EXPECT_EQ(UTIL_METHOD(nativeIntAlloc)(&env, nullptr, length), nullptr);
        EXPECT_THAT(env.take_calls(), ElementsAre("NewIntArray(" + std::to_string(length) + ")"));
    }
}

TEST_P(Util_selection_arrays, NativeIntReleasePinsReleasesAndChangesNothing) {
    fake_ints array("array", {1, -2, 3});

    EXPECT_EQ(UTIL_METHOD(nativeIntRelease)(&env, nullptr, array), 0);

    EXPECT_THAT(env.take_calls(), ElementsAre("GetIntArrayElements(array, null)",
                                              "ReleaseIntArrayElements(array, elements, 0)"));
    EXPECT_THAT(array.elements(), ElementsAre(1, -2, 3));
    EXPECT_EQ(array.times_copied_back(), one_copy());
}

TEST_F(Util_selection, NativeIntReleaseOfNullMakesNoCall) {
    EXPECT_EQ(UTIL_METHOD(nativeIntRelease)(&env, nullptr, nullptr), 0);

    EXPECT_THAT(env.take_calls(), IsEmpty());
}

// ---- all of them

TEST_F(Util_selection, NullGoesOnToJavaWhereNothingIsChecked) {
    UTIL_METHOD(update_1objectROI)(&env, nullptr, nullptr, 4, 3);  // the old box is off the image
    EXPECT_THAT(env.take_calls(), ElementsAre("GetByteArrayElements(null, null)",
                                              "ReleaseByteArrayElements(null, null, 0)"));

    UTIL_METHOD(draw_1reversemask)(&env, nullptr, nullptr, nullptr, nullptr, 3, 0);
    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetIntArrayElements(null, null)", "GetIntArrayElements(null, null)",
                    "GetByteArrayElements(null, null)", "ReleaseIntArrayElements(null, null, 0)",
                    "ReleaseIntArrayElements(null, null, 0)",
                    "ReleaseByteArrayElements(null, null, 0)"));

    UTIL_METHOD(set_1objectROI)(&env, nullptr, nullptr);
    EXPECT_THAT(
        env.take_calls(),
        ElementsAre("GetObjectClass(null)", "GetFieldID(class of null, left, I)",
                    "GetFieldID(class of null, right, I)", "GetFieldID(class of null, top, I)",
                    "GetFieldID(class of null, bottom, I)", "GetIntField(null, left)",
                    "GetIntField(null, right)", "GetIntField(null, top)",
                    "GetIntField(null, bottom)"));

    UTIL_METHOD(modify_1objectsel)
    (&env, nullptr, nullptr, nullptr, 3, 2, nullptr, nullptr, 0, nullptr, 1);
    EXPECT_THAT(env.take_calls(), SizeIs(27));
}

TEST_F(Util_selection, ClassesAndFieldsAreLookedUpAfreshInEveryCall) {
    ze_set_brush_size(1, 0);
    fake_ints pixels("pixels", Pixels("abc def ghi").cells);
    fake_bytes mask("mask", Picture("... ... ...").cells);
    fake_point p1("p1", 1, 1), p2("p2", 1, 1);
    fake_rect rect("rect", {0, 0, 0, 0});

    std::vector<std::string> rounds[2];
    for (auto& calls : rounds) {
        g_object_boundary = {0, 0, 0, 0};
        UTIL_METHOD(modify_1objectsel)(&env, nullptr, pixels, mask, 3, 3, p1, p2, 0, rect, 0);
        UTIL_METHOD(draw_1withmask)(&env, nullptr, pixels, pixels, mask, 3, rect);
        UTIL_METHOD(get_1objectROI)(&env, nullptr, rect);
        UTIL_METHOD(set_1objectROI)(&env, nullptr, rect);
        UTIL_METHOD(reinit_1objectsel)(&env, nullptr, mask, 3, 3, rect);
        calls = env.take_calls();
    }

    EXPECT_THAT(rounds[0], SizeIs(27 + 15 + 9 + 9 + 11));
    EXPECT_EQ(rounds[1], rounds[0]);
}
