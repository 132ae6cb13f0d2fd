// That the recording JNIEnv sees what native methods must not do.

#include "tests/helpers/recording_env.h"

#include <gmock/gmock.h>
#include <gtest/gtest-spi.h>
#include <gtest/gtest.h>

#include <memory>
#include <vector>

using testing::ElementsAre;

TEST(recording_env, EndsTheProgramAtAnyOtherFunction) {
    recording_env env;
    fake_ints array("array", {1});
    EXPECT_DEATH(env.ExceptionCheck(), "not.allowed");
    EXPECT_DEATH(env.GetArrayLength(array), "not.allowed");
    EXPECT_DEATH(env.DeleteLocalRef(array), "not.allowed");
    EXPECT_DEATH(env.GetPrimitiveArrayCritical(array, nullptr), "not.allowed");
}

TEST(recording_env, ShowsIsCopyPointersAndReleaseModes) {
    recording_env env;
    fake_ints array("array", {1, 2, 3});
    jboolean is_copy = JNI_TRUE;

    jint* const elements = env.GetIntArrayElements(array, &is_copy);
    env.ReleaseIntArrayElements(array, elements, JNI_ABORT);

    EXPECT_EQ(is_copy, JNI_FALSE);
    EXPECT_THAT(env.take_calls(), ElementsAre("GetIntArrayElements(array, is-copy pointer)",
                                              "ReleaseIntArrayElements(array, elements, 2)"));
}

TEST(recording_env, RefusesASecondReleaseAndStrangeElements) {
    for (const array_access access : {array_access::direct, array_access::copy}) {
        recording_env env(access);
        fake_ints array("array", {1, 2, 3}), other("other", {1, 2, 3});
        jint* const elements = env.GetIntArrayElements(array, nullptr);
        EXPECT_NONFATAL_FAILURE(env.ReleaseIntArrayElements(other, elements, 0), "not pinned");
        env.ReleaseIntArrayElements(array, elements, 0);
        env.take_calls();

        EXPECT_NONFATAL_FAILURE(env.ReleaseIntArrayElements(array, elements, 0), "not pinned");

        EXPECT_THAT(env.take_calls(),
                    ElementsAre("ReleaseIntArrayElements(array, what is not pinned, 0)"));
        EXPECT_EQ(env.pins(), 1);
        EXPECT_EQ(env.releases(), 1);
    }
}

TEST(recording_env, MissesAReleaseAtItsEndAndAtTheArrays) {
    for (const array_access access : {array_access::direct, array_access::copy}) {
        auto env = std::make_unique<recording_env>(access);
        auto array = std::make_unique<fake_bytes>("array", std::vector<jbyte>{1});
        env->GetByteArrayElements(*array, nullptr);
        EXPECT_NONFATAL_FAILURE(env.reset(), "every pinned array is released once");
        EXPECT_NONFATAL_FAILURE(array.reset(), "array is still pinned");
    }
}

TEST(recording_env, SeesWritesBesideTheElements) {
    const auto release_after_write_at = [](array_access access, int index) {
        recording_env env(access);
        fake_bytes array("array", {1, 2, 3});
        jbyte* const elements = env.GetByteArrayElements(array, nullptr);
        const jbyte before = elements[index];
        elements[index] = 0;
        env.ReleaseByteArrayElements(array, elements, 0);
        if (access == array_access::direct) elements[index] = before;  // spares the array's own end
    };
    EXPECT_NONFATAL_FAILURE(release_after_write_at(array_access::direct, -1), "in front of");
    EXPECT_NONFATAL_FAILURE(release_after_write_at(array_access::direct, 3), "behind");
    EXPECT_NONFATAL_FAILURE(release_after_write_at(array_access::copy, -1), "in front of");
    EXPECT_NONFATAL_FAILURE(release_after_write_at(array_access::copy, 3), "behind");
}

TEST(recording_env, RefusesFieldsThatAreNotThereOrOfOtherObjects) {
    recording_env env;
    fake_point a("a", 1, 2), b("b", 3, 4);
    const jclass type = env.GetObjectClass(a);
    const jfieldID x = env.GetFieldID(type, "x", "I");

    EXPECT_EQ(env.GetIntField(a, x), 1);
    EXPECT_NONFATAL_FAILURE(env.GetFieldID(type, "left", "I"), "no field left");
    EXPECT_NONFATAL_FAILURE(env.GetFieldID(type, "x", "J"), "no field x of type J");
    EXPECT_NONFATAL_FAILURE(env.GetIntField(b, x), "not a field of b");
    EXPECT_NONFATAL_FAILURE(env.SetIntField(b, x, 5), "not a field of b");
}

TEST(recording_env, CopiesBackOnReleaseUnlessTheModeIsAbort) {
    recording_env env(array_access::copy);
    fake_bytes array("array", {1, 2, 3});

    jbyte* elements = env.GetByteArrayElements(array, nullptr);
    elements[0] = 7;
    EXPECT_THAT(array.elements(), ElementsAre(1, 2, 3));
    env.ReleaseByteArrayElements(array, elements, 0);
    EXPECT_THAT(array.elements(), ElementsAre(7, 2, 3));

    elements = env.GetByteArrayElements(array, nullptr);
    elements[1] = 8;
    env.ReleaseByteArrayElements(array, elements, JNI_ABORT);
    EXPECT_THAT(array.elements(), ElementsAre(7, 2, 3));
    EXPECT_EQ(array.times_copied_back(), 1);
}
