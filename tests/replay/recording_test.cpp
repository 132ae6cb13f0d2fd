// Reading recordings, and the digest.

#include "tests/replay/recording.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>

#include "tests/replay/digest.h"

using testing::ElementsAre;

namespace {

// Bytes written in hexadecimal digits, with blanks between them at will.
std::string bytes(const std::string& digits) {
    std::string all;
    std::string digit_pair;
    for (const char c : digits) {
        if (c == ' ') continue;
        digit_pair += c;
        if (digit_pair.size() < 2) continue;
        all += static_cast<char>(std::stoi(digit_pair, nullptr, 16));
        digit_pair.clear();
    }
    return all;
}

std::string repeated(const std::string& text, int times) {
    std::string all;
    for (int i = 0; i < times; ++i) all += text;
    return all;
}

const std::string HEAD = "calls 1\n";
const std::string PHOTO = bytes("00000002 00000001 FF123456 FF000001");  // 2 x 1
const std::string END = bytes("07 08");

std::string fault_in(const std::string& recorded) {
    try {
        parse_recording(recorded);
    } catch (const malformed_recording& e) {
        return e.what();
    }
    return "none";
}

}  // namespace

TEST(recording, HoldsPhotoAndCalls) {
    const recording r = parse_recording(
        HEAD + PHOTO +
        bytes("01 0000000A 00000001  02"
              "03 00000005 00000001 00000000 00000001 FFFFFFFF 000001F4  04 05 06") +
        END);
    EXPECT_EQ(r.width, 2);
    EXPECT_EQ(r.height, 1);
    EXPECT_THAT(r.pixels, ElementsAre(static_cast<int32_t>(0xFF123456), -0xFFFFFF));

    std::vector<call_kind> kinds;
    for (const recorded_call& call : r.calls) kinds.push_back(call.kind);
    EXPECT_THAT(kinds, ElementsAre(call_kind::set_brush, call_kind::init, call_kind::modify,
                                   call_kind::invert, call_kind::reset, call_kind::update_box,
                                   call_kind::digest, call_kind::destroy));
    EXPECT_THAT(r.calls[0].arguments, ElementsAre(10, 1, 0, 0, 0, 0));
    EXPECT_THAT(r.calls[2].arguments, ElementsAre(5, 1, 0, 1, -1, 500));
}

TEST(recording, HoldsTheRunsThatAreSelected) {
    const recording r = parse_recording(
        HEAD + bytes("00000003 00000002" + repeated("FF000000", 6)) +
        bytes("09 00000000  09 00000003  00000000 00000000 00000000  00000000 00000002 00000002"
              "00000001 00000000 00000002  04") +
        END);
    ASSERT_EQ(r.calls.size(), 5u);
    EXPECT_EQ(r.calls[0].kind, call_kind::select);
    EXPECT_EQ(r.calls[0].runs.size(), 0u);
    EXPECT_EQ(r.calls[1].kind, call_kind::select);
    EXPECT_EQ(r.calls[2].kind, call_kind::invert);

    std::vector<std::array<int32_t, 3>> runs;
    for (const pixel_run& run : r.calls[1].runs) runs.push_back({run.row, run.first, run.last});
    EXPECT_THAT(runs, ElementsAre(std::array<int32_t, 3>{0, 0, 0}, std::array<int32_t, 3>{0, 2, 2},
                                  std::array<int32_t, 3>{1, 0, 2}));
}

TEST(recording, HasMoreRunsThanItHolds) {
    // No memory is asked for what is not there.
    for (const char* count : {"00000001", "00000002", "7FFFFFFF", "80000000", "FFFFFFFF"}) {
        EXPECT_EQ(fault_in(HEAD + PHOTO + bytes(std::string("09") + count) + END),
                  "it ends inside a call")
            << count;
    }
    EXPECT_EQ(fault_in(HEAD + PHOTO + bytes("09 0000")), "it ends inside a call");
    EXPECT_EQ(fault_in(HEAD + PHOTO + bytes("09 00000002 00000000 00000000 00000000") + END),
              "it ends inside a call");
}

TEST(recording, HasARunBeyondThePhoto) {
    const auto fault_in_run = [](const std::string& run) {
        return fault_in(HEAD + PHOTO + bytes("09 00000001" + run) + END);
    };
    ASSERT_EQ(fault_in_run("00000000 00000000 00000001"), "none");
    EXPECT_EQ(fault_in_run("00000001 00000000 00000001"),
              "the photo has no run 0 to 1 in row 1 at byte 29");
    EXPECT_EQ(fault_in_run("FFFFFFFF 00000000 00000001"),
              "the photo has no run 0 to 1 in row -1 at byte 29");
    EXPECT_EQ(fault_in_run("00000000 00000001 00000000"),
              "the photo has no run 1 to 0 in row 0 at byte 29");
    EXPECT_EQ(fault_in_run("00000000 FFFFFFFF 00000001"),
              "the photo has no run -1 to 1 in row 0 at byte 29");
    EXPECT_EQ(fault_in_run("00000000 00000000 00000002"),
              "the photo has no run 0 to 2 in row 0 at byte 29");
}

TEST(recording, MissesItsHead) {
    EXPECT_EQ(fault_in(""), "it does not begin with \"calls 1\"");
    EXPECT_EQ(fault_in("calls 2\n" + PHOTO + END), "it does not begin with \"calls 1\"");
}

TEST(recording, HasASizeThatNoPhotoHas) {
    EXPECT_EQ(fault_in(HEAD + bytes("00000000 00000001") + END), "the photo's width is 0");
    EXPECT_EQ(fault_in(HEAD + bytes("00000001 FFFFFFFF") + END), "the photo's height is -1");
    EXPECT_EQ(fault_in(HEAD + bytes("00008000 00000001") + END), "the photo's width is 32768");
    // No memory is asked for what is not there.
    EXPECT_EQ(fault_in(HEAD + bytes("00007FFF 00007FFF") + END), "it ends inside the photo");
}

TEST(recording, IsFoundShortAtEachPlace) {
    const std::string whole =
        HEAD + PHOTO + bytes("01 0000000A 00000001  09 00000001 00000000 00000001 00000001") + END;
    ASSERT_EQ(fault_in(whole), "none");
    for (size_t length = 0; length < whole.size(); ++length) {
        EXPECT_NE(fault_in(whole.substr(0, length)), "none") << "of " << length << " bytes";
    }
    EXPECT_EQ(fault_in((HEAD + PHOTO).substr(0, 14)), "it ends inside the photo's size");
    EXPECT_EQ(fault_in((HEAD + PHOTO).substr(0, 23)), "it ends inside the photo");
    EXPECT_EQ(fault_in(HEAD + PHOTO + bytes("01 0000000A 0000")), "it ends inside a call");
}

TEST(recording, HasACallThatIsNone) {
    EXPECT_EQ(fault_in(HEAD + PHOTO + bytes("02 0A") + END), "there is no call 10 at byte 25");
    EXPECT_EQ(fault_in(HEAD + PHOTO + bytes("00") + END), "there is no call 0 at byte 24");
}

TEST(recording, EndsWithItsOneDigestAndDestroy) {
    const std::string fault = "it does not end with a digest, taken once, and the session's end";
    for (const char* calls :
         {"", "02", "07", "08", "0208", "0807", "070208", "070802", "070708", "080708"}) {
        EXPECT_EQ(fault_in(HEAD + PHOTO + bytes(calls)), fault) << calls;
    }
}

TEST(digest, IsTheCrcOfTheMaskAndThenOfAlphaRedGreenBlue) {
    // The well-known check value: CRC-32 of "123456789".
    EXPECT_EQ(digest_of({'1', '2', '3', '4', '5', '6', '7', '8', '9'}, {}), 0xCBF43926u);
    EXPECT_EQ(digest_of({'1'}, {0x32333435, 0x36373839}), 0xCBF43926u);
}
