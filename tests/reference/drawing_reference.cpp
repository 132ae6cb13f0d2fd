#include "tests/reference/drawing_reference.h"

#include <cstddef>

#include "tests/reference/arithmetic_reference.h"

namespace reference {
namespace {

constexpr int64_t ONE = 65536;   // 1 in 16.16
constexpr int64_t HALF = 32768;  // 1/2 in 16.16

// Row-major index of (x, y) where rows are `width` apart. Converted to the unsigned index type of
// a vector, a negative index is beyond every vector's end, so at() refuses it.
size_t index_of(int64_t x, int64_t y, int64_t width) { return static_cast<size_t>(y * width + x); }

int64_t step_of(float scale) {
    const float product = scale * 65536.0f;
    return truncated(product);
}

// Photo column or row under view column or row v, not clamped. `rounding` is 0 or HALF.
int64_t photo_position(int64_t v, int offset, int64_t step, int64_t rounding) {
    return floor_divided(wrapped(offset * ONE + v * step + rounding), ONE);
}

// Deliberate order: for a size of 0 or less the lower bound has the last word.
int64_t clamped(int64_t position, int size) {
    if (position > int64_t{size} - 1) position = int64_t{size} - 1;
    if (position < 0) position = 0;
    return position;
}

// Colour of a 5 x 5 checkerboard's cell. Truncating division makes the cells around coordinate 0
// nine wide.
int32_t dash_colour(int64_t x, int64_t y, int32_t first, int32_t second) {
    const bool odd_column = x / 5 % 2 != 0;
    const bool odd_row = y / 5 % 2 != 0;
    return odd_column == odd_row ? first : second;
}

}  // namespace

int native_drawImage(std::vector<int32_t>& view, int view_width, int /*view_height*/,
                     const std::vector<int32_t>& photo, int photo_width, int photo_height,
                     float scale, int offset_x, int offset_y, int left, int right, int top,
                     int bottom) {
    const int64_t step = step_of(scale);
    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const int64_t sx = clamped(photo_position(x, offset_x, step, 0), photo_width);
            const int64_t sy = clamped(photo_position(y, offset_y, step, 0), photo_height);
            view.at(index_of(x, y, view_width)) = photo.at(index_of(sx, sy, photo_width));
        }
    }
    return 1;
}

int native_drawSmallImage(std::vector<int32_t>& view, int view_width, int /*view_height*/,
                          const std::vector<int32_t>& photo, int photo_width, int photo_height,
                          int left, int right, int top, int bottom) {
    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const int64_t sx = clamped(x - left, photo_width);
            const int64_t sy = clamped(y - top, photo_height);
            view.at(index_of(x, y, view_width)) = photo.at(index_of(sx, sy, photo_width));
        }
    }
    return 1;
}

void native_setImagePoints(int columns, int rows, int /*unread_3*/, int /*unread_4*/, float scale,
                           int offset_x, int offset_y, std::vector<int32_t>& points) {
    const int64_t step = step_of(scale);
    for (int64_t i = 0; i < columns; ++i) {
        points.at(static_cast<size_t>(i)) =
            static_cast<int32_t>(photo_position(i, offset_x, step, 0));
    }
    for (int64_t j = 0; j < rows; ++j) {
        points.at(static_cast<size_t>(columns + j)) =
            static_cast<int32_t>(photo_position(j, offset_y, step, 0));
    }
}

int native_drawImageWithMaskContour(std::vector<int32_t>& view, int view_width, int /*view_height*/,
                                    const std::vector<int32_t>& photo, int photo_width,
                                    int photo_height, const std::vector<int8_t>& mask, float scale,
                                    int offset_x, int offset_y, int32_t first_colour,
                                    int32_t second_colour, int left, int right, int top,
                                    int bottom) {
    const int64_t step = step_of(scale);
    const int64_t mask_size = int64_t{photo_width} * photo_height;

    const auto column_under = [&](int64_t x) { return photo_position(x, offset_x, step, HALF); };
    const auto row_under = [&](int64_t y) { return photo_position(y, offset_y, step, HALF); };
    const auto sx = [&](int64_t x) { return clamped(column_under(x), photo_width); };
    const auto sy = [&](int64_t y) { return clamped(row_under(y), photo_height); };

    const auto selected = [&](int64_t x, int64_t y) {
        const int8_t m = mask.at(index_of(sx(x), sy(y), photo_width));
        return m == 1 || m == 3;
    };
    const auto draw = [&](int64_t x, int64_t y, bool dash) {
        view.at(index_of(x, y, view_width)) = dash ? dash_colour(x, y, first_colour, second_colour)
                                                   : photo.at(index_of(sx(x), sy(y), photo_width));
    };
    const auto on_photo_border = [&](int64_t x, int64_t y) {
        return sy(y) == 0 || sy(y) >= int64_t{photo_height} - 1 || sx(x) == 0 ||
               sx(x) >= int64_t{photo_width} - 1;
    };
    // Neighbours are not clamped: past a row's end lies the next row, past the mask nothing.
    const auto outside = [&](int64_t column, int64_t row) {
        const int64_t i = row * photo_width + column;
        if (i < 0 || i >= mask_size) return false;
        const int8_t m = mask.at(static_cast<size_t>(i));
        return m == 0 || m == 4 || m == 5;
    };
    const auto has_outside_neighbour = [&](int64_t x, int64_t y) {
        return outside(column_under(x + 1), sy(y)) || outside(sx(x), row_under(y + 1)) ||
               outside(column_under(x - 1), sy(y)) || outside(sx(x), row_under(y - 1));
    };

    for (int64_t x = left; x <= right; ++x) draw(x, top, selected(x, top));
    for (int64_t y = int64_t{top} + 1; y < bottom; ++y) {
        // Deliberate: both end columns are drawn even where left > right.
        draw(left, y, selected(left, y));
        for (int64_t x = int64_t{left} + 1; x < right; ++x) {
            draw(x, y, selected(x, y) && !on_photo_border(x, y) && has_outside_neighbour(x, y));
        }
        draw(right, y, selected(right, y));
    }
    for (int64_t x = left; x <= right; ++x) draw(x, bottom, selected(x, bottom));
    return 1;
}

int native_drawSmallImageWithMaskContour(std::vector<int32_t>& view, int view_width,
                                         int /*view_height*/, const std::vector<int32_t>& photo,
                                         int photo_width, int photo_height,
                                         const std::vector<int8_t>& mask, int32_t first_colour,
                                         int32_t second_colour, int left, int right, int top,
                                         int bottom) {
    const auto mask_at = [&](int64_t column, int64_t row) {
        return mask.at(index_of(column, row, photo_width));
    };
    for (int64_t y = top; y <= bottom; ++y) {
        for (int64_t x = left; x <= right; ++x) {
            const int64_t sx = clamped(x - left, photo_width);
            const int64_t sy = clamped(y - top, photo_height);

            bool dash = false;
            if (mask_at(sx, sy) == 1) {
                const bool on_photo_border = sy == 0 || sy >= int64_t{photo_height} - 1 ||
                                             sx <= 0 || sx >= int64_t{photo_width} - 1;
                dash = on_photo_border || mask_at(sx + 1, sy) == 0 || mask_at(sx, sy + 1) == 0 ||
                       mask_at(sx - 1, sy) == 0 || mask_at(sx, sy - 1) == 0;
            }
            view.at(index_of(x, y, view_width)) =
                dash ? dash_colour(x, y, first_colour, second_colour)
                     : photo.at(index_of(sx, sy, photo_width));
        }
    }
    return 1;
}

}  // namespace reference
