// Paints a disc with an engine of its own, shows the photo grey outside it, and queues two nodes.
// Exits 1 when a result is not the expected one.
#include <draventaUtil.h>

#include <cstdint>
#include <iostream>
#include <string>
#include <vector>

namespace {

constexpr int WIDTH = 9;
constexpr int HEIGHT = 7;

// Without right and lower rim, as ER_selection::Brush_Add says.
const std::string EXPECTED =
    "..###....\n"
    ".#####...\n"
    "######...\n"
    "######...\n"
    "######...\n"
    ".#####...\n"
    ".........\n";

std::string drawn(const std::vector<unsigned char>& mask) {
    std::string text;
    for (int y = 0; y < HEIGHT; ++y) {
        for (int x = 0; x < WIDTH; ++x) text += mask[y * WIDTH + x] == 1 ? '#' : '.';
        text += '\n';
    }
    return text;
}

bool cheapest_comes_first() {
    node dear = {0, 0, 9, 1, nullptr, nullptr};
    node cheap = {1, 0, 3, 1, nullptr, nullptr};
    D_Queue queue;
    queue.push(&dear);
    queue.push(&cheap);
    return queue.pop() == &cheap && queue.pop() == &dear && queue.empty();
}

}  // namespace

int main() {
    std::vector<unsigned char> mask(WIDTH * HEIGHT);
    ze_rect changed = {WIDTH, 0, HEIGHT, 0};

    ER_selection engine;
    engine.initial(3, 1);
    engine.Brush_Add(mask.data(), WIDTH, HEIGHT, 3, 3, &changed);
    std::cout << drawn(mask);
    if (drawn(mask) != EXPECTED) return 1;
    if (changed.left != 0 || changed.right != 5 || changed.top != 0 || changed.bottom != 5)
        return 1;

    std::vector<uint32_t> photo(WIDTH * HEIGHT, 0xFF0306FFu), picture(photo.size());
    ze_draw_withmask(photo.data(), picture.data(), mask.data(), WIDTH, 0, WIDTH - 1, 0, HEIGHT - 1);
    for (std::size_t i = 0; i < photo.size(); ++i)
        if (picture[i] != (mask[i] == 1 ? 0xFF0306FFu : 0xFF585858u)) return 1;

    return cheapest_comes_first() ? 0 : 1;
}
