#include "tests/helpers/recording_env.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <sstream>
#include <type_traits>

namespace {

// The JDK and Android name the function table's type differently.
using function_table = std::remove_const_t<std::remove_pointer_t<decltype(JNIEnv::functions)>>;

// Stands in the table for a function that the library must not call. SLOT is the number that JNI's
// documentation gives the function.
template <size_t SLOT>
[[noreturn]] void not_allowed_jni_function() {
    std::fprintf(stderr, "JNI function %zu is not allowed: not one of the nine that may be used\n",
                 SLOT);
    std::abort();
}

template <size_t... SLOTS>
function_table table_of_not_allowed(std::index_sequence<SLOTS...>) {
    void (*const functions[])() = {not_allowed_jni_function<SLOTS>...};
    function_table table;
    static_assert(sizeof functions == sizeof table, "a table of pointers and nothing else");
    std::memcpy(&table, functions, sizeof table);
    return table;
}

std::string name_of(jobject reference) {
    const java_thing* const thing = java_thing::behind<java_thing>(reference);
    return thing ? thing->name : "null";
}

std::string name_of(const jboolean* is_copy) { return is_copy ? "is-copy pointer" : "null"; }

}  // namespace

// The nine functions.
struct recorded_functions {
    static function_table table() {
        auto t = table_of_not_allowed(
            std::make_index_sequence<sizeof(function_table) / sizeof(void*)>());
        t.GetObjectClass = get_object_class;
        t.GetFieldID = get_field_id;
        t.GetIntField = get_int_field;
        t.SetIntField = set_int_field;
        t.GetIntArrayElements = get_int_array_elements;
        t.ReleaseIntArrayElements = release_int_array_elements;
        t.GetByteArrayElements = get_byte_array_elements;
        t.ReleaseByteArrayElements = release_byte_array_elements;
        t.NewIntArray = new_int_array;
        return t;
    }

private:
    static recording_env& recorder(JNIEnv* env) { return *static_cast<recording_env*>(env); }

    template <class First, class... Rest>
    static void record(JNIEnv* env, const char* function, const First& first, const Rest&... rest) {
        std::ostringstream line;
        line << function << '(' << first;
        ((line << ", " << rest), ...);
        line << ')';
        recorder(env).calls.push_back(line.str());
    }

    static jclass JNICALL get_object_class(JNIEnv* env, jobject object) {
        record(env, "GetObjectClass", name_of(object));
        if (!object) return recorder(env).null_object.its_class;
        fake_object* const fake = java_thing::behind<fake_object>(object);
        EXPECT_TRUE(fake) << name_of(object) << " is not an object with fields";
        return fake ? jclass(fake->its_class) : nullptr;
    }

    static jfieldID JNICALL get_field_id(JNIEnv* env, jclass of, const char* name,
                                         const char* signature) {
        record(env, "GetFieldID", name_of(of), name, signature);
        const auto* const fake_class = java_thing::behind<fake_object::class_of_object>(of);
        fake_object::int_field* const field =
            fake_class ? fake_class->object->field(name) : nullptr;
        EXPECT_TRUE(field && std::strcmp(signature, "I") == 0)
            << name_of(of) << " has no field " << name << " of type " << signature;
        return reinterpret_cast<jfieldID>(field);
    }

    // The field's value, or null if it is not one of the object.
    static jint* value_of(JNIEnv* env, jobject object, fake_object::int_field* field) {
        const fake_object* const fake =
            object ? java_thing::behind<fake_object>(object) : &recorder(env).null_object;
        const bool fits = field && fake && field->object == fake;
        EXPECT_TRUE(fits) << "not a field of " << name_of(object);
        return fits ? &field->value : nullptr;
    }

    static fake_object::int_field* field_behind(jfieldID id) {
        return reinterpret_cast<fake_object::int_field*>(id);
    }

    static jint JNICALL get_int_field(JNIEnv* env, jobject object, jfieldID id) {
        auto* const field = field_behind(id);
        record(env, "GetIntField", name_of(object), field ? field->name : "null");
        const jint* const value = value_of(env, object, field);
        return value ? *value : 0;
    }

    static void JNICALL set_int_field(JNIEnv* env, jobject object, jfieldID id, jint new_value) {
        auto* const field = field_behind(id);
        record(env, "SetIntField", name_of(object), field ? field->name : "null", new_value);
        if (jint* const value = value_of(env, object, field)) *value = new_value;
    }

    template <class Element, class Array>
    static Element* pin(JNIEnv* env, const char* function, Array array, jboolean* is_copy) {
        record(env, function, name_of(array), name_of(is_copy));
        const bool as_copy = recorder(env).access == array_access::copy;
        if (is_copy) *is_copy = as_copy;
        ++recorder(env).pin_count;
        auto* const fake = java_thing::behind<fake_array<Element, Array>>(array);
        EXPECT_TRUE(fake || !array) << name_of(array) << " is not an array of this type";
        return fake ? fake->pin(as_copy) : nullptr;
    }

    template <class Element, class Array>
    static void release(JNIEnv* env, const char* function, Array array, Element* elements,
                        jint mode) {
        auto* const fake = java_thing::behind<fake_array<Element, Array>>(array);
        const bool pinned = fake && fake->is_pinned(elements);
        record(env, function, name_of(array),
               pinned     ? "elements"
               : elements ? "what is not pinned"
                          : "null",
               mode);
        if (pinned) fake->release(elements, mode);
        if (pinned || (!array && !elements)) {
            ++recorder(env).release_count;
        } else {
            ADD_FAILURE() << "released what is not pinned of " << name_of(array);
        }
    }

    static jint* JNICALL get_int_array_elements(JNIEnv* env, jintArray array, jboolean* is_copy) {
        return pin<jint>(env, "GetIntArrayElements", array, is_copy);
    }

    static void JNICALL release_int_array_elements(JNIEnv* env, jintArray array, jint* elements,
                                                   jint mode) {
        release(env, "ReleaseIntArrayElements", array, elements, mode);
    }

    static jbyte* JNICALL get_byte_array_elements(JNIEnv* env, jbyteArray array,
                                                  jboolean* is_copy) {
        return pin<jbyte>(env, "GetByteArrayElements", array, is_copy);
    }

    static void JNICALL release_byte_array_elements(JNIEnv* env, jbyteArray array, jbyte* elements,
                                                    jint mode) {
        release(env, "ReleaseByteArrayElements", array, elements, mode);
    }

    static jintArray JNICALL new_int_array(JNIEnv* env, jsize length) {
        record(env, "NewIntArray", length);
        if (length < 0 || length > recording_env::LONGEST_ARRAY) return nullptr;
        auto& arrays = recorder(env).new_arrays;
        arrays.emplace_back("new array", std::vector<jint>(static_cast<size_t>(length)));
        return arrays.back();
    }
};

fake_object::fake_object(const std::string& object_name, std::vector<int_field> its_fields)
    : java_thing(object_name), its_class(this), fields(std::move(its_fields)) {
    for (int_field& f : fields) f.object = this;
}

fake_object::int_field* fake_object::field(const std::string& field_name) {
    const auto found = std::find_if(fields.begin(), fields.end(),
                                    [&](const int_field& f) { return f.name == field_name; });
    return found == fields.end() ? nullptr : &*found;
}

// The fields are listed in no particular order: neither the library nor a test goes by it.
fake_rect::fake_rect(const std::string& object_name, const ze_rect& r)
    : fake_object(object_name,
                  {{"bottom", r.bottom}, {"left", r.left}, {"right", r.right}, {"top", r.top}}) {}

ze_rect fake_rect::value() {
    return {field("left")->value, field("right")->value, field("top")->value,
            field("bottom")->value};
}

fake_point::fake_point(const std::string& object_name, jint x, jint y)
    : fake_object(object_name, {{"x", x}, {"y", y}}) {}

template <class Element>
guarded_elements<Element>::guarded_elements(const std::vector<Element>& values)
    : memory(values.size() + 2 * GUARD, GUARD_VALUE) {
    std::copy(values.begin(), values.end(), memory.begin() + GUARD);
}

template <class Element>
void guarded_elements<Element>::expect_intact_guards(const std::string& whose) const {
    const auto untouched = [](Element e) { return e == GUARD_VALUE; };
    EXPECT_TRUE(std::all_of(memory.begin(), memory.begin() + GUARD, untouched))
        << "written in front of the elements of " << whose;
    EXPECT_TRUE(std::all_of(memory.end() - GUARD, memory.end(), untouched))
        << "written behind the elements of " << whose;
}

template <class Element, class Array>
fake_array<Element, Array>::~fake_array() {
    EXPECT_EQ(direct_pins, 0) << name << " is still pinned";
    EXPECT_TRUE(copies.empty()) << name << " is still pinned";
    own.expect_intact_guards(name);
}

template <class Element, class Array>
Element* fake_array<Element, Array>::pin(bool as_copy) {
    if (as_copy) return copies.emplace_back(own.values()).data();
    ++direct_pins;
    return own.data();
}

template <class Element, class Array>
bool fake_array<Element, Array>::is_pinned(const Element* elements) const {
    if (direct_pins > 0 && elements == own.data()) return true;
    return std::any_of(copies.begin(), copies.end(),
                       [&](const auto& copy) { return copy.data() == elements; });
}

template <class Element, class Array>
void fake_array<Element, Array>::release(const Element* elements, jint mode) {
    EXPECT_TRUE(mode == 0 || mode == JNI_COMMIT || mode == JNI_ABORT) << "release mode " << mode;
    const bool frees = mode != JNI_COMMIT;
    const auto copy = std::find_if(copies.begin(), copies.end(),
                                   [&](const auto& c) { return c.data() == elements; });
    if (copy == copies.end()) {
        own.expect_intact_guards(name);
        if (frees) --direct_pins;
        return;
    }
    copy->expect_intact_guards("a copy of " + name);
    if (mode != JNI_ABORT) {
        const std::vector<Element> values = copy->values();
        std::copy(values.begin(), values.end(), own.data());
        ++copy_backs;
    }
    if (frees) copies.erase(copy);
}

template class guarded_elements<jint>;
template class guarded_elements<jbyte>;
template class fake_array<jint, jintArray>;
template class fake_array<jbyte, jbyteArray>;

recording_env::recording_env(array_access how)
    : access(how),
      null_object("null",
                  {{"left", 0}, {"right", 0}, {"top", 0}, {"bottom", 0}, {"x", 0}, {"y", 0}}) {
    static const function_table table = recorded_functions::table();
    functions = &table;
}

recording_env::~recording_env() {
    EXPECT_EQ(pin_count, release_count) << "every pinned array is released once";
}

std::vector<std::string> recording_env::take_calls() {
    std::vector<std::string> taken;
    taken.swap(calls);
    return taken;
}
