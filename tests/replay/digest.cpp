#include "tests/replay/digest.h"

namespace {

constexpr uint32_t POLYNOMIAL = 0xEDB88320;  // of CRC-32, lowest power in the highest bit

void add_byte(uint32_t* crc, uint8_t byte) {
    *crc ^= byte;
    for (int i = 0; i < 8; ++i) *crc = *crc >> 1 ^ (*crc & 1 ? POLYNOMIAL : 0);
}

}  // namespace

uint32_t digest_of(const std::vector<uint8_t>& mask, const std::vector<uint32_t>& view) {
    uint32_t crc = ~0u;
    for (const uint8_t byte : mask) add_byte(&crc, byte);
    for (const uint32_t pixel : view) {
        for (int shift = 24; shift >= 0; shift -= 8) {
            add_byte(&crc, static_cast<uint8_t>(pixel >> shift));
        }
    }
    return ~crc;
}
