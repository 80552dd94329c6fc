// SPDX-License-Identifier: Apache-2.0
// Finding classes and their members, making objects, registering natives.
#include "FakeJni/EnvSupport.h"

namespace fakejni {

namespace {

jclass findClass(JNIEnv* env, const char* path) {
    Entry entry(env, "FindClass", path);
    Class* found = entry.fails() ? nullptr : entry.vm.find(path);
    if (found == nullptr) return entry.raise("java/lang/NoClassDefFoundError", path);
    return entry.local<jclass>(found->mirror);
}

jclass getObjectClass(JNIEnv* env, jobject handle) {
    Entry entry(env, "GetObjectClass");
    ObjectPtr object = entry.object(handle);
    if (object == nullptr || entry.fails()) return nullptr;
    return entry.local<jclass>(object->type->mirror);
}

jclass getSuperclass(JNIEnv* env, jclass handle) {
    Entry entry(env, "GetSuperclass");
    Class* type = entry.javaClass(handle);
    if (type == nullptr || type->super == nullptr) return nullptr;
    return entry.local<jclass>(type->super->mirror);
}

jboolean isInstanceOf(JNIEnv* env, jobject handle, jclass classHandle) {
    Entry entry(env, "IsInstanceOf");
    ObjectPtr object = entry.object(handle, true);
    Class* type = entry.javaClass(classHandle);
    return object == nullptr || object->type->isSubclassOf(type);
}

jboolean isAssignableFrom(JNIEnv* env, jclass from, jclass to) {
    Entry entry(env, "IsAssignableFrom");
    Class* source = entry.javaClass(from);
    return source != nullptr && source->isSubclassOf(entry.javaClass(to));
}

jmethodID lookUpMethod(JNIEnv* env, const char* function, jclass handle, const char* name,
                       const char* signature, bool isStatic) {
    Entry entry(env, function, std::string(name) + " " + signature);
    Class* type = entry.javaClass(handle);
    if (type == nullptr) return nullptr;
    Method* found = entry.fails() ? nullptr : type->findMethod(name, signature, isStatic);
    if (found == nullptr) return entry.raise("java/lang/NoSuchMethodError", name);
    entry.vm.handOut(found);
    return reinterpret_cast<jmethodID>(found);
}

jfieldID lookUpField(JNIEnv* env, const char* function, jclass handle, const char* name,
                     const char* signature, bool isStatic) {
    Entry entry(env, function, std::string(name) + " " + signature);
    Class* type = entry.javaClass(handle);
    if (type == nullptr) return nullptr;
    Field* found = entry.fails() ? nullptr : type->findField(name, signature, isStatic);
    if (found == nullptr) return entry.raise("java/lang/NoSuchFieldError", name);
    entry.vm.handOut(found);
    return reinterpret_cast<jfieldID>(found);
}

jobject toReflectedMethod(JNIEnv* env, jclass, jmethodID id, jboolean) {
    Entry entry(env, "ToReflectedMethod");
    if (!entry.vm.isHandedOut(id)) {
        entry.violation("not a method ID");
        return nullptr;
    }
    return entry.local(entry.vm.reflect(*reinterpret_cast<Method*>(id)));
}

jobject allocObject(JNIEnv* env, jclass handle) {
    Entry entry(env, "AllocObject");
    Class* type = entry.javaClass(handle);
    if (type == nullptr) return nullptr;
    if (entry.fails()) return entry.outOfMemory();
    return entry.local(entry.vm.newObject(type->path));
}

Method* findNative(Class& type, const JNINativeMethod& row) {
    for (bool isStatic : {false, true}) {
        Method* found = type.findMethod(row.name, row.signature, isStatic);
        if (found != nullptr && found->isNative) return found;
    }
    return nullptr;
}

jint registerNatives(JNIEnv* env, jclass handle, const JNINativeMethod* rows, jint count) {
    Entry entry(env, "RegisterNatives", std::to_string(count));
    Class* type = entry.javaClass(handle);
    if (type == nullptr) return JNI_ERR;
    const bool failed = entry.fails();
    for (jint i = 0; i < count; ++i) {
        entry.vm.recordRegistration(rows[i]);
        Method* found = failed ? nullptr : findNative(*type, rows[i]);
        if (found == nullptr) {
            entry.raise("java/lang/NoSuchMethodError", rows[i].name);
            return JNI_ERR;
        }
        found->native = rows[i].fnPtr;
    }
    return JNI_OK;
}

}  // namespace

void installClasses(JNINativeInterface& table) {
    table.FindClass = findClass;
    table.GetObjectClass = getObjectClass;
    table.GetSuperclass = getSuperclass;
    table.IsInstanceOf = isInstanceOf;
    table.IsAssignableFrom = isAssignableFrom;
    table.AllocObject = allocObject;
    table.ToReflectedMethod = toReflectedMethod;
    table.RegisterNatives = registerNatives;
    table.GetMethodID = [](JNIEnv* env, jclass type, const char* name, const char* signature) {
        return lookUpMethod(env, "GetMethodID", type, name, signature, false);
    };
    table.GetStaticMethodID = [](JNIEnv* env, jclass type, const char* name,
                                 const char* signature) {
        return lookUpMethod(env, "GetStaticMethodID", type, name, signature, true);
    };
    table.GetFieldID = [](JNIEnv* env, jclass type, const char* name, const char* signature) {
        return lookUpField(env, "GetFieldID", type, name, signature, false);
    };
    table.GetStaticFieldID = [](JNIEnv* env, jclass type, const char* name, const char* signature) {
        return lookUpField(env, "GetStaticFieldID", type, name, signature, true);
    };
}

}  // namespace fakejni
