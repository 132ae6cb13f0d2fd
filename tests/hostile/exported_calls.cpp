#include "tests/hostile/exported_calls.h"

#include <cctype>
#include <cinttypes>
#include <cstdio>
#include <map>
#include <set>
#include <string>

namespace {

const char* const exported_names[] = {
#include "exported_names.inc"
};

// Names that cannot be called.
const std::set<std::string> variables = {
    "_acos_tbl",       "_cos_tbl",          "_tan_tbl",   "fixtorad_r",
    "g_Brush_Center",  "g_Brush_Radius",    "g_ERBrush",  "g_fix_errno",
    "g_fill_boundary", "g_object_boundary", "radtofix_r",
};

std::map<std::string, uint64_t> counts;

// Takes a length and as many characters, as mangled names have them.
std::string take_word(const std::string& mangled, size_t* at) {
    size_t length = 0;
    while (std::isdigit(static_cast<unsigned char>(mangled[*at]))) {
        length = 10 * length + static_cast<size_t>(mangled[(*at)++] - '0');
    }
    std::string word = mangled.substr(*at, length);
    *at += length;
    return word;
}

// Class::method of a method's mangled name; any other name as it is.
std::string readable(const std::string& name) {
    if (name.compare(0, 3, "_ZN") != 0) return name;
    size_t at = 3;
    const std::string type = take_word(name, &at);
    if (name[at] == 'C') return type + "::" + type;
    if (name[at] == 'D') return type + "::~" + type;
    return type + "::" + take_word(name, &at);
}

}  // namespace

void count_call(const std::string& name) { ++counts[name]; }

bool every_export_was_called() {
    bool complete = true;
    std::set<std::string> functions, unseen_variables = variables;
    for (const std::string exported : exported_names) {
        if (unseen_variables.erase(exported) == 0) functions.insert(readable(exported));
    }
    for (const std::string& name : unseen_variables) {
        std::fprintf(stderr, "%s is listed as a variable and not exported\n", name.c_str());
        complete = false;
    }
    for (const auto& [name, count] : counts) {
        if (functions.count(name) > 0) continue;
        std::fprintf(stderr, "%s was called and is no exported function\n", name.c_str());
        complete = false;
    }
    std::string rarest;
    for (const std::string& name : functions) {
        if (rarest.empty() || counts[name] < counts[rarest]) rarest = name;
        if (counts[name] > 0) continue;
        std::fprintf(stderr, "%s is exported and was not called\n", name.c_str());
        complete = false;
    }
    std::printf("%zu exported functions called, %s %" PRIu64 " times, the others more often\n",
                functions.size(), rarest.c_str(), counts[rarest]);
    return complete;
}
