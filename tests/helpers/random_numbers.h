// Random numbers that are the same on every machine and from every C++ library.
#pragma once

#include <random>

class random_numbers {
public:
    explicit random_numbers(unsigned seed) : numbers(seed) {}

    // low to high, both included.
    int between(int low, int high) {
        return low + static_cast<int>(numbers() % static_cast<unsigned>(high - low + 1));
    }
    bool one_in(int n) { return between(1, n) == 1; }

private:
    std::mt19937 numbers;
};
