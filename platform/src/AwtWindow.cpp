// SPDX-License-Identifier: Apache-2.0
// The X window of a Java component. The library of the JDK that knows it is loaded
// by the Java half.
#include <dlfcn.h>
#include <jawt_md.h>

namespace {

using GetAwt = jboolean(JNICALL*)(JNIEnv*, JAWT*);

GetAwt findGetAwt() {
    void* const library = dlopen("libjawt.so", RTLD_NOW | RTLD_NOLOAD);
    return library == nullptr ? nullptr : reinterpret_cast<GetAwt>(dlsym(library, "JAWT_GetAWT"));
}

jlong windowOf(JAWT_DrawingSurface* surface) {
    JAWT_DrawingSurfaceInfo* const info = surface->GetDrawingSurfaceInfo(surface);
    if (info == nullptr) return 0;
    const auto* const x = static_cast<const JAWT_X11DrawingSurfaceInfo*>(info->platformInfo);
    const auto window = static_cast<jlong>(x->drawable);
    surface->FreeDrawingSurfaceInfo(info);
    return window;
}

}  // namespace

// 0 for a component that is not on an X screen.
extern "C" JNIEXPORT jlong JNICALL
Java_com_quintora_mmp_platform_internal_ViewWindow_nativeWindowOf(JNIEnv* env, jclass,
                                                                  jobject component) {
    const GetAwt getAwt = findGetAwt();
    JAWT awt = {};
    awt.version = JAWT_VERSION_9;
    if (getAwt == nullptr || !getAwt(env, &awt)) return 0;
    JAWT_DrawingSurface* const surface = awt.GetDrawingSurface(env, component);
    if (surface == nullptr) return 0;
    jlong window = 0;
    if ((surface->Lock(surface) & JAWT_LOCK_ERROR) == 0) {
        window = windowOf(surface);
        surface->Unlock(surface);
    }
    awt.FreeDrawingSurface(surface);
    return window;
}
