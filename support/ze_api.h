// Marks what leaves the library. Everything is compiled with hidden visibility; exports.txt lists
// the names that ZE_API (and JNIEXPORT) let out.
//
// A header between ZE_BEGIN_FLAT and ZE_END_FLAT declares plain names and reads the same in C99 and
// in C++17.
#pragma once

#define ZE_API __attribute__((visibility("default")))

#ifdef __cplusplus
#define ZE_BEGIN_FLAT extern "C" {
#define ZE_END_FLAT }
#else
#define ZE_BEGIN_FLAT
#define ZE_END_FLAT
#endif
