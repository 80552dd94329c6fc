// SPDX-License-Identifier: Apache-2.0
// Two DivX callbacks hand Java other argument types than their signatures
// declare. What Java receives is then what the calling convention makes of the
// words: here they are read as a virtual machine reads them, by signature,
// without following the references among them.

#include <stdarg.h>

#include <cstdint>
#include <string>
#include <vector>

#include "FakeJni/EnvSupport.h"
#include "JniFixture.h"
#include "jni/DivxNavigation.h"

namespace orvtest {
namespace {

using testing::ElementsAre;

// One argument of the Java method: its raw bits, a reference's as the handle.
using Arguments = std::vector<uint64_t>;

struct Capture {
    std::string parameters;  // a JNI letter each
    Arguments arguments;
};
Capture* gCapture;

void captureArguments(JNIEnv*, jobject, jmethodID, va_list list) {
    for (char type : gCapture->parameters) {
        uint64_t value;
        if (type == 'J') {
            value = static_cast<uint64_t>(va_arg(list, jlong));
        } else if (type == 'L') {
            value = reinterpret_cast<uintptr_t>(va_arg(list, jobject));
        } else {
            value = static_cast<uint32_t>(va_arg(list, jint));
        }
        gCapture->arguments.push_back(value);
    }
}

class VariadicCallbacksTest : public JniFixture {
protected:
    // What the one void call of deliver hands to the Java method of that
    // signature, which the player class gets.
    template <typename Deliver>
    Arguments capture(const std::string& method, const std::string& signature, Deliver deliver) {
        playerClass.method(method, signature);
        Capture capture{fakejni::shapeOf(signature).parameters, {}};
        gCapture = &capture;
        JNIEnv* env = vm.env();
        const JNINativeInterface* original = env->functions;
        JNINativeInterface table = *original;
        table.CallVoidMethodV = captureArguments;
        env->functions = &table;
        EXPECT_TRUE(deliver(env, vm.local(player)));
        env->functions = original;
        return capture.arguments;
    }
};

constexpr uint64_t low(uint64_t value) { return value & 0xFFFFFFFF; }

Arguments lowWords(Arguments arguments) {
    for (uint64_t& argument : arguments) argument = low(argument);
    return arguments;
}

TEST_F(VariadicCallbacksTest, DisplayInfoShiftsByOneAgainstItsSignature) {
    DivxDisplayInfo info;
    for (int i = 0; i < 6; ++i) info.mValues[i] = 101 + i;
    info.mValue7 = 107;
    clearText(info.mText1);
    clearText(info.mText2);
    info.mText1[0] = 'a';
    info.mText2[0] = 'b';
    jstring made[2] = {};
    const Arguments got =
        capture("setDivxDisplayInfoPrm", "(IIIIILjava/lang/String;ILjava/lang/String;I)V",
                [&](JNIEnv* env, jobject thiz) {
                    static jstring* next;
                    static jstring (*newString)(JNIEnv*, const jchar*, jsize);
                    next = made;
                    newString = env->functions->NewString;
                    auto* table = const_cast<JNINativeInterface*>(env->functions);
                    table->NewString = [](JNIEnv* e, const jchar* text, jsize length) {
                        return *next++ = newString(e, text, length);
                    };
                    return android::deliverDivxDisplayInfo(env, thiz, info);
                });
    const uint64_t text1 = reinterpret_cast<uintptr_t>(made[0]);
    const uint64_t text2 = reinterpret_cast<uintptr_t>(made[1]);
    ASSERT_NE(text1, 0u);
    ASSERT_NE(text2, 0u);
    // The sixth number arrives as the first string, text 1 as the number behind
    // it, the seventh number as the second string, text 2 as the last number.
    // Where pointers are wider than int, the rest of such a string's reference
    // is left open and a text's handle loses its high half.
    EXPECT_THAT(lowWords(got),
                ElementsAre(101, 102, 103, 104, 105, 106, low(text1), 107, low(text2)));
#ifdef __arm__
    EXPECT_EQ(got, lowWords(got));
#endif
}

// The seventeen words, each telling its place.
DivxLastMemoryFilePosition numberedPosition() {
    DivxLastMemoryFilePosition position;
    uint32_t words[17];
    for (uint32_t i = 0; i < 17; ++i) words[i] = 0xA0000001 + i;
    static_assert(sizeof(words) == sizeof(position));
    memcpy(&position, words, sizeof(words));
    return position;
}

TEST_F(VariadicCallbacksTest, LastMemoryLongsAreAssembledFromNeighbours) {
    const Arguments got = capture(
        "setDivxLastMemoryFilePositionPrm", "(JIIIIIJJJJJJIIJJI)V", [&](JNIEnv* env, jobject thiz) {
            return android::deliverDivxLastMemoryFilePosition(env, thiz, numberedPosition());
        });
    ASSERT_EQ(got.size(), 17u);
#if defined(__arm__)
    // The first word is alone in r3; a long begins at an even word, so the
    // first of them skips it and takes words 2 and 3. Five numbers follow, then
    // word 9 is skipped likewise. With word 17 the record ends: the last seven
    // parameters are whatever lies behind it on the stack.
    const Arguments known(got.begin(), got.begin() + 10);
    EXPECT_THAT(known, ElementsAre(0xA0000003A0000002, 0xA0000004, 0xA0000005, 0xA0000006,
                                   0xA0000007, 0xA0000008, 0xA000000BA000000A, 0xA000000DA000000C,
                                   0xA000000FA000000E, 0xA0000011A0000010));
#elif defined(__x86_64__)
    // Each word has a register or eight bytes of stack of its own: every
    // parameter gets its word. The high half of the longs is left open.
    EXPECT_THAT(lowWords(got),
                ElementsAre(0xA0000001, 0xA0000002, 0xA0000003, 0xA0000004, 0xA0000005, 0xA0000006,
                            0xA0000007, 0xA0000008, 0xA0000009, 0xA000000A, 0xA000000B, 0xA000000C,
                            0xA000000D, 0xA000000E, 0xA000000F, 0xA0000010, 0xA0000011));
#else
#error "say what this calling convention makes of the words"
#endif
}

}  // namespace
}  // namespace orvtest
