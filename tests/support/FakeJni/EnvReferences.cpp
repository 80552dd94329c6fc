// SPDX-License-Identifier: Apache-2.0
// Local, global and weak references, and the exceptions that are pending.
#include "FakeJni/EnvSupport.h"
#include "FakeJni/ModifiedUtf8.h"

namespace fakejni {

namespace {

// What a handle refers to, for the record.
std::string targetOf(JNIEnv* env, jobject handle) {
    Vm& vm = *static_cast<FakeEnv*>(env)->vm;
    std::lock_guard<MachineMutex> lock(vm.mutex());
    std::string fault;
    return toString(Value::of(vm.references().resolve(handle, threadNumber(), &fault)));
}

jobject newReference(JNIEnv* env, const char* function, RefKind kind, jobject handle) {
    Entry entry(env, function, targetOf(env, handle));
    ObjectPtr object = entry.object(handle, true);
    if (object == nullptr || entry.fails()) return nullptr;
    return entry.vm.references().make(kind, object, entry.thread.number);
}

void deleteReference(JNIEnv* env, const char* function, RefKind kind, jobject handle) {
    Entry entry(env, function, targetOf(env, handle), Entry::kAllowed);
    std::string fault;
    entry.vm.references().remove(handle, kind, entry.thread.number, &fault);
    if (!fault.empty()) entry.violation(fault);
}

jboolean isSameObject(JNIEnv* env, jobject a, jobject b) {
    Entry entry(env, "IsSameObject");
    return entry.object(a, true) == entry.object(b, true);
}

// Nobody waits for a monitor here; only its pairing is checked.
jint enterMonitor(JNIEnv* env, jobject handle) {
    Entry entry(env, "MonitorEnter");
    ObjectPtr object = entry.object(handle);
    if (object == nullptr || entry.fails()) return JNI_ERR;
    ++object->monitorEntries;
    return JNI_OK;
}

jint exitMonitor(JNIEnv* env, jobject handle) {
    Entry entry(env, "MonitorExit", "", Entry::kAllowed);
    ObjectPtr object = entry.object(handle);
    if (object == nullptr || object->monitorEntries == 0) {
        entry.violation("the monitor was not entered");
        return JNI_ERR;
    }
    --object->monitorEntries;
    return JNI_OK;
}

jint throwNew(JNIEnv* env, jclass handle, const char* message) {
    Entry entry(env, "ThrowNew");
    Class* type = entry.javaClass(handle);
    if (type == nullptr || !type->isSubclassOf(entry.vm.find("java/lang/Throwable"))) {
        entry.violation("not an exception class");
        return JNI_ERR;
    }
    if (entry.fails()) return JNI_ERR;
    entry.vm.raise(type->path, message == nullptr ? std::optional<std::string>() : message);
    return JNI_OK;
}

jint throwObject(JNIEnv* env, jthrowable handle) {
    Entry entry(env, "Throw");
    ObjectPtr thrown = entry.object(handle, "java/lang/Throwable");
    if (thrown == nullptr) return JNI_ERR;
    entry.thread.pending = thrown;
    return JNI_OK;
}

jthrowable exceptionOccurred(JNIEnv* env) {
    Entry entry(env, "ExceptionOccurred", "", Entry::kAllowed);
    return entry.local<jthrowable>(entry.thread.pending);
}

jboolean exceptionCheck(JNIEnv* env) {
    Entry entry(env, "ExceptionCheck", "", Entry::kAllowed);
    return entry.thread.pending != nullptr;
}

void exceptionClear(JNIEnv* env) {
    Entry entry(env, "ExceptionClear", "", Entry::kAllowed);
    entry.thread.pending = nullptr;
}

jint getJavaVm(JNIEnv* env, JavaVM** vm) {
    Entry entry(env, "GetJavaVM", "", Entry::kAllowed);
    *vm = entry.vm.javaVm();
    return JNI_OK;
}

}  // namespace

void installReferences(JNINativeInterface& table) {
    table.NewLocalRef = [](JNIEnv* env, jobject object) {
        return newReference(env, "NewLocalRef", RefKind::kLocal, object);
    };
    table.NewGlobalRef = [](JNIEnv* env, jobject object) {
        return newReference(env, "NewGlobalRef", RefKind::kGlobal, object);
    };
    table.NewWeakGlobalRef = [](JNIEnv* env, jobject object) {
        return newReference(env, "NewWeakGlobalRef", RefKind::kWeak, object);
    };
    table.DeleteLocalRef = [](JNIEnv* env, jobject object) {
        deleteReference(env, "DeleteLocalRef", RefKind::kLocal, object);
    };
    table.DeleteGlobalRef = [](JNIEnv* env, jobject object) {
        deleteReference(env, "DeleteGlobalRef", RefKind::kGlobal, object);
    };
    table.DeleteWeakGlobalRef = [](JNIEnv* env, jweak object) {
        deleteReference(env, "DeleteWeakGlobalRef", RefKind::kWeak, object);
    };
    table.IsSameObject = isSameObject;
    table.MonitorEnter = enterMonitor;
    table.MonitorExit = exitMonitor;
    table.GetObjectRefType = [](JNIEnv* env, jobject object) {
        Entry entry(env, "GetObjectRefType");
        return entry.vm.references().typeOf(object);
    };
    table.EnsureLocalCapacity = [](JNIEnv* env, jint) -> jint {
        Entry entry(env, "EnsureLocalCapacity");
        return JNI_OK;
    };
}

void installExceptions(JNINativeInterface& table) {
    table.ThrowNew = throwNew;
    table.Throw = throwObject;
    table.ExceptionOccurred = exceptionOccurred;
    table.ExceptionCheck = exceptionCheck;
    table.ExceptionClear = exceptionClear;
    table.GetJavaVM = getJavaVm;
    table.GetVersion = [](JNIEnv* env) -> jint {
        Entry entry(env, "GetVersion", "", Entry::kAllowed);
        return JNI_VERSION_1_6;
    };
}

}  // namespace fakejni
