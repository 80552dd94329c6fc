// SPDX-License-Identifier: Apache-2.0
#include <android_runtime/AndroidRuntime.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace android {
namespace {

using testing::ElementsAre;

// A virtual machine of five functions; any other one that is called is null
// and ends the test run.
class TinyVm {
public:
    TinyVm() {
        mEnvTable.FindClass = [](JNIEnv* env, const char* name) {
            self(env)->mCalls.push_back(std::string("FindClass ") + name);
            return self(env)->classFound ? self(env)->theClass() : nullptr;
        };
        mEnvTable.RegisterNatives = [](JNIEnv* env, jclass, const JNINativeMethod* methods,
                                       jint count) -> jint {
            std::string call = "RegisterNatives";
            for (jint i = 0; i < count; ++i) call += std::string(" ") + methods[i].name;
            self(env)->mCalls.push_back(call);
            return JNI_OK;
        };
        mEnvTable.DeleteLocalRef = [](JNIEnv* env, jobject reference) {
            EXPECT_EQ(reference, self(env)->theClass());
            self(env)->mCalls.emplace_back("DeleteLocalRef");
        };
        mEnvTable.GetJavaVM = [](JNIEnv* env, JavaVM** vm) -> jint {
            *vm = &self(env)->mVm;
            return JNI_OK;
        };
        mVmTable.GetEnv = [](JavaVM* vm, void** env, jint version) -> jint {
            TinyVm* const tiny = static_cast<Vm*>(vm)->owner;
            EXPECT_EQ(version, JNI_VERSION_1_4);
            if (!tiny->attached) return JNI_EDETACHED;
            *env = &tiny->mEnv;
            return JNI_OK;
        };
        mEnv.functions = &mEnvTable;
        mEnv.owner = this;
        mVm.functions = &mVmTable;
        mVm.owner = this;
    }

    JNIEnv* env() { return &mEnv; }
    JavaVM* vm() { return &mVm; }
    const std::vector<std::string>& calls() const { return mCalls; }

    bool classFound = true;
    bool attached = true;

private:
    struct Env : JNIEnv {
        TinyVm* owner;
    };
    struct Vm : JavaVM {
        TinyVm* owner;
    };

    static TinyVm* self(JNIEnv* env) { return static_cast<Env*>(env)->owner; }
    jclass theClass() { return reinterpret_cast<jclass>(this); }

    Env mEnv = {};
    Vm mVm = {};
    JNINativeInterface mEnvTable = {};
    JNIInvokeInterface mVmTable = {};
    std::vector<std::string> mCalls;
};

const JNINativeMethod kMethods[] = {{"one", "()V", nullptr}, {"two", "(I)I", nullptr}};

int registerOn(TinyVm* tiny) {
    return AndroidRuntime::registerNativeMethods(tiny->env(), "a/B", kMethods, 2);
}

TEST(AndroidRuntimeTest, RegistersAllRowsInOneCall) {
    TinyVm tiny;
    EXPECT_EQ(registerOn(&tiny), 0);
    EXPECT_THAT(tiny.calls(),
                ElementsAre("FindClass a/B", "RegisterNatives one two", "DeleteLocalRef"));
}

TEST(AndroidRuntimeTest, AMissingClassIsNotRegistered) {
    TinyVm tiny;
    tiny.classFound = false;
    EXPECT_EQ(registerOn(&tiny), -1);
    EXPECT_THAT(tiny.calls(), ElementsAre("FindClass a/B"));
}

TEST(AndroidRuntimeTest, RemembersTheLatestMachine) {
    TinyVm first;
    TinyVm second;
    registerOn(&first);
    EXPECT_EQ(AndroidRuntime::getJavaVM(), first.vm());
    registerOn(&second);
    EXPECT_EQ(AndroidRuntime::getJavaVM(), second.vm());
    EXPECT_EQ(AndroidRuntime::getJNIEnv(), second.env());
}

TEST(AndroidRuntimeTest, AThreadThatIsNotAttachedHasNoEnvironment) {
    TinyVm tiny;
    registerOn(&tiny);
    tiny.attached = false;
    EXPECT_EQ(AndroidRuntime::getJNIEnv(), nullptr);
}

}  // namespace
}  // namespace android
