// SPDX-License-Identifier: Apache-2.0
#include "LineReader.h"

#include <errno.h>
#include <poll.h>
#include <string.h>
#include <unistd.h>

namespace orvtrace {

namespace {
constexpr size_t kReadSize = 4 * LineReader::kMaxLine;
}

LineReader::LineReader(int fd, int patienceMs)
    : mFd(fd), mPatienceMs(patienceMs), mBuffer(kReadSize) {}

LineReader::Result LineReader::next(std::string_view& line) {
    while (true) {
        const char* from = mBuffer.data() + mScanned;
        const void* newline = memchr(from, '\n', mEnd - mScanned);
        if (newline != nullptr) {
            const size_t end = static_cast<const char*>(newline) - mBuffer.data();
            const size_t begin = mBegin;
            mBegin = mScanned = end + 1;
            if (mSkipping) {
                mSkipping = false;
                continue;
            }
            if (end - begin > kMaxLine) {
                ++mLongLines;
                line = {mBuffer.data() + begin, kMaxLine};
            } else {
                line = withoutReturn(begin, end);
            }
            return Result::kLine;
        }
        mScanned = mEnd;
        if (mSkipping) {
            mBegin = mScanned = mEnd = 0;
        } else if (mEnd - mBegin > kMaxLine) {
            line = {mBuffer.data() + mBegin, kMaxLine};
            ++mLongLines;
            mSkipping = true;
            mBegin = mEnd;
            return Result::kLine;
        }
        const Result result = fill();
        if (result != Result::kLine) return result;
    }
}

LineReader::Result LineReader::fill() {
    if (mBegin > 0) {
        memmove(mBuffer.data(), mBuffer.data() + mBegin, mEnd - mBegin);
        mScanned -= mBegin;
        mEnd -= mBegin;
        mBegin = 0;
    }
    if (mPatienceMs >= 0) {
        pollfd descriptor = {mFd, POLLIN, 0};
        const int ready = poll(&descriptor, 1, mPatienceMs);
        if (ready < 0) return errno == EINTR ? Result::kInterrupted : Result::kError;
        if (ready == 0) return Result::kNothingYet;
    }
    const ssize_t count = read(mFd, mBuffer.data() + mEnd, mBuffer.size() - mEnd);
    if (count < 0) return errno == EINTR ? Result::kInterrupted : Result::kError;
    if (count == 0) return Result::kEnd;
    mEnd += count;
    mBytesRead += count;
    return Result::kLine;
}

std::string_view LineReader::rest() {
    const std::string_view line = mSkipping ? std::string_view() : withoutReturn(mBegin, mEnd);
    mBegin = mScanned = mEnd = 0;
    mSkipping = false;
    return line;
}

std::string_view LineReader::withoutReturn(size_t begin, size_t end) const {
    if (end > begin && mBuffer[end - 1] == '\r') --end;
    return {mBuffer.data() + begin, end - begin};
}

}  // namespace orvtrace
