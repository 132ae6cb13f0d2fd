// That over a long session every array which a native method pins is released: the same array, the
// same elements, with copy-back, before the method returns.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "selection/objectsel.h"
#include "tests/differential/random_source.h"
#include "tests/helpers/log_lines.h"
#include "tests/helpers/recording_env.h"
#include "tests/helpers/util_methods.h"

using testing::Each;
using testing::Gt;
using testing::IsEmpty;
using testing::UnorderedElementsAreArray;

namespace {

constexpr int CALLS = 20000;
constexpr uint64_t SEED = 20260;
constexpr int WIDTH = 24, HEIGHT = 17;
constexpr int VIEW_WIDTH = 20, VIEW_HEIGHT = 15;
constexpr size_t PIXELS = WIDTH * HEIGHT;
constexpr size_t VIEW_PIXELS = VIEW_WIDTH * VIEW_HEIGHT;
constexpr float SCALE = 1.5f;
constexpr jint DASH = -1;

#define NAME(result, name, ...) name,
#define TEXT(result, name, ...) #name,
enum class util_method { UTIL_METHODS(NAME) };
const std::vector<std::string> NAMES = {UTIL_METHODS(TEXT)};
#undef NAME
#undef TEXT

class array_pins : public testing::TestWithParam<array_access> {
protected:
    array_pins() : env(GetParam()) {}
    ~array_pins() override {
        ze_destroy_objectsel();
        EXPECT_THAT(take_log_lines(), IsEmpty());
    }

    // Calls a method with arguments that a caller may pass and returns how many arrays it takes.
    size_t call(util_method method);

    random_source random{SEED};
    recording_env env;

private:
    void modify() {
        const int x = random.between(-1, WIDTH), y = random.between(-1, HEIGHT);
        fake_point p1("p1", x, y);
        fake_point p2("p2", WIDTH - 1 - x, y);
        fake_rect changed("changed", {});
        const int mode = random.between(-1, 6), fill = random.between(0, 1);
        UTIL_METHOD(modify_1objectsel)
        (&env, util, photo, mask, WIDTH, HEIGHT, p1, p2, mode, changed, fill);
    }

    void set_brush() {
        const int radius = random.between(0, 6), core = random.between(0, 4);
        UTIL_METHOD(set_1brush_1size)(&env, util, radius, core);
    }

    ze_rect random_rect(int width, int height) {
        const int left = random.between(0, width - 1), top = random.between(0, height - 1);
        const int right = random.between(left, width - 1);
        const int bottom = random.between(top, height - 1);
        return {left, right, top, bottom};
    }

    static std::vector<jint> some_pixels() {
        std::vector<jint> pixels(PIXELS);
        for (size_t i = 0; i < pixels.size(); ++i) pixels[i] = static_cast<jint>(i / 5 % 40) << 8;
        return pixels;
    }

    const jobject util = nullptr;  // the class, which no method uses
    fake_ints photo{"photo", some_pixels()};
    fake_ints picture{"picture", std::vector<jint>(PIXELS)};
    fake_ints view{"view", std::vector<jint>(VIEW_PIXELS)};
    fake_bytes mask{"mask", std::vector<jbyte>(PIXELS)};
};

size_t array_pins::call(util_method method) {
    fake_rect roi("roi", random_rect(WIDTH, HEIGHT));
    fake_rect area("area", random_rect(VIEW_WIDTH, VIEW_HEIGHT));
    // What is drawn from the photo may go back into it.
    const jintArray target = random.one_in(4) ? photo : picture;
    switch (method) {
        case util_method::init_1objectsel:
            UTIL_METHOD(init_1objectsel)(&env, util, WIDTH, HEIGHT);
            return 0;
        case util_method::modify_1objectsel:
            modify();
            return 2;
        case util_method::destroy_1objectsel:
            UTIL_METHOD(destroy_1objectsel)(&env, util);
            return 0;
        case util_method::inverse_1objectsel:
            UTIL_METHOD(inverse_1objectsel)(&env, util, mask, WIDTH, HEIGHT);
            return 1;
        case util_method::reset_1objectsel:
            UTIL_METHOD(reset_1objectsel)(&env, util, mask, WIDTH, HEIGHT);
            return 1;
        case util_method::set_1brush_1size:
            set_brush();
            return 0;
        case util_method::draw_1withmask:
            UTIL_METHOD(draw_1withmask)(&env, util, photo, target, mask, WIDTH, roi);
            return 3;
        case util_method::draw_1reversemask:
            UTIL_METHOD(draw_1reversemask)(&env, util, photo, target, mask, WIDTH, HEIGHT);
            return 3;
        case util_method::get_1objectROI:
            UTIL_METHOD(get_1objectROI)(&env, util, roi);
            return 0;
        case util_method::set_1objectROI:
            UTIL_METHOD(set_1objectROI)(&env, util, roi);
            return 0;
        case util_method::get_1brush_1radius:
            UTIL_METHOD(get_1brush_1radius)(&env, util);
            return 0;
        case util_method::get_1brush_1center:
            UTIL_METHOD(get_1brush_1center)(&env, util);
            return 0;
        case util_method::reset_1fill_1ROI:
            UTIL_METHOD(reset_1fill_1ROI)(&env, util, WIDTH, HEIGHT);
            return 0;
        case util_method::reinit_1objectsel:
            UTIL_METHOD(reinit_1objectsel)(&env, util, mask, WIDTH, HEIGHT, roi);
            return 1;
        case util_method::update_1objectROI:
            UTIL_METHOD(update_1objectROI)(&env, util, mask, WIDTH, HEIGHT);
            return 1;
        case util_method::nativeIntAlloc:
            UTIL_METHOD(nativeIntAlloc)(&env, util, 3);
            return 0;
        case util_method::nativeIntRelease:
            UTIL_METHOD(nativeIntRelease)(&env, util, view);
            return 1;
        case util_method::native_1setImagePoints:
            UTIL_METHOD(native_1setImagePoints)
            (&env, util, VIEW_WIDTH, VIEW_HEIGHT, 0, 0, SCALE, -2, 3, view);
            return 1;
        case util_method::native_1drawImage___3III_3IIIFIILandroid_graphics_Rect_2:
            UTIL_METHOD(native_1drawImage___3III_3IIIFIILandroid_graphics_Rect_2)
            (&env, util, view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT, SCALE, -2, 3, area);
            return 2;
        case util_method::native_1drawSmallImage:
            UTIL_METHOD(native_1drawSmallImage)
            (&env, util, view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT, area);
            return 2;
        case util_method::native_1drawImageWithMaskContour:
            UTIL_METHOD(native_1drawImageWithMaskContour)
            (&env, util, view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT, mask, SCALE, -2, 3,
             DASH, DASH, area);
            return 3;
        case util_method::native_1drawSmallImageWithMaskContour:
            UTIL_METHOD(native_1drawSmallImageWithMaskContour)
            (&env, util, view, VIEW_WIDTH, VIEW_HEIGHT, photo, WIDTH, HEIGHT, mask, DASH, DASH,
             area);
            return 3;
    }
    return 0;
}

// The line with which a pin that was recorded must be released; empty for any other call.
std::string release_of(const std::string& call) {
    for (const std::string type : {"Int", "Byte"}) {
        const std::string pin = "Get" + type + "ArrayElements(", end = ", null)";
        if (call.compare(0, pin.size(), pin) != 0) continue;
        const std::string array = call.substr(pin.size(), call.size() - pin.size() - end.size());
        return "Release" + type + "ArrayElements(" + array + ", elements, 0)";
    }
    return "";
}

}  // namespace

TEST_P(array_pins, AreReleasedByEveryCallOfALongSession) {
    const auto last = static_cast<int>(NAMES.size()) - 1;
    std::vector<int> times(NAMES.size());
    size_t pins = 0;
    for (int i = 0; i < CALLS && !HasFailure(); ++i) {
        // Every second call is a stroke, so that there is something to draw, fill and erase.
        const int number =
            i % 2 ? random.between(0, last) : static_cast<int>(util_method::modify_1objectsel);
        const size_t expected_pins = call(static_cast<util_method>(number));

        std::vector<std::string> releases, expected;
        for (const std::string& line : env.take_calls()) {
            if (line.compare(0, 7, "Release") == 0) releases.push_back(line);
            if (!release_of(line).empty()) expected.push_back(release_of(line));
        }
        const std::string where = NAMES[number] + ", call " + std::to_string(i);
        EXPECT_THAT(releases, UnorderedElementsAreArray(expected)) << where;
        EXPECT_EQ(expected.size(), expected_pins) << where;
        pins += expected_pins;
        ++times[number];
    }
    EXPECT_EQ(env.pins(), static_cast<int>(pins));
    EXPECT_EQ(env.releases(), static_cast<int>(pins));
    EXPECT_THAT(times, Each(Gt(CALLS / 100)));
}

INSTANTIATE_TEST_SUITE_P(access, array_pins,
                         testing::Values(array_access::direct, array_access::copy),
                         testing::PrintToStringParamName());
