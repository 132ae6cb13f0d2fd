// Photos and views drawn as text, for tests; Picture draws the masks beside them.
//
//   a .. z   a colour of its own, alpha included     1, 2   the two dash colours
//   A .. Z   the grey of the small letter            .      0, a pixel not drawn
//
// Lines are rows; blank lines and white space around rows do not count.
#pragma once

#include <cstdint>
#include <ostream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

constexpr uint32_t FIRST_DASH = 0xD1000001u;
constexpr uint32_t SECOND_DASH = 0xD2000002u;

struct Pixels {
    explicit Pixels(const std::string& drawing) {
        std::istringstream lines(drawing);
        for (std::string row; lines >> row; ++height) {
            if (height > 0 && static_cast<int>(row.size()) != width) {
                throw std::invalid_argument("a picture's rows differ in length: " + row);
            }
            width = static_cast<int>(row.size());
            for (const char c : row) cells.push_back(pixel_of(c));
        }
    }

    // All pixels of one kind.
    Pixels(int columns, int rows, char kind)
        : width(columns),
          height(rows),
          cells(static_cast<size_t>(columns) * static_cast<size_t>(rows), pixel_of(kind)) {}

    // The bytes of a letter's colour are code, code + 1, code and code - 1: their grey is the code
    // in every channel.
    static uint32_t pixel_of(char c) {
        if (c == '.') return 0;
        if (c == '1') return FIRST_DASH;
        if (c == '2') return SECOND_DASH;
        const uint32_t code = static_cast<unsigned char>(c);
        if (c >= 'a' && c <= 'z') return code * 0x01010101u + 0x00010000u - 0x00000001u;
        if (c >= 'A' && c <= 'Z') return (code + ('a' - 'A')) * 0x01010101u;
        throw std::invalid_argument(std::string("no pixel of a picture: ") + c);
    }

    uint32_t* data() { return cells.data(); }
    int32_t* ints() { return reinterpret_cast<int32_t*>(cells.data()); }
    const int32_t* ints() const { return reinterpret_cast<const int32_t*>(cells.data()); }

    int width = 0;
    int height = 0;
    std::vector<uint32_t> cells;
};

inline bool operator==(const Pixels& a, const Pixels& b) {
    return a.width == b.width && a.height == b.height && a.cells == b.cells;
}

inline std::ostream& operator<<(std::ostream& out, const Pixels& picture) {
    static const std::string KINDS = ".12abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ";
    out << picture.width << " x " << picture.height;
    for (size_t i = 0; i < picture.cells.size(); ++i) {
        if (i % static_cast<size_t>(picture.width) == 0) out << '\n';
        size_t kind = 0;
        while (kind < KINDS.size() && Pixels::pixel_of(KINDS[kind]) != picture.cells[i]) ++kind;
        if (kind < KINDS.size()) {
            out << KINDS[kind];
        } else {
            out << '<' << std::hex << picture.cells[i] << std::dec << '>';
        }
    }
    return out;
}
