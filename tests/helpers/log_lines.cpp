#include "tests/helpers/log_lines.h"

#include <android/log.h>

#include <cstdarg>
#include <cstdio>

namespace {

std::vector<log_line> lines;

}  // namespace

int __android_log_print(int priority, const char* tag, const char* format, ...) {
    char text[256];
    va_list arguments;
    va_start(arguments, format);
    const int length = std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    lines.push_back({priority, tag, text});
    return length;
}

std::vector<log_line> take_log_lines() {
    std::vector<log_line> taken;
    taken.swap(lines);
    return taken;
}
