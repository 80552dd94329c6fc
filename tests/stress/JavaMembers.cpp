// SPDX-License-Identifier: Apache-2.0
#include "JavaMembers.h"

#include <fstream>
#include <sstream>
#include <stdexcept>

namespace stress {

namespace {

void defineMember(fakejni::Class& type, const std::string& kind, std::istringstream& rest) {
    std::string name;
    std::string signature;
    rest >> name >> signature;
    if (kind == "field" && type.findField(name, signature, false) == nullptr) {
        type.field(name, signature);
    } else if (kind == "method" && type.findMethod(name, signature, false) == nullptr) {
        type.method(name, signature);
    }
}

// The class, derived from what the next line names if it does.
fakejni::Class& classOf(fakejni::Vm& vm, const std::string& path, std::ifstream& list) {
    fakejni::Class* found = vm.find(path);
    if (found != nullptr) return *found;
    const std::streampos here = list.tellg();
    std::string word;
    std::string super;
    if (list >> word >> super && word == "extends") return vm.define(path, super);
    list.clear();
    list.seekg(here);
    return vm.define(path);
}

}  // namespace

void defineJavaMembers(fakejni::Vm& vm, const std::string& list) {
    std::ifstream file(list);
    if (!file) throw std::runtime_error("cannot read " + list);
    fakejni::Class* type = nullptr;
    for (std::string line; std::getline(file, line);) {
        std::istringstream words(line);
        std::string kind;
        words >> kind;
        if (kind == "class") {
            std::string path;
            words >> path;
            type = &classOf(vm, path, file);
        } else if (type != nullptr) {
            defineMember(*type, kind, words);
        }
    }
}

}  // namespace stress
