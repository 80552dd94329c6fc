// SPDX-License-Identifier: Apache-2.0
// Strings. Characters are handed out as copies that must be given back.
#include <string.h>

#include "FakeJni/EnvSupport.h"
#include "FakeJni/ModifiedUtf8.h"
#include "Trace.h"

namespace fakejni {

namespace {

const char* const kString = "java/lang/String";

jstring newString(JNIEnv* env, const jchar* units, jsize length) {
    const bool isText = units != nullptr && length > 0;
    const std::u16string text(units, units + (isText ? length : 0));
    Entry entry(env, "NewString", toModifiedUtf8(text));
    if (length < 0 || (units == nullptr && length > 0)) {
        entry.violation("bad text or length " + std::to_string(length));
        return nullptr;
    }
    if (entry.fails()) return entry.outOfMemory();
    return entry.local<jstring>(entry.vm.newString(text));
}

jstring newStringUtf(JNIEnv* env, const char* bytes) {
    Entry entry(env, "NewStringUTF", bytes == nullptr ? "null" : bytes);
    // Machines answer null with null; libraries rely on it.
    if (bytes == nullptr) return nullptr;
    std::u16string text;
    if (!fromModifiedUtf8(bytes, &text)) {
        entry.violation("text is no modified UTF-8");
        return nullptr;
    }
    if (entry.fails()) return entry.outOfMemory();
    return entry.local<jstring>(entry.vm.newString(text));
}

jsize getStringLength(JNIEnv* env, jstring handle) {
    Entry entry(env, "GetStringLength");
    ObjectPtr string = entry.object(handle, kString);
    return string == nullptr ? 0 : static_cast<jsize>(string->text->size());
}

jsize getStringUtfLength(JNIEnv* env, jstring handle) {
    Entry entry(env, "GetStringUTFLength");
    ObjectPtr string = entry.object(handle, kString);
    return string == nullptr ? 0 : static_cast<jsize>(toModifiedUtf8(*string->text).size());
}

// A pinned copy of count units; null with an OutOfMemoryError when it fails.
template <typename Unit>
const Unit* handOut(Entry& entry, const ObjectPtr& string, const Unit* units, size_t count,
                    jboolean* isCopy) {
    if (entry.fails()) return entry.outOfMemory();
    Unit* copy = static_cast<Unit*>(malloc((count + 1) * sizeof(Unit)));
    memcpy(copy, units, count * sizeof(Unit));
    copy[count] = 0;
    entry.vm.pin(copy, copy, entry.function(), string);
    if (isCopy != nullptr) *isCopy = JNI_TRUE;
    return copy;
}

const char* getStringUtfChars(JNIEnv* env, jstring handle, jboolean* isCopy) {
    Entry entry(env, "GetStringUTFChars");
    ObjectPtr string = entry.object(handle, kString);
    if (string == nullptr) return nullptr;
    const std::string bytes = toModifiedUtf8(*string->text);
    return handOut(entry, string, bytes.data(), bytes.size(), isCopy);
}

const jchar* getStringChars(JNIEnv* env, jstring handle, jboolean* isCopy) {
    Entry entry(env, "GetStringChars");
    ObjectPtr string = entry.object(handle, kString);
    if (string == nullptr) return nullptr;
    const std::vector<jchar> units(string->text->begin(), string->text->end());
    return handOut(entry, string, units.data(), units.size(), isCopy);
}

void giveBack(JNIEnv* env, const char* function, jstring handle, const void* buffer) {
    Entry entry(env, function, "", Entry::kAllowed);
    ObjectPtr string = entry.object(handle, kString);
    ObjectPtr owner = entry.vm.unpin(buffer, function);
    if (owner == nullptr) return;
    if (owner != string) entry.violation("the characters belong to another string");
    orvtest::Trace::add("jni", "  of " + toString(Value::of(owner)));
    free(const_cast<void*>(buffer));
}

}  // namespace

void installStrings(JNINativeInterface& table) {
    table.NewString = newString;
    table.NewStringUTF = newStringUtf;
    table.GetStringLength = getStringLength;
    table.GetStringUTFLength = getStringUtfLength;
    table.GetStringUTFChars = getStringUtfChars;
    table.GetStringChars = getStringChars;
    table.ReleaseStringUTFChars = [](JNIEnv* env, jstring string, const char* chars) {
        giveBack(env, "ReleaseStringUTFChars", string, chars);
    };
    table.ReleaseStringChars = [](JNIEnv* env, jstring string, const jchar* chars) {
        giveBack(env, "ReleaseStringChars", string, chars);
    };
}

}  // namespace fakejni
