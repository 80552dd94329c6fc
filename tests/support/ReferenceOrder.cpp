// SPDX-License-Identifier: Apache-2.0
// Shows the thread sanitizer the order that android::RefBase gives to the last use
// of an object and its destruction. The counters are in libutils, which is not
// built for the sanitizer, so it misses them. The program's definitions go before
// the library's: each drop of a reference is announced before it is counted, and
// the last one waits for all of them. Linked into programs of that build alone.
#include <dlfcn.h>
#include <sanitizer/tsan_interface.h>
#include <stdio.h>
#include <stdlib.h>
#include <utils/RefBase.h>

namespace {

using Drop = void (*)(const android::RefBase*, const void*);

Drop librarysDrop() {
    void* found = dlsym(RTLD_NEXT, "_ZNK7android7RefBase9decStrongEPKv");
    if (found == nullptr) {
        fprintf(stderr, "libutils has no android::RefBase::decStrong.\n");
        abort();
    }
    return reinterpret_cast<Drop>(found);
}

// The object's one address, whatever the class that it is used as.
void* orderOf(const android::RefBase* object) { return object->getWeakRefs(); }

}  // namespace

namespace android {

void RefBase::decStrong(const void* id) const {
    static const Drop drop = librarysDrop();
    __tsan_release(orderOf(this));
    drop(this, id);
}

// Called by the drop of the last reference, before the destructor.
void RefBase::onLastStrongRef(const void*) { __tsan_acquire(orderOf(this)); }

}  // namespace android
