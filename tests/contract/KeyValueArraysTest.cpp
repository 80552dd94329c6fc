// SPDX-License-Identifier: Apache-2.0
#include "JniFixture.h"
#include "jni/KeyValueArrays.h"

namespace orvtest {
namespace {

using android::KeyedVector;
using android::String8;
using fakejni::NativeResult;
using fakejni::ObjectPtr;
using fakejni::Value;

constexpr char kUtilsTag[] = "Customer_media_Utils";

class KeyValueArraysTest : public JniFixture {
protected:
    Outcome convert(jobjectArray keys, jobjectArray values) {
        return observe("ConvertKeyValueArraysToKeyedVector", [&] {
            const bool good =
                android::ConvertKeyValueArraysToKeyedVector(vm.env(), keys, values, &pairs);
            return NativeResult{Value::ofBoolean(good), 0};
        });
    }
    std::string text() const {
        std::string all;
        for (size_t i = 0; i < pairs.size(); ++i)
            all += std::string(pairs.keyAt(i).c_str()) + "=" + pairs.valueAt(i).c_str() + ";";
        return all;
    }

    KeyedVector<String8, String8> pairs;
};

TEST_F(KeyValueArraysTest, PairsAreAddedInOrderAndLaterKeysReplace) {
    EXPECT_THAT(convert(strings({"b", "a", "b"}), strings({"1", "2", "3"})), Returns("true"));
    EXPECT_EQ(text(), "a=2;b=3;");
}

TEST_F(KeyValueArraysTest, NothingIsClearedBeforehand) {
    pairs.add(String8("x"), String8("0"));
    convert(strings({"a"}), strings({"1"}));
    EXPECT_EQ(text(), "a=1;x=0;");
}

TEST_F(KeyValueArraysTest, NullAndEmptyArraysHaveNoPairs) {
    EXPECT_THAT(convert(nullptr, nullptr), Returns("true"));
    EXPECT_THAT(convert(strings({}), strings({})), Returns("true"));
    EXPECT_EQ(text(), "");
}

TEST_F(KeyValueArraysTest, MismatchThrows) {
    const Expected refused =
        Returns("false")
            .logs({error("keys and values arrays have different length").tagged(kUtilsTag)})
            .throws(kIllegalArgument);
    EXPECT_THAT(convert(strings({"a", "b"}), strings({"1"})), refused);
    EXPECT_THAT(convert(strings({"a"}), nullptr), refused);
    EXPECT_THAT(convert(nullptr, strings({"1"})), refused);
    EXPECT_THAT(convert(strings({}), nullptr), refused);
    EXPECT_THAT(convert(nullptr, strings({})), refused);
    EXPECT_EQ(text(), "");
}

// Pairs added before the failing one stay, and every buffer is given back.
TEST_F(KeyValueArraysTest, KeyWithoutCharactersEndsTheConversion) {
    jobjectArray keys = strings({"a", "b", "c"});
    jobjectArray values = strings({"1", "2", "3"});
    vm.fail("GetStringUTFChars", 3);
    EXPECT_THAT(convert(keys, values), Returns("false").throws(kOutOfMemory, "GetStringUTFChars"));
    EXPECT_EQ(text(), "a=1;");
}

TEST_F(KeyValueArraysTest, ValueWithoutCharactersReleasesTheKey) {
    jobjectArray keys = strings({"a", "b", "c"});
    jobjectArray values = strings({"1", "2", "3"});
    vm.fail("GetStringUTFChars", 4);
    EXPECT_THAT(convert(keys, values), Returns("false").throws(kOutOfMemory, "GetStringUTFChars"));
    EXPECT_EQ(text(), "a=1;");
    EXPECT_THAT(vm.callsOf("ReleaseStringUTFChars"), testing::SizeIs(3));
}

TEST_F(KeyValueArraysTest, NullElementHasNoCharacters) {
    const ObjectPtr a = vm.newString("a");
    jobjectArray keys = vm.local<jobjectArray>(vm.newArray("java/lang/String", {a, nullptr}));
    EXPECT_THAT(convert(keys, strings({"1", "2"})), Returns("false"));
    EXPECT_EQ(text(), "a=1;");
    jobjectArray values = vm.local<jobjectArray>(vm.newArray("java/lang/String", {nullptr, a}));
    EXPECT_THAT(convert(strings({"x", "y"}), values), Returns("false"));
    EXPECT_EQ(text(), "a=1;");
}

TEST_F(KeyValueArraysTest, ElementReferencesAreDeletedInTheLoop) {
    const Untraced repeated(*this);
    const std::vector<std::string> many(600, "text");
    jobjectArray keys = strings(many);
    jobjectArray values = strings(many);
    const size_t before = vm.localReferences();
    EXPECT_THAT(convert(keys, values), Returns("true"));
    EXPECT_EQ(vm.localReferences(), before);
}

}  // namespace
}  // namespace orvtest
