// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <jni.h>

#include <deque>
#include <string>
#include <unordered_set>

#include "FakeJni/Model.h"

namespace fakejni {

enum class RefKind { kLocal, kGlobal, kWeak };

// One reference handed to native code. Never freed while the virtual machine
// lives, so that a use after its deletion is seen and not undefined.
struct Ref {
    RefKind kind;
    ObjectPtr object;
    int thread;  // of locals, the thread's number
    bool live;
};

// The ledger of references. Faults are texts: null stands for no fault.
class References {
public:
    jobject make(RefKind kind, ObjectPtr object, int thread);

    // The object behind a handle; null for the null handle and for a faulty
    // one, which then fills fault.
    ObjectPtr resolve(jobject handle, int thread, std::string* fault) const;
    // Fills fault when the handle is no live reference of that kind.
    void remove(jobject handle, RefKind kind, int thread, std::string* fault);

    size_t liveCount(RefKind kind) const { return mLive[static_cast<int>(kind)]; }
    jobjectRefType typeOf(jobject handle) const;

    // Locals of a thread made after a mark are the frame of one native call.
    size_t mark() const { return mRefs.size(); }
    size_t liveLocalsSince(size_t mark, int thread) const;
    void dropLocalsSince(size_t mark, int thread);

private:
    Ref* find(jobject handle) const;
    void drop(Ref& ref);

    mutable std::deque<Ref> mRefs;
    std::unordered_set<const void*> mKnown;
    size_t mLive[3] = {};  // by kind
};

}  // namespace fakejni
