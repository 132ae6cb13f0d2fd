// What the view-drawing family does with Java's arrays and objects, call by call; what is drawn is
// told by view_image_test.cpp and view_outline_test.cpp.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/helpers/java_pictures.h"
#include "tests/helpers/log_lines.h"
#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/recording_env.h"
#include "tests/helpers/rect_printing.h"
#include "tests/helpers/util_methods.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace {

// Passed wherever an argument is not read; as a height or size it would draw nonsense.
constexpr jint NOT_READ = -987654321;

// The calls of a method that draws the array `photo` into `view` where the rectangle `area` says.
auto is_the_calls_of_a_drawing() {
    return ElementsAre("GetObjectClass(area)", "GetFieldID(class of area, left, I)",
                       "GetFieldID(class of area, right, I)", "GetFieldID(class of area, top, I)",
                       "GetFieldID(class of area, bottom, I)", "GetIntField(area, left)",
                       "GetIntField(area, right)", "GetIntField(area, top)",
                       "GetIntField(area, bottom)", "GetIntArrayElements(view, null)",
                       "GetIntArrayElements(photo, null)",
                       "ReleaseIntArrayElements(view, elements, 0)",
                       "ReleaseIntArrayElements(photo, elements, 0)");
}

// The same with the outline of `mask`.
auto is_the_calls_of_an_outlined_drawing() {
    return ElementsAre("GetObjectClass(area)", "GetFieldID(class of area, left, I)",
                       "GetFieldID(class of area, right, I)", "GetFieldID(class of area, top, I)",
                       "GetFieldID(class of area, bottom, I)", "GetIntField(area, left)",
                       "GetIntField(area, right)", "GetIntField(area, top)",
                       "GetIntField(area, bottom)", "GetIntArrayElements(view, null)",
                       "GetIntArrayElements(photo, null)", "GetByteArrayElements(mask, null)",
                       "ReleaseIntArrayElements(view, elements, 0)",
                       "ReleaseIntArrayElements(photo, elements, 0)",
                       "ReleaseByteArrayElements(mask, elements, 0)");
}

// With both ways in which a virtual machine hands out arrays.
class Util_drawing : public testing::TestWithParam<array_access> {
protected:
    ~Util_drawing() override { EXPECT_THAT(take_log_lines(), IsEmpty()); }

    // Copies that come back from an array pinned once.
    static int one_copy() { return GetParam() == array_access::copy ? 1 : 0; }

    recording_env env{GetParam()};
};

INSTANTIATE_TEST_SUITE_P(access, Util_drawing,
                         testing::Values(array_access::direct, array_access::copy),
                         testing::PrintToStringParamName());

// A view, a photo, its mask and a rectangle of the view, as the drawing methods take them.
struct scene {
    scene(const Pixels& v, const Pixels& p, const Picture& m, const ze_rect& r)
        : width(v.width),
          height(v.height),
          photo_width(p.width),
          photo_height(p.height),
          view("view", v.cells),
          photo("photo", p.cells),
          mask("mask", m.cells),
          area("area", r) {}

    jint draw(recording_env* env, jfloat scale, jint x, jint y) {
        return UTIL_METHOD(native_1drawImage___3III_3IIIFIILandroid_graphics_Rect_2)(
            env, nullptr, view, width, NOT_READ, photo, photo_width, photo_height, scale, x, y,
            area);
    }
    jint draw_small(recording_env* env) {
        return UTIL_METHOD(native_1drawSmallImage)(env, nullptr, view, width, NOT_READ, photo,
                                                   photo_width, photo_height, area);
    }
    jint draw_outlined(recording_env* env, jfloat scale, jint x, jint y) {
        return UTIL_METHOD(native_1drawImageWithMaskContour)(
            env, nullptr, view, width, NOT_READ, photo, photo_width, photo_height, mask, scale, x,
            y, static_cast<jint>(FIRST_DASH), static_cast<jint>(SECOND_DASH), area);
    }
    jint draw_small_outlined(recording_env* env) {
        return UTIL_METHOD(native_1drawSmallImageWithMaskContour)(
            env, nullptr, view, width, NOT_READ, photo, photo_width, photo_height, mask,
            static_cast<jint>(FIRST_DASH), static_cast<jint>(SECOND_DASH), area);
    }

    Pixels picture() const { return pixels_of(view, width, height); }

    const int width, height;
    const int photo_width, photo_height;
    fake_ints view, photo;
    fake_bytes mask;
    fake_rect area;
};

// Selected at (1, 3) and (2, 2).
const char* const TWO_PIXELS = R"(
    .....
    .....
    ..#..
    .#...
    .....)";

const char* const FIVE_BY_FIVE = R"(
    abcde
    fghij
    klmno
    pqrst
    uvwxy)";

// The two above in an 8 x 7 view with the photo's left top at (3, 1).
const char* const TWO_PIXELS_OUTLINED = R"(
    ........
    ...abcde
    ...fghij
    ...kl2no
    ...p1rst
    ...uvwxy
    ........)";

}  // namespace

TEST_P(Util_drawing, DrawImageReadsTheRectanglePinsDrawsAndReleasesInPinOrder) {
    const Pixels photo("abc def");
    scene s(Pixels(4, 3, '.'), photo, Picture(0, 0, 0), {1, 3, 0, 1});

    // Columns 0.5, 1, 1.5 of the photo and rows 1, 1.5, rounded down.
    EXPECT_EQ(s.draw(&env, 0.5f, 0, 1), 1);

    EXPECT_THAT(env.take_calls(), is_the_calls_of_a_drawing());
    EXPECT_EQ(s.picture(), Pixels(R"(
        .dee
        .dee
        ....)"));
    EXPECT_EQ(pixels_of(s.photo, 3, 2), photo);
    EXPECT_EQ(s.photo.times_copied_back(), one_copy());
    EXPECT_EQ(s.area.value(), (ze_rect{1, 3, 0, 1}));
}

TEST_P(Util_drawing, DrawSmallImageReadsTheRectanglePinsDrawsAndReleasesInPinOrder) {
    const Pixels photo("ab");
    scene s(Pixels(4, 3, '.'), photo, Picture(0, 0, 0), {1, 3, 1, 2});

    EXPECT_EQ(s.draw_small(&env), 1);

    EXPECT_THAT(env.take_calls(), is_the_calls_of_a_drawing());
    EXPECT_EQ(s.picture(), Pixels(R"(
        ....
        .abb
        .abb)"));
    EXPECT_EQ(pixels_of(s.photo, 2, 1), photo);
    EXPECT_EQ(s.photo.times_copied_back(), one_copy());
    EXPECT_EQ(s.area.value(), (ze_rect{1, 3, 1, 2}));
}

TEST_P(Util_drawing, DrawImageWithMaskContourReadsTheRectanglePinsDrawsAndReleasesInPinOrder) {
    scene s(Pixels(8, 7, '.'), Pixels(FIVE_BY_FIVE), Picture(TWO_PIXELS), {3, 7, 1, 5});

    EXPECT_EQ(s.draw_outlined(&env, 1.0f, -3, -1), 1);

    EXPECT_THAT(env.take_calls(), is_the_calls_of_an_outlined_drawing());
    EXPECT_EQ(s.picture(), Pixels(TWO_PIXELS_OUTLINED));
    EXPECT_EQ(pixels_of(s.photo, 5, 5), Pixels(FIVE_BY_FIVE));
    EXPECT_EQ(s.photo.times_copied_back(), one_copy());
    EXPECT_EQ(picture_of(s.mask, 5, 5), Picture(TWO_PIXELS));
    EXPECT_EQ(s.mask.times_copied_back(), one_copy());
    EXPECT_EQ(s.area.value(), (ze_rect{3, 7, 1, 5}));
}

TEST_P(Util_drawing, DrawImageWithMaskContourPassesScaleAndPhotoSize) {
    scene s(Pixels(4, 2, '.'), Pixels("abc def"), Picture("... ..."), {0, 3, 0, 1});

    // Columns 0, 0.5, 1, 1.5 of the photo and rows 1, 1.5, rounded to the nearest on the photo.
    EXPECT_EQ(s.draw_outlined(&env, 0.5f, 0, 1), 1);

    EXPECT_EQ(s.picture(), Pixels(R"(
        deef
        deef)"));
}

TEST_P(Util_drawing, DrawSmallImageWithMaskContourReadsTheRectanglePinsDrawsAndReleasesInPinOrder) {
    scene s(Pixels(8, 7, '.'), Pixels(FIVE_BY_FIVE), Picture(TWO_PIXELS), {3, 7, 1, 5});

    EXPECT_EQ(s.draw_small_outlined(&env), 1);

    EXPECT_THAT(env.take_calls(), is_the_calls_of_an_outlined_drawing());
    EXPECT_EQ(s.picture(), Pixels(TWO_PIXELS_OUTLINED));
    EXPECT_EQ(pixels_of(s.photo, 5, 5), Pixels(FIVE_BY_FIVE));
    EXPECT_EQ(s.photo.times_copied_back(), one_copy());
    EXPECT_EQ(picture_of(s.mask, 5, 5), Picture(TWO_PIXELS));
    EXPECT_EQ(s.mask.times_copied_back(), one_copy());
    EXPECT_EQ(s.area.value(), (ze_rect{3, 7, 1, 5}));
}

TEST_P(Util_drawing, EveryDrawingMethodPassesThePhotosWidthAndHeight) {
    const Pixels view(3, 5, '.');
    const Pixels photo("ab cd ef gh");
    const Picture mask(2, 4, 0);
    const ze_rect area = {0, 2, 0, 4};
    const Pixels with_edges_repeated("abb cdd eff ghh ghh");

    scene image(view, photo, mask, area);
    image.draw(&env, 1.0f, 0, 0);
    EXPECT_EQ(image.picture(), with_edges_repeated);

    scene small_image(view, photo, mask, area);
    small_image.draw_small(&env);
    EXPECT_EQ(small_image.picture(), with_edges_repeated);

    scene outlined(view, photo, mask, area);
    outlined.draw_outlined(&env, 1.0f, 0, 0);
    EXPECT_EQ(outlined.picture(), with_edges_repeated);

    scene small_outlined(view, photo, mask, area);
    small_outlined.draw_small_outlined(&env);
    EXPECT_EQ(small_outlined.picture(), with_edges_repeated);
}

TEST_P(Util_drawing, AnEmptyRectangleStillPinsReleasesAndReturnsOne) {
    const Pixels view("zzz zzz zzz");
    const Pixels photo("abc def ghi");
    const Picture mask("... ... ...");

    for (const ze_rect& area : {ze_rect{0, 2, 2, 1}, ze_rect{2, 1, 0, 1}, ze_rect{2, 1, 2, 1}}) {
        SCOPED_TRACE(testing::Message() << area);
        scene s(view, photo, mask, area);

        EXPECT_EQ(s.draw(&env, 1.0f, 0, 0), 1);
        EXPECT_THAT(env.take_calls(), is_the_calls_of_a_drawing());
        EXPECT_EQ(s.picture(), view);

        EXPECT_EQ(s.draw_small(&env), 1);
        EXPECT_THAT(env.take_calls(), is_the_calls_of_a_drawing());
        EXPECT_EQ(s.picture(), view);

        EXPECT_EQ(s.draw_small_outlined(&env), 1);
        EXPECT_THAT(env.take_calls(), is_the_calls_of_an_outlined_drawing());
        EXPECT_EQ(s.picture(), view);
    }
    EXPECT_EQ(env.pins(), 3 * (2 + 2 + 3));
    EXPECT_EQ(env.releases(), 3 * (2 + 2 + 3));
}

// Deliberate: an outlined drawing at a scale draws rows top and bottom in either order.
TEST_P(Util_drawing, DrawImageWithMaskContourPinsAndReleasesForAnEmptyRectangleToo) {
    const Pixels view("zzz zzz zzz");
    const struct {
        ze_rect area;
        Pixels picture;
    } cases[] = {{{0, 2, 2, 1}, Pixels("zzz def ghi")}, {{2, 1, 0, 1}, view}, {{2, 1, 2, 1}, view}};

    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << c.area);
        scene s(view, Pixels("abc def ghi"), Picture("... ... ..."), c.area);

        EXPECT_EQ(s.draw_outlined(&env, 1.0f, 0, 0), 1);
        EXPECT_THAT(env.take_calls(), is_the_calls_of_an_outlined_drawing());
        EXPECT_EQ(s.picture(), c.picture);
    }
}

TEST_P(Util_drawing, SetImagePointsPinsWritesAndReleases) {
    fake_ints points("points", {9, 9, 9, 9, 9, 9});

    // Columns 1, 1.5, 2 and rows -1, -0.5, rounded down.
    UTIL_METHOD(native_1setImagePoints)
    (&env, nullptr, 3, 2, NOT_READ, NOT_READ, 0.5f, 1, -1, points);

    EXPECT_THAT(env.take_calls(), ElementsAre("GetIntArrayElements(points, null)",
                                              "ReleaseIntArrayElements(points, elements, 0)"));
    EXPECT_THAT(points.elements(), ElementsAre(1, 1, 2, -1, -1, 9));
}

TEST_P(Util_drawing, SetImagePointsPinsAndReleasesWithNothingToWriteToo) {
    fake_ints points("points", {9});

    UTIL_METHOD(native_1setImagePoints)
    (&env, nullptr, 0, 0, NOT_READ, NOT_READ, 0.5f, 1, -1, points);

    EXPECT_THAT(env.take_calls(), ElementsAre("GetIntArrayElements(points, null)",
                                              "ReleaseIntArrayElements(points, elements, 0)"));
    EXPECT_THAT(points.elements(), ElementsAre(9));
    EXPECT_EQ(points.times_copied_back(), one_copy());
}

TEST_P(Util_drawing, NullGoesOnToJava) {
    UTIL_METHOD(native_1setImagePoints)
    (&env, nullptr, 0, 0, NOT_READ, NOT_READ, 0.5f, 1, -1, nullptr);
    EXPECT_THAT(env.take_calls(), ElementsAre("GetIntArrayElements(null, null)",
                                              "ReleaseIntArrayElements(null, null, 0)"));
}

TEST_P(Util_drawing, ClassesAndFieldsAreLookedUpAfreshInEveryCall) {
    scene s(Pixels(3, 3, '.'), Pixels("abc def ghi"), Picture("... .#. ..."), {0, 2, 0, 2});

    std::vector<std::string> rounds[2];
    for (auto& calls : rounds) {
        s.draw(&env, 1.0f, 0, 0);
        s.draw_small(&env);
        s.draw_outlined(&env, 1.0f, 0, 0);
        s.draw_small_outlined(&env);
        calls = env.take_calls();
    }

    EXPECT_THAT(rounds[0], SizeIs(13 + 13 + 15 + 15));
    EXPECT_EQ(rounds[1], rounds[0]);
}
