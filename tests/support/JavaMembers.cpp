// SPDX-License-Identifier: Apache-2.0
#include "JavaMembers.h"

#include <fstream>
#include <sstream>
#include <stdexcept>

namespace orvtest {
namespace {

using fakejni::Class;
using fakejni::ObjectPtr;
using fakejni::Value;

Class& classOf(fakejni::Vm& vm, const std::string& path) {
    Class* known = vm.find(path);
    return known == nullptr ? vm.define(path) : *known;
}

void define(fakejni::Vm& vm, Class& type, const std::string& line) {
    std::istringstream words(line);
    std::string kind;
    std::string name;
    std::string signature;
    words >> kind >> name >> signature;
    if (kind == "extends") {
        type.super = &classOf(vm, name);
    } else if (kind == "field" && type.findField(name, signature, false) == nullptr) {
        type.field(name, signature);
    } else if (kind == "method" && type.findMethod(name, signature, false) == nullptr) {
        type.method(name, signature);
    }
}

}  // namespace

void defineJavaMembers(fakejni::Vm& vm, const std::string& list) {
    std::ifstream in(list);
    if (!in) throw std::runtime_error("cannot read " + list);
    Class* type = nullptr;
    for (std::string line; std::getline(in, line);) {
        if (line.rfind("class ", 0) == 0) type = &classOf(vm, line.substr(6));
        if (line.rfind("    ", 0) == 0) define(vm, *type, line);
    }
}

ObjectPtr newFilledObject(fakejni::Vm& vm, const std::string& path) {
    ObjectPtr object = vm.newObject(path);
    for (const Class* type = object->type; type != nullptr; type = type->super) {
        for (const auto& field : type->fields) {
            const std::string& signature = field->signature;
            if (field->isStatic) continue;
            if (signature == "I") object->set(field->name, Value::ofInt(1));
            if (signature[0] == 'L') {
                const std::string nested = signature.substr(1, signature.size() - 2);
                object->set(field->name, Value::of(newFilledObject(vm, nested)));
            }
        }
    }
    return object;
}

}  // namespace orvtest
