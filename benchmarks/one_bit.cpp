#include "benchmarks/one_bit.h"

std::shared_ptr<PIX> one_bit_copy(const mask_buffer& mask) {
    PIX* const pix = pixCreate(PHOTO_WIDTH, PHOTO_HEIGHT, 1);
    const unsigned char* pixel = mask.data();
    for (int y = 0; y < PHOTO_HEIGHT; ++y) {
        for (int x = 0; x < PHOTO_WIDTH; ++x) {
            if (*pixel++ == 1) pixSetPixel(pix, x, y, 1);
        }
    }
    return {pix, [](PIX* p) { pixDestroy(&p); }};
}

void copy_to_bytes(PIX* pix, mask_buffer* mask) {
    unsigned char* pixel = mask->data();
    for (int y = 0; y < PHOTO_HEIGHT; ++y) {
        for (int x = 0; x < PHOTO_WIDTH; ++x) {
            l_uint32 bit = 0;
            pixGetPixel(pix, x, y, &bit);
            *pixel++ = static_cast<unsigned char>(bit);
        }
    }
}
