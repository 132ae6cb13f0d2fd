// Java objects and arrays for native methods, and a JNIEnv that knows the nine functions that may
// be called. Arrays are pinned in place, without anything around them, so that AddressSanitizer
// sees the first access beyond; or their pins are refused, as a virtual machine without memory does
// it. Whatever no correct caller does ends the program.
#pragma once

#include <jni.h>

#include <list>
#include <vector>

#include "selection/ze_rect.h"

class java_memory {
public:
    java_memory();
    ~java_memory();
    java_memory(const java_memory&) = delete;
    java_memory& operator=(const java_memory&) = delete;

    JNIEnv* env() { return &environment; }

    // Arrays over these elements, which must stay. A refused one pins as null.
    jintArray ints(std::vector<int>* elements, bool refused);
    jbyteArray bytes(std::vector<unsigned char>* elements, bool refused);

    jobject rect(const ze_rect& r);
    jobject point(int x, int y);

    struct thing {
        void* elements = nullptr;
        int pins = 0;
        jint fields[6] = {};  // left, right, top, bottom, x, y
        std::vector<int> own;
    };

private:
    struct functions;
    struct java_env : JNIEnv {
        java_memory* memory;
    };

    java_env environment;
    std::list<thing> things;
};
