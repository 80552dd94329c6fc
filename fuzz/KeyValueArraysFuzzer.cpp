// SPDX-License-Identifier: Apache-2.0
//
// Request headers from Java's two arrays, on their way to the engine. Input:
// "key TEXT" and "value TEXT" add an element, "nokey" and "novalue" a null one,
// "nokeys" and "novalues" make the array null, "fail N" has the machine's N-th
// call from then on fail.
#include <jni/KeyValueArrays.h>

#include <algorithm>
#include <map>
#include <optional>

#include "FakeJni/ModifiedUtf8.h"
#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using android::KeyedVector;
using android::String8;
using fakejni::ObjectPtr;
using orvfuzz::require;
using Texts = std::vector<ObjectPtr>;

constexpr size_t kMostElements = 1000;

struct Headers {
    std::optional<Texts> keys = Texts();
    std::optional<Texts> values = Texts();
    int failing = 0;
};

// What no string of Java's can hold becomes what came before it.
ObjectPtr textOf(fakejni::Vm& vm, const std::string& bytes) {
    std::u16string text;
    fakejni::fromModifiedUtf8(bytes.c_str(), &text);
    return vm.newString(text);
}

void add(std::optional<Texts>& texts, ObjectPtr text) {
    if (texts.has_value() && texts->size() < kMostElements) texts->push_back(std::move(text));
}

Headers headersOf(fakejni::Vm& vm, orvfuzz::Words words) {
    Headers headers;
    while (!words.atEnd()) {
        const std::string_view word = words.next();
        if (word == "key") add(headers.keys, textOf(vm, words.text()));
        if (word == "value") add(headers.values, textOf(vm, words.text()));
        if (word == "nokey") add(headers.keys, nullptr);
        if (word == "novalue") add(headers.values, nullptr);
        if (word == "nokeys") headers.keys.reset();
        if (word == "novalues") headers.values.reset();
        if (word == "fail") headers.failing = words.below(1000);
    }
    return headers;
}

jobjectArray arrayOf(fakejni::Vm& vm, const std::optional<Texts>& texts) {
    if (!texts.has_value()) return nullptr;
    return vm.local<jobjectArray>(vm.newArray("java/lang/String", *texts));
}

bool mismatch(const Headers& headers) {
    if (headers.keys.has_value() != headers.values.has_value()) return true;
    return headers.keys.has_value() && headers.keys->size() != headers.values->size();
}

// The pairs before the first that has a null.
std::map<std::string, std::string> pairsOf(const Headers& headers, bool& whole) {
    std::map<std::string, std::string> pairs;
    const size_t count = headers.keys.has_value() ? headers.keys->size() : 0;
    for (size_t i = 0; i < count; i++) {
        const ObjectPtr& key = (*headers.keys)[i];
        const ObjectPtr& value = (*headers.values)[i];
        whole = key != nullptr && value != nullptr;
        if (!whole) break;
        pairs[fakejni::toModifiedUtf8(*key->text)] = fakejni::toModifiedUtf8(*value->text);
    }
    return pairs;
}

void requirePairs(const KeyedVector<String8, String8>& found,
                  const std::map<std::string, std::string>& expected) {
    require(found.size() == expected.size(), "every pair arrives, an equal key once");
    size_t i = 0;
    for (const auto& [key, value] : expected) {
        require(key == found.keyAt(i).c_str() && value == found.valueAt(i).c_str(),
                "keys are in order, each with its last value");
        i++;
    }
}

void requireResult(fakejni::Vm& vm, const Headers& headers, bool good, bool failed,
                   const KeyedVector<String8, String8>& found) {
    const auto thrown = vm.pending();
    if (mismatch(headers)) {
        require(!good && found.isEmpty(), "arrays of different lengths give nothing");
        require(thrown.has_value() && thrown->type == "java/lang/IllegalArgumentException",
                "arrays of different lengths are an illegal argument");
        return;
    }
    bool whole = true;
    const auto expected = pairsOf(headers, whole);
    if (failed) {
        require(!good && thrown.has_value(), "a failure of the machine is handed on");
        require(found.size() <= expected.size(), "a failure adds no pair");
        return;
    }
    require(good == whole && !thrown.has_value(), "a null element ends the conversion");
    requirePairs(found, expected);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvfuzz::PlayerMachine machine;
    fakejni::Vm& vm = machine.vm;
    const Headers headers = headersOf(vm, {data, size});
    jobjectArray keys = arrayOf(vm, headers.keys);
    jobjectArray values = arrayOf(vm, headers.values);
    if (headers.failing > 0 && !mismatch(headers)) vm.failNth(headers.failing);
    const int failures = vm.failures();
    const size_t before = vm.localReferences();
    KeyedVector<String8, String8> found;
    const bool good = android::ConvertKeyValueArraysToKeyedVector(vm.env(), keys, values, &found);
    requireResult(vm, headers, good, vm.failures() != failures, found);
    if (good) require(vm.localReferences() == before, "the loop leaves no reference");
    machine.finish();
    return 0;
}
