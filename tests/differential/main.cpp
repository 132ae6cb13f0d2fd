// Compares the library with slow models of it on random cases.
//
// Every case has a seed of its own, made of the run's seed, the family and the case's number. On a
// difference the run ends and says how to repeat just that case.

#include <chrono>
#include <cinttypes>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>
#include <vector>

#include "tests/differential/family.h"

namespace {

using steady = std::chrono::steady_clock;

constexpr char USAGE[] =
    "usage: differential [--seconds N] [--cases N] [--seed S] [--family NAME] [--case SEED]\n"
    "  --seconds N    run for N seconds in all (default 10)\n"
    "  --cases N      run at least N cases of every family, however long it takes\n"
    "  --seed S       draw the cases from S (default 1)\n"
    "  --family NAME  only this family; may be given again\n"
    "  --case SEED    only the case with this seed, of the one --family given\n";

struct options {
    double seconds = 10;
    uint64_t cases = 0;
    uint64_t seed = 1;
    std::vector<std::string> families;
    bool single = false;
    uint64_t single_seed = 0;
};

struct run_state {
    const family* f;
    uint64_t cases = 0;
    double seconds = 0;
    tally seen;
    std::map<std::string, uint64_t> first_case;  // in which each thing seen came up first
};

[[noreturn]] void refuse(const std::string& why) {
    std::fprintf(stderr, "differential: %s\n%s", why.c_str(), USAGE);
    std::exit(2);
}

uint64_t number(const char* option, const char* text) {
    char* end = nullptr;
    const uint64_t value = text ? std::strtoull(text, &end, 0) : 0;
    if (!text || end == text || *end) refuse(std::string(option) + " takes a whole number");
    return value;
}

options read_options(int count, char** arguments) {
    options o;
    for (int i = 1; i < count; i += 2) {
        const std::string option = arguments[i];
        const char* value = i + 1 < count ? arguments[i + 1] : nullptr;
        if (option == "--seconds") {
            o.seconds = static_cast<double>(number("--seconds", value));
        } else if (option == "--cases") {
            o.cases = number("--cases", value);
        } else if (option == "--seed") {
            o.seed = number("--seed", value);
        } else if (option == "--case") {
            o.single = true;
            o.single_seed = number("--case", value);
        } else if (option == "--family" && value) {
            o.families.push_back(value);
        } else {
            refuse("cannot make sense of '" + option + "'");
        }
    }
    if (o.single && o.families.size() != 1) refuse("--case goes with one --family");
    return o;
}

std::vector<run_state> chosen_families(const options& o) {
    std::vector<run_state> runs;
    std::string known;
    for (const auto* families : {&queue_families, &stroke_families, &region_families,
                                 &session_families, &rendering_families, &fixed_point_families}) {
        for (const family& f : *families) {
            known += std::string(" ") + f.name;
            bool wanted = o.families.empty();
            for (const std::string& name : o.families) wanted = wanted || name == f.name;
            if (wanted) runs.push_back({&f, 0, 0, {}, {}});
        }
    }
    if (runs.size() < o.families.size() || runs.empty()) refuse("the families are:" + known);
    return runs;
}

uint64_t case_seed(uint64_t seed, const family& f, uint64_t number) {
    for (const char* c = f.name; *c; ++c) seed = seed * 1099511628211u + static_cast<unsigned>(*c);
    random_source mixer(seed);
    return random_source(mixer.bits() + number).bits();
}

// Runs one case; ends the program when library and model differ.
void run_case(run_state* run, uint64_t seed) {
    random_source random(seed);
    const std::string difference = run->f->run(random, &run->seen);
    ++run->cases;
    for (const auto& [what, times] : run->seen) run->first_case.emplace(what, seed);
    if (difference.empty()) return;
    std::printf("DIFFERENCE in family %s, case 0x%" PRIx64
                ":\n  %s\nrepeat it: differential "
                "--family %s --case 0x%" PRIx64 "\n",
                run->f->name, seed, difference.c_str(), run->f->name, seed);
    std::exit(1);
}

void run_for(run_state* run, const options& o, double seconds) {
    const auto start = steady::now();
    double passed = 0;
    while (passed < seconds) {
        for (int i = 0; i < 16; ++i) run_case(run, case_seed(o.seed, *run->f, run->cases));
        passed = std::chrono::duration<double>(steady::now() - start).count();
    }
    run->seconds += passed;
}

void print_seen(const run_state& run) {
    for (const auto& [what, times] : run.seen) {
        std::printf("%-16s %12" PRIu64 "  %s, first in case 0x%" PRIx64 "\n", "", times,
                    what.c_str(), run.first_case.at(what));
    }
}

void print_table(const std::vector<run_state>& runs) {
    std::printf("%-16s %12s %12s  %s\n", "family", "cases", "cases/s", "what");
    for (const run_state& run : runs) {
        std::printf("%-16s %12" PRIu64 " %12.0f  %s\n", run.f->name, run.cases,
                    static_cast<double>(run.cases) / run.seconds, run.f->what);
        print_seen(run);
    }
}

}  // namespace

int main(int count, char** arguments) {
    std::setvbuf(stdout, nullptr, _IOLBF, 0);
    const options o = read_options(count, arguments);
    std::vector<run_state> runs = chosen_families(o);
    if (o.single) {
        run_case(&runs.front(), o.single_seed);
        print_seen(runs.front());
        std::printf("no difference\n");
        return 0;
    }

    // In rounds, so that every family gets its share and progress shows.
    std::printf("comparing with the models for %.0f seconds, seed %" PRIu64 "\n", o.seconds,
                o.seed);
    const int rounds = 4;
    for (int round = 1; round <= rounds; ++round) {
        for (run_state& run : runs) {
            run_for(&run, o, o.seconds / rounds / static_cast<double>(runs.size()));
        }
        std::printf("round %d of %d: no difference so far\n", round, rounds);
    }
    for (run_state& run : runs) {
        while (run.cases < o.cases) run_for(&run, o, 1);
    }
    print_table(runs);
    std::printf("0 differences\n");
}
