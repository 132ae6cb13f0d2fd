#include "support/ze_alloc.h"

#include <gtest/gtest.h>
#include <malloc.h>

#include <cstdint>
#include <string>

#include "tests/helpers/failing_allocations.h"

TEST(ze_calloc, ZeroesCountTimesSizeBytes) {
    unsigned char* const block = static_cast<unsigned char*>(ze_calloc(300, 7));
    ASSERT_NE(block, nullptr);
    EXPECT_GE(malloc_usable_size(block), 2100u);
    for (int i = 0; i < 2100; ++i) ASSERT_EQ(block[i], 0) << "byte " << i;
    ze_free(block);
}

TEST(ze_calloc, PassesAFailureOn) {
    failing_allocations out_of_memory(1);
    EXPECT_EQ(ze_calloc(1, 1), nullptr);
}

TEST(ze_malloc, TakesTheProductOfItsArguments) {
    void* const block = ze_malloc(300, 7);
    ASSERT_NE(block, nullptr);
    EXPECT_GE(malloc_usable_size(block), 2100u);
    EXPECT_LT(malloc_usable_size(block), 4200u);
    ze_free(block);
}

TEST(ze_malloc, LetsTheProductWrap) {
    void* const block = ze_malloc(SIZE_MAX / 2 + 1, 2);  // 0 bytes
    EXPECT_NE(block, nullptr);
    ze_free(block);
}

TEST(ze_memset, SetsExactlyTheBytesAskedFor) {
    std::string text = "abcdef";
    EXPECT_EQ(ze_memset(&text[1], 0x100 + 'x', 3), &text[1]);  // the low byte counts
    EXPECT_EQ(text, "axxxef");
}

TEST(ze_memcpy, CopiesExactlyTheBytesAskedFor) {
    std::string text = "abcdef";
    EXPECT_EQ(ze_memcpy(&text[2], "XYZ", 2), &text[2]);
    EXPECT_EQ(text, "abXYef");
}

TEST(ze_realloc, GrowsABlockAndKeepsItsContents) {
    char* block = static_cast<char*>(ze_realloc(nullptr, 4));
    ASSERT_NE(block, nullptr);
    ze_memcpy(block, "key", 4);
    block = static_cast<char*>(ze_realloc(block, 5000));
    ASSERT_NE(block, nullptr);
    EXPECT_GE(malloc_usable_size(block), 5000u);
    EXPECT_STREQ(block, "key");
    ze_free(block);
}

TEST(ze_free, TakesNull) { ze_free(nullptr); }
