#include <cmath>
#include <limits>

#include "support/fixed_point.h"
#include "tests/differential/family.h"
#include "tests/reference/fixed_point_reference.h"

namespace {

int32_t random_fixed(random_source& random) {
    constexpr int32_t HIGHEST = std::numeric_limits<int32_t>::max();
    switch (random.between(0, 4)) {
        case 0:
            return random.between(-3, 3);
        case 1:
            return random.between(-0x20000, 0x20000);
        case 2:
            return random.any_of({HIGHEST, -HIGHEST, -HIGHEST - 1, 0x7FFF0000, 0x7FFF0001, 0x10000,
                                  -0x10000, 0x10001, -0x10001, 0x8000, 0x400000, 0x800000});
        case 3:
            return random.any_int() >> random.between(0, 31);
        default:
            return random.any_int();
    }
}

double random_double(random_source& random) {
    switch (random.between(0, 3)) {
        case 0:
            return random.any_of({0.0, -0.0, 0.5, -0.5, 32767.0, 32767.5, -32767.0, -32768.0, 2.5,
                                  -2.5, 2147483647.5, -2147483648.5, 1e300, -1e300, 1e-310,
                                  std::numeric_limits<double>::infinity(),
                                  -std::numeric_limits<double>::infinity(), std::nan("")});
        case 1: {
            const double near = random_fixed(random) / 65536.0;
            return near + random.between(-2, 2) / 131072.0;
        }
        default: {
            const double numerator = random.any_int();
            return numerator / random.between(1, 70000);
        }
    }
}

void run_fixed_point(random_source& random, findings* found) {
    static reference::fixed_point model;
    const int32_t x = random_fixed(random), y = random_fixed(random);
    const double d = random_double(random);
    g_fix_errno = model.g_fix_errno = random.any_of({0, 33, 34, 7});

    struct call {
        const char* name;
        int32_t (*library)(int32_t, int32_t, double);
        int32_t (*expected)(int32_t, int32_t, double);
    };
    using i = int32_t;
    static const call calls[] = {
        {"itofix", [](i a, i, double) { return itofix(a); },
         [](i a, i, double) { return model.itofix(a); }},
        {"fixtoi", [](i a, i, double) { return fixtoi(a); },
         [](i a, i, double) { return model.fixtoi(a); }},
        {"fixfloor", [](i a, i, double) { return fixfloor(a); },
         [](i a, i, double) { return model.fixfloor(a); }},
        {"fixceil", [](i a, i, double) { return fixceil(a); },
         [](i a, i, double) { return model.fixceil(a); }},
        {"ftofix", [](i, i, double f) { return ftofix(f); },
         [](i, i, double f) { return model.ftofix(f); }},
        {"fixadd", [](i a, i b, double) { return fixadd(a, b); },
         [](i a, i b, double) { return model.fixadd(a, b); }},
        {"fixsub", [](i a, i b, double) { return fixsub(a, b); },
         [](i a, i b, double) { return model.fixsub(a, b); }},
        {"fixmul", [](i a, i b, double) { return fixmul(a, b); },
         [](i a, i b, double) { return model.fixmul(a, b); }},
        {"fixdiv", [](i a, i b, double) { return fixdiv(a, b); },
         [](i a, i b, double) { return model.fixdiv(a, b); }},
        {"fixatan", [](i a, i, double) { return fixatan(a); },
         [](i a, i, double) { return model.fixatan(a); }},
        {"fixatan2", [](i a, i b, double) { return fixatan2(a, b); },
         [](i a, i b, double) { return model.fixatan2(a, b); }},
        {"fixcos", [](i a, i, double) { return fixcos(a); },
         [](i a, i, double) { return model.fixcos(a); }},
        {"fixsin", [](i a, i, double) { return fixsin(a); },
         [](i a, i, double) { return model.fixsin(a); }},
        {"fixtan", [](i a, i, double) { return fixtan(a); },
         [](i a, i, double) { return model.fixtan(a); }},
        {"fixacos", [](i a, i, double) { return fixacos(a); },
         [](i a, i, double) { return model.fixacos(a); }},
        {"fixasin", [](i a, i, double) { return fixasin(a); },
         [](i a, i, double) { return model.fixasin(a); }},
        {"isqrt_", [](i a, i, double) { return isqrt_(a & 0x7FFFFFFF); },
         [](i a, i, double) { return model.isqrt_(a & 0x7FFFFFFF); }},
        {"idiv", [](i a, i b, double) { return idiv(a, b); },
         [](i a, i b, double) { return model.idiv(a, b); }},
        {"iidiv", [](i a, i b, double) { return iidiv(a, b); },
         [](i a, i b, double) { return model.iidiv(a, b); }},
        {"round__", [](i, i, double f) { return round__(f); },
         [](i, i, double f) { return model.round_(f); }},
    };
    for (const call& c : calls) {
        found->compare(c.name, c.library(x, y, d), c.expected(x, y, d));
        found->compare("the error of the same call", g_fix_errno, model.g_fix_errno);
    }
    found->compare_doubles("fixtof", fixtof(x), model.fixtof(x));
}

void run_fixed_tables(random_source&, findings* found) {
    static const reference::fixed_point model;
    found->compare_arrays("_cos_tbl", _cos_tbl, model.cos_tbl);
    found->compare_arrays("_tan_tbl", _tan_tbl, model.tan_tbl);
    found->compare_arrays("_acos_tbl", _acos_tbl, model.acos_tbl);
    found->compare("radtofix_r", radtofix_r, model.radtofix_r);
    found->compare("fixtorad_r", fixtorad_r, model.fixtorad_r);
}

}  // namespace

const std::vector<family> fixed_point_families = {
    {"fixed-point", "every function of the fixed-point toolkit, each case", 1000000,
     run_fixed_point},
    {"fixed-tables", "its tables and constants", 16, run_fixed_tables},
};
