// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>
#include <stdio.h>
#include <stdlib.h>

#include <string>
#include <type_traits>

#include "FakeJni/EnvSupport.h"

// Calls a registered native method as the virtual machine does: looked up by
// name and signature, arguments in their exact JNI types, a frame of local
// references around it.
namespace fakejni {

// The JNI letter of a C++ parameter type.
template <typename T>
constexpr char letter() {
    if constexpr (std::is_void_v<T>) return 'V';
    if constexpr (std::is_pointer_v<T>) return 'L';
    if constexpr (std::is_same_v<T, jboolean>) return 'Z';
    if constexpr (std::is_same_v<T, jbyte>) return 'B';
    if constexpr (std::is_same_v<T, jchar>) return 'C';
    if constexpr (std::is_same_v<T, jshort>) return 'S';
    if constexpr (std::is_same_v<T, jint>) return 'I';
    if constexpr (std::is_same_v<T, jlong>) return 'J';
    if constexpr (std::is_same_v<T, jfloat>) return 'F';
    if constexpr (std::is_same_v<T, jdouble>) return 'D';
}

struct NativeResult {
    Value value;
    size_t locals;  // local references left for the machine to free, the result's included
};

// The registered function; stops the program when the row is absent, has no
// function, or its signature is not that of the call.
inline void* nativeFunction(Vm& vm, Class& type, const std::string& name,
                            const std::string& signature, const Shape& call) {
    for (bool isStatic : {false, true}) {
        Method* method = type.findMethod(name, signature, isStatic);
        if (method == nullptr) continue;
        const Shape shape = shapeOf(signature);
        if (method->native != nullptr && shape.parameters == call.parameters &&
            shape.result == call.result)
            return method->native;
    }
    (void)vm;
    fprintf(stderr, "fakejni: no native %s%s for a call of (%s)%c\n", name.c_str(),
            signature.c_str(), call.parameters.c_str(), call.result);
    abort();
}

template <typename R>
Value toValue(Vm& vm, R result) {
    if constexpr (std::is_pointer_v<R>) {
        return Value::of(vm.deref(result));
    } else if constexpr (std::is_floating_point_v<R>) {
        return {letter<R>(), 0, result, nullptr};
    } else {
        return {letter<R>(), static_cast<int64_t>(result), 0, nullptr};
    }
}

inline size_t markOf(Vm& vm) {
    std::lock_guard<MachineMutex> lock(vm.mutex());
    return vm.references().mark();
}

// thiz is the object, or for static methods the class. R and the arguments
// must be the JNI types of the signature.
template <typename R, typename... A>
NativeResult callNative(Vm& vm, Class& type, jobject thiz, const std::string& name,
                        const std::string& signature, A... args) {
    const Shape shape{std::string{letter<A>()...}, letter<R>()};
    auto function = reinterpret_cast<R (*)(JNIEnv*, jobject, A...)>(
        nativeFunction(vm, type, name, signature, shape));
    const int thread = threadNumber();
    const size_t mark = markOf(vm);
    NativeResult result{};
    if constexpr (std::is_void_v<R>) {
        function(vm.env(), thiz, args...);
    } else {
        result.value = toValue(vm, function(vm.env(), thiz, args...));
    }
    std::lock_guard<MachineMutex> lock(vm.mutex());
    result.locals = vm.references().liveLocalsSince(mark, thread);
    vm.references().dropLocalsSince(mark, thread);
    return result;
}

}  // namespace fakejni
