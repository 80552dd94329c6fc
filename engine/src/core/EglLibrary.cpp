// SPDX-License-Identifier: Apache-2.0
#include "core/EglLibrary.h"

#include "base/DynamicLibrary.h"

namespace orvtarn {

EglLibrary* eglLibrary() {
    static EglLibrary* const loaded = []() -> EglLibrary* {
        static EglLibrary egl;
        DynamicLibrary library("libEGL.so.1");
        library.find("eglGetPlatformDisplay", egl.getPlatformDisplay);
        library.find("eglInitialize", egl.initialize);
        library.find("eglTerminate", egl.terminate);
        library.find("eglBindAPI", egl.bindApi);
        library.find("eglQueryString", egl.queryString);
        library.find("eglChooseConfig", egl.chooseConfig);
        library.find("eglGetConfigAttrib", egl.getConfigAttrib);
        library.find("eglCreateContext", egl.createContext);
        library.find("eglDestroyContext", egl.destroyContext);
        library.find("eglCreatePlatformWindowSurface", egl.createPlatformWindowSurface);
        library.find("eglDestroySurface", egl.destroySurface);
        library.find("eglMakeCurrent", egl.makeCurrent);
        library.find("eglSwapInterval", egl.swapInterval);
        library.find("eglSwapBuffers", egl.swapBuffers);
        library.find("eglGetProcAddress", egl.getProcAddress);
        library.find("eglReleaseThread", egl.releaseThread);
        return library.isComplete() ? &egl : nullptr;
    }();
    return loaded;
}

}  // namespace orvtarn
