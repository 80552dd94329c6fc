// SPDX-License-Identifier: Apache-2.0
#include "TestWindow.h"

#include <stdlib.h>
#include <string.h>

#include "PlayerTest.h"

// Last: their macros are words of other headers.
#include <X11/Xlib.h>
#include <X11/Xutil.h>

namespace orvtest {
namespace {

// Null without a display. One connection stays for the whole program: the virtual
// server begins anew after its last one, and refuses others meanwhile.
Display* connection() {
    static Display* const display = [] {
        XInitThreads();  // players look, too
        Display* opened = nullptr;
        if (getenv("DISPLAY") == nullptr) return opened;
        eventually([&] { return (opened = XOpenDisplay(nullptr)) != nullptr; });
        return opened;
    }();
    return display;
}

}  // namespace

bool TestWindow::isPossible() { return connection() != nullptr; }

TestWindow::TestWindow(int width, int height) : mDisplay(connection()) {
    mWindow = XCreateSimpleWindow(mDisplay, DefaultRootWindow(mDisplay), 0, 0, width, height, 0, 0,
                                  BlackPixel(mDisplay, DefaultScreen(mDisplay)));
    show();
}

TestWindow::~TestWindow() { destroy(); }

void TestWindow::resize(int width, int height) {
    XResizeWindow(mDisplay, mWindow, width, height);
    XSync(mDisplay, 0);
}

void TestWindow::hide() {
    XUnmapWindow(mDisplay, mWindow);
    XSync(mDisplay, 0);
}

void TestWindow::show() {
    XMapRaised(mDisplay, mWindow);
    XSync(mDisplay, 0);
    XWindowAttributes now = {};
    do {
        XGetWindowAttributes(mDisplay, mWindow, &now);
    } while (now.map_state != IsViewable);
}

void TestWindow::destroy() {
    if (mWindow == 0) return;
    XDestroyWindow(mDisplay, mWindow);
    XSync(mDisplay, 0);
    mWindow = 0;
}

void TestWindow::erase() {
    XClearWindow(mDisplay, mWindow);
    XSync(mDisplay, 0);
}

Picture TestWindow::look() {
    XWindowAttributes now = {};
    XGetWindowAttributes(mDisplay, mWindow, &now);
    XImage* const image =
        XGetImage(mDisplay, mWindow, 0, 0, now.width, now.height, AllPlanes, ZPixmap);
    Picture picture;
    picture.width = now.width;
    picture.height = now.height;
    const size_t row = size_t(now.width) * 4;
    picture.pixels.resize(row * now.height);
    for (int y = 0; y < now.height; y++) {
        memcpy(&picture.pixels[y * row], image->data + size_t(y) * image->bytes_per_line, row);
    }
    XDestroyImage(image);
    return picture;
}

bool TestWindow::waitFor(const std::function<bool(const Picture&)>& condition) {
    return eventually([&] { return condition(look()); }, 10);
}

}  // namespace orvtest
