// SPDX-License-Identifier: Apache-2.0
// The tests' virtual machine: what it must see for the other tests to be worth
// anything.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nativehelper/JNIHelp.h>

#include "FakeJni/NativeCall.h"
#include "FakeJni/Vm.h"
#include "LogCapture.h"

namespace fakejni {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Optional;

class FakeJniTest : public testing::Test {
protected:
    FakeJniTest() : type(vm.define("Thing")), env(vm.env()) {
        // Other tests leave the dispatcher's worker running.
        GTEST_FLAG_SET(death_test_style, "threadsafe");
        type.field("number", "I");
        type.field("flag", "Z");
        type.field("text", "Ljava/lang/String;");
        thing = vm.local(vm.newObject("Thing"));
        clazz = env->GetObjectClass(thing);
    }
    void expectViolation(const std::string& text) {
        EXPECT_THAT(vm.violations(), ElementsAre(HasSubstr(text)));
    }

    orvtest::LogCapture log;
    Vm vm;
    Class& type;
    JNIEnv* env;
    jobject thing;
    jclass clazz;
};

TEST_F(FakeJniTest, LookupsFailWithTheirExceptions) {
    EXPECT_EQ(env->FindClass("Nothing"), nullptr);
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/lang/NoClassDefFoundError", "Nothing"}));
    vm.clearPending();
    EXPECT_EQ(env->GetFieldID(clazz, "number", "J"), nullptr);
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/lang/NoSuchFieldError", "number"}));
    vm.clearPending();
    EXPECT_EQ(env->GetStaticMethodID(clazz, "run", "()V"), nullptr);
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/lang/NoSuchMethodError", "run"}));
    EXPECT_THAT(vm.violations(), IsEmpty());
}

TEST_F(FakeJniTest, CallsWithAPendingExceptionAreSeen) {
    vm.raise("java/lang/RuntimeException");
    env->DeleteLocalRef(env->ExceptionOccurred());
    EXPECT_THAT(vm.violations(), IsEmpty());
    env->FindClass("Thing");
    expectViolation("FindClass: called with a pending java/lang/RuntimeException");
}

TEST_F(FakeJniTest, FieldsAreCheckedForTypeAndOwner) {
    jfieldID flag = env->GetFieldID(clazz, "flag", "Z");
    env->SetBooleanField(thing, flag, JNI_TRUE);
    EXPECT_EQ(env->GetByteField(thing, flag), 1);
    EXPECT_THAT(vm.violations(), IsEmpty());
    env->GetIntField(thing, flag);
    expectViolation("GetIntField: field flag is a Z");
    vm.tolerate("is a Z");
    env->GetBooleanField(env->NewStringUTF("x"), flag);
    expectViolation("has no field flag");
}

TEST_F(FakeJniTest, IdsOfNoLookupAreSeen) {
    env->GetIntField(thing, nullptr);
    expectViolation("not a field ID");
}

TEST_F(FakeJniTest, DeletedReferencesAreSeen) {
    jobject global = env->NewGlobalRef(thing);
    EXPECT_EQ(vm.globalReferences(), 1u);
    env->DeleteGlobalRef(global);
    EXPECT_EQ(vm.globalReferences(), 0u);
    env->DeleteGlobalRef(global);
    expectViolation("second deletion");
    vm.tolerate("second deletion");
    env->DeleteLocalRef(thing);
    env->GetObjectClass(thing);
    expectViolation("use of a deleted local");
}

TEST_F(FakeJniTest, KindsOfReferencesAreNotMixedUp) {
    env->DeleteGlobalRef(thing);
    expectViolation("deleted as global");
}

TEST_F(FakeJniTest, OtherThreadsReferencesAndEnvironmentsAreSeen) {
    vm.onJavaThread([&] { vm.env()->GetObjectClass(thing); });
    expectViolation("another thread's local");
    vm.tolerate("another thread's local");
    vm.onJavaThread([&] { env->FindClass("Thing"); });
    expectViolation("another thread's environment");
}

TEST_F(FakeJniTest, ThreadsAttachAndDetach) {
    vm.onNativeThread([&] {
        EXPECT_EQ(vm.env(), nullptr);
        JNIEnv* mine = nullptr;
        EXPECT_EQ(vm.javaVm()->GetEnv(reinterpret_cast<void**>(&mine), JNI_VERSION_1_4),
                  JNI_EDETACHED);
        vm.javaVm()->AttachCurrentThread(&mine, nullptr);
        EXPECT_EQ(vm.attachedThreads(), 1);
        mine->FindClass("Thing");
        const size_t locals = vm.localReferences();
        vm.javaVm()->DetachCurrentThread();
        EXPECT_EQ(vm.localReferences(), locals - 1);
        EXPECT_EQ(vm.attachedThreads(), 0);
        EXPECT_THAT(vm.violations(), IsEmpty());
        vm.javaVm()->DetachCurrentThread();
    });
    expectViolation("on a thread not attached");
}

TEST_F(FakeJniTest, JavaThreadsMayNotBeDetached) {
    EXPECT_EQ(vm.javaVm()->DetachCurrentThread(), JNI_ERR);
    expectViolation("on a thread that runs Java");
}

TEST_F(FakeJniTest, ArgumentsAreReadByTheSignature) {
    type.method("all", "(ZBCSIJFDLjava/lang/String;[B)V");
    jmethodID id = env->GetMethodID(clazz, "all", "(ZBCSIJFDLjava/lang/String;[B)V");
    jstring text = env->NewStringUTF("t");
    jbyteArray bytes = env->NewByteArray(2);
    const std::string expected =
        "all(true, -3, 65535, -5, -6, 1099511627776, 1.5, -2.5, \"t\", byte[2])";
    env->functions->CallVoidMethod(env, thing, id, JNI_TRUE, jbyte(-3), jchar(0xFFFF), jshort(-5),
                                   -6, jlong(1) << 40, 1.5, -2.5, text, bytes);
    env->CallVoidMethod(thing, id, JNI_TRUE, jbyte(-3), jchar(0xFFFF), jshort(-5), -6,
                        jlong(1) << 40, 1.5, -2.5, text, bytes);
    jvalue values[10] = {};
    values[0].z = JNI_TRUE;
    values[1].b = -3;
    values[2].c = 0xFFFF;
    values[3].s = -5;
    values[4].i = -6;
    values[5].j = jlong(1) << 40;
    values[6].f = 1.5f;
    values[7].d = -2.5;
    values[8].l = text;
    values[9].l = bytes;
    env->CallVoidMethodA(thing, id, values);
    EXPECT_THAT(vm.javaCallTexts(), ElementsAre(expected, expected, expected));
}

TEST_F(FakeJniTest, ResultFormsAreChecked) {
    type.method("size", "()J", [](const Invocation&) { return Value::ofLong(-7); });
    type.method("stop", "()V");
    EXPECT_EQ(env->CallLongMethod(thing, env->GetMethodID(clazz, "size", "()J")), -7);
    env->CallLongMethod(thing, env->GetMethodID(clazz, "stop", "()V"));
    EXPECT_THAT(vm.violations(), IsEmpty());
    env->CallIntMethod(thing, env->GetMethodID(clazz, "size", "()J"));
    expectViolation("size is a ()J");
}

TEST_F(FakeJniTest, BuffersMustBeGivenBackUnharmed) {
    jbyteArray array = env->NewByteArray(4);
    jbyte* bytes = env->GetByteArrayElements(array, nullptr);
    EXPECT_THAT(vm.unreleased(), ElementsAre("GetByteArrayElements"));
    bytes[3] = 9;
    env->ReleaseByteArrayElements(array, bytes, 0);
    EXPECT_THAT(vm.unreleased(), IsEmpty());
    EXPECT_EQ(vm.deref(array)->bytes[3], 9);
    bytes = env->GetByteArrayElements(array, nullptr);
    bytes[4] = 1;
    env->ReleaseByteArrayElements(array, bytes, JNI_ABORT);
    expectViolation("written past the end");
}

TEST_F(FakeJniTest, StringsKeepEveryUnit) {
    const std::u16string text = {u'a', 0, u'\u00e9', 0xD83D, 0xDE00};
    jstring string = env->NewString(reinterpret_cast<const jchar*>(text.data()),
                                    static_cast<jsize>(text.size()));
    const char* bytes = env->GetStringUTFChars(string, nullptr);
    EXPECT_STREQ(bytes, "a\xC0\x80\xC3\xA9\xED\xA0\xBD\xED\xB8\x80");
    EXPECT_EQ(vm.deref(env->NewStringUTF(bytes))->text, text);
    env->ReleaseStringUTFChars(string, bytes);
    EXPECT_THAT(vm.violations(), IsEmpty());
    env->NewStringUTF("\xF0\x9F\x98\x80");
    expectViolation("no modified UTF-8");
}

TEST_F(FakeJniTest, ThePlatformsThrowHelperWorksOnIt) {
    jniThrowException(env, "java/io/IOException", "first");
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/io/IOException", "first"}));
    vm.clearPending();
    jniThrowException(env, "java/lang/IllegalStateException", nullptr);
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/lang/IllegalStateException", {}}));
    EXPECT_THAT(vm.violations(), IsEmpty());
}

TEST_F(FakeJniTest, PlannedFailuresComeOnce) {
    vm.fail("NewByteArray", 2);
    EXPECT_NE(env->NewByteArray(1), nullptr);
    EXPECT_EQ(env->NewByteArray(1), nullptr);
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/lang/OutOfMemoryError", "NewByteArray"}));
    vm.clearPending();
    EXPECT_NE(env->NewByteArray(1), nullptr);
    EXPECT_EQ(vm.failures(), 1);
}

jint addThree(JNIEnv*, jobject, jint value) { return value + 3; }

TEST_F(FakeJniTest, NativeMethodsAreCalledByNameAndSignature) {
    type.nativeMethod("add", "(I)I");
    const JNINativeMethod rows[] = {{"add", "(I)I", reinterpret_cast<void*>(addThree)}};
    EXPECT_EQ(env->RegisterNatives(clazz, rows, 1), JNI_OK);
    EXPECT_EQ(callNative<jint>(vm, type, thing, "add", "(I)I", 4).value.integer, 7);
    EXPECT_DEATH(callNative<jlong>(vm, type, thing, "add", "(I)I", 4), "no native add");

    const JNINativeMethod wrong[] = {{"add", "(J)I", reinterpret_cast<void*>(addThree)}};
    EXPECT_EQ(env->RegisterNatives(clazz, wrong, 1), JNI_ERR);
    EXPECT_THAT(vm.pending(), Optional(Thrown{"java/lang/NoSuchMethodError", "add"}));
}

TEST_F(FakeJniTest, UnsupportedFunctionsStopWithTheirName) {
    EXPECT_DEATH(env->NewIntArray(1), "NewIntArray is not part");
}

}  // namespace
}  // namespace fakejni
