#include "tests/strokes/stroke_cases.h"

#include <algorithm>
#include <iomanip>
#include <memory>
#include <sstream>
#include <stdexcept>

namespace {

constexpr char DIGITS[] = "0123456789abcdefghijklmnopqrstuvwxyz";

// Reads lines, skipping blank ones and comments. Lines of pictures are indented.
class case_reader {
public:
    explicit case_reader(std::istream& text) : in(text) { advance(); }

    std::vector<stroke_case> read() {
        std::vector<stroke_case> cases;
        while (!done) cases.push_back(one_case());
        return cases;
    }

private:
    [[noreturn]] void refuse(const std::string& why) const {
        throw std::runtime_error("line " + std::to_string(number) + ": " + why + ": " + line);
    }

    void advance() {
        while (std::getline(in, line)) {
            ++number;
            if (!line.empty() && line[0] != '#') return;
        }
        done = true;
        line = "the end";
    }

    bool at(const std::string& word) const {
        return !done && (line == word || line.rfind(word + " ", 0) == 0);
    }

    // The rest of a line that begins with `word`.
    std::istringstream take(const std::string& word) {
        if (!at(word)) refuse("expected '" + word + "'");
        std::istringstream rest(line.substr(word.size()));
        advance();
        return rest;
    }

    std::vector<int> numbers(const std::string& word, size_t count) {
        const std::string whole = line;
        std::istringstream rest = take(word);
        std::vector<int> read;
        for (int n; rest >> n;) read.push_back(n);
        if (!rest.eof() || read.size() != count) {
            throw std::runtime_error("line before " + std::to_string(number) + ": expected " +
                                     std::to_string(count) + " numbers: " + whole);
        }
        return read;
    }

    std::string rows(const std::string& word) {
        take(word);
        std::string drawing;
        for (; !done && line[0] == ' '; advance()) drawing += line + "\n";
        if (drawing.empty()) refuse("expected the rows of '" + word + "'");
        return drawing;
    }

    stroke_case one_case() {
        stroke_case c;
        std::getline(take("case") >> std::ws, c.name);
        if (c.name.empty()) refuse("a case has a name; before");
        const std::vector<int> brush = numbers("brush", 2);
        c.radius = brush[0];
        c.core = brush[1];
        if (at("step")) c.step = numbers("step", 1)[0];
        while (at("cost_h") || at("cost_v")) {
            const bool horizontal = at("cost_h");
            const std::vector<int> n = numbers(horizontal ? "cost_h" : "cost_v", 3);
            c.old_costs.push_back(
                {horizontal ? cost_of::STEP_LEFT : cost_of::STEP_UP, n[0], n[1], n[2]});
        }
        while (at("colours") || at("mask")) stroke(&c);
        if (c.strokes.empty()) refuse("expected 'colours'");
        return c;
    }

    void stroke(stroke_case* c) {
        stroke_input s;
        if (at("colours")) {
            s.photo = photo();
        } else if (!c->strokes.empty()) {
            s.photo = c->strokes.back().photo;
        }
        s.mask = Picture(rows("mask"));
        if (s.photo.size() != s.mask.cells.size()) refuse("photo and mask differ in size; before");
        s.grows = at("grow");
        const std::vector<int> point = numbers(s.grows ? "grow" : "shrink", 2);
        s.x = point[0];
        s.y = point[1];
        c->strokes.push_back(s);
        pinned_outcome e;
        const std::vector<int> r = numbers("rect", 4);
        e.rect = {r[0], r[1], r[2], r[3]};
        e.nodes = numbers("nodes", 1)[0];
        e.mask = Picture(rows("becomes"));
        c->expected.push_back(e);
    }

    std::vector<int> photo() {
        std::istringstream rest = take("colours");
        std::vector<int> colours;
        for (int colour; rest >> std::hex >> colour;) colours.push_back(colour);
        std::istringstream lines(rows("photo"));
        std::vector<int> pixels;
        for (std::string row; lines >> row;) {
            for (const char digit : row) {
                const size_t n = std::string(DIGITS).find(digit);
                if (n >= colours.size()) refuse("a pixel of no colour; before");
                pixels.push_back(colours[n]);
            }
        }
        return pixels;
    }

    std::istream& in;
    std::string line;
    int number = 0;
    bool done = false;
};

void write_rows(std::ostream& out, const std::string& cells, int width) {
    for (size_t i = 0; i < cells.size(); i += static_cast<size_t>(width)) {
        out << "  " << cells.substr(i, static_cast<size_t>(width)) << '\n';
    }
}

void write_mask(std::ostream& out, const char* title, const Picture& mask) {
    out << title << '\n';
    std::string cells;
    for (const unsigned char value : mask.cells) {
        if (value > 9) throw std::runtime_error("no character for a mask value above 9");
        cells += ".#23456789"[value];
    }
    write_rows(out, cells, mask.width);
}

void write_photo(std::ostream& out, const stroke_input& s) {
    std::vector<int> colours = s.photo;
    std::sort(colours.begin(), colours.end());
    colours.erase(std::unique(colours.begin(), colours.end()), colours.end());
    if (colours.size() > MOST_COLOURS) throw std::runtime_error("too many colours to write");
    out << "colours";
    for (const int colour : colours) {
        out << ' ' << std::hex << std::uppercase << std::setw(6) << std::setfill('0') << colour;
    }
    out << std::dec << "\nphoto\n";
    std::string pixels;
    for (const int colour : s.photo) {
        pixels +=
            DIGITS[std::lower_bound(colours.begin(), colours.end(), colour) - colours.begin()];
    }
    write_rows(out, pixels, s.mask.width);
}

}  // namespace

void prepare(stroke_engine* engine, const stroke_case& c) {
    if (c.step > 0) engine->set_step(c.step);
    for (const old_cost& o : c.old_costs) {
        engine->set_cost(o.which, o.row * (2 * c.radius + 1) + o.column, o.cost);
    }
}

std::vector<stroke_outcome> play(stroke_engine* (*new_engine)(int radius, int core),
                                 const stroke_case& c) {
    const std::unique_ptr<stroke_engine> engine(new_engine(c.radius, c.core));
    prepare(engine.get(), c);
    std::vector<stroke_outcome> outcomes;
    for (const stroke_input& stroke : c.strokes) outcomes.push_back(engine->play(stroke));
    return outcomes;
}

std::vector<stroke_case> read_cases(std::istream& in) { return case_reader(in).read(); }

void write_case(std::ostream& out, const stroke_case& c) {
    out << "case " << c.name << "\nbrush " << c.radius << ' ' << c.core << '\n';
    if (c.step > 0) out << "step " << c.step << '\n';
    for (const old_cost& o : c.old_costs) {
        out << (o.which == cost_of::STEP_LEFT ? "cost_h " : "cost_v ") << o.column << ' ' << o.row
            << ' ' << o.cost << '\n';
    }
    for (size_t i = 0; i < c.strokes.size(); ++i) {
        const stroke_input& s = c.strokes[i];
        if (i == 0 || s.photo != c.strokes[i - 1].photo) write_photo(out, s);
        write_mask(out, "mask", s.mask);
        out << (s.grows ? "grow " : "shrink ") << s.x << ' ' << s.y << '\n';
        const pinned_outcome& e = c.expected.at(i);
        out << "rect " << e.rect.left << ' ' << e.rect.right << ' ' << e.rect.top << ' '
            << e.rect.bottom << "\nnodes " << e.nodes << '\n';
        write_mask(out, "becomes", e.mask);
    }
}
