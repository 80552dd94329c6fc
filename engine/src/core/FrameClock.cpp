// SPDX-License-Identifier: Apache-2.0
#include "core/FrameClock.h"

#include <algorithm>
#include <cmath>

namespace orvtarn {
namespace {

// After a longer break the frames before say nothing.
constexpr int64_t kLongestGap = 1000000;
// No frames are closer than this, as far as is known.
constexpr int64_t kShortestStep = 4000;
// By which due moments are off at most, in steps.
constexpr double kJitter = 0.3;

constexpr double kMicroseconds = 1e-6;

}  // namespace

void FrameClock::setSpeed(double speed) {
    std::lock_guard<std::mutex> lock(mMutex);
    mSpeed = speed;
    mKnown.reset();
    mStep.reset();
    mLastStep.reset();
}

std::optional<double> FrameClock::leave(int64_t at) {
    std::lock_guard<std::mutex> lock(mMutex);
    mLeftAt = at;
    return follows() ? expected() : std::nullopt;
}

std::optional<double> FrameClock::begin(int64_t due) {
    std::lock_guard<std::mutex> lock(mMutex);
    const int64_t step = due - mDue;
    mDue = due;
    // After a jump of mpv's own the next frame is due at once.
    const bool continues = step > 0 && step < kLongestGap && step > mStep.value_or(0) / 2;
    if (!continues) mKnown.reset();
    if (step > 0 && step < kLongestGap) {
        mStep = std::min(step, mLastStep.value_or(step));
        mLastStep = step;
    } else {
        mStep.reset();
        mLastStep.reset();
    }
    if (mLeftAt && (due >= *mLeftAt || !follows())) forget();
    return expected();
}

double FrameClock::resolve(double reported, int64_t readAt) {
    std::lock_guard<std::mutex> lock(mMutex);
    const double time = choose(reported, readAt);
    mPrevious = time;
    return time;
}

void FrameClock::stand() {
    std::lock_guard<std::mutex> lock(mMutex);
    forget();
}

void FrameClock::forget() {
    mKnown.reset();
    mLeftAt.reset();
}

double FrameClock::choose(double reported, int64_t readAt) {
    const std::optional<double> time = expected();
    // mpv has jumped meanwhile.
    if (time && (mLeftAt || (reported - mPrevious) * mSpeed <= 0)) return *time;
    if (isInTime(readAt) || !time || !agrees(*time, reported)) {
        mKnown = Frame{reported, mDue};
        return reported;
    }
    const double step = static_cast<double>(*mStep) * kMicroseconds * std::abs(mSpeed);
    return std::abs(*time - reported) < step * kJitter ? reported : *time;
}

std::optional<double> FrameClock::expected() const {
    if (!mKnown || !mStep) return {};
    return mKnown->time + static_cast<double>(mDue - mKnown->due) * kMicroseconds * mSpeed;
}

bool FrameClock::follows() const {
    if (!mStep) return false;
    return static_cast<double>(*mLastStep) < static_cast<double>(*mStep) * (1 + kJitter);
}

// Before the next frame can be due.
bool FrameClock::isInTime(int64_t readAt) const {
    return readAt < mDue + mStep.value_or(kShortestStep) * 9 / 10;
}

// Whether the report is of the frame or of the one after. Otherwise mpv has begun
// its distances anew, as it does when it was late.
bool FrameClock::agrees(double expected, double reported) const {
    const double ahead = (reported - expected) / mSpeed / kMicroseconds;
    const auto step = static_cast<double>(*mStep);
    return ahead > -step / 2 && ahead < step * 1.5;
}

}  // namespace orvtarn
