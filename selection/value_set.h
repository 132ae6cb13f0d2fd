// Sets of mask values.
#pragma once

class value_set {
public:
    template <class... Values>
    constexpr explicit value_set(Values... values) : bits((0u | ... | (1u << values))) {}

    constexpr bool has(unsigned char value) const { return value < 32 && (bits >> value & 1) != 0; }

private:
    unsigned bits;
};
