// Masks drawn as text, for tests.
//
//   .  0, not selected          #  1, selected          2 .. 9  that value
//
// Lines are rows; blank lines and white space around rows do not count.
#pragma once

#include <ostream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

struct Picture {
    explicit Picture(const std::string& drawing) {
        std::istringstream lines(drawing);
        for (std::string row; lines >> row; ++height) {
            if (height > 0 && static_cast<int>(row.size()) != width) {
                throw std::invalid_argument("a picture's rows differ in length: " + row);
            }
            width = static_cast<int>(row.size());
            for (const char c : row) cells.push_back(value_of(c));
        }
    }

    // All cells of one value.
    Picture(int columns, int rows, unsigned char value)
        : width(columns),
          height(rows),
          cells(static_cast<size_t>(columns) * static_cast<size_t>(rows), value) {}

    unsigned char& at(int x, int y) { return cells.at(static_cast<size_t>(y * width + x)); }
    unsigned char at(int x, int y) const { return cells.at(static_cast<size_t>(y * width + x)); }
    unsigned char* data() { return cells.data(); }

    int width = 0;
    int height = 0;
    std::vector<unsigned char> cells;

private:
    static unsigned char value_of(char c) {
        if (c == '.') return 0;
        if (c == '#') return 1;
        if (c >= '2' && c <= '9') return static_cast<unsigned char>(c - '0');
        throw std::invalid_argument(std::string("no cell of a picture: ") + c);
    }
};

inline bool operator==(const Picture& a, const Picture& b) {
    return a.width == b.width && a.height == b.height && a.cells == b.cells;
}

inline std::ostream& operator<<(std::ostream& out, const Picture& picture) {
    out << picture.width << " x " << picture.height;
    for (size_t i = 0; i < picture.cells.size(); ++i) {
        if (i % static_cast<size_t>(picture.width) == 0) out << '\n';
        const int value = picture.cells[i];
        if (value < 10) {
            out << ".#23456789"[value];
        } else {
            out << '<' << value << '>';
        }
    }
    return out;
}
