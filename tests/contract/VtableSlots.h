// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stddef.h>
#include <utils/RefBase.h>

#include <new>
#include <type_traits>

namespace orvtest {

// Virtual operations by their slot number, as a caller that was compiled apart
// reaches them. Both targets follow the Itanium C++ ABI: an object begins with
// a pointer to its table, and this is a plain first argument.

inline void* const* slotsOf(const void* object) {
    return *static_cast<void* const* const*>(object);
}

template <typename Result = void, typename... Arguments>
Result callSlot(void* object, int slot, Arguments... arguments) {
    auto function = reinterpret_cast<Result (*)(void*, Arguments...)>(slotsOf(object)[slot]);
    return function(object, arguments...);
}

// A T that tells its destructors apart: the complete one only destroys, the
// deleting one gives the memory back as well.
template <typename T>
class Counted : public T {
public:
    template <typename... Arguments>
    explicit Counted(Arguments... arguments) : T(arguments...) {
        // Destroyed without ever being held, which is worth a warning and a
        // stack trace to counted objects of the usual lifetime.
        if constexpr (std::is_base_of_v<android::RefBase, T>) {
            this->extendObjectLifetime(T::OBJECT_LIFETIME_WEAK);
        }
    }
    ~Counted() override { ++destroyed; }

    static void* operator new(size_t size) { return ::operator new(size); }
    static void operator delete(void* memory) {
        ++deleted;
        ::operator delete(memory);
    }

    static inline int destroyed = 0;
    static inline int deleted = 0;
};

// Whether a T's destructors stand in this slot and the next one.
template <typename T, typename... Arguments>
bool hasDestructorsAt(int slot, Arguments... arguments) {
    using Object = Counted<T>;
    Object::destroyed = Object::deleted = 0;
    void* memory = ::operator new(sizeof(Object));  // counted objects refuse the stack
    T* object = ::new (memory) Object(arguments...);
    callSlot(object, slot);
    const bool complete = Object::destroyed == 1 && Object::deleted == 0;
    ::operator delete(memory);

    object = new Object(arguments...);
    callSlot(object, slot + 1);
    return complete && Object::destroyed == 2 && Object::deleted == 1;
}

}  // namespace orvtest
