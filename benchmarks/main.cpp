// Times the library's hot paths. report.py calls this once for each job; by hand:
//
//   benchmarks --photo=FILE --list
//   benchmarks --photo=FILE --job=NAME [Google Benchmark's options]
//
// Ours is compared with the plain version first; a difference ends the program with 1.

#include <benchmark/benchmark.h>
#include <malloc.h>
#include <time.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <string>

#include "benchmarks/inputs.h"
#include "benchmarks/job.h"

namespace {

// A run of this many seconds is timed once: the one that was compared.
constexpr double SLOW = 0.4;

// Processor time of this thread: what others do on the machine does not count.
double seconds() {
    timespec t = {};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &t);
    return static_cast<double>(t.tv_sec) + static_cast<double>(t.tv_nsec) * 1e-9;
}

template <class Run>
double seconds_with_clock(Run run) {
    const double start = seconds();
    run();
    return seconds() - start;
}

// Without what looking at the clock takes, which matters to the shortest runs.
template <class Run>
double seconds_of(Run run) {
    static const double clock = [] {
        double least = 1;
        for (int i = 0; i < 1000; ++i) least = std::min(least, seconds_with_clock([] {}));
        return least;
    }();
    return std::max(seconds_with_clock(run) - clock, 0.0);
}

void call(const std::function<void()>& f) {
    if (f) f();
}

using snapshot = std::vector<std::vector<unsigned char>>;

snapshot copy_of(const std::vector<result_part>& parts) {
    snapshot copies;
    for (const result_part& part : parts) {
        const auto* const from = static_cast<const unsigned char*>(part.data);
        copies.emplace_back(from, from + part.count * part.size);
    }
    return copies;
}

// Whoever does not write a result must not find that of the one before.
void spoil(const std::vector<result_part>& parts) {
    for (const result_part& part : parts) std::memset(part.data, 0xA5, part.count * part.size);
}

// Share of a part's elements that differ.
double difference(const result_part& part, const std::vector<unsigned char>& expected) {
    const auto* const actual = static_cast<const unsigned char*>(part.data);
    size_t differing = 0;
    for (size_t i = 0; i < expected.size(); i += part.size) {
        differing += std::memcmp(actual + i, &expected[i], part.size) != 0;
    }
    return static_cast<double>(differing) / static_cast<double>(part.count);
}

// What the one run for comparison found.
struct finding {
    double seconds;
    double difference;  // from plain, below 0 when not compared
};

finding try_out(const job& j, const variant& v, const snapshot& expected) {
    spoil(j.results);
    call(j.reset);
    call(v.reset);
    const double time = seconds_of(v.run);
    if (!v.compared || expected.empty()) return {time, -1};
    call(v.finish);
    return {time, difference(j.results[0], expected[0])};
}

bool equals(const job& j, const snapshot& expected) {
    for (size_t i = 0; i < expected.size(); ++i) {
        const double share = difference(j.results[i], expected[i]);
        if (share == 0) continue;
        std::fprintf(stderr, "ours differs from plain in part %zu of the result, %.3g %%\n", i,
                     100 * share);
        return false;
    }
    return true;
}

void measure(const job& j, const variant& v, const std::string& name, const finding& found) {
    const bool slow = found.seconds >= SLOW;
    auto* const registered =
        benchmark::RegisterBenchmark(name.c_str(), [&j, &v, found, slow](benchmark::State& state) {
            call(j.reset);
            call(v.reset);
            for (auto _ : state) {
                if (slow) {
                    state.SetIterationTime(found.seconds);
                } else if (j.reset_before_each_run) {
                    call(j.reset);
                    call(v.reset);
                    state.SetIterationTime(seconds_of(v.run));
                } else {
                    v.run();
                    benchmark::ClobberMemory();
                }
            }
            if (found.difference >= 0) state.counters["differs"] = found.difference;
            if (j.cells > 0) state.counters["cells"] = j.cells;
        });
    if (slow) registered->Iterations(1)->Repetitions(1);
    if (slow || j.reset_before_each_run) registered->UseManualTime();
}

// False when ours is wrong.
bool run_job(const named_job& named) {
    const job j = named.make();
    if (!j.omitted.empty()) {
        benchmark::RegisterBenchmark((named.name + "/ours").c_str(), [&j](benchmark::State& state) {
            state.SkipWithError(j.omitted.c_str());
        });
        benchmark::RunSpecifiedBenchmarks();
        return true;
    }
    snapshot expected;
    std::vector<finding> found(j.variants.size());
    // Plain first: it is what the others are compared with.
    for (const bool plain : {true, false}) {
        for (size_t i = 0; i < j.variants.size(); ++i) {
            const variant& v = j.variants[i];
            if ((v.name == "plain") != plain) continue;
            found[i] = try_out(j, v, expected);
            if (plain) expected = copy_of(j.results);
            if (v.name == "ours" && !equals(j, expected)) {
                std::fprintf(stderr, "benchmarks: '%s' gives a wrong result\n", named.name.c_str());
                return false;
            }
        }
    }
    for (size_t i = 0; i < j.variants.size(); ++i) {
        measure(j, j.variants[i], named.name + "/" + j.variants[i].name, found[i]);
    }
    benchmark::RunSpecifiedBenchmarks();
    benchmark::ClearRegisteredBenchmarks();
    return true;
}

// The rest of the argument if it starts with `option`, otherwise null.
const char* value_of(const char* argument, const char* option) {
    const size_t length = std::strlen(option);
    return std::strncmp(argument, option, length) == 0 ? argument + length : nullptr;
}

}  // namespace

int main(int argc, char** argv) {
    // Large blocks are used again instead of going back to the system after each run. Whether they
    // do otherwise depends on what was freed before.
    mallopt(M_MMAP_MAX, 0);
    mallopt(M_TRIM_THRESHOLD, 1 << 30);

    job_list jobs;
    list_compositing_jobs(&jobs);
    list_view_jobs(&jobs);
    list_region_jobs(&jobs);
    list_lasso_jobs(&jobs);
    list_object_box_jobs(&jobs);
    list_mask_transfer_jobs(&jobs);
    list_stroke_jobs(&jobs);

    benchmark::Initialize(&argc, argv);
    std::string photo_path, wanted;
    bool list = false;
    for (int i = 1; i < argc; ++i) {
        if (const char* path = value_of(argv[i], "--photo=")) {
            photo_path = path;
        } else if (const char* name = value_of(argv[i], "--job=")) {
            wanted = name;
        } else if (std::strcmp(argv[i], "--list") == 0) {
            list = true;
        } else {
            std::fprintf(stderr, "benchmarks: unknown option '%s'\n", argv[i]);
            return 2;
        }
    }
    if (list) {
        for (const named_job& named : jobs) std::puts(named.name.c_str());
        return 0;
    }
    if (!read_photo(photo_path)) {
        std::fprintf(stderr, "benchmarks: --photo='%s' is not the photo that report.py makes\n",
                     photo_path.c_str());
        return 2;
    }
    for (const named_job& named : jobs) {
        if (named.name != wanted) continue;
        return run_job(named) ? 0 : 1;
    }
    std::fprintf(stderr, "benchmarks: no job '%s'; --list shows them\n", wanted.c_str());
    return 2;
}
