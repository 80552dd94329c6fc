// SPDX-License-Identifier: Apache-2.0
// The classes every virtual machine starts with: java.lang's base, what
// reflection needs, and the exceptions.
#include <algorithm>

#include "FakeJni/Vm.h"

namespace fakejni {

namespace {

const char* const kExceptionClasses[][2] = {
    {"java/lang/Exception", "java/lang/Throwable"},
    {"java/lang/RuntimeException", "java/lang/Exception"},
    {"java/lang/IllegalStateException", "java/lang/RuntimeException"},
    {"java/lang/IllegalArgumentException", "java/lang/RuntimeException"},
    {"java/lang/SecurityException", "java/lang/RuntimeException"},
    {"java/lang/ArrayIndexOutOfBoundsException", "java/lang/RuntimeException"},
    {"java/io/IOException", "java/lang/Exception"},
    {"java/lang/Error", "java/lang/Throwable"},
    {"java/lang/OutOfMemoryError", "java/lang/Error"},
    {"java/lang/NoClassDefFoundError", "java/lang/Error"},
    {"java/lang/NoSuchFieldError", "java/lang/Error"},
    {"java/lang/NoSuchMethodError", "java/lang/Error"},
};

std::string declarationOf(const Method& method) {
    return std::string("public ") + (method.isStatic ? "static " : "") +
           (method.isNative ? "native " : "") + method.owner->path + "." + method.name +
           method.signature;
}

Value className(const Invocation& call) {
    std::string name = call.self->reflected->path;
    std::replace(name.begin(), name.end(), '/', '.');
    return Value::of(call.vm.newString(name));
}

Value declaredMethods(const Invocation& call) {
    std::vector<ObjectPtr> methods;
    for (const auto& method : call.self->reflected->methods)
        methods.push_back(call.vm.reflect(*method));
    return Value::of(call.vm.newArray("java/lang/reflect/Method", methods));
}

Value throwableMessage(const Invocation& call) {
    const auto& message = call.self->text;
    return Value::of(message ? call.vm.newString(*message) : nullptr);
}

// The platform's helper throws by a constructor or, in earlier releases, without.
Value constructThrowable(const Invocation& call) {
    const ObjectPtr& message = call.args[0].object;
    if (message != nullptr) call.self->text = message->text;
    return {};
}

}  // namespace

void Vm::defineBaseClasses() {
    add("java/lang/Object", nullptr);
    Class& reflection = define("java/lang/Class");
    for (auto& [path, existing] : mClasses) existing->mirror->type = &reflection;
    define("java/lang/String");
    Class& throwable = define("java/lang/Throwable");
    Class& method = define("java/lang/reflect/Method");
    for (const auto& [path, super] : kExceptionClasses) {
        define(path, super).method("<init>", "(Ljava/lang/String;)V", constructThrowable);
    }

    reflection.method("getName", "()Ljava/lang/String;", className);
    reflection.method("getDeclaredMethods", "()[Ljava/lang/reflect/Method;", declaredMethods);
    throwable.method("getMessage", "()Ljava/lang/String;", throwableMessage);
    method.method("getName", "()Ljava/lang/String;", [](const Invocation& call) {
        return Value::of(call.vm.newString(call.self->reflectedMethod->name));
    });
    method.method("toString", "()Ljava/lang/String;", [](const Invocation& call) {
        return Value::of(call.vm.newString(declarationOf(*call.self->reflectedMethod)));
    });
}

ObjectPtr Vm::reflect(Method& method) {
    ObjectPtr object = newObject("java/lang/reflect/Method");
    object->reflectedMethod = &method;
    return object;
}

}  // namespace fakejni
