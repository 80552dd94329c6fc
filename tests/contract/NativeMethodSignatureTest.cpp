// SPDX-License-Identifier: Apache-2.0
// What the table's check at compile time takes and what it refuses. That it is asked,
// and what the compiler then says, is seen by mismatched_row.cpp.
#include <gtest/gtest.h>
#include <jni/NativeMethodSignature.h>

namespace android {
namespace {

TEST(NativeMethodSignatureTest, APrefixIsOneWithAllItsCharacters) {
    EXPECT_TRUE(isPrefix("", ""));
    EXPECT_TRUE(isPrefix("", "a"));
    EXPECT_TRUE(isPrefix("ab", "ab"));
    EXPECT_TRUE(isPrefix("ab", "abc"));
    EXPECT_FALSE(isPrefix("ab", "a"));
    EXPECT_FALSE(isPrefix("ab", "ba"));
    EXPECT_FALSE(isPrefix("ab", "ac"));
    EXPECT_FALSE(isPrefix("a", ""));
}

TEST(NativeMethodSignatureTest, WhatIsSkippedIsOneObjectType) {
    EXPECT_STREQ(skipObject("La/B;"), "");
    EXPECT_STREQ(skipObject("La/B;I"), "I");
    EXPECT_STREQ(skipObject("La/B;Lc/D;"), "Lc/D;") << "up to the first end";
    EXPECT_EQ(skipObject("La/B"), nullptr) << "without its end";
    EXPECT_EQ(skipObject("I"), nullptr);
    EXPECT_EQ(skipObject(""), nullptr);
    EXPECT_EQ(skipObject("XLa/B;"), nullptr);
}

TEST(NativeMethodSignatureTest, WhatIsBehindAPrefixIsReturned) {
    EXPECT_STREQ(skipPrefix("(", "(I)V"), "I)V");
    EXPECT_STREQ(skipPrefix("", "I"), "I");
    EXPECT_STREQ(skipPrefix("[B", "[B"), "");
    EXPECT_EQ(skipPrefix("[B", "[I"), nullptr);
}

template <typename Result, typename... Arguments>
bool matches(const char* descriptor) {
    return NativeMethodSignature<Result (*)(JNIEnv*, jobject, Arguments...)>::matches(descriptor);
}

TEST(NativeMethodSignatureTest, EveryTypeHasItsDescriptorAlone) {
    const char* const descriptors[] = {
        "()V", "()Z", "()I", "()J", "()F", "()Ljava/lang/String;", "()[B", "()[La/B;", "()La/B;"};
    bool (*const types[])(const char*) = {
        matches<void>,       matches<jboolean>,     matches<jint>,
        matches<jlong>,      matches<jfloat>,       matches<jstring>,
        matches<jbyteArray>, matches<jobjectArray>, matches<jobject>};
    for (size_t type = 0; type < std::size(types); type++) {
        for (size_t one = 0; one < std::size(descriptors); one++) {
            EXPECT_EQ(types[type](descriptors[one]), type == one) << type << descriptors[one];
        }
    }
}

TEST(NativeMethodSignatureTest, EveryPlaceCounts) {
    EXPECT_TRUE((matches<void, jint, jlong>("(IJ)V")));
    EXPECT_TRUE((matches<jint, jstring, jobject>("(Ljava/lang/String;La/B;)I")));
    EXPECT_FALSE((matches<void, jint, jlong>("(JI)V"))) << "another order";
    EXPECT_FALSE((matches<void, jint, jlong>("(I)V"))) << "one too few";
    EXPECT_FALSE((matches<void, jint, jlong>("(IJJ)V"))) << "one too many";
    EXPECT_FALSE((matches<void, jint>("(I)I"))) << "another result";
    EXPECT_FALSE((matches<void, jint>("(I)"))) << "no result";
    EXPECT_FALSE((matches<void, jint>("(I)VV"))) << "something behind it";
    EXPECT_FALSE((matches<void, jint>("I)V"))) << "not opened";
    EXPECT_FALSE((matches<void, jint>("(IV"))) << "not closed";
    EXPECT_FALSE((matches<void>("")));
}

}  // namespace
}  // namespace android
