// Makes the calls of a stroke player's recordings through the native methods and prints the digest
// of each, as the player does: on any processor, without Java or a JPEG decoder.

#include <gtest/gtest.h>
#include <jni.h>

#include <algorithm>
#include <cstddef>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "tests/helpers/recording_env.h"
#include "tests/helpers/util_methods.h"
#include "tests/replay/digest.h"
#include "tests/replay/recording.h"

namespace {

constexpr char USAGE[] =
    "usage: replay FILE...\n"
    "       replay FILE --expect DIGEST\n"
    "Replays recordings (desktop/player SCRIPT --record FILE) and prints their digests.\n"
    "Status: 0 replayed, 1 replayed with another digest or a fault in the JNI calls, 2 not "
    "replayed.\n";

constexpr jint WHITE = -1;
constexpr jint BLACK = -0x1000000;  // 0xFF000000

struct options {
    std::vector<std::string> files;
    std::optional<uint32_t> expected;
};

[[noreturn]] void refuse(const std::string& why) {
    std::fprintf(stderr, "replay: %s\n%s", why.c_str(), USAGE);
    std::exit(2);
}

uint32_t parse_digest(const std::string& text) {
    const bool eight_digits =
        text.size() == 8 && text.find_first_not_of("0123456789ABCDEFabcdef") == std::string::npos;
    if (!eight_digits) refuse("'" + text + "' is no digest of 8 hexadecimal digits");
    return static_cast<uint32_t>(std::stoul(text, nullptr, 16));
}

options read_options(int count, char** arguments) {
    options o;
    for (int i = 1; i < count; ++i) {
        const std::string argument = arguments[i];
        if (argument == "--expect") {
            if (++i == count) refuse("--expect lacks its value");
            o.expected = parse_digest(arguments[i]);
        } else if (argument.compare(0, 2, "--") == 0) {
            refuse("there is no option " + argument);
        } else {
            o.files.push_back(argument);
        }
    }
    if (o.files.empty()) refuse("no recording is given");
    if (o.expected && o.files.size() > 1) refuse("--expect goes with one recording");
    return o;
}

std::string bytes_of(const std::string& file) {
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> in(std::fopen(file.c_str(), "rb"),
                                                             std::fclose);
    std::string bytes;
    std::vector<char> block(1 << 16);
    while (in) {
        const size_t count = std::fread(block.data(), 1, block.size(), in.get());
        bytes.append(block.data(), count);
        if (count < block.size()) break;
    }
    if (!in || std::ferror(in.get())) throw malformed_recording("it cannot be read");
    return bytes;
}

// A session on the photo of a recording.
class replayed_session {
public:
    explicit replayed_session(const recording& r)
        : width(r.width),
          height(r.height),
          photo("photo", r.pixels),
          mask("mask", std::vector<jbyte>(r.pixels.size())) {}

    void make(const recorded_call& call) {
        const auto& a = call.arguments;
        switch (call.kind) {
            case call_kind::set_brush:
                UTIL_METHOD(set_1brush_1size)(&env, util, a[0], a[1]);
                break;
            case call_kind::init:
                UTIL_METHOD(init_1objectsel)(&env, util, width, height);
                break;
            case call_kind::modify:
                modify(a[0], a[1], {a[2], a[3]}, {a[4], a[5]});
                break;
            case call_kind::invert:
                UTIL_METHOD(inverse_1objectsel)(&env, util, mask, width, height);
                break;
            case call_kind::reset:
                UTIL_METHOD(reset_1objectsel)(&env, util, mask, width, height);
                break;
            case call_kind::update_box:
                UTIL_METHOD(update_1objectROI)(&env, util, mask, width, height);
                break;
            case call_kind::select:
                select(call.runs);
                break;
            case call_kind::digest:
                take_digest();
                break;
            case call_kind::destroy:
                UTIL_METHOD(destroy_1objectsel)(&env, util);
                break;
        }
        env.take_calls();  // nobody reads what was recorded
    }

    uint32_t digest() const { return taken; }

private:
    struct position {
        jint x;
        jint y;
    };

    void modify(jint mode, jint fill, position first, position second) {
        fake_point p1("p1", first.x, first.y), p2("p2", second.x, second.y);
        fake_rect changed("changed", {});
        UTIL_METHOD(modify_1objectsel)
        (&env, util, photo, mask, width, height, p1, p2, mode, changed, fill);
    }

    // Writes into the mask as Java code does, and measures the object box from scratch.
    void select(const std::vector<pixel_run>& runs) {
        jbyte* pixels = env.GetByteArrayElements(mask, nullptr);
        std::fill_n(pixels, ptrdiff_t{width} * height, jbyte{0});
        for (const pixel_run& run : runs) {
            jbyte* row = pixels + ptrdiff_t{run.row} * width;
            std::fill(row + run.first, row + run.last + 1, jbyte{1});
        }
        env.ReleaseByteArrayElements(mask, pixels, 0);
        fake_rect whole("whole", {0, width - 1, 0, height - 1});
        UTIL_METHOD(set_1objectROI)(&env, util, whole);
        UTIL_METHOD(update_1objectROI)(&env, util, mask, width, height);
    }

    void take_digest() {
        const int columns = DIGEST_VIEW_WIDTH, rows = DIGEST_VIEW_HEIGHT;
        fake_ints view("view", std::vector<jint>(columns * rows));
        fake_rect all("all", {0, columns - 1, 0, rows - 1});
        const float scale = std::max(static_cast<float>(width) / static_cast<float>(columns),
                                     static_cast<float>(height) / static_cast<float>(rows));
        UTIL_METHOD(native_1drawImageWithMaskContour)
        (&env, util, view, columns, rows, photo, width, height, mask, scale, 0, 0, WHITE, BLACK,
         all);
        taken = digest_of(mask.elements<uint8_t>(), view.elements<uint32_t>());
    }

    const jint width;
    const jint height;
    const jobject util = nullptr;  // the class: the methods are static, and none uses it
    recording_env env;
    fake_ints photo;
    fake_bytes mask;
    uint32_t taken = 0;
};

uint32_t digest_of_replay(const recording& r) {
    replayed_session session(r);
    for (const recorded_call& call : r.calls) session.make(call);
    return session.digest();
}

}  // namespace

int main(int count, char** arguments) {
    const options o = read_options(count, arguments);
    int status = 0;
    for (const std::string& file : o.files) {
        try {
            const uint32_t digest = digest_of_replay(parse_recording(bytes_of(file)));
            std::printf("digest %08X  %s\n", static_cast<unsigned>(digest), file.c_str());
            if (digest == o.expected.value_or(digest)) continue;
            std::fprintf(stderr, "replay: %s has the digest %08X, expected %08X\n", file.c_str(),
                         static_cast<unsigned>(digest), static_cast<unsigned>(*o.expected));
            status = 1;
        } catch (const malformed_recording& e) {
            std::fprintf(stderr, "%s: no recording: %s\n", file.c_str(), e.what());
            return 2;
        }
    }
    // What the recording JNIEnv has found, such as an array that is released twice.
    return testing::UnitTest::GetInstance()->Failed() ? 1 : status;
}
