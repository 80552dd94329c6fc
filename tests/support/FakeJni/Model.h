// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

// The Java side of the fake virtual machine: classes, objects and values, as
// plain data that tests build and look into.
namespace fakejni {

class Vm;
struct Class;
struct Object;
using ObjectPtr = std::shared_ptr<Object>;

// A Java value. type is the JNI letter: Z B C S I J F D, L for every
// reference (arrays too, null included), V for none.
struct Value {
    char type = 'V';
    int64_t integer = 0;  // Z B C S I J
    double real = 0;      // F D
    ObjectPtr object;     // L

    static Value ofBoolean(bool v) { return {'Z', v, 0, nullptr}; }
    static Value ofByte(jbyte v) { return {'B', v, 0, nullptr}; }
    static Value ofChar(jchar v) { return {'C', v, 0, nullptr}; }
    static Value ofShort(jshort v) { return {'S', v, 0, nullptr}; }
    static Value ofInt(jint v) { return {'I', v, 0, nullptr}; }
    static Value ofLong(jlong v) { return {'J', v, 0, nullptr}; }
    static Value ofFloat(jfloat v) { return {'F', 0, v, nullptr}; }
    static Value ofDouble(jdouble v) { return {'D', 0, v, nullptr}; }
    static Value of(ObjectPtr v) { return {'L', 0, 0, std::move(v)}; }
    // The zero, false or null that a field of that signature starts with.
    static Value zero(char type) { return {type, 0, 0, nullptr}; }
};

// As a Java programmer would write it: 5, true, null, "text", byte[3], a class path.
std::string toString(const Value& value);

// One call of a Java method from native code.
struct Invocation {
    Vm& vm;
    ObjectPtr self;  // null for static methods
    std::vector<Value> args;
};
using Implementation = std::function<Value(const Invocation&)>;

struct Field {
    Class* owner;
    std::string name;
    std::string signature;
    bool isStatic;
    Value value;  // of static fields
};

struct Method {
    Class* owner;
    std::string name;
    std::string signature;
    bool isStatic;
    bool isNative;
    Implementation implementation;  // none: answers zero
    void* native = nullptr;         // what RegisterNatives gave
};

struct Class {
    std::string path;  // "java/lang/String", "[B"
    Class* super;
    std::vector<std::unique_ptr<Field>> fields;
    std::vector<std::unique_ptr<Method>> methods;
    ObjectPtr mirror;  // its java.lang.Class

    Field& field(const std::string& name, const std::string& signature);
    Field& staticField(const std::string& name, const std::string& signature);
    Method& method(const std::string& name, const std::string& signature, Implementation body = {});
    Method& staticMethod(const std::string& name, const std::string& signature,
                         Implementation body = {});
    Method& nativeMethod(const std::string& name, const std::string& signature,
                         bool isStatic = false);
    // Takes every field and method of that name away. IDs handed out stay valid.
    void remove(const std::string& name);

    // Looked up here and in the superclasses; null when there is none.
    Field* findField(const std::string& name, const std::string& signature, bool isStatic);
    Method* findMethod(const std::string& name, const std::string& signature, bool isStatic);
    bool isSubclassOf(const Class* other) const;

private:
    std::vector<std::unique_ptr<Field>> mRemovedFields;
    std::vector<std::unique_ptr<Method>> mRemovedMethods;
};

struct Object {
    Class* type;
    std::map<const Field*, Value> fields;  // what was written; the rest is zero
    std::optional<std::u16string> text;    // of strings; of throwables, the message
    std::vector<uint8_t> bytes;            // of byte[]
    std::vector<ObjectPtr> elements;       // of object arrays
    Class* reflected = nullptr;            // of java.lang.Class
    Method* reflectedMethod = nullptr;     // of java.lang.reflect.Method
    int monitorEntries = 0;

    // By name, for tests. Aborts for a field the class does not have.
    Value get(const std::string& fieldName) const;
    void set(const std::string& fieldName, Value value);
};

// The letters of a method's parameters and of its result.
struct Shape {
    std::string parameters;  // one letter each, L for references
    char result;
};
Shape shapeOf(const std::string& signature);

// The letter of a field's signature, L for every reference.
char letterOf(const std::string& signature);

}  // namespace fakejni
