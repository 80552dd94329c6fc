// SPDX-License-Identifier: Apache-2.0
#pragma once

#define EGL_NO_X11  // windows are numbers here
#include <EGL/egl.h>
#include <EGL/eglext.h>

namespace orvtarn {

// The functions of libEGL that the engine uses, found at run time: a machine
// without it plays by software.
struct EglLibrary {
    decltype(&eglGetPlatformDisplay) getPlatformDisplay;
    decltype(&eglInitialize) initialize;
    decltype(&eglTerminate) terminate;
    decltype(&eglBindAPI) bindApi;
    decltype(&eglQueryString) queryString;
    decltype(&eglChooseConfig) chooseConfig;
    decltype(&eglGetConfigAttrib) getConfigAttrib;
    decltype(&eglCreateContext) createContext;
    decltype(&eglDestroyContext) destroyContext;
    decltype(&eglCreatePlatformWindowSurface) createPlatformWindowSurface;
    decltype(&eglDestroySurface) destroySurface;
    decltype(&eglMakeCurrent) makeCurrent;
    decltype(&eglSwapInterval) swapInterval;
    decltype(&eglSwapBuffers) swapBuffers;
    decltype(&eglGetProcAddress) getProcAddress;
    decltype(&eglReleaseThread) releaseThread;
};

// Null without a complete library. Tests replace its functions.
EglLibrary* eglLibrary();

}  // namespace orvtarn
