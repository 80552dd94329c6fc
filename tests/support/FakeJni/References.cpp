// SPDX-License-Identifier: Apache-2.0
#include "FakeJni/References.h"

namespace fakejni {

namespace {

const char* nameOf(RefKind kind) {
    switch (kind) {
        case RefKind::kLocal:
            return "local";
        case RefKind::kGlobal:
            return "global";
        case RefKind::kWeak:
            return "weak global";
    }
    return "?";
}

std::string describe(const Ref& ref) {
    const std::string kind = std::string(nameOf(ref.kind)) + " reference";
    return ref.live ? kind + " to " + toString(Value::of(ref.object)) : kind;
}

bool isFrameLocal(const Ref& ref, int thread) {
    return ref.live && ref.kind == RefKind::kLocal && ref.thread == thread;
}

}  // namespace

jobject References::make(RefKind kind, ObjectPtr object, int thread) {
    if (object == nullptr) return nullptr;
    mRefs.push_back({kind, std::move(object), thread, true});
    mKnown.insert(&mRefs.back());
    ++mLive[static_cast<int>(kind)];
    return reinterpret_cast<jobject>(&mRefs.back());
}

Ref* References::find(jobject handle) const {
    return mKnown.count(handle) != 0 ? reinterpret_cast<Ref*>(handle) : nullptr;
}

ObjectPtr References::resolve(jobject handle, int thread, std::string* fault) const {
    if (handle == nullptr) return nullptr;
    const Ref* ref = find(handle);
    if (ref == nullptr) {
        *fault = "not a reference";
    } else if (!ref->live) {
        *fault = "use of a deleted " + describe(*ref);
    } else if (ref->kind == RefKind::kLocal && ref->thread != thread) {
        *fault = "use of another thread's " + describe(*ref);
    } else {
        return ref->object;
    }
    return nullptr;
}

void References::remove(jobject handle, RefKind kind, int thread, std::string* fault) {
    if (handle == nullptr) return;
    Ref* ref = find(handle);
    if (ref == nullptr) {
        *fault = "not a reference";
    } else if (!ref->live) {
        *fault = "second deletion of a " + describe(*ref);
    } else if (ref->kind != kind) {
        *fault = "deleted as " + std::string(nameOf(kind)) + ": " + describe(*ref);
    } else if (kind == RefKind::kLocal && ref->thread != thread) {
        *fault = "deletion of another thread's " + describe(*ref);
    } else {
        drop(*ref);
    }
}

void References::drop(Ref& ref) {
    ref.live = false;
    ref.object = nullptr;
    --mLive[static_cast<int>(ref.kind)];
}

jobjectRefType References::typeOf(jobject handle) const {
    const Ref* ref = find(handle);
    if (ref == nullptr || !ref->live) return JNIInvalidRefType;
    switch (ref->kind) {
        case RefKind::kLocal:
            return JNILocalRefType;
        case RefKind::kGlobal:
            return JNIGlobalRefType;
        case RefKind::kWeak:
            return JNIWeakGlobalRefType;
    }
    return JNIInvalidRefType;
}

size_t References::liveLocalsSince(size_t mark, int thread) const {
    size_t count = 0;
    for (size_t i = mark; i < mRefs.size(); ++i) count += isFrameLocal(mRefs[i], thread);
    return count;
}

void References::dropLocalsSince(size_t mark, int thread) {
    for (size_t i = mark; i < mRefs.size(); ++i) {
        if (isFrameLocal(mRefs[i], thread)) drop(mRefs[i]);
    }
}

}  // namespace fakejni
