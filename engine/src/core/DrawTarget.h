// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <gui/NativeWindow.h>
#include <mpv/client.h>

#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "core/FrameDrawer.h"
#include "core/WindowDrawer.h"

namespace orvtarn {

// The surface that a player draws on, and the way in which it does: by OpenGL on a
// surface that has a window, else, or where that fails, by software into the
// surface's buffers. On the rendering thread, but for create.
class DrawTarget : private android::NativeWindow::User {
public:
    using Producer = android::sp<android::IGraphicBufferProducer>;
    // Runs what it is given, which ends one way of drawing and begins another, while
    // mpv has no video; onWindow is the new way. Called on the rendering thread, and
    // may ask mpv.
    using Exchange = std::function<void(bool onWindow, const std::function<void()>& change)>;

    // wake: mpv has another frame, or the window wants attention. Any thread.
    DrawTarget(std::function<void()> wake, Exchange exchange)
        : mWake(std::move(wake)), mExchange(std::move(exchange)) {}
    ~DrawTarget() { destroy(); }

    bool create(mpv_handle* mpv);
    void destroy();

    // Draws there from now on, null for nowhere. Nothing touches the surface before
    // afterwards, nor its window.
    void attach(const Producer& producer);
    // Whether the window is about to go: something else is to be attached.
    bool isWindowClosing() const { return mWindow != nullptr && mWindow->isClosing(); }
    // Whether the window's picture is to be drawn anew.
    bool takeRedraw() { return mWindow != nullptr && mWindow->takeRedraw(); }
    // Whether the window is to keep its picture.
    bool isHeld() const { return mWindow != nullptr && mWindow->isHeld(); }
    // The window cannot be drawn on any more: goes on by software.
    void fallBack(const std::string& why);

    bool hasSurface() const { return mProducer != nullptr && mDrawer != nullptr; }
    bool isOnWindow() const { return mWindow != nullptr; }
    // See FrameDrawer; with a surface or without.
    void skip() {
        if (mDrawer != nullptr) mDrawer->skip();
    }
    // Only with a surface.
    FrameDrawer& drawer() { return *mDrawer; }
    // mpv's; null when it has none.
    mpv_render_context* context() const {
        return mDrawer == nullptr ? nullptr : mDrawer->context();
    }

private:
    void onWindowChanged() override { mWake(); }
    static void onUpdate(void* self);

    void letGo();
    bool drawOn(const android::sp<android::NativeWindow>& window, std::string& why);
    bool beginOpenGl(android::NativeWindow& window, std::string& why);
    void beginSoftware();
    void replace(std::unique_ptr<FrameDrawer> drawer);

    const std::function<void()> mWake;
    const Exchange mExchange;
    mpv_handle* mMpv = nullptr;
    std::unique_ptr<FrameDrawer> mDrawer;
    WindowDrawer* mOpenGl = nullptr;  // the drawer, if it is that
    Producer mProducer;
    android::sp<android::NativeWindow> mWindow;  // that is drawn on
};

}  // namespace orvtarn
