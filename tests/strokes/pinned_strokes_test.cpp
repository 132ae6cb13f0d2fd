// The strokes of pinned.txt: what they come to depends on single lines of the competition of fronts
// and its queue. Whoever carries them out has to come to the same.
#include <gtest/gtest.h>

#include <fstream>
#include <memory>
#include <sstream>
#include <stdexcept>

#include "tests/helpers/rect_printing.h"
#include "tests/reference/engine_reference.h"
#include "tests/strokes/stroke_cases.h"

namespace {

// The slow model as an engine for cases.
class model_engine : public stroke_engine {
public:
    model_engine(int radius, int core) { engine.initial(radius, core); }

    void set_step(int step) override { engine.queue->step = step; }

    void set_cost(cost_of which, int cell, int cost) override {
        (which == cost_of::STEP_LEFT ? engine.cost_h : engine.cost_v)
            .at(static_cast<size_t>(cell)) = cost;
    }

    stroke_outcome play(const stroke_input& s) override {
        const int width = s.mask.width, height = s.mask.height;
        stroke_outcome after;
        after.mask = s.mask;
        reference::rect rect = {width, 0, height, 0};
        engine.queue->count = 7;
        engine.queue->spare = 1;
        if (s.grows) {
            engine.DoSelection(s.photo, after.mask.cells, width, height, s.x, s.y, &rect);
        } else {
            engine.DeSelection(s.photo, after.mask.cells, width, height, s.x, s.y, &rect);
        }
        after.rect = {rect.left, rect.right, rect.top, rect.bottom};
        after.nodes = engine.nodes_used;
        after.count = engine.queue->count;
        after.spare = engine.queue->spare;
        after.has_list = engine.queue->head != reference::NO_NODE;
        after.cost_h = engine.cost_h;
        after.cost_v = engine.cost_v;
        for (const int n : engine.node_map) after.recorded.push_back(n != reference::NO_NODE);
        return after;
    }

private:
    reference::engine engine;
};

stroke_engine* new_model_engine(int radius, int core) { return new model_engine(radius, core); }

constexpr size_t LEAST_CASES = 35;  // so that a file cut short is noticed

std::vector<stroke_case> pinned_cases() {
    std::ifstream in(DRAVENTA_PINNED_STROKES);
    if (!in) throw std::runtime_error("cannot read " DRAVENTA_PINNED_STROKES);
    const std::vector<stroke_case> cases = read_cases(in);
    if (cases.size() < LEAST_CASES) throw std::runtime_error("most of pinned.txt is missing");
    return cases;
}

void expect_outcomes(stroke_engine* (*new_engine)(int radius, int core)) {
    for (const stroke_case& c : pinned_cases()) {
        const std::vector<stroke_outcome> outcomes = play(new_engine, c);
        for (size_t i = 0; i < outcomes.size(); ++i) {
            SCOPED_TRACE(c.name + ", stroke " + std::to_string(i + 1));
            EXPECT_EQ(outcomes[i].mask, c.expected.at(i).mask);
            EXPECT_EQ(outcomes[i].rect, c.expected.at(i).rect);
            EXPECT_EQ(outcomes[i].nodes, c.expected.at(i).nodes);
        }
    }
}

// What an engine keeps for later strokes is too much to be written down, so it is compared.
void expect_equal_engines(stroke_engine* (*new_engine)(int radius, int core)) {
    for (const stroke_case& c : pinned_cases()) {
        const std::vector<stroke_outcome> outcomes = play(new_engine, c);
        const std::vector<stroke_outcome> expected = play(new_plain_engine, c);
        for (size_t i = 0; i < expected.size(); ++i) {
            SCOPED_TRACE(c.name + ", stroke " + std::to_string(i + 1));
            EXPECT_EQ(outcomes[i].count, expected[i].count);
            EXPECT_EQ(outcomes[i].spare, expected[i].spare);
            EXPECT_EQ(outcomes[i].has_list, expected[i].has_list);
            EXPECT_EQ(outcomes[i].cost_h, expected[i].cost_h);
            EXPECT_EQ(outcomes[i].cost_v, expected[i].cost_v);
            EXPECT_EQ(outcomes[i].recorded, expected[i].recorded);
        }
    }
}

const char EXAMPLE[] =
    "# a comment\n"
    "case an example 1\n"
    "brush 1 0\n"
    "step 2\n"
    "cost_v 2 0 -1\n"
    "colours 000000 FF00FF\n"
    "photo\n"
    "  010\n"
    "mask\n"
    "  .#5\n"
    "shrink 1 0\n"
    "rect 1 1 0 0\n"
    "nodes 1\n"
    "becomes\n"
    "  ..5\n";

std::vector<stroke_case> cases_of(const std::string& text) {
    std::istringstream in(text);
    return read_cases(in);
}

}  // namespace

TEST(PinnedStrokes, AreWhatTheLibraryComesTo) { expect_outcomes(new_library_engine); }
TEST(PinnedStrokes, AreWhatThePlainStrokesComeTo) { expect_outcomes(new_plain_engine); }
TEST(PinnedStrokes, AreWhatTheSlowModelComesTo) { expect_outcomes(new_model_engine); }

TEST(PinnedStrokes, LeaveTheSameBehind) {
    expect_equal_engines(new_library_engine);
    expect_equal_engines(new_model_engine);
}

TEST(StrokeCases, AreReadAsTheyAreWritten) {
    const std::vector<stroke_case> cases = cases_of(EXAMPLE);
    ASSERT_EQ(cases.size(), 1u);
    EXPECT_EQ(cases[0].name, "an example 1");
    EXPECT_EQ(cases[0].step, 2);
    EXPECT_EQ(cases[0].old_costs.at(0).cost, -1);
    EXPECT_EQ(cases[0].strokes.at(0).photo, (std::vector<int>{0, 0xFF00FF, 0}));
    EXPECT_EQ(cases[0].strokes.at(0).mask, Picture(".#5"));
    EXPECT_FALSE(cases[0].strokes.at(0).grows);
    EXPECT_EQ(cases[0].expected.at(0).rect, (ze_rect{1, 1, 0, 0}));
    EXPECT_EQ(cases[0].expected.at(0).mask, Picture("..5"));
    std::ostringstream out;
    write_case(out, cases[0]);
    EXPECT_EQ("# a comment\n" + out.str(), EXAMPLE);
}

TEST(StrokeCases, WithALineTooFewOrTooManyAreRefused) {
    const std::string example = EXAMPLE;
    const size_t first = example.find("case");
    for (size_t begin = first; begin < example.size(); begin = example.find('\n', begin) + 1) {
        const size_t end = example.find('\n', begin) + 1;
        const std::string line = example.substr(begin, end - begin);
        if (line.find("step") == std::string::npos && line.find("cost_v") == std::string::npos) {
            EXPECT_THROW(cases_of(example.substr(0, begin) + example.substr(end)),
                         std::runtime_error)
                << "without " << line;
        }
        EXPECT_THROW(cases_of(example.substr(0, begin) + "nodes\n" + example.substr(begin)),
                     std::runtime_error)
            << "with a line before " << line;
    }
}
