// SPDX-License-Identifier: Apache-2.0
// Calling Java methods: instance, static and non-virtual calls and
// constructors, each with variadic, va_list and array arguments.
#include <stdarg.h>

#include "FakeJni/EnvSupport.h"

namespace fakejni {

namespace {

Method* methodOf(JNIEnv* env, jmethodID id) {
    Vm& vm = *static_cast<FakeEnv*>(env)->vm;
    return vm.isHandedOut(id) ? reinterpret_cast<Method*>(id) : nullptr;
}

// Where the arguments of a call stand. The method's signature alone says how
// they are read.
class ArgumentList {
public:
    explicit ArgumentList(va_list list) : mArray(nullptr) { va_copy(mList, list); }
    explicit ArgumentList(const jvalue* array) : mArray(array) {}
    ~ArgumentList() {
        if (mArray == nullptr) va_end(mList);
    }
    ArgumentList(const ArgumentList&) = delete;
    ArgumentList& operator=(const ArgumentList&) = delete;

    Value next(Entry& entry, char type) {
        return mArray != nullptr ? fromArray(entry, type) : fromList(entry, type);
    }

private:
    Value fromList(Entry& entry, char type) {
        switch (type) {
            case 'L':
                return Value::of(entry.object(va_arg(mList, jobject), true));
            case 'J':
                return Value::ofLong(va_arg(mList, jlong));
            case 'F':
                return Value::ofFloat(static_cast<jfloat>(va_arg(mList, double)));
            case 'D':
                return Value::ofDouble(va_arg(mList, double));
            default:
                return narrowed(type, va_arg(mList, jint));
        }
    }

    Value fromArray(Entry& entry, char type) {
        const jvalue& value = *mArray++;
        switch (type) {
            case 'L':
                return Value::of(entry.object(value.l, true));
            case 'J':
                return Value::ofLong(value.j);
            case 'F':
                return Value::ofFloat(value.f);
            case 'D':
                return Value::ofDouble(value.d);
            default:
                return narrowed(type, value.i);
        }
    }

    static Value narrowed(char type, jint value) {
        switch (type) {
            case 'Z':
                return Value::ofBoolean(static_cast<jboolean>(value) != 0);
            case 'B':
                return Value::ofByte(static_cast<jbyte>(value));
            case 'C':
                return Value::ofChar(static_cast<jchar>(value));
            case 'S':
                return Value::ofShort(static_cast<jshort>(value));
            default:
                return Value::ofInt(value);
        }
    }

    va_list mList;
    const jvalue* mArray;
};

// What a call is made on and which result its form expects.
struct Target {
    const char* form;
    char result;
    bool isStatic;
};

// A void method may be called through the long-returning form, as the
// library's stream adapter does; any other mismatch is a breach.
bool resultFits(const Method& method, char form) {
    const char actual = shapeOf(method.signature).result;
    return actual == form || (actual == 'V' && form == 'J');
}

bool fits(Entry& entry, const Method& method, const Target& target, Class* type) {
    if (method.isStatic != target.isStatic) {
        entry.violation(method.name + (method.isStatic ? " is static" : " is not static"));
    } else if (!resultFits(method, target.result)) {
        entry.violation(method.name + " is a " + method.signature);
    } else if (type == nullptr || !type->isSubclassOf(method.owner)) {
        entry.violation((type == nullptr ? "null" : type->path) + " has no method " + method.name);
    } else {
        return true;
    }
    return false;
}

// Runs the method's Java side without the machine's lock: it may block, or
// call the machine again.
Value run(Entry& entry, const Method& method, const char* form, const ObjectPtr& self,
          ArgumentList& arguments) {
    std::vector<Value> args;
    const Shape shape = shapeOf(method.signature);
    for (char type : shape.parameters) args.push_back(arguments.next(entry, type));
    // How the platform makes its exceptions is its own affair.
    if (method.name != "<init>") {
        entry.vm.recordJava({method.name, form, self, args, std::this_thread::get_id()});
    }
    Value result = Value::zero(shape.result);
    if (method.implementation) {
        const Implementation body = method.implementation;
        entry.unlock();
        result = body({entry.vm, self, args});
        entry.lock();
    }
    return entry.thread.pending == nullptr ? result : Value::zero(shape.result);
}

Value invoke(Entry& entry, const Target& target, jobject handle, jmethodID id,
             ArgumentList& arguments) {
    Value zero = Value::zero(target.result);
    if (!entry.vm.isHandedOut(id)) {
        entry.violation("not a method ID");
        return zero;
    }
    Class* type = nullptr;
    ObjectPtr self;
    if (target.isStatic) {
        type = entry.javaClass(static_cast<jclass>(handle));
    } else {
        self = entry.object(handle);
        if (self != nullptr) type = self->type;
    }
    Method* method = reinterpret_cast<Method*>(id);
    if (!fits(entry, *method, target, type)) return zero;
    if (entry.fails()) {
        entry.raise("java/lang/RuntimeException", method->name);
        return zero;
    }
    if (!target.isStatic) {
        Method* overriding = type->findMethod(method->name, method->signature, false);
        if (overriding != nullptr) method = overriding;
    }
    return run(entry, *method, target.form, self, arguments);
}

template <typename T>
T unwrap(Entry&, const Value& value, T*) {
    return std::is_floating_point<T>::value ? static_cast<T>(value.real)
                                            : static_cast<T>(value.integer);
}
jobject unwrap(Entry& entry, const Value& value, jobject*) { return entry.local(value.object); }
void unwrap(Entry&, const Value&, void*) {}

template <typename T, typename Arguments>
T call(JNIEnv* env, const Target& target, jobject handle, jmethodID id, Arguments arguments) {
    const Method* method = methodOf(env, id);
    Entry entry(env, target.form, method == nullptr ? "?" : method->name);
    ArgumentList list(arguments);
    const Value result = invoke(entry, target, handle, id, list);
    return unwrap(entry, result, static_cast<T*>(nullptr));
}

template <typename Arguments>
jobject construct(JNIEnv* env, jclass classHandle, jmethodID id, Arguments arguments) {
    Entry entry(env, "NewObject");
    Class* type = entry.javaClass(classHandle);
    const Method* method = methodOf(env, id);
    if (type == nullptr || method == nullptr || method->owner != type || method->name != "<init>") {
        entry.violation("not a constructor of the class");
        return nullptr;
    }
    if (entry.fails()) return entry.outOfMemory();
    ObjectPtr made = entry.vm.newObject(type->path);
    ArgumentList list(arguments);
    run(entry, *method, "NewObject", made, list);
    return entry.thread.pending == nullptr ? entry.local(made) : nullptr;
}

// A call's three forms, for one target.
template <typename T, typename Handle, const Target& target>
struct Forms {
    static T variadic(JNIEnv* env, Handle handle, jmethodID id, ...) {
        va_list list;
        va_start(list, id);
        struct End {
            va_list& list;
            ~End() { va_end(list); }
        } end{list};
        return call<T>(env, target, handle, id, list);
    }
    static T fromList(JNIEnv* env, Handle handle, jmethodID id, va_list list) {
        return call<T>(env, target, handle, id, list);
    }
    static T fromArray(JNIEnv* env, Handle handle, jmethodID id, const jvalue* values) {
        return call<T>(env, target, handle, id, values);
    }
};

jobject newObject(JNIEnv* env, jclass type, jmethodID id, ...) {
    va_list list;
    va_start(list, id);
    jobject made = construct(env, type, id, list);
    va_end(list);
    return made;
}

#define FOR_EACH_RESULT(X)    \
    X(Object, jobject, 'L')   \
    X(Boolean, jboolean, 'Z') \
    X(Byte, jbyte, 'B')       \
    X(Char, jchar, 'C')       \
    X(Short, jshort, 'S')     \
    X(Int, jint, 'I')         \
    X(Long, jlong, 'J')       \
    X(Float, jfloat, 'F')     \
    X(Double, jdouble, 'D')   \
    X(Void, void, 'V')

#define TARGETS(Name, T, letter)                                           \
    constexpr Target kCall##Name = {"Call" #Name "Method", letter, false}; \
    constexpr Target kCallStatic##Name = {"CallStatic" #Name "Method", letter, true};
FOR_EACH_RESULT(TARGETS)
#undef TARGETS

}  // namespace

void installMethods(JNINativeInterface& table) {
#define INSTALL(Name, T, letter)                                                     \
    table.Call##Name##Method = Forms<T, jobject, kCall##Name>::variadic;             \
    table.Call##Name##MethodV = Forms<T, jobject, kCall##Name>::fromList;            \
    table.Call##Name##MethodA = Forms<T, jobject, kCall##Name>::fromArray;           \
    table.CallStatic##Name##Method = Forms<T, jclass, kCallStatic##Name>::variadic;  \
    table.CallStatic##Name##MethodV = Forms<T, jclass, kCallStatic##Name>::fromList; \
    table.CallStatic##Name##MethodA = Forms<T, jclass, kCallStatic##Name>::fromArray;
    FOR_EACH_RESULT(INSTALL)
#undef INSTALL
#undef FOR_EACH_RESULT
    table.NewObject = newObject;
    table.NewObjectV = [](JNIEnv* env, jclass type, jmethodID id, va_list list) {
        return construct(env, type, id, list);
    };
    table.NewObjectA = [](JNIEnv* env, jclass type, jmethodID id, const jvalue* values) {
        return construct(env, type, id, values);
    };
}

}  // namespace fakejni
