// Native methods of class Util for selecting, compositing and int buffers; Util.java documents
// them. Each pins, reads, makes one call, writes and releases. Three of them check their arguments.

#include "jni/java_access.h"
#include "render/compositing.h"
#include "selection/objectsel.h"
#include "support/log.h"

namespace {

// Says in the log that a call was refused.
void log_rejection() {
    __android_log_print(ANDROID_LOG_INFO, LOG_TAG, "Invalid Input Parameters\n");
}

}  // namespace

extern "C" {

JNIEXPORT jint JNICALL UTIL_METHOD(init_1objectsel)(JNIEnv*, jobject, jint width, jint height) {
    if (width <= 0 || height <= 0) {
        log_rejection();
        return 0;
    }
    return ze_init_objectsel(width, height);
}

JNIEXPORT void JNICALL UTIL_METHOD(modify_1objectsel)(JNIEnv* env, jobject, jintArray pixels,
                                                      jbyteArray mask, jint width, jint height,
                                                      jobject p1, jobject p2, jint mode,
                                                      jobject rect, jint fill) {
    const pinned_ints photo(env, pixels);
    const pinned_bytes selection(env, mask);
    const point a = read_point(env, p1);
    const point b = read_point(env, p2);
    const java_rect target(env, rect);
    ze_rect changed = target.read();  // Deliberate: read, and overwritten by the stroke
    ze_modify_objectsel(photo.elements(), selection.bytes(), width, height, a.x, a.y, b.x, b.y,
                        mode, &changed, fill);
    target.write(changed);
}  // releases mask, then pixels

JNIEXPORT void JNICALL UTIL_METHOD(destroy_1objectsel)(JNIEnv*, jobject) { ze_destroy_objectsel(); }

JNIEXPORT void JNICALL UTIL_METHOD(inverse_1objectsel)(JNIEnv* env, jobject, jbyteArray mask,
                                                       jint width, jint height) {
    if (!mask || width <= 0 || height <= 0) return log_rejection();
    const pinned_bytes selection(env, mask);
    ze_inverse_mask(selection.bytes(), width, height);
}

JNIEXPORT void JNICALL UTIL_METHOD(reset_1objectsel)(JNIEnv* env, jobject, jbyteArray mask,
                                                     jint width, jint height) {
    if (!mask || width <= 0 || height <= 0) return log_rejection();
    const pinned_bytes selection(env, mask);
    ze_reset_objectsel(selection.bytes(), width, height);
}

JNIEXPORT void JNICALL UTIL_METHOD(set_1brush_1size)(JNIEnv*, jobject, jint radius, jint center) {
    ze_set_brush_size(radius, center);
}

JNIEXPORT void JNICALL UTIL_METHOD(draw_1withmask)(JNIEnv* env, jobject, jintArray src,
                                                   jintArray dst, jbyteArray mask, jint width,
                                                   jobject roi) {
    pinned_ints s(env, src), d(env, dst);
    pinned_bytes m(env, mask);
    const ze_rect r = java_rect(env, roi).read();
    ze_draw_withmask(s.pixels(), d.pixels(), m.bytes(), width, r.left, r.right, r.top, r.bottom);
    s.release();  // in pin order; left to the destructors it would be reversed
    d.release();
    m.release();
}

JNIEXPORT void JNICALL UTIL_METHOD(draw_1reversemask)(JNIEnv* env, jobject, jintArray src,
                                                      jintArray dst, jbyteArray mask, jint width,
                                                      jint height) {
    pinned_ints s(env, src), d(env, dst);
    pinned_bytes m(env, mask);
    ze_draw_reverse_mask(s.pixels(), d.pixels(), m.bytes(), width, height);
    s.release();
    d.release();
    m.release();
}

JNIEXPORT void JNICALL UTIL_METHOD(get_1objectROI)(JNIEnv* env, jobject, jobject roi) {
    java_rect(env, roi).write(ze_get_objectROI());
}

JNIEXPORT void JNICALL UTIL_METHOD(set_1objectROI)(JNIEnv* env, jobject, jobject roi) {
    ze_set_objectROI(java_rect(env, roi).read());
}

JNIEXPORT jint JNICALL UTIL_METHOD(get_1brush_1radius)(JNIEnv*, jobject) {
    return ze_get_brush_radius();
}

JNIEXPORT jint JNICALL UTIL_METHOD(get_1brush_1center)(JNIEnv*, jobject) {
    return ze_get_brush_center();
}

JNIEXPORT void JNICALL UTIL_METHOD(reset_1fill_1ROI)(JNIEnv*, jobject, jint width, jint height) {
    ze_reset_fill_boundary(width, height);
}

JNIEXPORT void JNICALL UTIL_METHOD(reinit_1objectsel)(JNIEnv* env, jobject, jbyteArray mask,
                                                      jint width, jint height, jobject roi) {
    const ze_rect r = java_rect(env, roi).read();
    const pinned_bytes selection(env, mask);
    ze_reinit_objectsel(selection.bytes(), width, height, r);
}

JNIEXPORT void JNICALL UTIL_METHOD(update_1objectROI)(JNIEnv* env, jobject, jbyteArray mask,
                                                      jint width, jint height) {
    const pinned_bytes selection(env, mask);
    ze_update_objectROI(selection.bytes(), width, height);
}

JNIEXPORT jintArray JNICALL UTIL_METHOD(nativeIntAlloc)(JNIEnv* env, jobject, jint length) {
    return env->NewIntArray(length);
}

JNIEXPORT jint JNICALL UTIL_METHOD(nativeIntRelease)(JNIEnv* env, jobject, jintArray array) {
    // Deliberate: the pin and its release are all there is; the virtual machine owns the array.
    if (array) pinned_ints(env, array);
    return 0;
}

}  // extern "C"
