// Stands in for the Android log on machines that have none: lines go to standard error.

#include <android/log.h>

#include <cstdarg>
#include <cstdio>

int __android_log_print(int, const char* tag, const char* format, ...) {
    std::fprintf(stderr, "%s: ", tag);
    va_list arguments;
    va_start(arguments, format);
    const int length = std::vfprintf(stderr, format, arguments);
    va_end(arguments);
    std::fputc('\n', stderr);
    return length;
}
