// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "core/EglLibrary.h"
#include "core/FrameDrawer.h"
#include "core/XConnection.h"

namespace orvtarn {

// OpenGL on a window of the desktop. The context outlives the window and can
// go on with another one. All of it on one thread, on which the context is current.
class EglWindow {
public:
    // Null when there is no usable OpenGL for that window; why says so.
    static std::unique_ptr<EglWindow> open(unsigned long window, std::string& why);
    ~EglWindow();
    EglWindow(const EglWindow&) = delete;
    EglWindow& operator=(const EglWindow&) = delete;

    // False when this context cannot draw on that window.
    bool setWindow(unsigned long window);
    // Nothing touches the window any more.
    void dropWindow();
    // Nothing without a window, or when that is gone.
    std::optional<XWindow> look() const;
    // Shows what was drawn with the screen's next picture, for which it may wait.
    bool swap();

    // What draws, in its maker's words.
    const std::string& renderer() const { return mRenderer; }
    // Whether that is a program.
    bool isSoftware() const;
    Display* display() const { return mX->display(); }
    void* procAddress(const char* name) const;

private:
    EglWindow(const EglLibrary& egl, std::unique_ptr<XConnection> x)
        : mEgl(egl), mX(std::move(x)) {}

    const char* begin(unsigned long window);
    bool chooseConfig(unsigned long window);
    bool makeCurrent();
    void readRenderer();

    const EglLibrary& mEgl;
    const std::unique_ptr<XConnection> mX;
    EGLDisplay mDisplay = EGL_NO_DISPLAY;
    EGLConfig mConfig = nullptr;
    EGLContext mContext = EGL_NO_CONTEXT;
    EGLSurface mSurface = EGL_NO_SURFACE;
    unsigned long mWindow = 0;
    VisualID mVisual = 0;
    std::string mRenderer;
};

}  // namespace orvtarn
