// What the library has written to the Android log. The test program brings its own
// __android_log_print, which records instead of writing.
#pragma once

#include <string>
#include <vector>

struct log_line {
    int priority;
    std::string tag;
    std::string text;
};

inline bool operator==(const log_line& a, const log_line& b) {
    return a.priority == b.priority && a.tag == b.tag && a.text == b.text;
}

// The lines since the last call.
std::vector<log_line> take_log_lines();
