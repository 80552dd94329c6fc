// SPDX-License-Identifier: Apache-2.0
#include "source/StreamMediaSource.h"

#include <algorithm>
#include <chrono>
#include <thread>
#include <utility>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

constexpr uint32_t kUnknownLength = 0xFFFFFFFF;
// How often a source that has nothing now is asked again, and a blocked read
// is asked again to end: a request that comes just before the read blocks is lost.
constexpr std::chrono::milliseconds kPollInterval{10};

// The lock that the source keeps for the engine.
class SourceLock {
public:
    explicit SourceLock(IOrvStreamSource* stream) : mStream(stream) { mStream->lock(); }
    ~SourceLock() { mStream->unlock(); }
    SourceLock(const SourceLock&) = delete;
    SourceLock& operator=(const SourceLock&) = delete;

private:
    IOrvStreamSource* const mStream;
};

// A source that says that it can seek and does not is one that cannot. What
// cannot seek begins where it stands.
bool seeksToStart(IOrvStreamSource* stream) {
    SourceLock lock(stream);
    return stream->isSeekable() && stream->byteSeek(E_ORV_STREAM_SEEK_SET, 0) == 0;
}

class Counted {
public:
    explicit Counted(std::atomic<int>& count) : mCount(count) { mCount++; }
    ~Counted() { mCount--; }

private:
    std::atomic<int>& mCount;
};

}  // namespace

class StreamMediaSource::Reader : public ByteSource {
public:
    explicit Reader(StreamMediaSource& source) : mSource(source) {}
    ~Reader() override { mSource.mReaders.leave(); }

    int read(uint8_t* buffer, int length) override {
        const int count = mSource.readAt(mPosition, buffer, length);
        if (count > 0) mPosition += count;
        return count;
    }

    bool seek(int64_t position) override {
        if (position == mPosition) return true;
        if (!mSource.mSeekable || position < 0) return false;
        SourceLock lock(mSource.mStream.get());
        if (!mSource.moveTo(position)) return false;
        mPosition = position;
        return true;
    }

    int64_t size() override { return mSource.mSize; }
    bool isSeekable() override { return mSource.mSeekable; }

private:
    StreamMediaSource& mSource;
    int64_t mPosition = 0;
};

// A use of the source that close waits for, where it is not too late.
class StreamMediaSource::Call {
public:
    explicit Call(StreamMediaSource& source) : mSource(source), mEntered(source.mCalls.enter()) {}
    ~Call() {
        if (mEntered) mSource.mCalls.leave();
    }
    Call(const Call&) = delete;
    Call& operator=(const Call&) = delete;
    explicit operator bool() const { return mEntered; }

private:
    StreamMediaSource& mSource;
    const bool mEntered;
};

StreamMediaSource::StreamMediaSource(std::unique_ptr<IOrvStreamSource> stream)
    : mStream(std::move(stream)),
      mSeekable(seeksToStart(mStream.get())),
      mStalling(mStream->isStallingSupport()),
      mSize(measure()) {
    mStream->setThreadSelf();
}

// The length has 32 bits; the position at the end, where the source can go
// there, has all of them.
int64_t StreamMediaSource::measure() {
    const uint32_t low = mStream->getFileLength();
    if (low == kUnknownLength) return -1;
    if (!mSeekable) return low;
    SourceLock lock(mStream.get());
    const int64_t end = mStream->byteSeek(E_ORV_STREAM_SEEK_END, 0);
    if (end >= 0) mPosition = end;
    return end > 0 && static_cast<uint32_t>(end) == low ? end : low;
}

std::unique_ptr<ByteSource> StreamMediaSource::openReader() {
    const bool another = mReaders.count() > 0 || mPosition != 0;
    if (another && !mSeekable) return nullptr;
    if (!mReaders.enter()) return nullptr;
    std::unique_ptr<ByteSource> reader = std::make_unique<Reader>(*this);
    return mStream->isValid() ? std::move(reader) : nullptr;
}

int StreamMediaSource::readAt(int64_t position, uint8_t* buffer, int length) {
    const uint64_t cancels = mCancels;
    while (!mClosed && mCancels == cancels) {
        {
            SourceLock lock(mStream.get());
            if (!moveTo(position)) return -1;
            const int count = readOnce(buffer, length);
            if (count != 0 || !isStalled(position)) return count;
        }
        if (!awaitMore(cancels)) break;
    }
    return -1;
}

// The count, 0 at the end or when there is nothing now, -1 for an error.
int StreamMediaSource::readOnce(uint8_t* buffer, int length) {
    Counted reading(mReading);
    int reported = 0;
    const int status = mStream->read(reinterpret_cast<char*>(buffer), length, reported);
    // A source that has become invalid says that it ends: it breaks off.
    if (status == ORV_STREAM_ERROR_CODE_EOF) return mStream->isValid() ? 0 : -1;
    if (status != ORV_STREAM_ERROR_CODE_OK) return -1;
    const int count = std::clamp(reported, 0, length);
    // Where a source that gave more than it could write stands now, only a
    // seek can find out.
    mPosition = reported > length && mSeekable ? -1 : mPosition.load() + count;
    return count;
}

bool StreamMediaSource::moveTo(int64_t position) {
    if (position == mPosition) return true;
    if (!mSeekable) return false;
    Counted reading(mReading);
    const int64_t reached = mStream->byteSeek(E_ORV_STREAM_SEEK_SET, position);
    // A seek that failed leaves the source where it was.
    if (reached >= 0) mPosition = reached;
    return reached == position || refused("seek", "the source does not go there");
}

// A source that may pause and has not given all of its length yet.
bool StreamMediaSource::isStalled(int64_t position) const {
    return mStalling && mSize >= 0 && position < mSize;
}

bool StreamMediaSource::awaitMore(uint64_t cancels) {
    std::this_thread::sleep_for(kPollInterval);
    return !mClosed && mCancels == cancels;
}

void StreamMediaSource::cancelReads() {
    const Call call(*this);
    if (call) cancelBlocked();
}

void StreamMediaSource::cancelBlocked() {
    mCancels++;
    if (mReading > 0) mStream->cancelRead();
}

void StreamMediaSource::close() {
    if (mClosed.exchange(true)) return;
    mReaders.close();
    mStream->setInvalid();
    while (mReaders.count() > 0) {
        cancelBlocked();
        std::this_thread::sleep_for(kPollInterval);
    }
    mReaders.awaitNone();
    mStream->closeStream();
    mCalls.close();
    mCalls.awaitNone();
    mStream.reset();
}

int64_t StreamMediaSource::ownDuration() {
    const Call call(*this);
    const uint32_t duration = call ? mStream->getDuration() : 0;
    return duration == kUnknownLength ? 0 : duration;
}

}  // namespace orvtarn
