// Java arrays and objects as the native methods use them.
//
// The sequence of JNI calls is part of what callers rely on: nothing is cached, no is-copy flag is
// asked for, neither results nor pending exceptions are checked, and no class reference is deleted.
#pragma once

#include <jni.h>

#include <cstdint>

#include "selection/ze_rect.h"

// Name under which class Util finds the native method `name`, in which _ is written _1.
#define UTIL_METHOD(name) Java_com_velt_android_orvane_lumetrix_jni_Util_##name

// A pinned array, released with copy-back (mode 0) even when it was only read: by release(), or
// when it goes out of scope, in the reverse order of pinning.
template <class Array, class Element, Element* (JNIEnv::*GET)(Array, jboolean*),
          void (JNIEnv::*RELEASE)(Array, Element*, jint)>
class pinned_array {
public:
    pinned_array(JNIEnv* e, Array a) : env(e), array(a), data((e->*GET)(a, nullptr)) {}
    ~pinned_array() { release(); }
    pinned_array(const pinned_array&) = delete;
    pinned_array& operator=(const pinned_array&) = delete;

    void release() {
        if (held) (env->*RELEASE)(array, data, 0);
        held = false;
    }

    Element* elements() const { return data; }

private:
    JNIEnv* const env;
    const Array array;
    Element* const data;
    bool held = true;
};

// Pixels 0xAARRGGBB.
class pinned_ints : public pinned_array<jintArray, jint, &JNIEnv::GetIntArrayElements,
                                        &JNIEnv::ReleaseIntArrayElements> {
public:
    using pinned_array::pinned_array;
    uint32_t* pixels() const { return reinterpret_cast<uint32_t*>(elements()); }
};

// A selection mask.
class pinned_bytes : public pinned_array<jbyteArray, jbyte, &JNIEnv::GetByteArrayElements,
                                         &JNIEnv::ReleaseByteArrayElements> {
public:
    using pinned_array::pinned_array;
    unsigned char* bytes() const { return reinterpret_cast<unsigned char*>(elements()); }
};

// The int field `name` of objects of class `of`.
inline jfieldID int_field(JNIEnv* env, jclass of, const char* name) {
    return env->GetFieldID(of, name, "I");
}

// An android.graphics.Rect, or any object with int fields left, right, top, bottom.
class java_rect {
public:
    java_rect(JNIEnv* e, jobject o) : java_rect(e, o, e->GetObjectClass(o)) {}

    ze_rect read() const {
        return {env->GetIntField(object, left), env->GetIntField(object, right),
                env->GetIntField(object, top), env->GetIntField(object, bottom)};
    }

    void write(const ze_rect& r) const {
        env->SetIntField(object, left, r.left);
        env->SetIntField(object, right, r.right);
        env->SetIntField(object, top, r.top);
        env->SetIntField(object, bottom, r.bottom);
    }

private:
    java_rect(JNIEnv* e, jobject o, jclass c)
        : env(e),
          object(o),
          left(int_field(e, c, "left")),
          right(int_field(e, c, "right")),
          top(int_field(e, c, "top")),
          bottom(int_field(e, c, "bottom")) {}

    JNIEnv* const env;
    const jobject object;
    const jfieldID left;
    const jfieldID right;
    const jfieldID top;
    const jfieldID bottom;
};

struct point {
    int x;
    int y;
};

// Reads an android.graphics.Point, or any object with int fields x and y.
inline point read_point(JNIEnv* env, jobject object) {
    const jclass of = env->GetObjectClass(object);
    const jfieldID x = int_field(env, of, "x");
    const jfieldID y = int_field(env, of, "y");
    return {env->GetIntField(object, x), env->GetIntField(object, y)};
}
