// Native methods of class Util that draw into the view; Util.java documents them. Each reads the
// rectangle, pins, draws, and releases in the order of pinning.

#include "jni/java_access.h"
#include "jni/view_image.h"
#include "jni/view_outline.h"

namespace {

view_pixels view_of(const pinned_ints& view, int width) { return {view.elements(), width}; }

photo_pixels photo_of(const pinned_ints& photo, int width, int height) {
    return {photo.elements(), width, height};
}

}  // namespace

extern "C" {

JNIEXPORT void JNICALL UTIL_METHOD(native_1setImagePoints)(JNIEnv* env, jobject, jint columns,
                                                           jint rows, jint, jint, jfloat scale,
                                                           jint offset_x, jint offset_y,
                                                           jintArray points) {
    const pinned_ints p(env, points);
    set_image_points(columns, rows, scale, offset_x, offset_y, p.elements());
}

// Deliberate: the one method with its arguments in its name, and no short name beside it.
JNIEXPORT jint JNICALL UTIL_METHOD(native_1drawImage___3III_3IIIFIILandroid_graphics_Rect_2)(
    JNIEnv* env, jobject, jintArray view, jint view_width, jint, jintArray photo, jint photo_width,
    jint photo_height, jfloat scale, jint offset_x, jint offset_y, jobject rect) {
    const ze_rect area = java_rect(env, rect).read();
    pinned_ints v(env, view), p(env, photo);
    draw_image(view_of(v, view_width), photo_of(p, photo_width, photo_height), scale, offset_x,
               offset_y, area);
    v.release();
    p.release();
    return 1;
}

JNIEXPORT jint JNICALL UTIL_METHOD(native_1drawSmallImage)(JNIEnv* env, jobject, jintArray view,
                                                           jint view_width, jint, jintArray photo,
                                                           jint photo_width, jint photo_height,
                                                           jobject rect) {
    const ze_rect area = java_rect(env, rect).read();
    pinned_ints v(env, view), p(env, photo);
    draw_small_image(view_of(v, view_width), photo_of(p, photo_width, photo_height), area);
    v.release();
    p.release();
    return 1;
}

JNIEXPORT jint JNICALL UTIL_METHOD(native_1drawImageWithMaskContour)(
    JNIEnv* env, jobject, jintArray view, jint view_width, jint, jintArray photo, jint photo_width,
    jint photo_height, jbyteArray mask, jfloat scale, jint offset_x, jint offset_y,
    jint first_colour, jint second_colour, jobject rect) {
    const ze_rect area = java_rect(env, rect).read();
    pinned_ints v(env, view), p(env, photo);
    pinned_bytes m(env, mask);
    draw_image_with_outline(view_of(v, view_width),
                            {photo_of(p, photo_width, photo_height), m.bytes()}, scale, offset_x,
                            offset_y, {first_colour, second_colour}, area);
    v.release();
    p.release();
    m.release();
    return 1;
}

JNIEXPORT jint JNICALL UTIL_METHOD(native_1drawSmallImageWithMaskContour)(
    JNIEnv* env, jobject, jintArray view, jint view_width, jint, jintArray photo, jint photo_width,
    jint photo_height, jbyteArray mask, jint first_colour, jint second_colour, jobject rect) {
    const ze_rect area = java_rect(env, rect).read();
    pinned_ints v(env, view), p(env, photo);
    pinned_bytes m(env, mask);
    draw_small_image_with_outline(view_of(v, view_width),
                                  {photo_of(p, photo_width, photo_height), m.bytes()},
                                  {first_colour, second_colour}, area);
    v.release();
    p.release();
    m.release();
    return 1;
}

}  // extern "C"
