#include "tests/hostile/java_memory.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <type_traits>

namespace {

using thing = java_memory::thing;

// The JDK and Android name the function table's type differently.
using function_table = std::remove_const_t<std::remove_pointer_t<decltype(JNIEnv::functions)>>;

constexpr jint LONGEST_ARRAY = 1 << 16;

[[noreturn]] void fail(const char* what) {
    std::fprintf(stderr, "a native method %s\n", what);
    std::abort();
}

[[noreturn]] void not_allowed() { fail("calls a JNI function that it must not call"); }

thing* behind(jobject reference) {
    if (!reference) fail("hands null to the virtual machine");
    return reinterpret_cast<thing*>(reference);
}

// In the order of thing::fields; a field's id is the address of its name here.
const char* field_names[] = {"left", "right", "top", "bottom", "x", "y"};

jint* field_of(jobject object, jfieldID id) {
    return &behind(object)->fields[reinterpret_cast<const char**>(id) - field_names];
}

void* pin(jobject array) {
    ++behind(array)->pins;
    return behind(array)->elements;
}

void release(jobject array, const void* elements, jint mode) {
    if (elements != behind(array)->elements || mode != 0) fail("releases what it has not pinned");
    if (--behind(array)->pins < 0) fail("releases an array twice");
}

}  // namespace

struct java_memory::functions {
    static function_table table() {
        function_table t;
        void (*const none)() = not_allowed;
        for (size_t i = 0; i < sizeof t / sizeof none; ++i) {
            std::memcpy(reinterpret_cast<char*>(&t) + i * sizeof none, &none, sizeof none);
        }
        t.GetObjectClass = [](JNIEnv*, jobject object) -> jclass {
            behind(object);
            return static_cast<jclass>(object);
        };
        t.GetFieldID = [](JNIEnv*, jclass, const char* name, const char* type) -> jfieldID {
            for (const char*& field : field_names) {
                const bool found = std::strcmp(field, name) == 0 && std::strcmp(type, "I") == 0;
                if (found) return reinterpret_cast<jfieldID>(&field);
            }
            fail("asks for a field that is not there");
        };
        t.GetIntField = [](JNIEnv*, jobject o, jfieldID id) { return *field_of(o, id); };
        t.SetIntField = [](JNIEnv*, jobject o, jfieldID id, jint v) { *field_of(o, id) = v; };
        t.GetIntArrayElements = [](JNIEnv*, jintArray array, jboolean*) {
            return static_cast<jint*>(pin(array));
        };
        t.GetByteArrayElements = [](JNIEnv*, jbyteArray array, jboolean*) {
            return static_cast<jbyte*>(pin(array));
        };
        t.ReleaseIntArrayElements = [](JNIEnv*, jintArray array, jint* elements, jint mode) {
            release(array, elements, mode);
        };
        t.ReleaseByteArrayElements = [](JNIEnv*, jbyteArray array, jbyte* elements, jint mode) {
            release(array, elements, mode);
        };
        t.NewIntArray = [](JNIEnv* env, jsize length) -> jintArray {
            if (length < 0 || length > LONGEST_ARRAY) return nullptr;
            thing& array = static_cast<java_env*>(env)->memory->things.emplace_back();
            array.own.resize(static_cast<size_t>(length));
            array.elements = array.own.data();
            return reinterpret_cast<jintArray>(&array);
        };
        return t;
    }
};

java_memory::java_memory() {
    static const function_table table = functions::table();
    environment.functions = &table;
    environment.memory = this;
}

java_memory::~java_memory() {
    for (const thing& each : things) {
        if (each.pins != 0) fail("leaves an array pinned");
    }
}

jintArray java_memory::ints(std::vector<int>* elements, bool refused) {
    thing& array = things.emplace_back();
    if (!refused) array.elements = elements->data();
    return reinterpret_cast<jintArray>(&array);
}

jbyteArray java_memory::bytes(std::vector<unsigned char>* elements, bool refused) {
    thing& array = things.emplace_back();
    if (!refused) array.elements = elements->data();
    return reinterpret_cast<jbyteArray>(&array);
}

jobject java_memory::rect(const ze_rect& r) {
    thing& object = things.emplace_back();
    const jint sides[] = {r.left, r.right, r.top, r.bottom};
    std::memcpy(object.fields, sides, sizeof sides);
    return reinterpret_cast<jobject>(&object);
}

jobject java_memory::point(int x, int y) {
    thing& object = things.emplace_back();
    object.fields[4] = x;
    object.fields[5] = y;
    return reinterpret_cast<jobject>(&object);
}
