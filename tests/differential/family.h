// Families of random cases, each run through the library and through a slow model of it.
#pragma once

#include <cstdint>
#include <cstring>
#include <map>
#include <string>
#include <vector>

#include "selection/ze_rect.h"
#include "tests/differential/random_source.h"
#include "tests/reference/basics_reference.h"

// What a run of cases has found: the first difference between library and model, a digest of all
// that the library gave, and how often something worth counting came up.
class findings {
public:
    // Each takes the library's result into the digest and remembers the first that differs.
    void compare(const char* what, int64_t library, int64_t model) {
        digest_value(static_cast<uint64_t>(library));
        if (library != model) differs(what, std::to_string(library), std::to_string(model));
    }

    void compare_doubles(const char* what, double library, double model) {
        uint64_t library_bits, model_bits;
        std::memcpy(&library_bits, &library, sizeof library);
        std::memcpy(&model_bits, &model, sizeof model);
        digest_value(library_bits);
        if (library_bits != model_bits) {
            differs(what, std::to_string(library), std::to_string(model));
        }
    }

    void compare(const char* what, const ze_rect& library, const reference::rect& model) {
        const auto text = [](int left, int right, int top, int bottom) {
            return std::to_string(left) + ".." + std::to_string(right) + " x " +
                   std::to_string(top) + ".." + std::to_string(bottom);
        };
        for (const int side : {library.left, library.right, library.top, library.bottom}) {
            digest_value(static_cast<uint64_t>(int64_t{side}));
        }
        if (reference::rect{library.left, library.right, library.top, library.bottom} != model) {
            differs(what, text(library.left, library.right, library.top, library.bottom),
                    text(model.left, model.right, model.top, model.bottom));
        }
    }

    // Two arrays, of the model's length.
    template <class A, class B>
    void compare_arrays(const char* what, const A& library, const B& model) {
        for (size_t i = 0; i < model.size(); ++i) {
            digest_value(static_cast<uint64_t>(library[i]));
            if (library[i] == model[i]) continue;
            const std::string element = std::string(what) + "[" + std::to_string(i) + "]";
            differs(element.c_str(), std::to_string(library[i]), std::to_string(model[i]));
        }
    }

    bool agree() const { return difference.empty(); }
    const std::string& first_difference() const { return difference; }
    uint64_t digest() const { return mixed; }

    void count(const char* what) { ++counted[what]; }
    const std::map<std::string, uint64_t>& counts() const { return counted; }

private:
    // Every bit of a value reaches every later bit of the digest.
    void digest_value(uint64_t value) {
        mixed = (mixed ^ value) * 0x9E3779B97F4A7C15u;
        mixed ^= mixed >> 32;
    }

    void differs(const char* what, const std::string& library, const std::string& model) {
        if (agree()) difference = std::string(what) + " is " + library + ", the model has " + model;
    }

    std::string difference;
    uint64_t mixed = 0;
    std::map<std::string, uint64_t> counted;
};

struct family {
    const char* name;
    const char* what;

    uint64_t digest_cases;  // how many make the digest that is committed

    // Runs one case.
    void (*run)(random_source& random, findings* found);

    // Of a timed run's seconds, beside 1 for a family that finds most faults within few cases.
    double share = 1;
};

// The share of a family whose faults hide in rare cases: what a queue does with stale entries, and
// what one call leaves for the next.
constexpr double RARE_FAULTS = 5;

extern const std::vector<family> queue_families;
extern const std::vector<family> stroke_families;
extern const std::vector<family> region_families;
extern const std::vector<family> session_families;
extern const std::vector<family> rendering_families;
extern const std::vector<family> fixed_point_families;
