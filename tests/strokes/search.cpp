// Finds strokes that come out otherwise in another copy of the library. See search.py, which builds
// the copies.
//
//   search find LIBRARY DEVIANT VERSION FILE SECONDS SEED NAME
//                       searches random cases and such like the file's, prints one as simple as it
//                       can be made
//   search simplify LIBRARY DEVIANT VERSION FILE
//                       prints the file's cases that come out otherwise, as simple as they can be
//                       made
//   search check LIBRARY DEVIANT VERSION FILE
//                       prints the names of the file's cases that come out otherwise
//
// LIBRARY and DEVIANT are shared objects with stroke_engine.h's functions; VERSION is `library` or
// `plain`. What is pinned of a find comes from LIBRARY's plain version. Exits with 1 when there was
// nothing to print, with 2 when something else is wrong.

#include <dlfcn.h>
#include <sys/mman.h>
#include <sys/time.h>
#include <sys/wait.h>
#include <unistd.h>

#include <atomic>
#include <chrono>
#include <cinttypes>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <new>
#include <stdexcept>
#include <string>
#include <vector>

#include "tests/strokes/random_cases.h"
#include "tests/strokes/simplify.h"
#include "tests/strokes/stroke_cases.h"

namespace {

using new_engine = stroke_engine* (*)(int radius, int core);

// A deviant may loop for ever or touch what is not there. So it runs in a process of its own, with
// so many microseconds of the processor for a case.
constexpr int TIME_PER_CASE = 100'000;

// What the processes share.
struct progress {
    std::atomic<uint64_t> seed;
    std::atomic<bool> found;
};

void limit_time() {
    const itimerval limit = {{0, 0}, {0, TIME_PER_CASE}};
    setitimer(ITIMER_PROF, &limit, nullptr);
}

[[noreturn]] void refuse(const std::string& why) {
    std::fprintf(stderr, "search: %s\n", why.c_str());
    std::exit(2);
}

class comparison {
public:
    comparison(const char* library, const char* deviant, const std::string& version) {
        if (version != "library" && version != "plain") refuse("no version " + version);
        const std::string name = "new_" + version + "_engine";
        expected = function(library, name);
        actual = function(deviant, name);
        definition = function(library, "new_plain_engine");
    }

    // Compares in this process, which has to be one of its own: the deviant may end it.
    bool differ(const stroke_case& c) const { return !(play(expected, c) == play(actual, c)); }

    // Compares in a process of its own. One that ends otherwise than it should differs.
    bool differ_safely(const stroke_case& c) const {
        const pid_t child = fork();
        if (child < 0) refuse("fork failed");
        if (child == 0) {
            limit_time();
            _exit(differ(c) ? 1 : 0);
        }
        int status = 0;
        waitpid(child, &status, 0);
        return !WIFEXITED(status) || WEXITSTATUS(status) != 0;
    }

    // Pins what the strokes come to.
    void pin(stroke_case* c) const {
        c->expected.clear();
        for (const stroke_outcome& o : play(definition, *c)) {
            c->expected.push_back({o.mask, o.rect, o.nodes});
        }
    }

private:
    static new_engine function(const char* file, const std::string& name) {
        void* const library = dlopen(file, RTLD_NOW | RTLD_LOCAL);
        if (!library) refuse(dlerror());
        void* const address = dlsym(library, name.c_str());
        if (!address) refuse(dlerror());
        return reinterpret_cast<new_engine>(address);
    }

    new_engine expected;
    new_engine actual;
    new_engine definition;
};

// Searches in a process of its own. Returns true when the case of p->seed differs.
bool search(const comparison& compared, const std::vector<stroke_case>& known, progress* p,
            double seconds) {
    using steady = std::chrono::steady_clock;
    const auto end = steady::now() + std::chrono::duration<double>(seconds);
    const pid_t child = fork();
    if (child < 0) refuse("fork failed");
    if (child == 0) {
        for (; steady::now() < end; ++p->seed) {
            limit_time();
            if (compared.differ(random_case(p->seed, known))) {
                p->found = true;
                break;
            }
        }
        _exit(0);
    }
    int status = 0;
    waitpid(child, &status, 0);
    return p->found || !WIFEXITED(status);
}

std::vector<stroke_case> cases_of(const char* file) {
    std::ifstream in(file);
    if (!in) refuse(std::string("cannot read ") + file);
    return read_cases(in);
}

void print_simplified(const comparison& compared, stroke_case c) {
    c = simplified(c, [&](const stroke_case& simpler) { return compared.differ_safely(simpler); });
    compared.pin(&c);
    write_case(std::cout, c);
}

int find(const comparison& compared, const std::vector<stroke_case>& known, double seconds,
         uint64_t seed, const std::string& name) {
    void* const shared =
        mmap(nullptr, sizeof(progress), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    if (shared == MAP_FAILED) refuse("no shared memory");
    auto* const p = new (shared) progress;
    const uint64_t first = seed << 32;
    p->seed = first;
    p->found = false;
    if (!search(compared, known, p, seconds)) {
        std::fprintf(stderr, "%s: none of %" PRIu64 " cases differs\n", name.c_str(),
                     p->seed - first);
        return 1;
    }
    std::fprintf(stderr, "%s: case %" PRIu64 " differs\n", name.c_str(), p->seed - first + 1);
    stroke_case c = random_case(p->seed, known);
    if (!compared.differ_safely(c)) refuse("a find cannot be repeated");
    c.name = name;
    print_simplified(compared, c);
    return 0;
}

int simplify(const comparison& compared, const std::vector<stroke_case>& cases) {
    bool any = false;
    for (const stroke_case& c : cases) {
        if (!compared.differ_safely(c)) continue;
        print_simplified(compared, c);
        any = true;
    }
    return any ? 0 : 1;
}

int check(const comparison& compared, const std::vector<stroke_case>& cases) {
    bool any = false;
    for (const stroke_case& c : cases) {
        if (!compared.differ_safely(c)) continue;
        std::printf("%s\n", c.name.c_str());
        any = true;
    }
    return any ? 0 : 1;
}

}  // namespace

int main(int count, char** arguments) {
    try {
        const std::string command = count > 1 ? arguments[1] : "";
        if (command == "find" && count == 9) {
            return find({arguments[2], arguments[3], arguments[4]}, cases_of(arguments[5]),
                        std::atof(arguments[6]), std::strtoull(arguments[7], nullptr, 0),
                        arguments[8]);
        }
        if (command == "simplify" && count == 6) {
            return simplify({arguments[2], arguments[3], arguments[4]}, cases_of(arguments[5]));
        }
        if (command == "check" && count == 6) {
            return check({arguments[2], arguments[3], arguments[4]}, cases_of(arguments[5]));
        }
    } catch (const std::exception& e) {
        refuse(e.what());
    }
    refuse(
        "find LIBRARY DEVIANT VERSION FILE SECONDS SEED NAME\n"
        "        simplify LIBRARY DEVIANT VERSION FILE\n"
        "        check LIBRARY DEVIANT VERSION FILE");
}
