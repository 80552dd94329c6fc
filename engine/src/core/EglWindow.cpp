// SPDX-License-Identifier: Apache-2.0
#include "core/EglWindow.h"

#include <string.h>

#include <algorithm>
#include <array>

namespace orvtarn {
namespace {

constexpr unsigned int kRendererName = 0x1F01;  // GL_RENDERER

// The OpenGL of processors that are not made for it.
constexpr const char* kSoftwareRenderers[] = {"llvmpipe", "softpipe", "swrast", "Software", "SWR"};

constexpr EGLint kWantedConfig[] = {EGL_SURFACE_TYPE,
                                    EGL_WINDOW_BIT,
                                    EGL_RENDERABLE_TYPE,
                                    EGL_OPENGL_BIT,
                                    EGL_RED_SIZE,
                                    8,
                                    EGL_GREEN_SIZE,
                                    8,
                                    EGL_BLUE_SIZE,
                                    8,
                                    EGL_NONE};
constexpr size_t kMostConfigs = 256;

}  // namespace

std::unique_ptr<EglWindow> EglWindow::open(unsigned long window, std::string& why) {
    const EglLibrary* const egl = eglLibrary();
    if (egl == nullptr) {
        why = "there is no EGL";
        return nullptr;
    }
    std::unique_ptr<XConnection> x = XConnection::open();
    if (x == nullptr) {
        why = "there is no X server";
        return nullptr;
    }
    std::unique_ptr<EglWindow> opened(new EglWindow(*egl, std::move(x)));
    const char* const failure = opened->begin(window);
    if (failure == nullptr) return opened;
    why = failure;
    return nullptr;
}

// Null, or what is missing.
const char* EglWindow::begin(unsigned long window) {
    mDisplay = mEgl.getPlatformDisplay(EGL_PLATFORM_X11_KHR, mX->display(), nullptr);
    if (mDisplay == EGL_NO_DISPLAY || !mEgl.initialize(mDisplay, nullptr, nullptr)) {
        return "EGL does not know the display";
    }
    const char* const extensions = mEgl.queryString(mDisplay, EGL_EXTENSIONS);
    if (extensions == nullptr || strstr(extensions, "EGL_KHR_surfaceless_context") == nullptr) {
        return "EGL needs a window all the time";
    }
    if (!mEgl.bindApi(EGL_OPENGL_API)) return "EGL has no OpenGL";
    if (!chooseConfig(window)) return "OpenGL does not draw on such windows";
    mContext = mEgl.createContext(mDisplay, mConfig, EGL_NO_CONTEXT, nullptr);
    if (mContext == EGL_NO_CONTEXT) return "OpenGL cannot be started";
    if (!setWindow(window)) return "OpenGL does not draw on that window";
    readRenderer();
    return nullptr;
}

bool EglWindow::chooseConfig(unsigned long window) {
    const std::optional<VisualID> visual = mX->visualOf(window);
    if (!visual) return false;
    std::array<EGLConfig, kMostConfigs> configs;
    EGLint count = 0;
    mEgl.chooseConfig(mDisplay, kWantedConfig, configs.data(), kMostConfigs, &count);
    EGLConfig* const end = configs.data() + count;
    EGLConfig* const found = std::find_if(configs.data(), end, [&](EGLConfig config) {
        EGLint id = 0;
        return mEgl.getConfigAttrib(mDisplay, config, EGL_NATIVE_VISUAL_ID, &id) &&
               static_cast<VisualID>(id) == *visual;
    });
    if (found == end) return false;
    mConfig = *found;
    mVisual = *visual;
    return true;
}

void EglWindow::readRenderer() {
    using GetString = const unsigned char* (*)(unsigned int);
    const auto getString = reinterpret_cast<GetString>(procAddress("glGetString"));
    const unsigned char* const name = getString == nullptr ? nullptr : getString(kRendererName);
    mRenderer = name == nullptr ? "unknown" : reinterpret_cast<const char*>(name);
}

EglWindow::~EglWindow() {
    if (mDisplay == EGL_NO_DISPLAY) return;
    dropWindow();
    mEgl.makeCurrent(mDisplay, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
    if (mContext != EGL_NO_CONTEXT) mEgl.destroyContext(mDisplay, mContext);
    mEgl.terminate(mDisplay);
    mEgl.releaseThread();
}

bool EglWindow::setWindow(unsigned long window) {
    dropWindow();
    if (mX->visualOf(window) != mVisual) return false;
    mSurface = mEgl.createPlatformWindowSurface(mDisplay, mConfig, &window, nullptr);
    if (mSurface == EGL_NO_SURFACE) return false;
    mWindow = window;
    mX->watch(window);
    // Else frames would change while the screen is halfway through them.
    if (makeCurrent() && mEgl.swapInterval(mDisplay, 1)) return true;
    dropWindow();
    return false;
}

void EglWindow::dropWindow() {
    mWindow = 0;
    if (mSurface == EGL_NO_SURFACE) return;
    const EGLSurface surface = mSurface;
    mSurface = EGL_NO_SURFACE;
    makeCurrent();  // a current surface would live on
    mEgl.destroySurface(mDisplay, surface);
}

bool EglWindow::makeCurrent() { return mEgl.makeCurrent(mDisplay, mSurface, mSurface, mContext); }

std::optional<XWindow> EglWindow::look() const {
    if (mWindow == 0) return {};
    return mX->windowOf(mWindow);
}

bool EglWindow::swap() { return mEgl.swapBuffers(mDisplay, mSurface); }

bool EglWindow::isSoftware() const {
    return std::any_of(
        std::begin(kSoftwareRenderers), std::end(kSoftwareRenderers),
        [this](const char* name) { return mRenderer.find(name) != std::string::npos; });
}

void* EglWindow::procAddress(const char* name) const {
    return reinterpret_cast<void*>(mEgl.getProcAddress(name));
}

}  // namespace orvtarn
