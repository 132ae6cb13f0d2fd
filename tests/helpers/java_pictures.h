// Java arrays as the pictures that they hold, for tests. The other way is fake_bytes("mask",
// picture.cells).
#pragma once

#include "tests/helpers/picture.h"
#include "tests/helpers/pixels.h"
#include "tests/helpers/recording_env.h"

inline Picture picture_of(const fake_bytes& mask, int width, int height) {
    Picture picture(width, height, 0);
    picture.cells = mask.elements<unsigned char>();
    return picture;
}

inline Pixels pixels_of(const fake_ints& array, int width, int height) {
    Pixels pixels(width, height, '.');
    pixels.cells = array.elements<uint32_t>();
    return pixels;
}
