// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/NativeWindow.h>

#include <functional>

#include "FrameSink.h"

struct _XDisplay;

namespace orvtest {

// A window on the X server of the environment.
class TestWindow {
public:
    static bool isPossible();

    TestWindow(int width, int height);
    ~TestWindow();
    TestWindow(const TestWindow&) = delete;
    TestWindow& operator=(const TestWindow&) = delete;

    unsigned long id() const { return mWindow; }
    void resize(int width, int height);
    void hide();
    void show();
    // As when its program ends.
    void destroy();
    // Its pixels, black in place of all that was drawn.
    void erase();
    // What the screen shows of it.
    Picture look();
    // Waits until what it shows fulfils a condition; false after ten seconds.
    bool waitFor(const std::function<bool(const Picture&)>& condition);

private:
    _XDisplay* const mDisplay;
    unsigned long mWindow;
};

// A surface with a window, whose buffers a FrameSink takes.
class WindowSink : public FrameSink {
public:
    explicit WindowSink(const android::sp<android::NativeWindow>& window) : mNative(window) {}

    android::sp<android::NativeWindow> nativeWindow() override { return mNative; }

private:
    const android::sp<android::NativeWindow> mNative;
};

}  // namespace orvtest
