// SPDX-License-Identifier: Apache-2.0
#include "FakeJni/Vm.h"

#include <stdio.h>
#include <stdlib.h>

#include <algorithm>

#include "FakeJni/EnvSupport.h"
#include "FakeJni/ModifiedUtf8.h"

namespace fakejni {

namespace {

using Lock = std::lock_guard<MachineMutex>;

}  // namespace

struct Vm::Machine {
    FakeJavaVm vm;
};

std::string toString(const JavaCall& call) {
    std::string text = call.method + "(";
    for (size_t i = 0; i < call.args.size(); ++i) {
        if (i != 0) text += ", ";
        text += toString(call.args[i]);
    }
    return text + ")";
}

Vm::Vm() : mMachine(new Machine) {
    mMachine->vm.functions = vmTable();
    mMachine->vm.vm = this;
    defineBaseClasses();
    JNIEnv* env;
    attach(&env, true);
}

Vm::~Vm() {
    for (const auto& [buffer, pin] : mPins) free(pin.block);
}

JavaVM* Vm::javaVm() { return &mMachine->vm; }

JNIEnv* Vm::env() {
    ThreadState& thread = thisThread();
    return thread.attached ? &thread.env : nullptr;
}

Class& Vm::add(const std::string& path, Class* super) {
    std::unique_ptr<Class>& added = mClasses[path];
    added = std::make_unique<Class>();
    added->path = path;
    added->super = super;
    added->mirror = std::make_shared<Object>();
    added->mirror->type = mClasses.count("java/lang/Class") ? find("java/lang/Class") : nullptr;
    added->mirror->reflected = added.get();
    return *added;
}

Class& Vm::define(const std::string& path, const std::string& super) {
    Lock lock(mMutex);
    if (mClasses.count(path) != 0 || mClasses.count(super) == 0) {
        fprintf(stderr, "fakejni: cannot define %s on %s\n", path.c_str(), super.c_str());
        abort();
    }
    return add(path, mClasses[super].get());
}

Class* Vm::find(const std::string& path) {
    Lock lock(mMutex);
    if (std::find(mHidden.begin(), mHidden.end(), path) != mHidden.end()) return nullptr;
    auto found = mClasses.find(path);
    if (found != mClasses.end()) return found->second.get();
    return path[0] == '[' ? &add(path, mClasses["java/lang/Object"].get()) : nullptr;
}

void Vm::hide(const std::string& path) {
    Lock lock(mMutex);
    mHidden.push_back(path);
}

ObjectPtr Vm::newObject(const std::string& path) {
    Class* type = find(path);
    if (type == nullptr) {
        fprintf(stderr, "fakejni: no class %s\n", path.c_str());
        abort();
    }
    auto object = std::make_shared<Object>();
    object->type = type;
    return object;
}

ObjectPtr Vm::newString(const std::u16string& text) {
    ObjectPtr object = newObject("java/lang/String");
    object->text = text;
    return object;
}

ObjectPtr Vm::newString(const std::string& modifiedUtf8) {
    std::u16string text;
    if (!fromModifiedUtf8(modifiedUtf8.c_str(), &text)) violation("text is no modified UTF-8");
    return newString(text);
}

ObjectPtr Vm::newBytes(std::vector<uint8_t> bytes) {
    ObjectPtr object = newObject("[B");
    object->bytes = std::move(bytes);
    return object;
}

ObjectPtr Vm::newArray(const std::string& elementPath, std::vector<ObjectPtr> elements) {
    ObjectPtr object =
        newObject(elementPath[0] == '[' ? "[" + elementPath : "[L" + elementPath + ";");
    object->elements = std::move(elements);
    return object;
}

jobject Vm::makeLocal(ObjectPtr object) {
    Lock lock(mMutex);
    return mReferences.make(RefKind::kLocal, std::move(object), threadNumber());
}

ObjectPtr Vm::deref(jobject handle) {
    Lock lock(mMutex);
    std::string fault;
    ObjectPtr object = mReferences.resolve(handle, threadNumber(), &fault);
    if (!fault.empty()) violation(fault);
    return object;
}

std::optional<Thrown> Vm::pending() {
    ObjectPtr thrown = thisThread().pending;
    if (thrown == nullptr) return {};
    Thrown result{thrown->type->path, {}};
    if (thrown->text) result.message = toModifiedUtf8(*thrown->text);
    return result;
}

void Vm::clearPending() { thisThread().pending = nullptr; }

void Vm::raise(const std::string& path, const std::optional<std::string>& message) {
    ObjectPtr thrown = newObject(path);
    if (message) {
        thrown->text.emplace();
        fromModifiedUtf8(message->c_str(), &*thrown->text);
    }
    thisThread().pending = thrown;
}

}  // namespace fakejni
