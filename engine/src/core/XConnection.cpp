// SPDX-License-Identifier: Apache-2.0
#include "core/XConnection.h"

#include <mutex>
#include <set>

#include "base/DynamicLibrary.h"

namespace orvtarn {
namespace {

// Those whose errors end nothing.
std::mutex gDisplaysMutex;
std::set<Display*> gDisplays;
XErrorHandler gFormerHandler = nullptr;

}  // namespace

struct XConnection::Library {
    decltype(&XInitThreads) initThreads;
    decltype(&XOpenDisplay) openDisplay;
    decltype(&XCloseDisplay) closeDisplay;
    decltype(&XSetErrorHandler) setErrorHandler;
    decltype(&XGetWindowAttributes) getWindowAttributes;
    decltype(&XVisualIDFromVisual) visualIdFromVisual;
    decltype(&XSelectInput) selectInput;
    decltype(&XCheckWindowEvent) checkWindowEvent;
};

const XConnection::Library* XConnection::library() {
    static const Library* const loaded = []() -> const Library* {
        static Library x;
        DynamicLibrary library("libX11.so.6");
        library.find("XInitThreads", x.initThreads);
        library.find("XOpenDisplay", x.openDisplay);
        library.find("XCloseDisplay", x.closeDisplay);
        library.find("XSetErrorHandler", x.setErrorHandler);
        library.find("XGetWindowAttributes", x.getWindowAttributes);
        library.find("XVisualIDFromVisual", x.visualIdFromVisual);
        library.find("XSelectInput", x.selectInput);
        library.find("XCheckWindowEvent", x.checkWindowEvent);
        if (!library.isComplete()) return nullptr;
        x.initThreads();
        return &x;
    }();
    return loaded;
}

// Xlib has one handler for the whole process, and its own one ends that.
int XConnection::onError(Display* display, XErrorEvent* event) {
    XErrorHandler former = nullptr;
    {
        std::lock_guard<std::mutex> lock(gDisplaysMutex);
        if (gDisplays.count(display) > 0) return 0;
        former = gFormerHandler;
    }
    return former == nullptr ? 0 : former(display, event);
}

std::unique_ptr<XConnection> XConnection::open() {
    const Library* const x = library();
    Display* const display = x == nullptr ? nullptr : x->openDisplay(nullptr);
    if (display == nullptr) return nullptr;
    return std::unique_ptr<XConnection>(new XConnection(*x, display));
}

// The handler is set again each time: others may have set theirs meanwhile.
XConnection::XConnection(const Library& library, Display* display)
    : mLibrary(library), mDisplay(display) {
    std::lock_guard<std::mutex> lock(gDisplaysMutex);
    gDisplays.insert(display);
    const XErrorHandler former = mLibrary.setErrorHandler(onError);
    if (former != onError) gFormerHandler = former;
}

XConnection::~XConnection() {
    mLibrary.closeDisplay(mDisplay);
    std::lock_guard<std::mutex> lock(gDisplaysMutex);
    gDisplays.erase(mDisplay);
}

std::optional<XWindowAttributes> XConnection::attributesOf(Window window) const {
    XWindowAttributes attributes = {};
    if (mLibrary.getWindowAttributes(mDisplay, window, &attributes) == 0) return {};
    return attributes;
}

void XConnection::watch(Window window) {
    mIsCovered = false;
    mLibrary.selectInput(mDisplay, window, VisibilityChangeMask);
}

// Asking for the attributes has brought the events, too.
std::optional<XWindow> XConnection::windowOf(Window window) {
    const auto attributes = attributesOf(window);
    if (!attributes) return {};
    readVisibility(window);
    return XWindow{{attributes->width, attributes->height},
                   attributes->map_state == IsViewable && !mIsCovered};
}

void XConnection::readVisibility(Window window) {
    XEvent event = {};
    while (mLibrary.checkWindowEvent(mDisplay, window, VisibilityChangeMask, &event)) {
        mIsCovered = event.xvisibility.state == VisibilityFullyObscured;
    }
}

std::optional<VisualID> XConnection::visualOf(Window window) const {
    const auto attributes = attributesOf(window);
    if (!attributes) return {};
    return mLibrary.visualIdFromVisual(attributes->visual);
}

}  // namespace orvtarn
