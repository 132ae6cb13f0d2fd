// A libFuzzer target: the fuzzer's bytes draw the cases of some families of the comparison with the
// slow models. An input in which library and model differ ends the program, and so does what
// AddressSanitizer and UndefinedBehaviorSanitizer object to.
//
// FUZZED_FAMILIES lists the families of this target; the first byte of an input chooses one.

#include <cstdio>
#include <cstdlib>
#include <string>

#include "tests/differential/family.h"

namespace {

std::vector<const family*> fuzzed_families() {
    std::vector<const family*> chosen;
    for (const char* const name : {FUZZED_FAMILIES}) {
        const size_t before = chosen.size();
        for (const auto* families :
             {&queue_families, &stroke_families, &region_families, &session_families,
              &rendering_families, &fixed_point_families}) {
            for (const family& f : *families) {
                if (f.name == std::string(name)) chosen.push_back(&f);
            }
        }
        if (chosen.size() == before) {
            std::fprintf(stderr, "there is no family %s; see fuzz/CMakeLists.txt\n", name);
            std::abort();
        }
    }
    return chosen;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* bytes, size_t count) {
    static const std::vector<const family*> families = fuzzed_families();
    random_source random(bytes, count);
    const int last = static_cast<int>(families.size()) - 1;
    const family& f = *families[static_cast<size_t>(random.between(0, last))];
    findings found;
    f.run(random, &found);
    if (!found.agree()) {
        std::fprintf(stderr, "DIFFERENCE in family %s:\n  %s\n", f.name,
                     found.first_difference().c_str());
        std::abort();
    }
    return 0;
}
