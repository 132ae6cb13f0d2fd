// Marks what leaves the library. Everything is compiled with hidden visibility; exports.txt lists
// the names that this macro (and JNIEXPORT) let out.
#pragma once

#define ZE_API __attribute__((visibility("default")))
