// SPDX-License-Identifier: Apache-2.0
// Object arrays and byte arrays. Elements are handed out as copies between
// guard bytes, so that a write past either end is seen.
#include <string.h>

#include <algorithm>

#include "FakeJni/EnvSupport.h"
#include "Trace.h"

namespace fakejni {

namespace {

constexpr size_t kGuard = 16;
constexpr uint8_t kGuardByte = 0xA5;

bool isIntact(const uint8_t* guard) {
    return std::all_of(guard, guard + kGuard, [](uint8_t byte) { return byte == kGuardByte; });
}

bool isObjectArray(const Object& object) {
    const std::string& path = object.type->path;
    return path[0] == '[' && (path[1] == 'L' || path[1] == '[');
}

jsize getArrayLength(JNIEnv* env, jarray handle) {
    Entry entry(env, "GetArrayLength");
    ObjectPtr array = entry.object(handle);
    if (array == nullptr) return 0;
    if (array->type->path[0] != '[') entry.violation(array->type->path + " is no array");
    return static_cast<jsize>(isObjectArray(*array) ? array->elements.size() : array->bytes.size());
}

jobjectArray newObjectArray(JNIEnv* env, jsize length, jclass elementHandle, jobject initial) {
    Entry entry(env, "NewObjectArray", std::to_string(length));
    Class* element = entry.javaClass(elementHandle);
    if (element == nullptr || length < 0) {
        entry.violation("bad class or length");
        return nullptr;
    }
    if (entry.fails()) return entry.outOfMemory();
    std::vector<ObjectPtr> elements(length, entry.object(initial, true));
    return entry.local<jobjectArray>(entry.vm.newArray(element->path, elements));
}

// The element's place; null with a pending exception for a bad index.
ObjectPtr* elementOf(Entry& entry, jobjectArray handle, jsize index) {
    ObjectPtr array = entry.object(handle);
    if (array == nullptr) return nullptr;
    if (!isObjectArray(*array)) {
        entry.violation(array->type->path + " is no object array");
        return nullptr;
    }
    const bool inRange = index >= 0 && static_cast<size_t>(index) < array->elements.size();
    if (inRange) return &array->elements[index];
    return entry.raise("java/lang/ArrayIndexOutOfBoundsException", std::to_string(index));
}

jobject getObjectArrayElement(JNIEnv* env, jobjectArray handle, jsize index) {
    Entry entry(env, "GetObjectArrayElement", std::to_string(index));
    ObjectPtr* element = elementOf(entry, handle, index);
    if (element == nullptr) return nullptr;
    orvtest::Trace::add("jni", "  is " + toString(Value::of(*element)));
    return entry.local(*element);
}

void setObjectArrayElement(JNIEnv* env, jobjectArray handle, jsize index, jobject value) {
    Entry entry(env, "SetObjectArrayElement", std::to_string(index));
    ObjectPtr* element = elementOf(entry, handle, index);
    if (element != nullptr) *element = entry.object(value, true);
}

jbyteArray newByteArray(JNIEnv* env, jsize length) {
    Entry entry(env, "NewByteArray", std::to_string(length));
    if (length < 0) {
        entry.violation("length " + std::to_string(length));
        return nullptr;
    }
    if (entry.fails()) return entry.outOfMemory();
    return entry.local<jbyteArray>(entry.vm.newBytes(std::vector<uint8_t>(length)));
}

jbyte* getByteArrayElements(JNIEnv* env, jbyteArray handle, jboolean* isCopy) {
    Entry entry(env, "GetByteArrayElements");
    ObjectPtr array = entry.object(handle, "[B");
    if (array == nullptr) return nullptr;
    if (entry.fails()) return entry.outOfMemory();
    const size_t size = array->bytes.size();
    auto* block = static_cast<uint8_t*>(malloc(size + 2 * kGuard));
    memset(block, kGuardByte, size + 2 * kGuard);
    std::copy(array->bytes.begin(), array->bytes.end(), block + kGuard);
    entry.vm.pin(block + kGuard, block, entry.function(), array);
    if (isCopy != nullptr) *isCopy = JNI_TRUE;
    return reinterpret_cast<jbyte*>(block + kGuard);
}

void releaseByteArrayElements(JNIEnv* env, jbyteArray handle, jbyte* elements, jint mode) {
    Entry entry(env, "ReleaseByteArrayElements", std::to_string(mode), Entry::kAllowed);
    ObjectPtr array = entry.object(handle, "[B");
    ObjectPtr owner = entry.vm.unpin(elements, entry.function(), mode == JNI_COMMIT);
    if (owner == nullptr) return;
    if (owner != array) entry.violation("the elements belong to another array");
    auto* bytes = reinterpret_cast<uint8_t*>(elements);
    if (!isIntact(bytes - kGuard) || !isIntact(bytes + owner->bytes.size()))
        entry.violation("written past the end of " + toString(Value::of(owner)));
    if (mode != JNI_ABORT) std::copy_n(bytes, owner->bytes.size(), owner->bytes.begin());
    if (mode != JNI_COMMIT) free(bytes - kGuard);
}

// The range's first byte; null with a pending exception for a bad range.
uint8_t* regionOf(Entry& entry, jbyteArray handle, jsize start, jsize length) {
    ObjectPtr array = entry.object(handle, "[B");
    if (array == nullptr) return nullptr;
    const auto size = static_cast<int64_t>(array->bytes.size());
    if (start >= 0 && length >= 0 && int64_t{start} + length <= size)
        return array->bytes.data() + start;
    return entry.raise("java/lang/ArrayIndexOutOfBoundsException", std::to_string(start));
}

void getByteArrayRegion(JNIEnv* env, jbyteArray handle, jsize start, jsize length, jbyte* out) {
    Entry entry(env, "GetByteArrayRegion");
    const uint8_t* region = regionOf(entry, handle, start, length);
    if (region != nullptr && length > 0) memcpy(out, region, length);
}

void setByteArrayRegion(JNIEnv* env, jbyteArray handle, jsize start, jsize length,
                        const jbyte* in) {
    Entry entry(env, "SetByteArrayRegion");
    uint8_t* region = regionOf(entry, handle, start, length);
    if (region != nullptr && length > 0) memcpy(region, in, length);
}

}  // namespace

void installArrays(JNINativeInterface& table) {
    table.GetArrayLength = getArrayLength;
    table.NewObjectArray = newObjectArray;
    table.GetObjectArrayElement = getObjectArrayElement;
    table.SetObjectArrayElement = setObjectArrayElement;
    table.NewByteArray = newByteArray;
    table.GetByteArrayElements = getByteArrayElements;
    table.ReleaseByteArrayElements = releaseByteArrayElements;
    table.GetByteArrayRegion = getByteArrayRegion;
    table.SetByteArrayRegion = setByteArrayRegion;
}

}  // namespace fakejni
