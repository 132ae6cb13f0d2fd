// Families of random cases, each run through the library and through a slow model of it.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "tests/differential/random_source.h"

// How often something worth counting came up (rings found in the queue, say).
using tally = std::map<std::string, uint64_t>;

struct family {
    const char* name;
    const char* what;

    // Runs one case. Returns "" when library and model agree, otherwise what differs.
    std::string (*run)(random_source& random, tally* seen);
};

extern const std::vector<family> queue_families;
extern const std::vector<family> stroke_families;
extern const std::vector<family> region_families;
extern const std::vector<family> session_families;
extern const std::vector<family> rendering_families;
extern const std::vector<family> fixed_point_families;

// Names the first element in which two equally long arrays differ; "" when they are equal.
template <class A, class B>
std::string first_difference(const char* what, const A& library, const B& model) {
    for (size_t i = 0; i < model.size(); ++i) {
        if (library[i] != model[i]) {
            return std::string(what) + "[" + std::to_string(i) + "] is " +
                   std::to_string(library[i]) + ", the model has " + std::to_string(model[i]);
        }
    }
    return "";
}
