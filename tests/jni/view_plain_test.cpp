// The fast drawing loops of view_image.h and view_outline.h against their definition.
#include "jni/view_plain.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include "jni/photo_columns.h"
#include "jni/view_image.h"
#include "jni/view_outline.h"
#include "tests/differential/random_source.h"
#include "tests/helpers/block_edges.h"
#include "tests/helpers/guarded_buffer.h"
#include "tests/helpers/rect_printing.h"

namespace {

constexpr float INFINITE = std::numeric_limits<float>::infinity();
constexpr dash_colours DASHES = {-1111, -2222};

// A view to draw in and what to draw.
struct drawing {
    int view_width, view_height;
    int photo_width, photo_height;
    float scale;
    int offset_x, offset_y;
    ze_rect area;
    std::vector<int32_t> photo;
    std::vector<uint8_t> mask;
};

std::ostream& operator<<(std::ostream& out, const drawing& d) {
    return out << "view " << d.view_width << " x " << d.view_height << ", photo " << d.photo_width
               << " x " << d.photo_height << ", scale " << d.scale << ", offset " << d.offset_x
               << ", " << d.offset_y << ", rectangle " << testing::PrintToString(d.area);
}

float random_scale(random_source& random) {
    switch (random.between(0, 4)) {
        case 0:
            return random.any_of({0.25f, 0.5f, 1.0f, 2.0f, 4.0f});
        case 1:
            return random.any_of({0.0f, 1e-30f, 1.0f / 65536, -0.5f, -1.0f, -1e30f, INFINITE,
                                  -INFINITE, NAN, 1e30f, 32767.9f, 16384.0f, 1000.0f});
        default:
            return static_cast<float>(random.between(1, 3500)) / 1000.0f;
    }
}

int random_offset(random_source& random, int size) {
    if (random.one_in(12)) {
        return random.any_of({INT_MIN, INT_MAX, 32767, 32760, -32768, 65536, 40000});
    }
    return random.between(-size - 3, size + 3);
}

// Large regions with some holes and other values, so that there are rows with outline and without.
std::vector<uint8_t> random_mask(random_source& random, int width, int height) {
    std::vector<uint8_t> mask(static_cast<size_t>(width * height),
                              static_cast<uint8_t>(random.between(0, 1)));
    for (int k = random.between(0, 4); k > 0; --k) {
        const int left = random.between(0, width - 1), right = random.between(left, width - 1);
        const int top = random.between(0, height - 1), bottom = random.between(top, height - 1);
        const auto value = static_cast<uint8_t>(random.between(0, 6));
        for (int y = top; y <= bottom; ++y) {
            std::fill_n(mask.begin() + y * width + left, right - left + 1, value);
        }
    }
    if (random.one_in(3)) {
        for (uint8_t& value : mask) {
            if (random.one_in(9)) value = static_cast<uint8_t>(random.between(0, 255));
        }
    }
    return mask;
}

drawing random_drawing(random_source& random) {
    drawing d;
    const bool wide = random.one_in(25);  // than a tile
    d.view_width = wide ? random.between(TILE - 3, 2 * TILE + 5) : random.size_up_to(60);
    d.view_height = wide ? random.between(1, 6) : random.size_up_to(50);
    d.photo_width = random.one_in(8) ? random.between(1, 3) : random.size_up_to(wide ? 5000 : 80);
    d.photo_height = random.one_in(8) ? random.between(1, 3) : random.size_up_to(wide ? 8 : 80);
    d.scale = random_scale(random);
    d.offset_x = random_offset(random, d.photo_width);
    d.offset_y = random_offset(random, d.photo_height);
    d.area = {0, d.view_width - 1, 0, d.view_height - 1};
    if (random.one_in(2)) {
        d.area = {random.between(0, d.view_width - 1), random.between(0, d.view_width - 1),
                  random.between(0, d.view_height - 1), random.between(0, d.view_height - 1)};
    }
    for (int i = 0; i < d.photo_width * d.photo_height; ++i) d.photo.push_back(i);
    d.mask = random_mask(random, d.photo_width, d.photo_height);
    if (random.one_in(20)) {  // arrays of some pixels, said to have none
        d.photo_width = random.any_of({0, 0, -1, -5});
        d.photo_height = random.any_of({0, 1, -1, INT_MIN});
    }
    return d;
}

// Draws into a view that was 7 all over, between pages that cannot be touched.
template <class Draw>
std::vector<int32_t> drawn(const drawing& d, guard side, Draw draw) {
    guarded_buffer<int32_t> view(
        std::vector<int32_t>(static_cast<size_t>(d.view_width * d.view_height), 7), side);
    guarded_buffer<int32_t> photo(d.photo, side);
    guarded_buffer<uint8_t> mask(d.mask, side);
    draw(view_pixels{view.data(), d.view_width},
         outlined_photo{{photo.data(), d.photo_width, d.photo_height}, mask.data()});
    EXPECT_EQ(photo.values(), d.photo) << "the photo changed";
    EXPECT_EQ(mask.values(), d.mask) << "the mask changed";
    return view.values();
}

// Compares all four loops on a drawing.
void compare(const drawing& d, guard side) {
    SCOPED_TRACE(testing::PrintToString(d));
    const auto image = [&](auto draw) {
        return drawn(d, side, [&](const view_pixels& view, const outlined_photo& o) {
            draw(view, o.photo, d.scale, d.offset_x, d.offset_y, d.area);
        });
    };
    ASSERT_EQ(image(draw_image), image(plain::draw_image));
    const auto small_image = [&](auto draw) {
        return drawn(d, side, [&](const view_pixels& view, const outlined_photo& o) {
            draw(view, o.photo, d.area);
        });
    };
    ASSERT_EQ(small_image(draw_small_image), small_image(plain::draw_small_image));
    const auto outline = [&](auto draw) {
        return drawn(d, side, [&](const view_pixels& view, const outlined_photo& o) {
            draw(view, o, d.scale, d.offset_x, d.offset_y, DASHES, d.area);
        });
    };
    ASSERT_EQ(outline(draw_image_with_outline), outline(plain::draw_image_with_outline));
    const auto small_outline = [&](auto draw) {
        return drawn(d, side, [&](const view_pixels& view, const outlined_photo& o) {
            draw(view, o, DASHES, d.area);
        });
    };
    ASSERT_EQ(small_outline(draw_small_image_with_outline),
              small_outline(plain::draw_small_image_with_outline));
}

}  // namespace

TEST(view_plain, EqualsTheFastLoopsOnRandomDrawings) {
    constexpr uint64_t FIRST_SEED = 1, DRAWINGS = 1500;
    for (uint64_t seed = FIRST_SEED; seed < FIRST_SEED + DRAWINGS && !HasFailure(); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        random_source random(seed);
        const drawing d = random_drawing(random);
        compare(d, random.one_in(2) ? guard::BEFORE : guard::BEHIND);
    }
}

// Every rectangle in a small view, the unordered ones too.
TEST(view_plain, EqualsTheFastLoopsInEveryRectangle) {
    random_source random(1);
    drawing d = {4, 4, 6, 5, 1.0f, 1, 1, {}, {}, {}};
    for (int i = 0; i < 30; ++i) d.photo.push_back(i);
    for (const float scale : {0.4f, 1.0f, 2.2f}) {
        d.scale = scale;
        for (int left = 0; left < 4; ++left) {
            for (int right = 0; right < 4; ++right) {
                for (int top = 0; top < 4; ++top) {
                    for (int bottom = 0; bottom < 4 && !HasFailure(); ++bottom) {
                        d.area = {left, right, top, bottom};
                        d.mask = random_mask(random, 6, 5);
                        compare(d, guard::BEHIND);
                    }
                }
            }
        }
    }
}

// Stretches of one mask value are looked for where columns lie close together.
TEST(view_plain, EqualsTheFastLoopsOnStretchesOfOneValueAtAnyScale) {
    random_source random(3);
    for (const float scale : {0.3f, 1.7f, 3.9f, 4.1f, 6.5f}) {
        drawing d = {300, 3, 2000, 20, scale, 0, 0, {0, 299, 0, 2}, {}, {}};
        for (int i = 0; i < 40000; ++i) d.photo.push_back(i);
        for (int times = 0; times < 4 && !HasFailure(); ++times) {
            d.mask = random_mask(random, 2000, 20);
            compare(d, guard::BEHIND);
        }
        d.mask.assign(40000, 1);
        compare(d, guard::BEHIND);
    }
}

namespace {

// A photo of three rows under a mask of one value but for a pixel in column x of the middle row,
// drawn whole.
drawing with_lone_pixel(int width, int x, float scale, uint8_t lone) {
    const int view_width = static_cast<int>(static_cast<float>(width) / scale);
    const int view_height = static_cast<int>(3 / scale) + 1;
    drawing d = {view_width, view_height, width, 3, scale, 0, 0, {}, {}, {}};
    d.area = {0, view_width - 1, 0, view_height - 1};
    for (int i = 0; i < 3 * width; ++i) d.photo.push_back(i);
    d.mask.assign(d.photo.size(), static_cast<uint8_t>(1 - lone));
    d.mask[static_cast<size_t>(width + x)] = lone;
    return d;
}

}  // namespace

TEST(view_plain, EqualsTheFastLoopsOnASinglePixelInEveryColumn) {
    for (const int width : LENGTHS_AROUND_BLOCKS) {
        for (const int x : places_in(width)) {
            for (const float scale : {0.5f, 0.8f, 1.0f}) {
                for (const uint8_t lone : {0, 1}) {
                    compare(with_lone_pixel(width, x, scale, lone), guard::BEHIND);
                    ASSERT_FALSE(HasFailure()) << int{lone} << " in column " << x;
                }
            }
        }
    }
}

TEST(view_plain, EqualsTheFastLoopsOnASinglePixelWhereTilesMeet) {
    for (const int width : {TILE, TILE + 1, TILE + 2, 2 * TILE + 2}) {
        for (const int from_edge : {-3, -2, -1, 0, 1, 2}) {
            for (const float scale : {0.5f, 1.0f}) {
                const int x = static_cast<int>(TILE * scale) + from_edge;
                if (x >= width) continue;
                for (const uint8_t lone : {0, 1}) {
                    compare(with_lone_pixel(width, x, scale, lone), guard::BEHIND);
                    ASSERT_FALSE(HasFailure()) << int{lone} << " in column " << x;
                }
            }
        }
    }
}

// The view shows photo rows -1, 1, 3, 5 and 7 of 7: what lies beyond the photo is no neighbour.
TEST(view_plain, EqualsTheFastLoopsWhereARowAboveOrBelowLiesBeyondThePhoto) {
    constexpr int SIDE = 7;
    drawing d = {5, 5, SIDE, SIDE, 2.0f, 0, -1, {0, 4, 0, 4}, {}, {}};
    for (int i = 0; i < SIDE * SIDE; ++i) d.photo.push_back(i);
    for (const int unselected_row : {0, 1, 3, 5, 6}) {
        d.mask.assign(SIDE * SIDE, 1);
        std::fill_n(d.mask.begin() + unselected_row * SIDE, SIDE, 0);
        for (const int offset_x : {-1, 0, 1}) {
            d.offset_x = offset_x;
            compare(d, guard::BEHIND);
        }
    }
}

// A photo with columns where positions end: those of the last neighbour wrap first.
TEST(view_plain, EqualsTheFastLoopsInAPhotoAsWideAsPositionsReach) {
    constexpr int WIDTH = 32770, HEIGHT = 4;
    drawing d = {12, HEIGHT, WIDTH, HEIGHT, 1.0f, 0, 0, {0, 11, 0, HEIGHT - 1}, {}, {}};
    for (int i = 0; i < WIDTH * HEIGHT; ++i) d.photo.push_back(i);
    d.mask.assign(d.photo.size(), 1);
    for (size_t i = 0; i < d.mask.size(); i += 3) d.mask[i] = 0;
    for (int from_last = 0; from_last < 5; ++from_last) {
        d.scale = 1.0f;
        d.offset_x = 32754 + from_last;
        compare(d, guard::BEHIND);
        d.scale = 0.5f;
        d.offset_x = 32759 + from_last;
        compare(d, guard::BEHIND);
    }
}

TEST(view_plain, EqualsTheFastLoopsWherePositionsBeginToWrap) {
    for (const float scale : {0.5f, 1.0f, 1.5f}) {
        for (int offset = 32755; offset <= 32767 && !HasFailure(); ++offset) {
            for (const int photo_width : {1, 9}) {
                drawing d = {12, 4, photo_width, 4, scale, offset, 0, {0, 11, 0, 3}, {}, {}};
                for (int i = 0; i < 4 * photo_width; ++i) d.photo.push_back(i);
                d.mask.assign(d.photo.size(), 1);
                d.mask[d.mask.size() / 2] = 0;
                compare(d, guard::BEHIND);
                d.offset_x = 0;
                d.offset_y = offset;
                compare(d, guard::BEHIND);
            }
        }
    }
}

// Pixels drawn earlier are then the photo of later ones.
TEST(view_plain, EqualsTheFastLoopsWhereThePhotoIsTheView) {
    for (int view_width = 1; view_width <= 6; ++view_width) {
        for (int photo_width = 1; photo_width <= 6; ++photo_width) {
            for (const int left : {0, view_width / 2, view_width - 1}) {
                SCOPED_TRACE(testing::Message() << "view " << view_width << ", photo "
                                                << photo_width << " wide, from " << left);
                const ze_rect area = {left, view_width - 1, 0, 36 / view_width - 1};
                const auto both = [&](auto draw, auto plain_draw) {
                    std::vector<int32_t> drawn, plain_drawn;
                    for (int i = 0; i < 36; ++i) drawn.push_back(i);
                    plain_drawn = drawn;
                    const int height = 36 / photo_width;
                    draw(view_pixels{drawn.data(), view_width},
                         photo_pixels{drawn.data(), photo_width, height});
                    plain_draw(view_pixels{plain_drawn.data(), view_width},
                               photo_pixels{plain_drawn.data(), photo_width, height});
                    EXPECT_EQ(drawn, plain_drawn);
                };
                // From offset 2 on, a row drawn onto itself and drawn again moves on once more.
                for (const int offset : {1, 2, 3}) {
                    both([&](auto v, auto p) { draw_image(v, p, 0.5f, offset, 0, area); },
                         [&](auto v, auto p) { plain::draw_image(v, p, 0.5f, offset, 0, area); });
                }
                both([&](auto v, auto p) { draw_small_image(v, p, area); },
                     [&](auto v, auto p) { plain::draw_small_image(v, p, area); });
                const std::vector<uint8_t> mask(36, 1);
                const auto outlined = [&](const photo_pixels& p) {
                    return outlined_photo{p, mask.data()};
                };
                for (const int offset : {1, 2, 3}) {
                    both(
                        [&](auto v, auto p) {
                            draw_image_with_outline(v, outlined(p), 0.5f, offset, 0, DASHES, area);
                        },
                        [&](auto v, auto p) {
                            plain::draw_image_with_outline(v, outlined(p), 0.5f, offset, 0, DASHES,
                                                           area);
                        });
                }
                both([&](auto v,
                         auto p) { draw_small_image_with_outline(v, outlined(p), DASHES, area); },
                     [&](auto v, auto p) {
                         plain::draw_small_image_with_outline(v, outlined(p), DASHES, area);
                     });
            }
        }
    }
}

// Rows then overlap, and what is drawn later stays.
TEST(view_plain, EqualsTheFastLoopsInARectangleWiderThanTheView) {
    random_source random(2);
    for (const int narrower : {0, 1, 2, 5}) {
        drawing d = {9, 8, 12, 7, 0.5f, 0, 0, {0, 8, 0, 4}, {}, {}};
        for (int i = 0; i < 84; ++i) d.photo.push_back(i);
        d.mask = random_mask(random, 12, 7);
        const auto both = [&](auto draw, auto plain_draw) {
            std::vector<int32_t> view(72, 7), plain_view = view;
            draw(view_pixels{view.data(), 9 - narrower});
            plain_draw(view_pixels{plain_view.data(), 9 - narrower});
            EXPECT_EQ(view, plain_view) << narrower << " columns narrower";
        };
        const photo_pixels photo = {d.photo.data(), 12, 7};
        both([&](auto view) { draw_image(view, photo, d.scale, 0, 0, d.area); },
             [&](auto view) { plain::draw_image(view, photo, d.scale, 0, 0, d.area); });
        both([&](auto view) { draw_small_image(view, photo, d.area); },
             [&](auto view) { plain::draw_small_image(view, photo, d.area); });
        const outlined_photo o = {photo, d.mask.data()};
        both([&](auto view) { draw_image_with_outline(view, o, d.scale, 0, 0, DASHES, d.area); },
             [&](auto view) {
                 plain::draw_image_with_outline(view, o, d.scale, 0, 0, DASHES, d.area);
             });
        both([&](auto view) { draw_small_image_with_outline(view, o, DASHES, d.area); },
             [&](auto view) { plain::draw_small_image_with_outline(view, o, DASHES, d.area); });
    }
}

// A pixel is then read after it has been drawn.
TEST(view_plain, EqualsTheFastLoopsWhenThePhotoIsTheView) {
    random_source random(3);
    const std::vector<uint8_t> mask = random_mask(random, 9, 8);
    const ze_rect area = {1, 8, 1, 7};
    const auto both = [&](auto draw, auto plain_draw) {
        std::vector<int32_t> pixels(72);
        for (size_t i = 0; i < pixels.size(); ++i) pixels[i] = static_cast<int32_t>(i);
        std::vector<int32_t> plain_pixels = pixels;
        draw(view_pixels{pixels.data(), 9}, photo_pixels{pixels.data(), 9, 8});
        plain_draw(view_pixels{plain_pixels.data(), 9}, photo_pixels{plain_pixels.data(), 9, 8});
        EXPECT_EQ(pixels, plain_pixels);
    };
    for (const float scale : {0.5f, 1.0f, 1.5f}) {
        both([&](auto view, auto photo) { draw_image(view, photo, scale, 0, 0, area); },
             [&](auto view, auto photo) { plain::draw_image(view, photo, scale, 0, 0, area); });
        both(
            [&](auto view, auto photo) {
                draw_image_with_outline(view, {photo, mask.data()}, scale, 0, 0, DASHES, area);
            },
            [&](auto view, auto photo) {
                plain::draw_image_with_outline(view, {photo, mask.data()}, scale, 0, 0, DASHES,
                                               area);
            });
    }
    both([&](auto view, auto photo) { draw_small_image(view, photo, area); },
         [&](auto view, auto photo) { plain::draw_small_image(view, photo, area); });
    both(
        [&](auto view, auto photo) {
            draw_small_image_with_outline(view, {photo, mask.data()}, DASHES, area);
        },
        [&](auto view, auto photo) {
            plain::draw_small_image_with_outline(view, {photo, mask.data()}, DASHES, area);
        });
}
