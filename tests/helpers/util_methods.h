// The native methods of class Util, as the virtual machine calls them: UTIL_METHOD(name)(env, ...).
// None uses the second argument, the class.
#pragma once

#include <jni.h>

#include "jni/java_access.h"  // UTIL_METHOD

// METHOD(result, name, arguments...) for each of them.
#define UTIL_METHODS(METHOD)                                                                      \
    METHOD(jint, init_1objectsel, JNIEnv*, jobject, jint width, jint height)                      \
    METHOD(void, modify_1objectsel, JNIEnv*, jobject, jintArray pixels, jbyteArray mask,          \
           jint width, jint height, jobject p1, jobject p2, jint mode, jobject rect, jint fill)   \
    METHOD(void, destroy_1objectsel, JNIEnv*, jobject)                                            \
    METHOD(void, inverse_1objectsel, JNIEnv*, jobject, jbyteArray mask, jint width, jint height)  \
    METHOD(void, reset_1objectsel, JNIEnv*, jobject, jbyteArray mask, jint width, jint height)    \
    METHOD(void, set_1brush_1size, JNIEnv*, jobject, jint radius, jint center)                    \
    METHOD(void, draw_1withmask, JNIEnv*, jobject, jintArray src, jintArray dst, jbyteArray mask, \
           jint width, jobject roi)                                                               \
    METHOD(void, draw_1reversemask, JNIEnv*, jobject, jintArray src, jintArray dst,               \
           jbyteArray mask, jint width, jint height)                                              \
    METHOD(void, get_1objectROI, JNIEnv*, jobject, jobject roi)                                   \
    METHOD(void, set_1objectROI, JNIEnv*, jobject, jobject roi)                                   \
    METHOD(jint, get_1brush_1radius, JNIEnv*, jobject)                                            \
    METHOD(jint, get_1brush_1center, JNIEnv*, jobject)                                            \
    METHOD(void, reset_1fill_1ROI, JNIEnv*, jobject, jint width, jint height)                     \
    METHOD(void, reinit_1objectsel, JNIEnv*, jobject, jbyteArray mask, jint width, jint height,   \
           jobject roi)                                                                           \
    METHOD(void, update_1objectROI, JNIEnv*, jobject, jbyteArray mask, jint width, jint height)   \
    METHOD(jintArray, nativeIntAlloc, JNIEnv*, jobject, jint length)                              \
    METHOD(jint, nativeIntRelease, JNIEnv*, jobject, jintArray array)                             \
    METHOD(void, native_1setImagePoints, JNIEnv*, jobject, jint columns, jint rows, jint, jint,   \
           jfloat scale, jint offset_x, jint offset_y, jintArray points)                          \
    METHOD(jint, native_1drawImage___3III_3IIIFIILandroid_graphics_Rect_2, JNIEnv*, jobject,      \
           jintArray view, jint view_width, jint view_height, jintArray photo, jint photo_width,  \
           jint photo_height, jfloat scale, jint offset_x, jint offset_y, jobject rect)           \
    METHOD(jint, native_1drawSmallImage, JNIEnv*, jobject, jintArray view, jint view_width,       \
           jint view_height, jintArray photo, jint photo_width, jint photo_height, jobject rect)  \
    METHOD(jint, native_1drawImageWithMaskContour, JNIEnv*, jobject, jintArray view,              \
           jint view_width, jint view_height, jintArray photo, jint photo_width,                  \
           jint photo_height, jbyteArray mask, jfloat scale, jint offset_x, jint offset_y,        \
           jint first_colour, jint second_colour, jobject rect)                                   \
    METHOD(jint, native_1drawSmallImageWithMaskContour, JNIEnv*, jobject, jintArray view,         \
           jint view_width, jint view_height, jintArray photo, jint photo_width,                  \
           jint photo_height, jbyteArray mask, jint first_colour, jint second_colour,             \
           jobject rect)

#define DECLARE_UTIL_METHOD(result, name, ...) \
    extern "C" JNIEXPORT result JNICALL UTIL_METHOD(name)(__VA_ARGS__);
UTIL_METHODS(DECLARE_UTIL_METHOD)
#undef DECLARE_UTIL_METHOD
