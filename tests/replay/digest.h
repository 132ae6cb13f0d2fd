// The digest of a selection: what the player prints, and desktop/README.md explains.
#pragma once

#include <cstdint>
#include <vector>

// Size of the view that the digest shows.
constexpr int DIGEST_VIEW_WIDTH = 640;
constexpr int DIGEST_VIEW_HEIGHT = 480;

// The CRC-32 of zip and PNG over the mask's bytes and then each pixel as alpha, red, green, blue.
uint32_t digest_of(const std::vector<uint8_t>& mask, const std::vector<uint32_t>& view);
