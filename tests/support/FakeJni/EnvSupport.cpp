// SPDX-License-Identifier: Apache-2.0
#include "FakeJni/EnvSupport.h"

#include <atomic>

namespace fakejni {

namespace {

Vm& vmOf(JNIEnv* env) { return *static_cast<FakeEnv*>(env)->vm; }

}  // namespace

int threadNumber() {
    static std::atomic<int> next{1};
    thread_local const int number = next++;
    return number;
}

Entry::Entry(JNIEnv* env, const char* function, const std::string& detail, Pending pending)
    : mFunction(function), vm(vmOf(env)), thread(vm.thisThread()), mLock(vm.mutex()) {
    vm.record(mFunction, detail);
    if (static_cast<FakeEnv*>(env)->thread != thread.number) {
        violation("called with another thread's environment");
    } else if (!thread.attached) {
        violation("called on a thread that is not attached");
    }
    if (pending == kForbidden && thread.pending != nullptr) {
        violation("called with a pending " + thread.pending->type->path);
    }
}

std::nullptr_t Entry::raise(const char* path, const std::string& message) {
    vm.raise(path, message);
    return nullptr;
}

ObjectPtr Entry::object(jobject handle, bool nullAllowed) {
    std::string fault;
    ObjectPtr found = vm.references().resolve(handle, thread.number, &fault);
    if (!fault.empty()) {
        violation(fault);
    } else if (found == nullptr && !nullAllowed) {
        violation("null argument");
    }
    return found;
}

ObjectPtr Entry::object(jobject handle, const char* path, bool nullAllowed) {
    ObjectPtr found = object(handle, nullAllowed);
    if (found == nullptr || found->type->isSubclassOf(vm.find(path))) return found;
    violation(toString(Value::of(found)) + " is no " + path);
    return nullptr;
}

Class* Entry::javaClass(jclass handle) {
    ObjectPtr mirror = object(handle, "java/lang/Class");
    return mirror == nullptr ? nullptr : mirror->reflected;
}

}  // namespace fakejni
