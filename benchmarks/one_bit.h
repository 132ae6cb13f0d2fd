// Masks as leptonica likes them: a bit a pixel.
#pragma once

#include <allheaders.h>

#include <memory>

#include "benchmarks/inputs.h"

std::shared_ptr<PIX> one_bit_copy(const mask_buffer& mask);
void copy_to_bytes(PIX* pix, mask_buffer* mask);
