// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <X11/Xlib.h>
#undef Status  // names that others use, too
#undef None
#undef Bool

#include <memory>
#include <optional>

#include "core/FrameDrawer.h"

namespace orvtarn {

struct XWindow {
    FrameSize size;
    bool isSeen = true;  // not minimised, nor covered as far as the server reports that
};

// A connection of its own to the X server of the environment. Its errors end
// nothing: a window that is gone only has no size any more. The library is loaded at
// run time, so that a machine without it still plays.
class XConnection {
public:
    // Null without the library or the server.
    static std::unique_ptr<XConnection> open();
    ~XConnection();
    XConnection(const XConnection&) = delete;
    XConnection& operator=(const XConnection&) = delete;

    Display* display() const { return mDisplay; }
    // From now on windowOf knows when that window is covered. One at a time.
    void watch(Window window);
    // Nothing when there is no such window.
    std::optional<XWindow> windowOf(Window window);
    std::optional<VisualID> visualOf(Window window) const;

private:
    struct Library;
    static const Library* library();
    static int onError(Display* display, XErrorEvent* event);

    XConnection(const Library& library, Display* display);
    std::optional<XWindowAttributes> attributesOf(Window window) const;

    void readVisibility(Window window);

    const Library& mLibrary;
    Display* const mDisplay;
    bool mIsCovered = false;
};

}  // namespace orvtarn
