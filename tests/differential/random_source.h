// Random numbers that are the same on every machine: a case is replayed from its seed alone. For
// that, draw no two numbers in the arguments of one call or around one operator, whose order C++
// leaves open; in braces it is fixed.
#pragma once

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <vector>

class random_source {
public:
    explicit random_source(uint64_t seed) : state(seed) {}

    // SplitMix64 (Steele, Lea, Flood: Fast Splittable Pseudorandom Number Generators, 2014).
    uint64_t bits() {
        uint64_t z = state += 0x9E3779B97F4A7C15u;
        z = (z ^ z >> 30) * 0xBF58476D1CE4E5B9u;
        z = (z ^ z >> 27) * 0x94D049BB133111EBu;
        return z ^ z >> 31;
    }

    // first .. last, both included.
    int between(int first, int last) {
        const auto span = static_cast<uint64_t>(int64_t{last} - first) + 1;
        return static_cast<int>(first + static_cast<int64_t>(bits() % span));
    }

    // One in n.
    bool one_in(int n) { return between(1, n) == 1; }

    // 1 .. most, small values more often: uniform below a bound that is itself random.
    int size_up_to(int most) { return between(1, between(1, between(1, most))); }

    template <class T>
    T any_of(std::initializer_list<T> values) {
        return values.begin()[static_cast<size_t>(between(0, static_cast<int>(values.size()) - 1))];
    }

    int any_int() { return static_cast<int>(static_cast<uint32_t>(bits())); }

private:
    uint64_t state;
};
