// SPDX-License-Identifier: Apache-2.0
#include "core/WindowDrawer.h"

#include <mpv/render_gl.h>

#include "base/EngineLog.h"

namespace orvtarn {

std::unique_ptr<WindowDrawer> WindowDrawer::create(mpv_handle* mpv,
                                                   std::unique_ptr<EglWindow> egl) {
    std::unique_ptr<WindowDrawer> drawer(new WindowDrawer(std::move(egl)));
    const int error = drawer->createContext(mpv);
    if (error >= 0) return drawer;
    refused("VideoOutput", mpv_error_string(error));
    return nullptr;
}

int WindowDrawer::createContext(mpv_handle* mpv) {
    mpv_opengl_init_params opengl = {};
    opengl.get_proc_address = procAddress;
    opengl.get_proc_address_ctx = mEgl.get();
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_API_TYPE, const_cast<char*>(MPV_RENDER_API_TYPE_OPENGL)},
        {MPV_RENDER_PARAM_OPENGL_INIT_PARAMS, &opengl},
        {MPV_RENDER_PARAM_X11_DISPLAY, mEgl->display()},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    return mpv_render_context_create(&mContext, mpv, parameters);
}

void* WindowDrawer::procAddress(void* egl, const char* name) {
    return static_cast<EglWindow*>(egl)->procAddress(name);
}

WindowDrawer::~WindowDrawer() {
    if (mContext != nullptr) mpv_render_context_free(mContext);
}

void WindowDrawer::attach(const android::sp<android::IGraphicBufferProducer>& producer) {
    mWindow = producer == nullptr ? nullptr : producer->nativeWindow();
    if (mWindow == nullptr) mEgl->dropWindow();
}

android::status_t WindowDrawer::draw(FrameSize size) {
    const std::optional<XWindow> window = mEgl->look();
    if (!window) return android::NO_INIT;
    mIsBehind = !window->isSeen;
    if (window->isSeen) return drawSeen(size);
    skip();
    return android::NO_ERROR;
}

android::status_t WindowDrawer::drawSeen(FrameSize size) {
    mpv_opengl_fbo window = {0, size.width, size.height, 0};
    int upsideDown = 1;
    mpv_render_param parameters[] = {
        {MPV_RENDER_PARAM_OPENGL_FBO, &window},
        {MPV_RENDER_PARAM_FLIP_Y, &upsideDown},
        {MPV_RENDER_PARAM_INVALID, nullptr},
    };
    const int error = mpv_render_context_render(mContext, parameters);
    if (error < 0) return failed(android::UNKNOWN_ERROR, "VideoOutput", mpv_error_string(error));
    const bool shown = mEgl->swap();
    mpv_render_context_report_swap(mContext);
    if (shown) return android::NO_ERROR;
    return mEgl->look() ? android::UNKNOWN_ERROR : android::NO_INIT;
}

// mpv waits for each swap once it has seen one.
void WindowDrawer::skip() {
    FrameDrawer::skip();
    mpv_render_context_report_swap(mContext);
}

android::status_t WindowDrawer::deliver(int64_t microseconds) {
    mWindow->reportFrame(microseconds);
    return android::NO_ERROR;
}

}  // namespace orvtarn
