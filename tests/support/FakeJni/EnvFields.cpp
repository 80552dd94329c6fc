// SPDX-License-Identifier: Apache-2.0
// Reading and writing fields, with the checks of the machine's checking mode.
#include "FakeJni/EnvSupport.h"

namespace fakejni {

namespace {

// A boolean field may be read as a byte: both are 8 bits wide, and the
// library's readers do so.
bool mayAccess(char field, char accessor, bool reading) {
    return field == accessor || (reading && field == 'Z' && accessor == 'B');
}

Field* checked(Entry& entry, jfieldID id, char accessor, bool isStatic, bool reading) {
    if (!entry.vm.isHandedOut(id)) {
        entry.violation("not a field ID");
        return nullptr;
    }
    Field* field = reinterpret_cast<Field*>(id);
    if (field->isStatic != isStatic || !mayAccess(letterOf(field->signature), accessor, reading)) {
        entry.violation("field " + field->name + " is a " + field->signature);
        return nullptr;
    }
    return field;
}

std::string nameOf(JNIEnv* env, jfieldID id) {
    Vm& vm = *static_cast<FakeEnv*>(env)->vm;
    return vm.isHandedOut(id) ? reinterpret_cast<Field*>(id)->name : "?";
}

// The place of an instance field, null with a violation for a wrong object.
Value* slotOf(Entry& entry, jobject handle, Field* field) {
    ObjectPtr object = entry.object(handle);
    if (object == nullptr || field == nullptr) return nullptr;
    if (!object->type->isSubclassOf(field->owner)) {
        entry.violation(object->type->path + " has no field " + field->name);
        return nullptr;
    }
    return &object->fields.try_emplace(field, Value::zero(letterOf(field->signature)))
                .first->second;
}

Value* staticSlotOf(Entry& entry, jobject handle, Field* field) {
    Class* type = entry.javaClass(static_cast<jclass>(handle));
    if (type == nullptr || field == nullptr) return nullptr;
    if (!type->isSubclassOf(field->owner)) {
        entry.violation(type->path + " has no static field " + field->name);
        return nullptr;
    }
    return &field->value;
}

template <typename T>
T fromValue(Entry&, const Value& value, T*) {
    return std::is_floating_point<T>::value ? static_cast<T>(value.real)
                                            : static_cast<T>(value.integer);
}
jobject fromValue(Entry& entry, const Value& value, jobject*) { return entry.local(value.object); }

template <typename T>
void toValue(Entry&, Value& slot, T value) {
    if (std::is_floating_point<T>::value) {
        slot.real = static_cast<double>(value);
    } else {
        // NOLINTNEXTLINE(bugprone-signed-char-misuse): Java's bytes are signed
        slot.integer = static_cast<int64_t>(value);
    }
}
void toValue(Entry& entry, Value& slot, jobject value) { slot.object = entry.object(value, true); }

template <typename T>
T get(JNIEnv* env, const char* function, jobject handle, jfieldID id, char type, bool isStatic) {
    Entry entry(env, function, nameOf(env, id));
    Field* field = checked(entry, id, type, isStatic, true);
    Value* slot = isStatic ? staticSlotOf(entry, handle, field) : slotOf(entry, handle, field);
    return slot == nullptr ? T() : fromValue(entry, *slot, static_cast<T*>(nullptr));
}

template <typename T>
void set(JNIEnv* env, const char* function, jobject handle, jfieldID id, char type, bool isStatic,
         T value) {
    Entry entry(env, function, nameOf(env, id));
    Field* field = checked(entry, id, type, isStatic, false);
    Value* slot = isStatic ? staticSlotOf(entry, handle, field) : slotOf(entry, handle, field);
    if (slot != nullptr) toValue(entry, *slot, value);
}

}  // namespace

void installFields(JNINativeInterface& table) {
#define ACCESSORS(Name, T, letter)                                                      \
    table.Get##Name##Field = [](JNIEnv* env, jobject object, jfieldID id) {             \
        return get<T>(env, "Get" #Name "Field", object, id, letter, false);             \
    };                                                                                  \
    table.Set##Name##Field = [](JNIEnv* env, jobject object, jfieldID id, T value) {    \
        set<T>(env, "Set" #Name "Field", object, id, letter, false, value);             \
    };                                                                                  \
    table.GetStatic##Name##Field = [](JNIEnv* env, jclass type, jfieldID id) {          \
        return get<T>(env, "GetStatic" #Name "Field", type, id, letter, true);          \
    };                                                                                  \
    table.SetStatic##Name##Field = [](JNIEnv* env, jclass type, jfieldID id, T value) { \
        set<T>(env, "SetStatic" #Name "Field", type, id, letter, true, value);          \
    }
    ACCESSORS(Object, jobject, 'L');
    ACCESSORS(Boolean, jboolean, 'Z');
    ACCESSORS(Byte, jbyte, 'B');
    ACCESSORS(Char, jchar, 'C');
    ACCESSORS(Short, jshort, 'S');
    ACCESSORS(Int, jint, 'I');
    ACCESSORS(Long, jlong, 'J');
    ACCESSORS(Float, jfloat, 'F');
    ACCESSORS(Double, jdouble, 'D');
#undef ACCESSORS
}

}  // namespace fakejni
