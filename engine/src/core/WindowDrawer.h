// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <memory>
#include <string>

#include "core/EglWindow.h"
#include "core/FrameDrawer.h"

namespace orvtarn {

// Draws on a surface's window by OpenGL. A frame is on the screen once it is drawn.
class WindowDrawer : public FrameDrawer {
public:
    // Takes over an OpenGL that draws on a window. Null, and a line in the log, when
    // mpv refuses it.
    static std::unique_ptr<WindowDrawer> create(mpv_handle* mpv, std::unique_ptr<EglWindow> egl);
    ~WindowDrawer() override;

    // Whether it can go on with that window; it is attached afterwards.
    bool canDrawOn(android::NativeWindow& window) { return mEgl->setWindow(window.id()); }
    const std::string& renderer() const { return mEgl->renderer(); }

    mpv_render_context* context() const override { return mContext; }
    void attach(const android::sp<android::IGraphicBufferProducer>& producer) override;
    FrameSize wantedSize() override { return mEgl->look().value_or(XWindow()).size; }
    // After frames that nobody could see.
    bool isBehind() override { return mIsBehind && mEgl->look().value_or(XWindow()).isSeen; }
    // Only where the window is seen. NO_INIT when it is gone.
    android::status_t draw(FrameSize size) override;
    void skip() override;
    android::status_t deliver(int64_t microseconds) override;
    void cancel() override {}

private:
    explicit WindowDrawer(std::unique_ptr<EglWindow> egl) : mEgl(std::move(egl)) {}
    static void* procAddress(void* egl, const char* name);
    int createContext(mpv_handle* mpv);
    android::status_t drawSeen(FrameSize size);

    const std::unique_ptr<EglWindow> mEgl;
    mpv_render_context* mContext = nullptr;
    android::sp<android::NativeWindow> mWindow;
    bool mIsBehind = false;
};

}  // namespace orvtarn
