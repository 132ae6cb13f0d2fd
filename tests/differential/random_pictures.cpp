#include "tests/differential/random_pictures.h"

#include <algorithm>
#include <cstdlib>

namespace {

int random_colour(random_source& random) { return random.any_int(); }

// A square of colour `value` with every channel moved by at most `noise`.
int near_colour(random_source& random, int value, int noise) {
    unsigned moved = static_cast<unsigned>(value) & 0xFF000000u;
    for (const int shift : {0, 8, 16}) {
        const int channel = (value >> shift & 0xFF) + random.between(-noise, noise);
        moved |= static_cast<unsigned>(std::clamp(channel, 0, 255)) << shift;
    }
    return static_cast<int>(moved);
}

// Sets pixels of a mask, ignoring those outside it.
struct canvas {
    std::vector<unsigned char>& cells;
    int width;
    int height;

    void set(int x, int y, unsigned char value = 1) {
        if (x < 0 || x >= width || y < 0 || y >= height) return;
        cells[static_cast<size_t>(y) * static_cast<size_t>(width) + static_cast<size_t>(x)] = value;
    }

    void rectangle(int left, int right, int top, int bottom, unsigned char value = 1) {
        for (int y = top; y <= bottom; ++y) {
            for (int x = left; x <= right; ++x) set(x, y, value);
        }
    }
};

void draw_noise(random_source& random, canvas& mask, int one_in) {
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) {
            if (random.one_in(one_in)) mask.set(x, y);
        }
    }
}

void draw_rings(random_source& random, canvas& mask) {
    for (int rings = random.between(1, 3); rings > 0; --rings) {
        const int cx = random.between(0, mask.width - 1);
        const int cy = random.between(0, mask.height - 1);
        const int gap = random.between(2, 6);
        for (int r = random.between(1, 30); r >= 0; r -= gap) {
            mask.rectangle(cx - r, cx + r, cy - r, cy + r, 1);
            mask.rectangle(cx - r + 1, cx + r - 1, cy - r + 1, cy + r - 1, 0);
        }
    }
}

void draw_spiral(random_source& random, canvas& mask) {
    int x = mask.width / 2;
    int y = mask.height / 2;
    int dx = 1, dy = 0;
    const int pitch = random.between(1, 3);
    for (int length = 1, turns = random.between(3, 30); turns > 0; --turns) {
        for (int i = 0; i < length * pitch; ++i) {
            mask.set(x, y);
            x += dx;
            y += dy;
        }
        length += turns % 2;
        const int turned = dx;
        dx = -dy;
        dy = turned;
    }
}

void draw_comb(random_source& random, canvas& mask) {
    const int pitch = random.between(2, 4);
    const int spine = random.between(0, mask.height - 1);
    mask.rectangle(0, mask.width - 1, spine, spine);
    for (int x = random.between(0, 3); x < mask.width; x += pitch) {
        const int top = spine - random.between(0, 9);
        mask.rectangle(x, x, top, spine + random.between(0, 9));
    }
}

void draw_diagonals(random_source& random, canvas& mask) {
    for (int chains = random.between(1, 8); chains > 0; --chains) {
        int x = random.between(0, mask.width - 1);
        int y = random.between(0, mask.height - 1);
        const int dx = random.any_of({-1, 1});
        for (int length = random.between(1, 30); length > 0; --length, x += dx, ++y) {
            mask.set(x, y);
        }
    }
}

void draw_rectangles(random_source& random, canvas& mask) {
    for (int count = random.between(1, 6); count > 0; --count) {
        const int left = random.between(-5, mask.width);
        const int top = random.between(-5, mask.height);
        const int right = left + random.size_up_to(60);
        const int bottom = top + random.size_up_to(60);
        mask.rectangle(left, right, top, bottom, random.one_in(3) ? 0 : 1);
    }
}

}  // namespace

std::vector<int> random_photo(random_source& random, int width, int height) {
    const size_t pixels = static_cast<size_t>(width) * static_cast<size_t>(height);
    std::vector<int> photo(pixels, random_colour(random));
    switch (random.between(0, 4)) {
        case 0:  // uniform
            break;
        case 1: {  // two colours in stripes and squares
            const int other = random_colour(random);
            const int cell = random.between(1, 12);
            for (size_t i = 0; i < pixels; ++i) {
                const int x = static_cast<int>(i) % width / cell;
                const int y = static_cast<int>(i) / width / cell;
                if ((x ^ y) & 1) photo[i] = other;
            }
            break;
        }
        case 2:
            for (int& pixel : photo) pixel = random_colour(random);
            break;
        case 3: {  // areas with edges, and noise within them
            const int noise = random.between(0, 12);
            const int areas = random.between(1, 5);
            for (int area = 0; area < areas; ++area) {
                const int colour = random_colour(random);
                const int left = random.between(0, width - 1);
                const int top = random.between(0, height - 1);
                const int right = std::min(left + random.between(0, width), width);
                const int bottom = std::min(top + random.between(0, height), height);
                for (int y = top; y < bottom; ++y) {
                    std::fill(photo.begin() + y * width + left, photo.begin() + y * width + right,
                              colour);
                }
            }
            for (int& pixel : photo) pixel = near_colour(random, pixel, noise);
            break;
        }
        default: {  // a palette
            const int palette[4] = {0, 1, 2, random_colour(random)};
            for (int& pixel : photo) pixel = palette[random.between(0, 3)];
            break;
        }
    }
    return photo;
}

std::vector<unsigned char> random_mask(random_source& random, int width, int height) {
    std::vector<unsigned char> cells(static_cast<size_t>(width) * static_cast<size_t>(height));
    canvas mask{cells, width, height};
    switch (random.between(0, 10)) {
        case 0:
            break;
        case 1:
            mask.rectangle(0, width - 1, 0, height - 1);
            break;
        case 2:
            draw_noise(random, mask, 2);
            break;
        case 3:
            draw_noise(random, mask, 20);
            break;
        case 4:  // full, with holes
            for (unsigned char& cell : cells) cell = random.one_in(12) ? 0 : 1;
            break;
        case 5:
            draw_rings(random, mask);
            break;
        case 6:
            draw_spiral(random, mask);
            break;
        case 7:
            draw_comb(random, mask);
            break;
        case 8:
            draw_diagonals(random, mask);
            break;
        case 9:
            draw_rectangles(random, mask);
            break;
        default:
            draw_rectangles(random, mask);
            draw_rings(random, mask);
            draw_diagonals(random, mask);
            break;
    }
    return cells;
}

void sprinkle(random_source& random, std::vector<unsigned char>* mask, int first, int last) {
    const int rarity = random.between(2, 30);
    for (unsigned char& cell : *mask) {
        if (random.one_in(rarity)) cell = static_cast<unsigned char>(random.between(first, last));
    }
}
