#include "tests/replay/recording.h"

#include <algorithm>
#include <cstddef>
#include <utility>

namespace {

constexpr char MAGIC[] = "calls 1\n";
constexpr int LONGEST_SIDE = 32767;  // the player refuses larger photos

[[noreturn]] void refuse(const std::string& what) { throw malformed_recording(what); }

std::string byte_number(size_t position) { return " at byte " + std::to_string(position); }

// Goes through the bytes from the first to the last.
class byte_reader {
public:
    explicit byte_reader(const std::string& b) : bytes(b) {}

    bool at_end() const { return place == bytes.size(); }
    size_t position() const { return place; }

    bool take_text(const std::string& text) {
        if (bytes.compare(place, text.size(), text) != 0) return false;
        place += text.size();
        return true;
    }

    unsigned take_byte() { return static_cast<unsigned char>(bytes[place++]); }

    // `of` is what the number belongs to.
    int32_t take_number(const char* of) {
        if (bytes.size() - place < 4) refuse(std::string("it ends inside ") + of);
        uint32_t number = 0;
        for (int i = 0; i < 4; ++i) number = number << 8 | take_byte();
        return static_cast<int32_t>(number);
    }

    size_t numbers_left() const { return (bytes.size() - place) / 4; }

private:
    const std::string& bytes;
    size_t place = 0;
};

size_t argument_count(call_kind kind) {
    switch (kind) {
        case call_kind::set_brush:
            return 2;
        case call_kind::modify:
            return 6;
        default:
            return 0;
    }
}

int32_t take_side(byte_reader* in, const char* name) {
    const int32_t side = in->take_number("the photo's size");
    if (side >= 1 && side <= LONGEST_SIDE) return side;
    refuse(std::string("the photo's ") + name + " is " + std::to_string(side));
}

std::vector<int32_t> take_pixels(byte_reader* in, size_t count) {
    if (count > in->numbers_left()) refuse("it ends inside the photo");
    std::vector<int32_t> pixels(count);
    for (int32_t& pixel : pixels) pixel = in->take_number("the photo");
    return pixels;
}

pixel_run take_run(byte_reader* in, int32_t width, int32_t height) {
    const size_t position = in->position();
    pixel_run run = {};
    for (int32_t* number : {&run.row, &run.first, &run.last}) *number = in->take_number("a call");
    const bool in_the_photo = run.row >= 0 && run.row < height && run.first >= 0 &&
                              run.first <= run.last && run.last < width;
    if (in_the_photo) return run;
    refuse("the photo has no run " + std::to_string(run.first) + " to " + std::to_string(run.last) +
           " in row " + std::to_string(run.row) + byte_number(position));
}

std::vector<pixel_run> take_runs(byte_reader* in, int32_t width, int32_t height) {
    const auto count = static_cast<uint32_t>(in->take_number("a call"));
    if (count > in->numbers_left() / 3) refuse("it ends inside a call");
    std::vector<pixel_run> runs(count);
    for (pixel_run& run : runs) run = take_run(in, width, height);
    return runs;
}

recorded_call take_call(byte_reader* in, int32_t width, int32_t height) {
    const size_t position = in->position();
    const unsigned number = in->take_byte();
    if (number < 1 || number > static_cast<unsigned>(call_kind::select)) {
        refuse("there is no call " + std::to_string(number) + byte_number(position));
    }
    recorded_call call = {static_cast<call_kind>(number), {}, {}};
    const size_t count = argument_count(call.kind);
    for (size_t i = 0; i < count; ++i) call.arguments[i] = in->take_number("a call");
    if (call.kind == call_kind::select) call.runs = take_runs(in, width, height);
    return call;
}

bool ends_with_a_digest(const std::vector<recorded_call>& calls) {
    const auto count = [&](call_kind kind) {
        return std::count_if(calls.begin(), calls.end(),
                             [&](const recorded_call& call) { return call.kind == kind; });
    };
    return count(call_kind::digest) == 1 && count(call_kind::destroy) == 1 &&
           calls.back().kind == call_kind::destroy &&
           calls[calls.size() - 2].kind == call_kind::digest;
}

}  // namespace

recording parse_recording(const std::string& bytes) {
    byte_reader in(bytes);
    if (!in.take_text(MAGIC)) refuse("it does not begin with \"calls 1\"");
    recording r;
    r.width = take_side(&in, "width");
    r.height = take_side(&in, "height");
    r.pixels = take_pixels(&in, static_cast<size_t>(r.width) * static_cast<size_t>(r.height));
    while (!in.at_end()) r.calls.push_back(take_call(&in, r.width, r.height));
    if (!ends_with_a_digest(r.calls))
        refuse("it does not end with a digest, taken once, and the session's end");
    return r;
}
