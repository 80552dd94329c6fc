// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <stream/IOrvStreamSource.h>

#include <atomic>
#include <memory>
#include <string>

#include "source/MediaSource.h"

namespace orvtarn {

// Media that the engine pulls from an IOrvStreamSource. The source has one
// position, its readers have one each: whoever reads moves it first, under the
// source's own lock.
class StreamMediaSource : public MediaSource {
public:
    // Takes the source over. close deletes it, on its caller's thread: the source may
    // hold on to what only a thread of the program's own can let go.
    explicit StreamMediaSource(std::unique_ptr<IOrvStreamSource> stream);

    std::string name() const override { return kByteSourceName; }
    bool isOfBytes() const override { return true; }
    // More than one reader needs a source that can seek.
    std::unique_ptr<ByteSource> openReader() override;
    void cancelReads() override;
    void close() override;

private:
    class Reader;

    class Call;

    int64_t ownDuration() override;
    void cancelBlocked();
    int64_t measure();
    int readAt(int64_t position, uint8_t* buffer, int length);
    int readOnce(uint8_t* buffer, int length);
    bool moveTo(int64_t position);
    bool isStalled(int64_t position) const;
    bool awaitMore(uint64_t cancels);

    std::unique_ptr<IOrvStreamSource> mStream;  // null once closed
    const bool mSeekable;
    const bool mStalling;
    ReaderCount mReaders;
    ReaderCount mCalls;  // other uses of the source, on any thread
    // The source's; -1 when only a seek can find out.
    std::atomic<int64_t> mPosition{0};
    const int64_t mSize;  // -1 when unknown

    std::atomic<int> mReading{0};  // calls that may block in the source
    std::atomic<uint64_t> mCancels{0};
    std::atomic<bool> mClosed{false};
};

}  // namespace orvtarn
