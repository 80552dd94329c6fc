// SPDX-License-Identifier: Apache-2.0
// The virtual machine's threads: attaching, detaching, and the table that
// native code reaches them through.
#include <algorithm>

#include "FakeJni/EnvSupport.h"

namespace fakejni {

namespace {

using Lock = std::lock_guard<MachineMutex>;

Vm& vmOf(JavaVM* vm) { return *static_cast<FakeJavaVm*>(vm)->vm; }

jint attachCurrentThread(JavaVM* vm, JNIEnv** env, void* arguments) {
    Lock lock(vmOf(vm).mutex());
    if (arguments != nullptr) vmOf(vm).violation("AttachCurrentThread: with arguments");
    vmOf(vm).record("AttachCurrentThread", "");
    if (vmOf(vm).mustFail("AttachCurrentThread")) return JNI_ERR;
    return vmOf(vm).attach(env, false);
}

jint detachCurrentThread(JavaVM* vm) {
    Lock lock(vmOf(vm).mutex());
    vmOf(vm).record("DetachCurrentThread", "");
    return vmOf(vm).detach();
}

jint getEnv(JavaVM* vm, void** env, jint version) {
    Lock lock(vmOf(vm).mutex());
    char text[16];
    snprintf(text, sizeof text, "0x%08X", static_cast<unsigned>(version));
    vmOf(vm).record("GetEnv", text);
    const bool known =
        version == JNI_VERSION_1_2 || version == JNI_VERSION_1_4 || version == JNI_VERSION_1_6;
    *env = nullptr;
    if (!known || vmOf(vm).mustFail("GetEnv")) return JNI_EVERSION;
    *env = vmOf(vm).env();
    return *env == nullptr ? JNI_EDETACHED : JNI_OK;
}

jint attachAsDaemon(JavaVM* vm, JNIEnv**, void*) {
    vmOf(vm).violation("AttachCurrentThreadAsDaemon: called by native code");
    return JNI_ERR;
}

jint destroyJavaVm(JavaVM* vm) {
    vmOf(vm).violation("DestroyJavaVM: called by native code");
    return JNI_ERR;
}

}  // namespace

const JNIInvokeInterface* vmTable() {
    static const JNIInvokeInterface table = {
        nullptr, nullptr,       nullptr, destroyJavaVm, attachCurrentThread, detachCurrentThread,
        getEnv,  attachAsDaemon};
    return &table;
}

ThreadState& Vm::thisThread() {
    Lock lock(mMutex);
    std::unique_ptr<ThreadState>& thread = mThreads[threadNumber()];
    if (thread == nullptr) {
        thread = std::make_unique<ThreadState>();
        thread->number = threadNumber();
        thread->env.functions = envTable();
        thread->env.vm = this;
        thread->env.thread = thread->number;
    }
    return *thread;
}

jint Vm::attach(JNIEnv** env, bool asJava) {
    Lock lock(mMutex);
    ThreadState& thread = thisThread();
    if (!thread.attached) {
        thread.isJava = asJava;
        thread.mark = mReferences.mark();
    }
    thread.attached = true;
    *env = &thread.env;
    return JNI_OK;
}

jint Vm::detach() {
    Lock lock(mMutex);
    ThreadState& thread = thisThread();
    if (!thread.attached || thread.isJava) {
        violation(std::string("DetachCurrentThread: ") +
                  (thread.isJava ? "on a thread that runs Java" : "on a thread not attached"));
        return JNI_ERR;
    }
    // An exception that nobody caught goes to the thread's handler.
    thread.pending = nullptr;
    thread.attached = false;
    mReferences.dropLocalsSince(thread.mark, thread.number);
    return JNI_OK;
}

void Vm::onNativeThread(const std::function<void()>& body) { std::thread(body).join(); }

void Vm::onJavaThread(const std::function<void()>& body) {
    onNativeThread([&] {
        JNIEnv* env;
        attach(&env, true);
        body();
        Lock lock(mMutex);
        thisThread().isJava = false;
        detach();
    });
}

int Vm::attachedThreads() {
    Lock lock(mMutex);
    return static_cast<int>(std::count_if(mThreads.begin(), mThreads.end(), [](const auto& entry) {
        return entry.second->attached && !entry.second->isJava;
    }));
}

bool Vm::isAttached() { return thisThread().attached; }

}  // namespace fakejni
