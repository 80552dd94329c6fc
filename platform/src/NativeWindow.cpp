// SPDX-License-Identifier: Apache-2.0
#include <gui/NativeWindow.h>

#include <algorithm>
#include <chrono>

namespace android {

bool NativeWindow::connect(User* user) {
    std::lock_guard<std::mutex> lock(mLock);
    if (mClosing || (mUser != nullptr && mUser != user)) return false;
    mUser = user;
    return true;
}

void NativeWindow::disconnect(User* user) {
    std::lock_guard<std::mutex> lock(mLock);
    if (mUser != user) return;
    mUser = nullptr;
    mChanged.notify_all();
}

bool NativeWindow::isClosing() {
    std::lock_guard<std::mutex> lock(mLock);
    return mClosing;
}

bool NativeWindow::takeRedraw() {
    std::lock_guard<std::mutex> lock(mLock);
    const bool wanted = mRedraw;
    mRedraw = false;
    return wanted;
}

bool NativeWindow::isHeld() {
    std::lock_guard<std::mutex> lock(mLock);
    return mHeld;
}

void NativeWindow::reportDrawing(const Drawing& drawing) {
    std::lock_guard<std::mutex> lock(mLock);
    mDrawing = drawing;
    mChanged.notify_all();
}

void NativeWindow::redraw() {
    std::lock_guard<std::mutex> lock(mLock);
    mRedraw = true;
    if (mUser != nullptr) mUser->onWindowChanged();
}

void NativeWindow::hold(bool held) {
    {
        std::lock_guard<std::mutex> lock(mLock);
        mHeld = held;
    }
    if (!held) redraw();
}

void NativeWindow::close() {
    std::unique_lock<std::mutex> lock(mLock);
    mClosing = true;
    mChanged.notify_all();
    if (mUser != nullptr) mUser->onWindowChanged();
    mChanged.wait(lock, [this] { return mUser == nullptr; });
}

NativeWindow::Drawing NativeWindow::drawing() {
    std::lock_guard<std::mutex> lock(mLock);
    return mDrawing;
}

uint64_t NativeWindow::frameCount() {
    std::lock_guard<std::mutex> lock(mLock);
    return mCount;
}

NativeWindow::Frame NativeWindow::awaitFrame(uint64_t seen, int timeoutMs) {
    std::unique_lock<std::mutex> lock(mLock);
    mChanged.wait_for(lock, std::chrono::milliseconds(timeoutMs),
                      [&] { return mCount > seen || mClosing; });
    if (mCount <= seen) return {};
    const uint64_t oldest = mCount - mTimesUs.size() + 1;
    const uint64_t number = std::max(seen + 1, oldest);
    return {number, mTimesUs[number - oldest]};
}

}  // namespace android
