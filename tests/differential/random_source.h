// Random numbers that are the same on every machine: a case is replayed from its seed alone, or
// from the bytes that stand in for it. For that, draw no two numbers in the arguments of one call
// or around one operator, whose order C++ leaves open; in braces it is fixed.
#pragma once

#include <cstddef>
#include <cstdint>
#include <initializer_list>

class random_source {
public:
    explicit random_source(uint64_t seed) : state(seed) {}

    // Draws from bytes that somebody else chose, a fuzzer mostly: each draw takes as many as it
    // needs, and once they are used up all draws are 0. The bytes must outlive the source.
    random_source(const uint8_t* bytes, size_t count) : next(bytes), end(bytes + count) {}

    // SplitMix64 (Steele, Lea, Flood: Fast Splittable Pseudorandom Number Generators, 2014).
    uint64_t bits() {
        if (next) return take(UINT64_MAX);
        uint64_t z = state += 0x9E3779B97F4A7C15u;
        z = (z ^ z >> 30) * 0xBF58476D1CE4E5B9u;
        z = (z ^ z >> 27) * 0x94D049BB133111EBu;
        return z ^ z >> 31;
    }

    // first .. last, both included.
    int between(int first, int last) {
        const auto span = static_cast<uint64_t>(int64_t{last} - first) + 1;
        const uint64_t drawn = next ? take(span - 1) : bits();
        return static_cast<int>(first + static_cast<int64_t>(drawn % span));
    }

    // One in n.
    bool one_in(int n) { return between(1, n) == 1; }

    // 1 .. most, small values more often: uniform below a bound that is itself random.
    int size_up_to(int most) { return between(1, between(1, between(1, most))); }

    template <class T>
    T any_of(std::initializer_list<T> values) {
        return values.begin()[static_cast<size_t>(between(0, static_cast<int>(values.size()) - 1))];
    }

    int any_int() {
        return static_cast<int>(static_cast<uint32_t>(next ? take(UINT32_MAX) : bits()));
    }

private:
    // As many bytes as a number up to `highest` has.
    uint64_t take(uint64_t highest) {
        uint64_t taken = 0;
        for (; highest > 0; highest >>= 8) taken = taken << 8 | (next < end ? *next++ : 0u);
        return taken;
    }

    uint64_t state = 0;
    const uint8_t* next = nullptr;  // null: drawn from `state`
    const uint8_t* end = nullptr;
};
