// Compares the library with slow models of it on random cases.
//
// Every case has a seed of its own, made of the run's seed, the family and the case's number; the
// seed also chooses where the library's buffers lie. On a difference the run ends and says how to
// repeat just that case.
//
// With --digests it prints a digest of all that the library gave in a fixed number of cases: the
// same on every machine, with every compiler, wherever the buffers lie.

#include <cerrno>
#include <chrono>
#include <cinttypes>
#include <cstdio>
#include <cstdlib>
#include <map>
#include <string>
#include <vector>

#include "tests/differential/family.h"
#include "tests/differential/placed_vector.h"

namespace {

using steady = std::chrono::steady_clock;

constexpr char USAGE[] =
    "usage: differential [--seconds N] [--cases N] [--seed S] [--family NAME] [--case SEED]\n"
    "                    [--digests short|long]\n"
    "  --seconds N    run for N seconds in all (default 10)\n"
    "  --cases N      run at least N cases of every family, however long it takes\n"
    "  --seed S       draw the cases from S (default 1)\n"
    "  --family NAME  only this family; may be given again\n"
    "  --case SEED    only the case with this seed, of the one --family given\n"
    "  --digests SIZE the digest of each family, of as many cases as are committed; short: of a\n"
    "                 sixteenth\n";

constexpr uint64_t MOST = 1000000000;

struct options {
    double seconds = 10;
    uint64_t cases = 0;
    uint64_t seed = 1;
    std::vector<std::string> families;
    bool single = false;
    uint64_t single_seed = 0;
    uint64_t digest_share = 0;  // digests of one case in so many; 0: no digests
};

struct run_state {
    const family* f;
    uint64_t cases = 0;
    double seconds = 0;
    findings found;
    std::map<std::string, uint64_t> first_case;  // in which each thing counted came up first
};

[[noreturn]] void refuse(const std::string& why) {
    std::fprintf(stderr, "differential: %s\n%s", why.c_str(), USAGE);
    std::exit(2);
}

uint64_t number(const char* option, const char* text) {
    // strtoull would take a sign, and blanks before it.
    const bool starts_with_digit = text && *text >= '0' && *text <= '9';
    char* end = nullptr;
    errno = 0;
    const uint64_t value = starts_with_digit ? std::strtoull(text, &end, 0) : 0;
    if (!starts_with_digit || *end || errno == ERANGE) {
        refuse(std::string(option) + " takes a whole number");
    }
    return value;
}

// A number of seconds or cases: with none, nothing would be compared.
uint64_t amount(const char* option, const char* text) {
    const uint64_t value = number(option, text);
    if (value < 1 || value > MOST) {
        refuse(std::string(option) + " takes a number from 1 to " + std::to_string(MOST));
    }
    return value;
}

options read_options(int count, char** arguments) {
    options o;
    for (int i = 1; i < count; i += 2) {
        const std::string option = arguments[i];
        const char* value = i + 1 < count ? arguments[i + 1] : nullptr;
        if (option == "--seconds") {
            o.seconds = static_cast<double>(amount("--seconds", value));
        } else if (option == "--cases") {
            o.cases = amount("--cases", value);
        } else if (option == "--seed") {
            o.seed = number("--seed", value);
        } else if (option == "--case") {
            o.single = true;
            o.single_seed = number("--case", value);
        } else if (option == "--family" && value) {
            o.families.push_back(value);
        } else if (option == "--digests" && value && value == std::string("short")) {
            o.digest_share = 16;
        } else if (option == "--digests" && value && value == std::string("long")) {
            o.digest_share = 1;
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

// Where a case's buffers lie. The sanitizers see most on the heap.
int placement_of(uint64_t seed) {
#ifdef DRAVENTA_SANITIZED
    (void)seed;
    return HEAP;
#else
    return static_cast<int>(seed % PLACEMENTS);
#endif
}

// Runs one case; ends the program when library and model differ.
void run_case(const family& f, uint64_t seed, int placement, findings* found) {
    random_source random(seed);
    set_placement(placement);
    f.run(random, found);
    if (found->agree()) return;
    std::printf("DIFFERENCE in family %s, case 0x%" PRIx64
                ":\n  %s\nrepeat it: differential "
                "--family %s --case 0x%" PRIx64 "\n",
                f.name, seed, found->first_difference().c_str(), f.name, seed);
    std::exit(1);
}

void run_case(run_state* run, uint64_t seed) {
    run_case(*run->f, seed, placement_of(seed), &run->found);
    ++run->cases;
    for (const auto& [what, times] : run->found.counts()) run->first_case.emplace(what, seed);
}

// --- digests -------------------------------------------------------------------------------------

constexpr uint64_t DIGEST_SEED = 1;

// The digest of the first cases of a family, all with their buffers at one placement.
uint64_t digest_at(const family& f, uint64_t cases, int placement) {
    findings found;
    for (uint64_t n = 0; n < cases; ++n) {
        run_case(f, case_seed(DIGEST_SEED, f, n), placement, &found);
    }
    return found.digest();
}

// The placements of every buffer, one after the other, on a part of the cases.
void check_placements(const family& f, uint64_t cases) {
    const uint64_t expected = digest_at(f, cases, 0);
    for (int placement = 1; placement < PLACEMENTS; ++placement) {
        const uint64_t digest = digest_at(f, cases, placement);
        if (digest == expected) continue;
        std::printf("%s: with buffers at placement %d the digest of %" PRIu64
                    " cases is %016" PRIx64 ", at placement 0 it is %016" PRIx64 "\n",
                    f.name, placement, cases, digest, expected);
        std::exit(1);
    }
}

void print_digest(const family& f, uint64_t share) {
    const uint64_t cases = (f.digest_cases + share - 1) / share;
    check_placements(f, (f.digest_cases + 255) / 256);
    findings found;
    for (uint64_t n = 0; n < cases; ++n) {
        const uint64_t seed = case_seed(DIGEST_SEED, f, n);
        run_case(f, seed, placement_of(seed), &found);
    }
    std::printf("%s %" PRIu64 " %016" PRIx64 "\n", f.name, cases, found.digest());
}

// --- timed runs ----------------------------------------------------------------------------------

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
    for (const auto& [what, times] : run.found.counts()) {
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

// The line that ./dev differential puts into its table. Ends the program when a family ran no case.
void print_verdict(const std::vector<run_state>& runs) {
    uint64_t cases = 0;
    for (const run_state& run : runs) {
        if (run.cases == 0) {
            std::printf("no case of family %s was compared\n", run.f->name);
            std::exit(1);
        }
        cases += run.cases;
    }
    std::printf("0 differences in %" PRIu64 " %s of %zu %s\n", cases, cases == 1 ? "case" : "cases",
                runs.size(), runs.size() == 1 ? "family" : "families");
}

}  // namespace

int main(int count, char** arguments) {
    std::setvbuf(stdout, nullptr, _IOLBF, 0);
    const options o = read_options(count, arguments);
    std::vector<run_state> runs = chosen_families(o);
    if (o.digest_share > 0) {
        for (const run_state& run : runs) print_digest(*run.f, o.digest_share);
        return 0;
    }
    if (o.single) {
        run_case(&runs.front(), o.single_seed);
        print_seen(runs.front());
        print_verdict(runs);
        return 0;
    }

    // In rounds, so that every family gets its share and progress shows.
    std::printf("comparing with the models for %.0f seconds, seed %" PRIu64 "\n", o.seconds,
                o.seed);
    const int rounds = 4;
    double shares = 0;
    for (const run_state& run : runs) shares += run.f->share;
    for (int round = 1; round <= rounds; ++round) {
        for (run_state& run : runs) {
            run_for(&run, o, o.seconds / rounds * run.f->share / shares);
        }
        std::printf("round %d of %d: no difference so far\n", round, rounds);
    }
    for (run_state& run : runs) {
        while (run.cases < o.cases) run_for(&run, o, 1);
    }
    print_table(runs);
    print_verdict(runs);
}
