// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <dlfcn.h>

namespace orvtarn {

// A library that may be missing; it stays loaded.
class DynamicLibrary {
public:
    explicit DynamicLibrary(const char* name)
        : mHandle(dlopen(name, RTLD_NOW | RTLD_LOCAL)), mIsComplete(mHandle != nullptr) {}

    template <class Function>
    void find(const char* name, Function*& function) {
        function = mHandle == nullptr ? nullptr : reinterpret_cast<Function*>(dlsym(mHandle, name));
        mIsComplete = mIsComplete && function != nullptr;
    }

    // Whether the library was there and all that was sought in it.
    bool isComplete() const { return mIsComplete; }

private:
    void* const mHandle;
    bool mIsComplete;
};

}  // namespace orvtarn
