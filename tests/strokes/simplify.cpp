#include "tests/strokes/simplify.h"

#include <algorithm>
#include <map>

namespace {

class simplifier {
public:
    simplifier(const stroke_case& c, const std::function<bool(const stroke_case&)>& is_kept)
        : best(c), kept(is_kept) {}

    // Every change is offered until none is taken any more.
    stroke_case run() {
        do {
            changed = false;
            drop_strokes();
            drop_costs();
            simplify_brush();
            crop();
            simplify_masks();
            simplify_photos();
        } while (changed);
        return best;
    }

private:
    bool offer(const stroke_case& simpler) {
        if (!kept(simpler)) return false;
        best = simpler;
        changed = true;
        return true;
    }

    void drop_strokes() {
        for (size_t i = best.strokes.size(); i-- > 0 && best.strokes.size() > 1;) {
            stroke_case c = best;
            c.strokes.erase(c.strokes.begin() + static_cast<ptrdiff_t>(i));
            offer(c);
        }
    }

    void drop_costs() {
        for (size_t i = best.old_costs.size(); i-- > 0;) {
            stroke_case c = best;
            c.old_costs.erase(c.old_costs.begin() + static_cast<ptrdiff_t>(i));
            offer(c);
        }
    }

    void simplify_brush() {
        while (best.radius > 0) {
            stroke_case c = best;
            --c.radius;
            for (old_cost& o : c.old_costs) {
                o.column = std::max(o.column - 1, 0);
                o.row = std::max(o.row - 1, 0);
                if (o.column > 2 * c.radius || o.row > 2 * c.radius) o.column = o.row = 0;
            }
            if (!offer(c)) break;
        }
        for (const int core : {0, 1, 2}) {
            stroke_case c = best;
            c.core = core;
            if (core < best.core && offer(c)) break;
        }
        for (const int step : {0, 1, 2, 3, 4}) {
            stroke_case c = best;
            c.step = step;
            const int rank = best.step == 0 ? 0 : best.step;
            if (step < rank && offer(c)) break;
        }
    }

    // Leaves out columns and rows of single strokes.
    void crop() {
        for (size_t i = 0; i < best.strokes.size(); ++i) {
            for (int column = best.strokes[i].mask.width; column-- > 0;) {
                if (best.strokes[i].mask.width > 1) offer(without(i, column, -1));
            }
            for (int row = best.strokes[i].mask.height; row-- > 0;) {
                if (best.strokes[i].mask.height > 1) offer(without(i, -1, row));
            }
        }
    }

    stroke_case without(size_t i, int column, int row) const {
        stroke_case c = best;
        const stroke_input& from = best.strokes[i];
        stroke_input& to = c.strokes[i];
        to.mask = Picture(from.mask.width - (column >= 0), from.mask.height - (row >= 0), 0);
        to.photo.clear();
        size_t cell = 0;
        for (int y = 0; y < from.mask.height; ++y) {
            for (int x = 0; x < from.mask.width; ++x) {
                if (x == column || y == row) continue;
                to.mask.cells[cell++] = from.mask.at(x, y);
                to.photo.push_back(from.photo[static_cast<size_t>(y * from.mask.width + x)]);
            }
        }
        to.x -= column >= 0 && column < from.x;
        to.y -= row >= 0 && row < from.y;
        return c;
    }

    // Replaces values at ever fewer places at once.
    template <class Get, class T>
    void replace_in_chunks(size_t stroke, Get get, T from, T to) {
        std::vector<size_t> places;
        const auto& values = get(best.strokes[stroke]);
        for (size_t i = 0; i < values.size(); ++i) {
            if (values[i] == from) places.push_back(i);
        }
        for (size_t chunk = places.size(); chunk > 0; chunk /= 2) {
            for (size_t first = 0; first < places.size(); first += chunk) {
                stroke_case c = best;
                auto& changed_values = get(c.strokes[stroke]);
                bool any = false;
                for (size_t i = first; i < std::min(first + chunk, places.size()); ++i) {
                    any |= changed_values[places[i]] == from;
                    changed_values[places[i]] = to;
                }
                if (any) offer(c);
            }
        }
    }

    void simplify_masks() {
        const auto mask_of = [](stroke_input& s) -> std::vector<unsigned char>& {
            return s.mask.cells;
        };
        for (size_t i = 0; i < best.strokes.size(); ++i) {
            for (int value = 9; value >= 2; --value) {
                const auto from = static_cast<unsigned char>(value);
                for (const unsigned char to : {0, 1, 5}) {
                    if (to < from) replace_in_chunks(i, mask_of, from, to);
                }
            }
            replace_in_chunks(i, mask_of, static_cast<unsigned char>(1),
                              static_cast<unsigned char>(0));
        }
    }

    void simplify_photos() {
        const auto photo_of = [](stroke_input& s) -> std::vector<int>& { return s.photo; };
        for (size_t i = 0; i < best.strokes.size(); ++i) {
            std::map<int, int> counts;
            for (const int colour : best.strokes[i].photo) ++counts[colour];
            const auto commonest =
                std::max_element(counts.begin(), counts.end(),
                                 [](const auto& a, const auto& b) { return a.second < b.second; });
            for (const auto& from : counts) {
                if (from.first != commonest->first) {
                    replace_in_chunks(i, photo_of, from.first, commonest->first);
                }
            }
            for (int level = 0; level < MOST_COLOURS; ++level) rename_a_colour(i, level * 0x010101);
        }
    }

    // Gives the next colour above `to` that colour, which nothing has yet.
    void rename_a_colour(size_t stroke, int to) {
        const std::vector<int>& photo = best.strokes[stroke].photo;
        if (std::count(photo.begin(), photo.end(), to) > 0) return;
        int next = INT32_MAX;
        for (const int colour : photo) {
            if (colour > to) next = std::min(next, colour);
        }
        if (next == INT32_MAX) return;
        stroke_case c = best;
        std::replace(c.strokes[stroke].photo.begin(), c.strokes[stroke].photo.end(), next, to);
        offer(c);
    }

    stroke_case best;
    const std::function<bool(const stroke_case&)>& kept;
    bool changed = false;
};

}  // namespace

stroke_case simplified(const stroke_case& c,
                       const std::function<bool(const stroke_case&)>& is_kept) {
    return simplifier(c, is_kept).run();
}
