// How the library's names are declared.
#pragma once

// Marks what leaves the library. Everything is compiled with hidden visibility; exports.txt lists
// the names that this macro (and JNIEXPORT) let out.
#define ZE_API __attribute__((visibility("default")))

// A header between these two declares plain names and reads the same in C99 and in C++17.
#ifdef __cplusplus
#define ZE_BEGIN_FLAT extern "C" {
#define ZE_END_FLAT }  // see ZE_BEGIN_FLAT
#else
#define ZE_BEGIN_FLAT
#define ZE_END_FLAT
#endif
