// SPDX-License-Identifier: Apache-2.0
#include "core/DrawTarget.h"

#include "base/EngineLog.h"
#include "core/BufferDrawer.h"

namespace orvtarn {

bool DrawTarget::create(mpv_handle* mpv) {
    mMpv = mpv;
    replace(BufferDrawer::create(mpv));
    return mDrawer != nullptr;
}

void DrawTarget::destroy() {
    letGo();
    replace(nullptr);
}

void DrawTarget::onUpdate(void* self) { static_cast<DrawTarget*>(self)->mWake(); }

void DrawTarget::attach(const Producer& producer) {
    letGo();
    if (producer == nullptr) return;
    mProducer = producer;
    const android::sp<android::NativeWindow> window = producer->nativeWindow();
    std::string why;
    if (window != nullptr && window->connect(this)) {
        if (drawOn(window, why)) return;
        window->reportDrawing({false, why});
        ALOGI("VideoOutput: draws by software: %s", why.c_str());
        window->disconnect(this);
    }
    beginSoftware();
}

bool DrawTarget::drawOn(const android::sp<android::NativeWindow>& window, std::string& why) {
    const bool goesOn = mOpenGl != nullptr && mOpenGl->canDrawOn(*window);
    if (!goesOn && !beginOpenGl(*window, why)) return false;
    mWindow = window;
    mDrawer->attach(mProducer);
    window->reportDrawing({true, mOpenGl->renderer()});
    return true;
}

bool DrawTarget::beginOpenGl(android::NativeWindow& window, std::string& why) {
    // One that cannot draw on this window gives its place up first.
    if (mOpenGl != nullptr) beginSoftware();
    std::unique_ptr<EglWindow> egl = EglWindow::open(window.id(), why);
    if (egl == nullptr) return false;
    if (egl->isSoftware() && !window.acceptsSoftwareGl()) {
        why = "the graphics processor is itself software, " + egl->renderer();
        return false;
    }
    mExchange(true, [&] {
        replace(nullptr);
        std::unique_ptr<WindowDrawer> drawer = WindowDrawer::create(mMpv, std::move(egl));
        WindowDrawer* const openGl = drawer.get();
        replace(std::move(drawer));
        mOpenGl = openGl;
    });
    if (mOpenGl != nullptr) return true;
    why = "the playback core cannot use this OpenGL";
    return false;
}

void DrawTarget::beginSoftware() {
    if (mOpenGl != nullptr || mDrawer == nullptr) {
        mExchange(false, [this] {
            replace(nullptr);
            replace(BufferDrawer::create(mMpv));
        });
    }
    if (mDrawer != nullptr) mDrawer->attach(mProducer);
}

void DrawTarget::replace(std::unique_ptr<FrameDrawer> drawer) {
    if (mDrawer != nullptr) {
        mpv_render_context_set_update_callback(mDrawer->context(), nullptr, nullptr);
    }
    mOpenGl = nullptr;
    mDrawer = std::move(drawer);
    if (mDrawer != nullptr) {
        mpv_render_context_set_update_callback(mDrawer->context(), onUpdate, this);
    }
}

void DrawTarget::fallBack(const std::string& why) {
    ALOGW("VideoOutput: the graphics processor fails (%s), software draws from now on",
          why.c_str());
    const Producer producer = mProducer;
    const android::sp<android::NativeWindow> window = mWindow;
    letGo();
    window->reportDrawing({false, why});
    mProducer = producer;
    beginSoftware();
}

// The drawer first: the window may go as soon as nobody is connected to it.
void DrawTarget::letGo() {
    if (mDrawer != nullptr) mDrawer->attach(nullptr);
    if (mWindow != nullptr) mWindow->disconnect(this);
    mWindow = nullptr;
    mProducer = nullptr;
}

}  // namespace orvtarn
