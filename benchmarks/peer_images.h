// The peers' images around our pixels. None but leptonica's copies them.
#pragma once

#include <allheaders.h>
#include <cairo.h>
#include <pixman.h>

#include <cstdint>
#include <memory>
#include <opencv2/core.hpp>

inline uint8_t* bytes(uint32_t* pixels) { return reinterpret_cast<uint8_t*>(pixels); }

inline cv::Mat cv_pixels(uint32_t* pixels, int width, int height) {
    return cv::Mat(height, width, CV_8UC4, pixels);
}

using pixman_picture = std::shared_ptr<pixman_image_t>;

inline pixman_picture pixman_pixels(uint32_t* pixels, int width, int height) {
    return {pixman_image_create_bits(PIXMAN_a8r8g8b8, width, height, pixels, width * 4),
            pixman_image_unref};
}

// A mask of 0 and 255.
inline pixman_picture pixman_mask(uint8_t* mask, int width, int height) {
    return {pixman_image_create_bits(PIXMAN_a8, width, height, reinterpret_cast<uint32_t*>(mask),
                                     width),
            pixman_image_unref};
}

using cairo_picture = std::shared_ptr<cairo_surface_t>;

inline cairo_picture cairo_pixels(uint32_t* pixels, int width, int height) {
    return {cairo_image_surface_create_for_data(bytes(pixels), CAIRO_FORMAT_ARGB32, width, height,
                                                width * 4),
            cairo_surface_destroy};
}

inline cairo_picture cairo_mask(uint8_t* mask, int width, int height) {
    return {cairo_image_surface_create_for_data(mask, CAIRO_FORMAT_A8, width, height, width),
            cairo_surface_destroy};
}

inline std::shared_ptr<cairo_t> cairo_on(const cairo_picture& surface) {
    return {cairo_create(surface.get()), cairo_destroy};
}

// A copy in leptonica's order of channels.
inline std::shared_ptr<PIX> pix_of(const uint32_t* pixels, int width, int height) {
    PIX* const pix = pixCreateNoInit(width, height, 32);
    l_uint32* const data = pixGetData(pix);  // rows of 32-bit pixels are as wide as the picture
    for (size_t i = 0; i < size_t(width) * size_t(height); ++i) {
        data[i] = pixels[i] << 8 | pixels[i] >> 24;
    }
    return {pix, [](PIX* p) { pixDestroy(&p); }};
}
