// The Android log, as this library uses it: one line of priority info for each rejected call.
#pragma once

#include <android/log.h>

constexpr char LOG_TAG[] = "KOVA_RM";
