// The Android log, as this library uses it: one line at priority ANDROID_LOG_INFO per rejected
// call.
#pragma once

#include <android/log.h>

constexpr char LOG_TAG[] = "KOVA_RM";
