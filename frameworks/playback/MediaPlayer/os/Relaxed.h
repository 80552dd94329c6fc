// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <atomic>

namespace os {

// A plain value that several threads read and write without a lock: no order
// is promised, only that each access is whole. As large as T.
template <typename T>
class Relaxed {
public:
    constexpr Relaxed(T value = T()) : mValue(value) {}

    operator T() const { return mValue.load(std::memory_order_relaxed); }
    Relaxed& operator=(T value) {
        mValue.store(value, std::memory_order_relaxed);
        return *this;
    }

private:
    std::atomic<T> mValue;
    static_assert(sizeof(std::atomic<T>) == sizeof(T), "the layout is that of the plain value");
};

}  // namespace os
