// SPDX-License-Identifier: Apache-2.0
#include "FakeJni/Model.h"

#include <stdio.h>
#include <stdlib.h>

#include <algorithm>

#include "FakeJni/ModifiedUtf8.h"

namespace fakejni {

namespace {

std::string objectToString(const Object& object) {
    const std::string& path = object.type->path;
    if (path == "java/lang/String") return '"' + toModifiedUtf8(*object.text) + '"';
    if (path == "[B") return "byte[" + std::to_string(object.bytes.size()) + "]";
    if (path[0] == '[') return path + "[" + std::to_string(object.elements.size()) + "]";
    return path;
}

const Field& fieldNamed(const Object& object, const std::string& name) {
    for (Class* c = object.type; c != nullptr; c = c->super) {
        for (const auto& field : c->fields) {
            if (field->name == name) return *field;
        }
    }
    fprintf(stderr, "fakejni: %s has no field %s\n", object.type->path.c_str(), name.c_str());
    abort();
}

template <typename Member>
void moveNamed(std::vector<std::unique_ptr<Member>>& from, const std::string& name,
               std::vector<std::unique_ptr<Member>>& to) {
    auto rest = std::stable_partition(from.begin(), from.end(),
                                      [&](const auto& member) { return member->name != name; });
    std::move(rest, from.end(), std::back_inserter(to));
    from.erase(rest, from.end());
}

template <typename Member>
Member* findMember(const std::vector<std::unique_ptr<Member>>& members, const std::string& name,
                   const std::string& signature, bool isStatic) {
    for (const auto& member : members) {
        if (member->name == name && member->signature == signature && member->isStatic == isStatic)
            return member.get();
    }
    return nullptr;
}

}  // namespace

std::string toString(const Value& value) {
    switch (value.type) {
        case 'V':
            return "void";
        case 'Z':
            return value.integer == 0   ? "false"
                   : value.integer == 1 ? "true"
                                        : "boolean(" + std::to_string(value.integer) + ")";
        case 'F':
        case 'D': {
            char text[32];
            snprintf(text, sizeof text, "%g", value.real);
            return text;
        }
        case 'L':
            return value.object == nullptr ? "null" : objectToString(*value.object);
        default:
            return std::to_string(value.integer);
    }
}

Field& Class::field(const std::string& name, const std::string& signature) {
    fields.emplace_back(new Field{this, name, signature, false, Value::zero(letterOf(signature))});
    return *fields.back();
}

Field& Class::staticField(const std::string& name, const std::string& signature) {
    fields.emplace_back(new Field{this, name, signature, true, Value::zero(letterOf(signature))});
    return *fields.back();
}

Method& Class::method(const std::string& name, const std::string& signature, Implementation body) {
    methods.emplace_back(new Method{this, name, signature, false, false, std::move(body)});
    return *methods.back();
}

Method& Class::staticMethod(const std::string& name, const std::string& signature,
                            Implementation body) {
    methods.emplace_back(new Method{this, name, signature, true, false, std::move(body)});
    return *methods.back();
}

Method& Class::nativeMethod(const std::string& name, const std::string& signature, bool isStatic) {
    methods.emplace_back(new Method{this, name, signature, isStatic, true, {}});
    return *methods.back();
}

void Class::remove(const std::string& name) {
    moveNamed(fields, name, mRemovedFields);
    moveNamed(methods, name, mRemovedMethods);
}

Field* Class::findField(const std::string& name, const std::string& signature, bool isStatic) {
    for (Class* c = this; c != nullptr; c = c->super) {
        if (Field* found = findMember(c->fields, name, signature, isStatic)) return found;
    }
    return nullptr;
}

Method* Class::findMethod(const std::string& name, const std::string& signature, bool isStatic) {
    for (Class* c = this; c != nullptr; c = c->super) {
        if (Method* found = findMember(c->methods, name, signature, isStatic)) return found;
        if (name == "<init>") return nullptr;  // constructors are not inherited
    }
    return nullptr;
}

bool Class::isSubclassOf(const Class* other) const {
    for (const Class* c = this; c != nullptr; c = c->super) {
        if (c == other) return true;
    }
    return false;
}

Value Object::get(const std::string& fieldName) const {
    const Field& field = fieldNamed(*this, fieldName);
    if (field.isStatic) return field.value;
    auto found = fields.find(&field);
    return found != fields.end() ? found->second : Value::zero(letterOf(field.signature));
}

void Object::set(const std::string& fieldName, Value value) {
    const Field& field = fieldNamed(*this, fieldName);
    value.type = letterOf(field.signature);
    fields[&field] = std::move(value);
}

char letterOf(const std::string& signature) { return signature[0] == '[' ? 'L' : signature[0]; }

Shape shapeOf(const std::string& signature) {
    Shape shape;
    size_t at = 1;  // behind the parenthesis
    while (signature[at] != ')') {
        shape.parameters += letterOf(signature.substr(at, 1));
        while (signature[at] == '[') ++at;
        if (signature[at] == 'L') at = signature.find(';', at);
        ++at;
    }
    shape.result = letterOf(signature.substr(at + 1));
    return shape;
}

}  // namespace fakejni
