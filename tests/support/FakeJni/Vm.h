// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include <functional>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "FakeJni/MachineMutex.h"
#include "FakeJni/Model.h"
#include "FakeJni/References.h"

namespace fakejni {

struct ThreadState;

// One call that native code made into the virtual machine. detail is what was
// looked up, or the member that was used.
struct JniCall {
    std::string function;
    std::string detail;
    std::thread::id thread;
};

// One Java method that ran because native code called it.
struct JavaCall {
    std::string method;
    std::string form;  // the JNI function, such as "CallIntMethod"
    ObjectPtr self;
    std::vector<Value> args;
    std::thread::id thread;
};
// "name(arg, arg)"
std::string toString(const JavaCall& call);

struct Thrown {
    std::string type;  // the exception's class path
    std::optional<std::string> message;
    bool operator==(const Thrown& other) const {
        return type == other.type && message == other.message;
    }
};

// A virtual machine for one test. It checks native code as strictly as the
// machine's own checking mode does: every breach of JNI's rules becomes a
// violation. The thread that makes it is a Java thread; the others are native
// until they attach. Any thread may use it.
//
// It starts with java.lang's Object, Class, String and Throwable, and the
// exception classes that the library raises.
class Vm {
public:
    Vm();
    ~Vm();
    Vm(const Vm&) = delete;
    Vm& operator=(const Vm&) = delete;

    JavaVM* javaVm();
    // The calling thread's environment; null when it is not attached.
    JNIEnv* env();

    // --- classes and objects
    Class& define(const std::string& path, const std::string& super = "java/lang/Object");
    // Null when there is none. Array classes come into being when asked for.
    Class* find(const std::string& path);
    // From now on the class of that path cannot be found.
    void hide(const std::string& path);
    ObjectPtr newObject(const std::string& path);
    // Its java.lang.reflect.Method.
    ObjectPtr reflect(Method& method);
    ObjectPtr newString(const std::u16string& text);
    ObjectPtr newString(const std::string& modifiedUtf8);
    ObjectPtr newBytes(std::vector<uint8_t> bytes);
    ObjectPtr newArray(const std::string& elementPath, std::vector<ObjectPtr> elements);

    // A local reference on the calling thread.
    template <typename Handle = jobject>
    Handle local(ObjectPtr object) {
        return static_cast<Handle>(makeLocal(std::move(object)));
    }
    // Null for the null handle; a faulty one is a violation.
    ObjectPtr deref(jobject handle);

    // --- failure
    // The n-th call of that function from now on fails as it naturally would:
    // lookups and allocations yield null with their Java exception pending,
    // NewGlobalRef and GetObjectClass plain null, attaching a negative result.
    void fail(const std::string& function, int nth = 1);
    // As fail, over all functions that can fail, counted together.
    void failNth(int n);
    // Failures that have not come yet do not come any more.
    void forgetFailures();
    // How many calls were failed so far, and which function was the last.
    int failures() const { return mFailures; }
    const std::string& lastFailed() const { return mLastFailed; }
    // failNth passes that function over.
    void spare(const std::string& function) { mSpared.insert(function); }

    // Runs in each call of that function, on its thread, before the function
    // does its work. The machine is locked meanwhile.
    void whenCalled(const std::string& function, std::function<void()> action);

    // --- exceptions, on the calling thread
    std::optional<Thrown> pending();
    void clearPending();
    void raise(const std::string& path, const std::optional<std::string>& message = {});

    // --- threads
    // Runs and joins. A native thread starts unattached; a Java thread is
    // attached for its whole life and may not be detached by native code.
    void onNativeThread(const std::function<void()>& body);
    void onJavaThread(const std::function<void()>& body);
    // Native threads that are attached now.
    int attachedThreads();
    bool isAttached();

    // --- what happened
    std::vector<JniCall> calls();
    // The details of the calls of one function, in order.
    std::vector<std::string> callsOf(const std::string& function);
    std::vector<JavaCall> javaCalls();
    // Every row that RegisterNatives was given, in order, forgotten never.
    std::vector<JNINativeMethod> registrations();
    std::vector<std::string> javaCallTexts();
    void forgetCalls();
    size_t globalReferences();
    size_t localReferences();  // of all threads
    // Buffers of strings and arrays not given back, by the function that gave them.
    std::vector<std::string> unreleased();
    std::vector<std::string> violations();
    // Returns those so far and forgets them.
    std::vector<std::string> takeViolations();
    // Violations whose text contains this are dropped, those to come too.
    void tolerate(const std::string& text);

    // --- for the environment's functions and for NativeCall
    ThreadState& thisThread();
    MachineMutex& mutex() { return mMutex; }
    References& references() { return mReferences; }
    bool mustFail(const std::string& function);
    void record(const std::string& function, const std::string& detail);
    void recordJava(JavaCall call);
    void recordRegistration(const JNINativeMethod& row) { mRegistrations.push_back(row); }
    void violation(const std::string& text);
    // Field and method IDs: only those that a lookup of this machine gave are good.
    void handOut(const void* id);
    bool isHandedOut(const void* id) const;
    // The buffer lies in a block from malloc; the machine's end frees those that
    // unreleased() still names.
    void pin(const void* buffer, void* block, const std::string& function, ObjectPtr owner);
    // Null, and a violation, for a buffer that was not given or was given back.
    ObjectPtr unpin(const void* buffer, const std::string& function, bool keep = false);
    jint attach(JNIEnv** env, bool asJava);
    jint detach();

private:
    struct Machine;
    struct Pin {
        void* block;
        std::string function;
        ObjectPtr owner;
    };
    struct Plan {
        std::string function;  // empty: any that can fail
        int remaining;
    };

    jobject makeLocal(ObjectPtr object);
    void defineBaseClasses();
    Class& add(const std::string& path, Class* super);

    MachineMutex mMutex;
    std::unique_ptr<Machine> mMachine;
    std::map<std::string, std::unique_ptr<Class>> mClasses;
    std::vector<std::string> mHidden;
    References mReferences;
    std::map<int, std::unique_ptr<ThreadState>> mThreads;
    std::vector<Plan> mPlans;
    int mFailures = 0;
    std::string mLastFailed;
    std::set<std::string> mSpared;
    std::map<std::string, std::function<void()>> mActions;
    std::vector<JniCall> mCalls;
    std::vector<JavaCall> mJavaCalls;
    std::vector<JNINativeMethod> mRegistrations;
    std::map<const void*, Pin> mPins;
    std::set<const void*> mIds;
    std::vector<std::string> mViolations;
    std::vector<std::string> mTolerated;
};

}  // namespace fakejni
