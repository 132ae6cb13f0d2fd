#include "benchmarks/inputs.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstring>
#include <fstream>
#include <random>
#include <utility>

namespace {

pixel_buffer the_photo;

// Whole numbers below a limit; the standard distributions differ between libraries.
class dice {
public:
    explicit dice(unsigned seed) : source(seed) {}
    int below(int limit) { return static_cast<int>(source() % static_cast<unsigned>(limit)); }

private:
    std::mt19937 source;
};

unsigned char& at(mask_buffer* mask, int x, int y) {
    return (*mask)[size_t(y) * PHOTO_WIDTH + size_t(x)];
}

bool is_free(mask_buffer* mask, const ze_rect& box) {
    for (int y = box.top; y <= box.bottom; ++y) {
        for (int x = box.left; x <= box.right; ++x) {
            if (at(mask, x, y) != 0) return false;
        }
    }
    return true;
}

// A speck of `size` pixels that hang together, within 5 pixels of (x, y).
void draw_speck(int x, int y, int size, dice* random, mask_buffer* mask) {
    constexpr int REACH = 5;
    constexpr int DX[] = {-1, 1, 0, 0};
    constexpr int DY[] = {0, 0, -1, 1};
    int px = x, py = y;
    for (int drawn = 0; drawn < size;) {
        unsigned char& pixel = at(mask, px, py);
        drawn += pixel == 0;
        pixel = 1;
        const int d = random->below(4);
        if (std::abs(px + DX[d] - x) <= REACH) px += DX[d];
        if (std::abs(py + DY[d] - y) <= REACH) py += DY[d];
    }
}

}  // namespace

bool read_photo(const std::string& path) {
    std::vector<unsigned char> bytes(PHOTO_PIXELS * 4 + 1);
    std::ifstream file(path, std::ios::binary);
    file.read(reinterpret_cast<char*>(bytes.data()), static_cast<std::streamsize>(bytes.size()));
    if (file.gcount() != static_cast<std::streamsize>(PHOTO_PIXELS * 4)) return false;
    the_photo.resize(PHOTO_PIXELS);
    for (size_t i = 0; i < PHOTO_PIXELS; ++i) {
        const unsigned char* const p = &bytes[4 * i];
        the_photo[i] = p[0] | uint32_t{p[1]} << 8 | uint32_t{p[2]} << 16 | uint32_t{p[3]} << 24;
    }
    return true;
}

pixel_buffer& photo() { return the_photo; }

mask_buffer object_mask() {
    constexpr double RADIUS = 1110;  // of a disc of a third of the photo, less what the waves add
    mask_buffer mask(PHOTO_PIXELS);
    for (int y = 0; y < PHOTO_HEIGHT; ++y) {
        for (int x = 0; x < PHOTO_WIDTH; ++x) {
            const double dx = x - PHOTO_WIDTH / 2.0, dy = y - PHOTO_HEIGHT / 2.0;
            const double distance = std::sqrt(dx * dx + dy * dy);
            const double c = distance > 0 ? dx / distance : 0;
            // Waves of three and five to the turn: cos 3a and cos 5a in terms of cos a.
            const double waves =
                0.15 * c * (4 * c * c - 3) + 0.08 * c * (16 * c * c * c * c - 20 * c * c + 5);
            at(&mask, x, y) = distance < RADIUS * (1 + waves);
        }
    }
    return mask;
}

mask_buffer object_with_holes() {
    mask_buffer mask = object_mask();
    dice random(1);
    for (int holes = 0; holes < 40; ++holes) {
        const int radius = 5 + random.below(56);
        const int cx = PHOTO_WIDTH / 2 - 700 + random.below(1400);
        const int cy = PHOTO_HEIGHT / 2 - 700 + random.below(1400);
        for (int dy = -radius; dy <= radius; ++dy) {
            for (int dx = -radius; dx <= radius; ++dx) {
                if (dx * dx + dy * dy <= radius * radius) at(&mask, cx + dx, cy + dy) = 0;
            }
        }
    }
    return mask;
}

void scatter_specks(int count, mask_buffer* mask) {
    constexpr int MARGIN = 8;  // more than a speck reaches, and a pixel between
    dice random(2);
    for (int drawn = 0; drawn < count;) {
        const int x = MARGIN + random.below(PHOTO_WIDTH - 2 * MARGIN);
        const int y = MARGIN + random.below(PHOTO_HEIGHT - 2 * MARGIN);
        if (!is_free(mask, {x - MARGIN, x + MARGIN, y - MARGIN, y + MARGIN})) continue;
        draw_speck(x, y, 3 + random.below(10), &random, mask);
        ++drawn;
    }
}

mask_buffer diagonal_specks(int count) {
    mask_buffer mask(PHOTO_PIXELS);
    dice random(3);
    for (int i = 0; i < count; ++i) {
        const int x = 1 + i * (PHOTO_WIDTH / count), y = 1 + i * (PHOTO_HEIGHT / count);
        const int size = 3 + random.below(4);
        for (int drawn = 0; drawn < size; ++drawn) at(&mask, x + drawn % 3, y + drawn / 3) = 1;
    }
    return mask;
}

mask_buffer noise_mask(int width, int height) {
    mask_buffer mask(size_t(width) * size_t(height));
    std::mt19937 random(4);
    uint32_t bits = 0;
    for (size_t i = 0; i < mask.size(); ++i) {
        bits = i % 32 == 0 ? static_cast<uint32_t>(random()) : bits >> 1;
        mask[i] = bits & 1;
    }
    return mask;
}

void read_bytes(const void* bytes, size_t size) {
    if (size == 0) return;
    constexpr size_t WORDS = 16;  // enough for the compiler to keep several loads on their way
    const unsigned char* const from = static_cast<const unsigned char*>(bytes);
    uint64_t all[WORDS] = {};
    for (size_t i = 0; i + sizeof(all) <= size; i += sizeof(all)) {
        uint64_t words[WORDS];
        std::memcpy(words, from + i, sizeof(words));
        for (size_t w = 0; w < WORDS; ++w) all[w] |= words[w];
    }
    benchmark::DoNotOptimize(all);
}
