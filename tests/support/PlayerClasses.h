// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/IGraphicBufferProducer.h>
#include <gui/Surface.h>

#include "FakeJni/Vm.h"

namespace orvtest {

constexpr char kPlayerClass[] = "com/quintora/mmp/OrvMediaPlayer";

// Declares the Java player class with all that the library looks up in it, and
// the platform classes that its methods take. The stream methods answer zero;
// postEventFromNative only records.
fakejni::Class& definePlayerClasses(fakejni::Vm& vm);

// A buffer producer that nobody draws into.
class TestProducer : public android::IGraphicBufferProducer {
public:
    android::status_t getDefaultSize(int*, int*) override { return android::NO_ERROR; }
    android::status_t dequeueBuffer(int, int, PixelBuffer*) override { return android::NO_INIT; }
    android::status_t queueBuffer(int, int64_t) override { return android::NO_INIT; }
    android::status_t cancelBuffer(int) override { return android::NO_INIT; }
};

// An android.view.Surface over that native one, which must outlive it; null
// for one that was released.
fakejni::ObjectPtr newJavaSurface(fakejni::Vm& vm, const android::sp<android::Surface>& surface);

// A java.io.FileDescriptor.
fakejni::ObjectPtr newFileDescriptor(fakejni::Vm& vm, int fd);

}  // namespace orvtest
