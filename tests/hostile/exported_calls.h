// Counts calls by the names of exports.txt.
//
//   CALLED(ze_free)(block)
//   CALLED_ON(engine, ER_selection, initial)(10, 1)
//   CALLED_UTIL(draw_1withmask)(env, nullptr, ...)
#pragma once

#include <string>

#include "jni/java_access.h"  // UTIL_METHOD

// Counts a call of a function, of Class::method, or of the native method behind UTIL_METHOD.
void count_call(const std::string& name);

#define CALLED(function) (count_call(#function), function)
#define CALLED_ON(object, type, method) (count_call(#type "::" #method), &(object))->method
#define CALLED_UTIL(method) (count_call(NAME_OF_UTIL(UTIL_METHOD(method))), UTIL_METHOD(method))
#define NAME_OF_UTIL(name) NAME_OF_EXPANDED(name)
#define NAME_OF_EXPANDED(name) #name

// An object whose constructor and destructor are counted.
template <class Object>
struct counted_life {
    explicit counted_life(const std::string& type) {
        count_call(type + "::" + type);
        count_call(type + "::~" + type);
    }
    Object object;
};

// Whether each name of exports.txt was called, or is no function. Says on stderr what was not, and
// on stdout how often the least called one was.
bool every_export_was_called();
