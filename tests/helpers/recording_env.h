// A JNIEnv that records every call, and the Java objects that it knows.
//
// Only the nine JNI functions that the library may call are there; any other ends the program with
// a message. Each call becomes one line, in which objects go by the names that the test gave them:
//
//   GetObjectClass(roi)                    GetFieldID(class of roi, left, I)
//   GetIntField(roi, left)                 SetIntField(roi, left, 3)
//   GetIntArrayElements(view, null)        ReleaseIntArrayElements(view, elements, 0)
//   GetByteArrayElements(mask, null)       ReleaseByteArrayElements(mask, elements, 0)
//   NewIntArray(5)
//
// The null behind a pinned array is the is-copy pointer; the number behind released elements is the
// release mode. A null reference goes by the name null: as an array it pins as a null pointer, as
// an object it has every field.
//
// What no correct caller does fails the test: releasing what is not pinned, leaving an array
// pinned, writing in front of or behind an array's elements, asking for a field that is not there,
// using the field of one object on another.
//
// The test owns the objects and arrays that it makes; a recording_env owns those of NewIntArray.
#pragma once

#include <jni.h>

#include <list>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "selection/ze_rect.h"

// What a Java reference points to.
class java_thing {
public:
    explicit java_thing(std::string n) : name(std::move(n)) {}
    virtual ~java_thing() = default;
    java_thing(const java_thing&) = delete;
    java_thing& operator=(const java_thing&) = delete;

    // The thing behind a reference, if it is a Thing; otherwise, and for null, null.
    template <class Thing>
    static Thing* behind(jobject reference) {
        return dynamic_cast<Thing*>(reinterpret_cast<java_thing*>(reference));
    }

    const std::string name;

protected:
    template <class Reference>
    Reference reference() {
        return reinterpret_cast<Reference>(this);
    }
};

// An object with int fields.
class fake_object : public java_thing {
public:
    struct int_field {
        std::string name;
        jint value;
        const fake_object* object = nullptr;
    };

    class class_of_object : public java_thing {
    public:
        explicit class_of_object(fake_object* o) : java_thing("class of " + o->name), object(o) {}
        operator jclass() { return reference<jclass>(); }
        fake_object* const object;
    };

    fake_object(const std::string& object_name, std::vector<int_field> its_fields);

    operator jobject() { return reference<jobject>(); }

    // The field of a name, or null.
    int_field* field(const std::string& field_name);

    class_of_object its_class;

private:
    std::vector<int_field> fields;  // never resized: a jfieldID points to an element
};

// An android.graphics.Rect.
class fake_rect : public fake_object {
public:
    fake_rect(const std::string& object_name, const ze_rect& r);
    ze_rect value();
};

// An android.graphics.Point.
class fake_point : public fake_object {
public:
    fake_point(const std::string& object_name, jint x, jint y);
};

// Elements between two guards.
template <class Element>
class guarded_elements {
public:
    explicit guarded_elements(const std::vector<Element>& values);

    Element* data() { return memory.data() + GUARD; }
    const Element* data() const { return memory.data() + GUARD; }
    std::vector<Element> values() const { return {memory.begin() + GUARD, memory.end() - GUARD}; }

    // Fails the test if a guard was overwritten; `whose` names the array.
    void expect_intact_guards(const std::string& whose) const;

private:
    static constexpr int GUARD = 64;  // elements: beyond any row of a test's picture
    static constexpr Element GUARD_VALUE = 0x5B;

    std::vector<Element> memory;
};

// An int[] or byte[].
template <class Element, class Array>
class fake_array : public java_thing {
public:
    // From any container of numbers, or from {a, b, c}.
    template <class Values = std::vector<Element>>
    fake_array(const std::string& array_name, const Values& values)
        : java_thing(array_name), own(std::vector<Element>(values.begin(), values.end())) {}
    ~fake_array() override;

    operator Array() { return reference<Array>(); }

    // The elements as Java sees them: what was done to a copy shows once it is copied back.
    template <class Number = Element>
    std::vector<Number> elements() const {
        const std::vector<Element> values = own.values();
        return {values.begin(), values.end()};
    }

    // How many copies were copied back.
    int times_copied_back() const { return copy_backs; }

    // The elements to work on: a copy, or the array's own.
    Element* pin(bool as_copy);

    bool is_pinned(const Element* elements) const;

    // Ends a pin, or with mode JNI_COMMIT only copies back. REQUIRES: is_pinned(elements).
    void release(const Element* elements, jint mode);

private:
    guarded_elements<Element> own;
    int direct_pins = 0;
    std::list<guarded_elements<Element>> copies;  // those that are pinned
    int copy_backs = 0;
};

using fake_ints = fake_array<jint, jintArray>;
using fake_bytes = fake_array<jbyte, jbyteArray>;

// What a virtual machine hands out for an array: its own memory, or a copy.
enum class array_access { direct, copy };

inline std::ostream& operator<<(std::ostream& out, array_access access) {
    return out << (access == array_access::direct ? "direct" : "copy");
}

class recording_env : public JNIEnv {
public:
    explicit recording_env(array_access = array_access::direct);
    ~recording_env();
    recording_env(const recording_env&) = delete;
    recording_env& operator=(const recording_env&) = delete;

    // The calls since the last time.
    std::vector<std::string> take_calls();

    int pins() const { return pin_count; }
    int releases() const { return release_count; }

    // NewIntArray refuses lengths below 0 and above this.
    static constexpr jint LONGEST_ARRAY = 1 << 16;

private:
    friend struct recorded_functions;

    const array_access access;
    std::vector<std::string> calls;
    int pin_count = 0;
    int release_count = 0;
    fake_object null_object;
    std::list<fake_ints> new_arrays;
};
