// Slow, literal model of the 16.16 fixed-point toolkit. The library is compared with it.
//
// Exact results are computed in 64 bits and then judged or wrapped; the tables come from their
// formulas, the square root from a search. One object is one toolkit with tables and an error cell
// of its own. Members have the names of the library's functions and variables without their
// leading underscore; round_ is its round__.

#pragma once

#include <cstdint>
#include <vector>

namespace reference {

class fixed_point {
public:
    // Fills the tables and clears the error cell.
    fixed_point();

    // The functions read the tables as they stand, so a changed entry changes them too.
    std::vector<int32_t> cos_tbl;   // 512 entries
    std::vector<int32_t> tan_tbl;   // 256
    std::vector<int32_t> acos_tbl;  // 513
    int32_t radtofix_r;
    int32_t fixtorad_r;

    // 34 after an overflow or a division by zero, 33 after an argument outside the domain. Only
    // fixatan2 ever clears it.
    int32_t g_fix_errno = 0;

    int32_t itofix(int32_t x);
    int32_t fixtoi(int32_t x);
    int32_t fixfloor(int32_t x);
    int32_t fixceil(int32_t x);
    int32_t ftofix(double x);
    double fixtof(int32_t x);

    int32_t fixadd(int32_t x, int32_t y);
    int32_t fixsub(int32_t x, int32_t y);
    int32_t fixmul(int32_t x, int32_t y);
    int32_t fixdiv(int32_t x, int32_t y);

    int32_t fixatan(int32_t x);
    int32_t fixatan2(int32_t y, int32_t x);
    int32_t fixcos(int32_t x);
    int32_t fixsin(int32_t x);
    int32_t fixtan(int32_t x);
    int32_t fixacos(int32_t x);
    int32_t fixasin(int32_t x);

    // Throws std::domain_error below 0, where the library promises no result.
    int32_t isqrt_(int32_t x);
    int32_t idiv(int32_t x, int32_t y);
    int32_t iidiv(int32_t x, int32_t y);
    int32_t round_(double x);
};

}  // namespace reference
