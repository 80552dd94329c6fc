// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>

#include "LogLine.h"

namespace orvtrace {

// Turns the times of a log's lines into nanoseconds on one line of time. Dates without a
// year are taken for those nearest to the line before, so that a log may go on over new
// year, and a thread's line from before midnight may stand behind another's from after.
// Its zero is of no meaning.
class Clock {
public:
    int64_t at(const LogTime& time);
    // How often a line was older than one before it by more than a second: the clock was set.
    uint64_t setBack() const { return mSetBack; }
    // The fewest digits after the point so far: 3 where lines have milliseconds.
    int digits() const { return mDigits; }

private:
    int64_t dayOf(const LogTime& time);

    bool mStarted = false;
    // Of lines without a year: the days before their year, counted from the log's first, and
    // how many the year before that had.
    int64_t mYearBegin = 0;
    int mLengthBefore = 365;
    bool mLeapDaySeen = false;
    int mDayOfYear = 0;
    int64_t mLatest = INT64_MIN;
    uint64_t mSetBack = 0;
    int mDigits = 9;
};

}  // namespace orvtrace
