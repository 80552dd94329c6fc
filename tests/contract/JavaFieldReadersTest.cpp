// SPDX-License-Identifier: Apache-2.0
#include "JniFixture.h"
#include "jni/JavaFieldReaders.h"

namespace orvtest {
namespace {

using fakejni::Value;

const char kHolder[] = "com/example/Holder";
const char kChild[] = "Lcom/example/Child;";

ExpectedLine readerInfo(const std::string& text) {
    return info(text).tagged("Customer_media_Utils");
}
ExpectedLine readerError(const std::string& text) {
    return error(text).tagged("Customer_media_Utils");
}

// What a reader answered and left in its output, "untouched" for neither.
struct Read {
    bool result = false;
    std::string out = "untouched";
};

// One of the four readers behind one form.
struct Reader {
    std::string name;
    std::string field;       // of the holder, of the reader's type
    std::string wrongField;  // of the holder, of another type
    std::string accessor;    // the function that reads the field
    Read (*read)(JNIEnv* env, const char* classPath, jobject object, const char* field);
    bool readsObject = false;

    ExpectedLine parameterError() const { return readerError(name + "(): parameter error!!\n"); }
    ExpectedLine entry(const std::string& classPath, const std::string& fieldName) const {
        if (readsObject) {
            return readerInfo(name + "(): pszClassPath_Parent=" + classPath +
                              ", pszClassPathType_Son=" + kChild +
                              ", pszVar_AliasName=" + fieldName);
        }
        return readerInfo(name + "(): pszClassPath=" + classPath +
                          ", pszVar_AliasName=" + fieldName);
    }
    ExpectedLine classError(const std::string& classPath) const {
        return readerError(name + "(): find " + (readsObject ? "parent " : "") + "class(" +
                           classPath + ") failed, please check\n");
    }
    ExpectedLine fieldError(const std::string& classPath, const std::string& fieldName) const {
        return readerError(name + "(): find variable(" +
                           (readsObject ? classPath : "SubtitleAttr") + ", " + fieldName +
                           ") failed, please check\n");
    }
};
void PrintTo(const Reader& reader, std::ostream* out) { *out << reader.name; }

Read readInt(JNIEnv* env, const char* classPath, jobject object, const char* field) {
    int value = -77;
    Read read;
    read.result = android::getIntValueFromJava(env, classPath, object, field, value);
    if (value != -77) read.out = std::to_string(value);
    return read;
}

Read readByte(JNIEnv* env, const char* classPath, jobject object, const char* field) {
    char value = 77;
    Read read;
    read.result = android::getByteValueFromJava(env, classPath, object, field, value);
    if (value != 77) read.out = std::to_string(static_cast<signed char>(value));
    return read;
}

// A bool has no third value: the output is written when it follows the field
// whatever it was before.
Read readBool(JNIEnv* env, const char* classPath, jobject object, const char* field) {
    bool value = true;
    Read read;
    read.result = android::getBoolValueFromJava(env, classPath, object, field, value);
    if (!read.result) return value ? Read() : Read{false, "touched"};
    read.out = value ? "true" : "false";
    return read;
}

Read readObject(JNIEnv* env, const char* classPath, jobject object, const char* field) {
    int marker = 0;
    jobject value = reinterpret_cast<jobject>(&marker);
    Read read;
    read.result = android::getObjValueFromJava(env, classPath, object, field, kChild, value);
    if (value != reinterpret_cast<jobject>(&marker)) {
        read.out = value == nullptr ? "null" : "object";
    }
    return read;
}

std::vector<Reader> readers() {
    return {{"getIntValueFromJava", "mInt", "mByte", "GetIntField", readInt},
            {"getByteValueFromJava", "mByte", "mInt", "GetByteField", readByte},
            {"getBoolValueFromJava", "mBool", "mByte", "GetByteField", readBool},
            {"getObjValueFromJava", "mChild", "mInt", "GetObjectField", readObject, true}};
}

class JavaFieldReadersFixture : public VmFixture {
protected:
    JavaFieldReadersFixture() {
        vm.define("com/example/Child");
        fakejni::Class& type = vm.define(kHolder);
        type.field("mInt", "I");
        type.field("mByte", "B");
        type.field("mBool", "Z");
        type.field("mChild", kChild);
        holder = vm.newObject(kHolder);
    }

    Read read(const Reader& reader, const char* classPath, const char* field) {
        Read read;
        outcome = observeAction(
            [&] { read = reader.read(vm.env(), classPath, vm.local(holder), field); });
        // Local references are the native method's to leave to the machine.
        EXPECT_THAT(vm.callsOf("DeleteLocalRef"), testing::IsEmpty());
        return read;
    }
    void expectFailure(const Read& read) {
        EXPECT_FALSE(read.result);
        EXPECT_EQ(read.out, "untouched");
    }

    fakejni::ObjectPtr holder;
    Outcome outcome;
};

class EveryReaderTest : public JavaFieldReadersFixture,
                        public testing::WithParamInterface<Reader> {};

TEST_P(EveryReaderTest, RefusesANullClassPath) {
    expectFailure(read(GetParam(), nullptr, "mInt"));
    EXPECT_THAT(outcome, ReturnsNothing().logs({GetParam().parameterError()}));
}

TEST_P(EveryReaderTest, RefusesANullFieldName) {
    expectFailure(read(GetParam(), kHolder, nullptr));
    EXPECT_THAT(outcome, ReturnsNothing().logs({GetParam().parameterError()}));
}

TEST_P(EveryReaderTest, RefusesANullEnvironment) {
    Read read;
    outcome = observeAction([&] { read = GetParam().read(nullptr, kHolder, nullptr, "mInt"); });
    expectFailure(read);
    EXPECT_THAT(outcome, ReturnsNothing().logs({GetParam().parameterError()}));
}

TEST_P(EveryReaderTest, LeavesTheExceptionOfAMissingClass) {
    expectFailure(read(GetParam(), "com/example/None", "mInt"));
    EXPECT_THAT(outcome, ReturnsNothing()
                             .logs({GetParam().entry("com/example/None", "mInt"),
                                    GetParam().classError("com/example/None")})
                             .throws("java/lang/NoClassDefFoundError", "com/example/None"));
}

TEST_P(EveryReaderTest, LeavesTheExceptionOfAMissingField) {
    expectFailure(read(GetParam(), kHolder, "mNone"));
    EXPECT_THAT(outcome, ReturnsNothing()
                             .logs({GetParam().entry(kHolder, "mNone"),
                                    GetParam().fieldError(kHolder, "mNone")})
                             .throws("java/lang/NoSuchFieldError", "mNone"));
}

TEST_P(EveryReaderTest, FindsNoFieldOfAnotherType) {
    const std::string& field = GetParam().wrongField;
    expectFailure(read(GetParam(), kHolder, field.c_str()));
    EXPECT_THAT(outcome,
                ReturnsNothing()
                    .logs({GetParam().entry(kHolder, field), GetParam().fieldError(kHolder, field)})
                    .throws("java/lang/NoSuchFieldError", field));
}

// The object is not examined: the read itself then meets the null.
TEST_P(EveryReaderTest, TakesANullObjectToTheFieldRead) {
    const Reader& reader = GetParam();
    vm.tolerate(reader.accessor + ": null argument");
    holder = nullptr;
    EXPECT_TRUE(read(reader, kHolder, reader.field.c_str()).result);
    EXPECT_THAT(vm.callsOf(reader.accessor), testing::ElementsAre(reader.field));
}

INSTANTIATE_TEST_SUITE_P(Readers, EveryReaderTest, testing::ValuesIn(readers()),
                         [](const auto& info) { return info.param.name; });

class JavaFieldReadersTest : public JavaFieldReadersFixture {
protected:
    void expectRead(const Reader& reader, const std::string& out,
                    const std::vector<ExpectedLine>& behind) {
        const Read read = JavaFieldReadersFixture::read(reader, kHolder, reader.field.c_str());
        EXPECT_TRUE(read.result);
        EXPECT_EQ(read.out, out);
        std::vector<ExpectedLine> lines = {reader.entry(kHolder, reader.field)};
        lines.insert(lines.end(), behind.begin(), behind.end());
        EXPECT_THAT(outcome, ReturnsNothing().logs(lines));
    }
    const Reader intReader = readers()[0];
    const Reader byteReader = readers()[1];
    const Reader boolReader = readers()[2];
    const Reader objectReader = readers()[3];
};

TEST_F(JavaFieldReadersTest, ReadsAnInt) {
    for (int value : {0, 1, -1, 2147483647, -2147483647 - 1}) {
        holder->set("mInt", Value::ofInt(value));
        expectRead(intReader, std::to_string(value),
                   {readerInfo("getIntValueFromJava(): i4Ret=" + std::to_string(value))});
    }
}

TEST_F(JavaFieldReadersTest, ReadsAByte) {
    for (int value : {0, 1, 127, -1, -128}) {
        holder->set("mByte", Value::ofByte(static_cast<jbyte>(value)));
        // A char is signed or not as the platform has it, and so is its line.
        const char shown = static_cast<char>(value);
        expectRead(byteReader, std::to_string(value),
                   {readerInfo("getByteValueFromJava(): chRet=" + std::to_string(+shown))});
    }
}

TEST_F(JavaFieldReadersTest, ReadsABooleanAsAByte) {
    for (bool value : {false, true}) {
        holder->set("mBool", Value::ofBoolean(value));
        expectRead(
            boolReader, value ? "true" : "false",
            {readerInfo(std::string("getBoolValueFromJava(): fgRet=") + (value ? "1" : "0"))});
    }
    vm.forgetCalls();
    bool out = false;
    android::getBoolValueFromJava(vm.env(), kHolder, vm.local(holder), "mBool", out);
    EXPECT_THAT(vm.callsOf("GetByteField"), testing::ElementsAre("mBool"));
    EXPECT_THAT(vm.callsOf("GetBooleanField"), testing::IsEmpty());
}

TEST_F(JavaFieldReadersTest, AnyNonZeroByteIsTrue) {
    holder->set("mBool", Value{'Z', 2, 0, nullptr});
    expectRead(boolReader, "true", {readerInfo("getBoolValueFromJava(): fgRet=1")});
}

TEST_F(JavaFieldReadersTest, ReadsAChildSilently) {
    expectRead(objectReader, "null", {});
    const fakejni::ObjectPtr child = vm.newObject("com/example/Child");
    holder->set("mChild", Value::of(child));
    expectRead(objectReader, "object", {});

    jobject out = nullptr;
    android::getObjValueFromJava(vm.env(), kHolder, vm.local(holder), "mChild", kChild, out);
    EXPECT_EQ(vm.deref(out), child);
    EXPECT_EQ(vm.env()->GetObjectRefType(out), JNILocalRefType);
}

TEST_F(JavaFieldReadersTest, ObjectReaderNeedsASignature) {
    jobject out = nullptr;
    outcome = observeAction([&] {
        EXPECT_FALSE(android::getObjValueFromJava(vm.env(), kHolder, vm.local(holder), "mChild",
                                                  nullptr, out));
    });
    EXPECT_THAT(outcome, ReturnsNothing().logs({objectReader.parameterError()}));
}

TEST(ShortLengthTest, EndsAtTheFirstZeroOrAtTheMaximum) {
    unsigned short text[] = {'a', 0xD83D, 'c', 0, 'e', 'f'};
    EXPECT_EQ(android::OrvMediaClient_shortLength(text, 6), 3);
    EXPECT_EQ(android::OrvMediaClient_shortLength(text, 4), 3);
    EXPECT_EQ(android::OrvMediaClient_shortLength(text, 3), 3);
    EXPECT_EQ(android::OrvMediaClient_shortLength(text, 2), 2);
    EXPECT_EQ(android::OrvMediaClient_shortLength(text + 3, 3), 0);
    EXPECT_EQ(android::OrvMediaClient_shortLength(text + 4, 2), 2);
}

TEST(ShortLengthTest, ReadsNothingForAMaximumOfZeroOrLess) {
    EXPECT_EQ(android::OrvMediaClient_shortLength(nullptr, 0), 0);
    EXPECT_EQ(android::OrvMediaClient_shortLength(nullptr, -1), 0);
}

}  // namespace
}  // namespace orvtest
