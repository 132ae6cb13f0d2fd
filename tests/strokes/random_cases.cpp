#include "tests/strokes/random_cases.h"

#include <algorithm>

#include "tests/differential/random_source.h"

namespace {

int grey(int level) { return level * 0x010101; }

std::vector<int> random_photo(random_source& random, int width, int height) {
    std::vector<int> photo(static_cast<size_t>(width) * static_cast<size_t>(height), grey(0));
    const int kind = random.between(0, 6);
    const int colours = random.between(2, 5);
    const int scale = random.any_of({1, 1, 2, 10, 63});
    for (size_t i = 0; i < photo.size(); ++i) {
        const int x = static_cast<int>(i) % width, y = static_cast<int>(i) / width;
        switch (kind) {
            case 0:  // one colour
                break;
            case 1:  // one colour, and a few specks
                if (random.one_in(12)) photo[i] = grey(random.between(1, 3) * scale);
                break;
            case 2:  // a gradient with a little noise
                photo[i] = grey((x + y) % 30 + random.between(0, 2));
                break;
            case 3:  // as dear as steps can be
                photo[i] = random.one_in(2) ? 0xFFFFFF : 0;
                break;
            case 4:  // many colours
                photo[i] = grey(8 * random.between(0, 31));
                break;
            default:
                photo[i] = grey(random.between(0, colours - 1) * scale);
        }
    }
    return photo;
}

Picture random_mask(random_source& random, int width, int height) {
    Picture mask(width, height, 0);
    const int selected = random.any_of({0, 0, 100, random.between(0, 100)});
    const int foreign = random.any_of({0, 0, 15, random.between(0, 90)});
    const int lowest = random.any_of({5, 5, 2, 0});
    for (unsigned char& value : mask.cells) {
        value = random.between(0, 99) < selected;
        if (random.between(0, 99) >= foreign) continue;
        value = static_cast<unsigned char>(lowest + random.between(0, lowest == 5 ? 0 : 6));
    }
    return mask;
}

// Levels of grey next to each other, one of them the commonest, and a mask with few values of 1 and
// more that block the fronts. Many paths cost the same, and what the queue does on ties decides.
stroke_input tied_stroke(random_source& random, int width, int height) {
    stroke_input s;
    s.mask = Picture(width, height, 0);
    const int rarity = random.between(2, 12), levels = random.between(1, 4);
    const int blocked = random.between(2, 12), selected = random.any_of({2, 20, 1000});
    for (unsigned char& value : s.mask.cells) {
        const int level = random.one_in(rarity) ? random.between(0, levels) : levels / 2;
        s.photo.push_back(grey(level));
        value = random.one_in(selected);
        if (random.one_in(blocked)) value = static_cast<unsigned char>(random.between(2, 5));
    }
    s.x = random.between(0, width - 1);
    s.y = random.between(0, height - 1);
    s.grows = random.one_in(2);
    if (!s.grows) s.mask.at(s.x, s.y) = 1;
    return s;
}

stroke_case tied_case(random_source& random) {
    stroke_case c;
    c.radius = random.between(3, 10);
    c.core = random.between(0, 2);
    if (random.one_in(3)) c.step = random.between(1, 4);
    const int width = random.between(3, 16), height = random.between(3, 16);
    for (int strokes = random.one_in(3) ? random.between(2, 4) : 1; strokes > 0; --strokes) {
        c.strokes.push_back(tied_stroke(random, width, height));
    }
    return c;
}

void change(random_source& random, stroke_input* s) {
    for (int pixels = random.size_up_to(6); pixels > 0; --pixels) {
        const int x = random.between(0, s->mask.width - 1);
        const int y = random.between(0, s->mask.height - 1);
        const size_t last = s->photo.size() - 1;
        const size_t other = static_cast<size_t>(random.between(0, static_cast<int>(last)));
        int& colour = s->photo[static_cast<size_t>(y * s->mask.width + x)];
        switch (random.between(0, 2)) {
            case 0:
                s->mask.at(x, y) = static_cast<unsigned char>(random.any_of({0, 0, 1, 1, 3, 5}));
                break;
            case 1:
                colour = s->photo[other];
                break;
            default:
                colour = grey(random.between(0, 3));
        }
    }
    if (random.one_in(6)) s->x += random.between(-1, 1);
    if (random.one_in(6)) s->y += random.between(-1, 1);
}

stroke_case changed_case(random_source& random, const std::vector<stroke_case>& known) {
    const auto any = [&] {
        const int last = static_cast<int>(known.size()) - 1;
        return known[static_cast<size_t>(random.between(0, last))];
    };
    stroke_case c = any();
    for (stroke_input& s : c.strokes) change(random, &s);
    if (random.one_in(4)) c.radius = std::max(c.radius + random.between(-2, 2), 0);
    if (random.one_in(6)) c.core = random.between(0, 2);
    if (random.one_in(4)) c.step = random.between(0, 4);
    if (random.one_in(6)) c.strokes.push_back(any().strokes.back());
    c.old_costs.clear();
    return c;
}

stroke_case new_case(random_source& random) {
    stroke_case c;
    c.radius = random.one_in(40) ? random.between(0, 30) : random.between(1, 9);
    c.core = random.one_in(12) ? random.between(-1, c.radius + 2) : random.between(0, 2);
    const int step = random.between(0, 9);
    if (step < 4) c.step = random.any_of({1, 2, 3, random.between(4, 20)});
    if (step == 4) c.step = random.any_of({100, 1000});
    for (int costs = random.one_in(12) ? 9 : 0; costs > 0; --costs) {
        c.old_costs.push_back({random.one_in(2) ? cost_of::STEP_LEFT : cost_of::STEP_UP,
                               random.between(0, 2 * c.radius), random.between(0, 2 * c.radius),
                               random.any_of({1, 100, 195075, 195075, 195076, -1})});
    }
    int width = random.between(3, 2 * c.radius + 6), height = random.between(3, 2 * c.radius + 6);
    const int strokes = random.one_in(3) ? random.between(2, 4) : 1;
    const int kinds = random.between(0, 2);
    for (int i = 0; i < strokes; ++i) {
        if (random.one_in(4)) width = random.between(3, 2 * c.radius + 6);
        if (random.one_in(4)) height = random.between(3, 2 * c.radius + 6);
        stroke_input s;
        s.photo = random_photo(random, width, height);
        s.mask = random_mask(random, width, height);
        s.grows = kinds == 2 ? random.one_in(2) : kinds == 1;
        s.x = random.between(0, width - 1);
        s.y = random.between(0, height - 1);
        if (!s.grows && !random.one_in(20)) s.mask.at(s.x, s.y) = 1;
        c.strokes.push_back(s);
    }
    return c;
}

}  // namespace

stroke_case random_case(uint64_t seed, const std::vector<stroke_case>& known) {
    random_source random(seed);
    switch (random.between(0, 3)) {
        case 0:
            return new_case(random);
        case 1:
            if (!known.empty()) return changed_case(random, known);
            [[fallthrough]];
        default:
            return tied_case(random);
    }
}
