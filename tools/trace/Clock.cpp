// SPDX-License-Identifier: Apache-2.0
#include "Clock.h"

#include <algorithm>

namespace orvtrace {

namespace {

constexpr int64_t kDay = 24 * 60 * 60 * kNanosecondsPerSecond;
constexpr int kDaysBefore[] = {0, 31, 59, 90, 120, 151, 181, 212, 243, 273, 304, 334};
constexpr int kHalfYear = 182;
constexpr int64_t kMostDays = int64_t{365} * (kLastYear - kFirstYear);

bool isLeapYear(int year) { return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0; }

int64_t leapDaysBefore(int year) {
    const int64_t past = year - 1;
    return past / 4 - past / 100 + past / 400;
}

// Days from the first of January of the first year that a log may have to that of this one.
int64_t daysBefore(int year) {
    return 365 * static_cast<int64_t>(year - kFirstYear) + leapDaysBefore(year) -
           leapDaysBefore(kFirstYear);
}

}  // namespace

int64_t Clock::at(const LogTime& time) {
    if (!time.known) return 0;
    mDigits = std::min(mDigits, time.digits);
    const int64_t now = (time.counted ? 0 : dayOf(time) * kDay) + time.nanoseconds;
    if (mStarted && now < mLatest - kNanosecondsPerSecond) {
        ++mSetBack;
        mLatest = now;
    }
    mLatest = std::max(mLatest, now);
    mStarted = true;
    return now;
}

// Which years are leap years is unknown where years are: then the 29th of February is the
// day before the first of March, and pushes the rest of its year by one.
int64_t Clock::dayOf(const LogTime& time) {
    if (time.year != 0) {
        const int leap = isLeapYear(time.year) && time.month > 2 ? 1 : 0;
        return daysBefore(time.year) + kDaysBefore[time.month - 1] + time.day - 1 + leap;
    }
    int day = kDaysBefore[time.month - 1] + time.day - 1;
    if (mStarted && day > mDayOfYear + kHalfYear) return mYearBegin - mLengthBefore + day;
    if (mStarted && day < mDayOfYear - kHalfYear && mYearBegin < kMostDays) {
        mLengthBefore = mLeapDaySeen ? 366 : 365;
        mYearBegin += mLengthBefore;
        mLeapDaySeen = false;
    }
    mDayOfYear = day;
    if (time.month == 2 && time.day == 29) mLeapDaySeen = true;
    if (mLeapDaySeen && time.month > 2) ++day;
    return mYearBegin + day;
}

}  // namespace orvtrace
