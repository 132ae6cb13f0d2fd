// A recording of the stroke player: a photo and the calls that a script made on it. What its bytes
// mean, desktop/README.md says.
#pragma once

#include <array>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <vector>

enum class call_kind : uint8_t {
    set_brush = 1,
    init,
    modify,
    invert,
    reset,
    update_box,
    digest,
    destroy,
    select
};

// Pixels of a row of the photo, first <= last.
struct pixel_run {
    int32_t row;
    int32_t first;
    int32_t last;
};

struct recorded_call {
    call_kind kind;
    std::array<int32_t, 6> arguments;  // as many as the kind has, then zeros
    std::vector<pixel_run> runs;       // of select; the pixels that it selects
};

struct recording {
    int32_t width;
    int32_t height;
    std::vector<int32_t> pixels;
    std::vector<recorded_call> calls;  // the last two are digest and destroy
};

// Says in one line what is wrong with a recording.
struct malformed_recording : std::runtime_error {
    using runtime_error::runtime_error;
};

// Reads a recording from a file's bytes; throws malformed_recording.
recording parse_recording(const std::string& bytes);
