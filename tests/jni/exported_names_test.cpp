// That the methods which the tests of this folder call are those that the library exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "tests/helpers/util_methods.h"

namespace {

#define TO_TEXT(name) #name
#define NAME_AS_TEXT(name) TO_TEXT(name)
#define METHOD_NAME(result, name, ...) NAME_AS_TEXT(UTIL_METHOD(name)),

const std::vector<std::string> METHOD_NAMES = {UTIL_METHODS(METHOD_NAME)};

// The Java_... names of exports.txt, in the root of the sources.
std::vector<std::string> exported_method_names() {
    const auto root = std::filesystem::path(__FILE__).parent_path().parent_path().parent_path();
    std::ifstream exports(root / "exports.txt");
    std::vector<std::string> names;
    for (std::string line; std::getline(exports, line);) {
        if (line.rfind("Java_", 0) == 0) names.push_back(line);
    }
    return names;
}

}  // namespace

TEST(exported_names, AreTheMethodsOfUtilAndNoOthers) {
    EXPECT_THAT(METHOD_NAMES, testing::SizeIs(22));
    EXPECT_THAT(METHOD_NAMES, testing::UnorderedElementsAreArray(exported_method_names()));
}

// Deliberate: of the one method with its arguments in its name there is no short name.
TEST(exported_names, HoldDrawImageUnderItsLongNameOnly) {
    const std::string short_name =
        "Java_com_velt_android_orvane_lumetrix_jni_Util_native_1drawImage";
    EXPECT_THAT(exported_method_names(),
                testing::Contains(short_name + "___3III_3IIIFIILandroid_graphics_Rect_2"));
    EXPECT_THAT(exported_method_names(), testing::Not(testing::Contains(short_name)));
}
