// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include <mutex>
#include <string>

#include "FakeJni/Vm.h"

// Shared by the files that implement the environment's functions.
namespace fakejni {

struct FakeEnv : _JNIEnv {
    Vm* vm;
    int thread;
};

struct FakeJavaVm : _JavaVM {
    Vm* vm;
};

struct ThreadState {
    int number;
    bool attached = false;
    bool isJava = false;
    size_t mark = 0;  // references made before it was attached
    ObjectPtr pending;
    FakeEnv env;
};

// A number for each thread that ever ran; unlike thread ids never used twice.
int threadNumber();

// What every function of the environment does first: takes the machine's
// lock, records the call, and checks the thread and the pending exception.
class Entry {
public:
    enum Pending { kForbidden, kAllowed };
    Entry(JNIEnv* env, const char* function, const std::string& detail = "",
          Pending pending = kForbidden);

    // True when this call is to fail. Only functions that can fail ask.
    bool fails() { return vm.mustFail(mFunction); }
    void violation(const std::string& text) { vm.violation(mFunction + ": " + text); }
    // Raises and yields null.
    std::nullptr_t raise(const char* path, const std::string& message);
    std::nullptr_t outOfMemory() { return raise("java/lang/OutOfMemoryError", mFunction); }

    // Null, with a violation unless null is allowed, for what is no object.
    ObjectPtr object(jobject handle, bool nullAllowed = false);
    // As object, of that class. what names the argument.
    ObjectPtr object(jobject handle, const char* path, bool nullAllowed = false);
    Class* javaClass(jclass handle);

    template <typename Handle = jobject>
    Handle local(ObjectPtr value) {
        return static_cast<Handle>(
            vm.references().make(RefKind::kLocal, std::move(value), thread.number));
    }

    const std::string& function() const { return mFunction; }
    void unlock() { mLock.unlock(); }
    void lock() { mLock.lock(); }

private:
    const std::string mFunction;

public:
    Vm& vm;
    ThreadState& thread;

private:
    std::unique_lock<MachineMutex> mLock;
};

void installClasses(JNINativeInterface& table);
void installFields(JNINativeInterface& table);
void installMethods(JNINativeInterface& table);
void installStrings(JNINativeInterface& table);
void installArrays(JNINativeInterface& table);
void installReferences(JNINativeInterface& table);
void installExceptions(JNINativeInterface& table);
void installMissing(JNINativeInterface& table);

const JNINativeInterface* envTable();
const JNIInvokeInterface* vmTable();

}  // namespace fakejni
