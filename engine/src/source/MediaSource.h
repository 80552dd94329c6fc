// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <atomic>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "source/ByteSource.h"
#include "source/RequestHeaders.h"

namespace orvtarn {

// Where the media of one setDataSource comes from. Either a name that the
// media libraries open themselves, or bytes that this engine reads for them.
class MediaSource {
public:
    virtual ~MediaSource() = default;

    // A path or URL; for sources of bytes the name under which StreamProtocol
    // finds them.
    virtual std::string name() const = 0;
    virtual RequestHeaders headers() const { return {}; }
    // Whether openReader gives readers.
    virtual bool isOfBytes() const { return false; }
    // A file of this machine.
    virtual bool isLocal() const { return false; }
    // Whether the name may be opened once more beside playback. What a second
    // reader of a pipe gets, playback lacks.
    virtual bool canOpenTwice() const { return true; }
    // Whether the media may name others that are opened with them: a playlist's
    // entries, a manifest's segments. Beside other files nothing is opened.
    virtual bool mayReference() const { return false; }
    // A reader with a position of its own; null when the source is closed,
    // cannot be read twice, or is not of bytes.
    virtual std::unique_ptr<ByteSource> openReader() { return nullptr; }

    // Ends the reads that block now; later ones work again.
    virtual void cancelReads() {}
    // Ends all reads for good and waits until no reader is left. The source's
    // owner may delete what it lent to it afterwards.
    virtual void close() {}

    // Milliseconds, 0 when unknown: by the source's own word, or else by that of
    // whoever described the media.
    int64_t knownDuration();
    void setToldDuration(int64_t milliseconds) { mToldDuration = milliseconds; }

    // Whether the last read failed, as opposed to having come to the end.
    bool readFailed() const { return mReadFailed; }
    void setReadFailed(bool value) { mReadFailed = value; }

protected:
    virtual int64_t ownDuration() { return 0; }

private:
    std::atomic<bool> mReadFailed{false};
    std::atomic<int64_t> mToldDuration{0};
};

// The name that sources of bytes have towards mpv.
constexpr char kByteSourceProtocol[] = "orvbytes";
constexpr char kByteSourceName[] = "orvbytes://source";

// Counts what is open on a source, for its close to wait for.
class ReaderCount {
public:
    // False once closed.
    bool enter();
    void leave();
    // Refuses new readers.
    void close();
    void awaitNone();
    int count() const;

private:
    mutable std::mutex mMutex;
    std::condition_variable mLeft;
    int mCount = 0;
    bool mClosed = false;
};

class UrlMediaSource : public MediaSource {
public:
    UrlMediaSource(std::string name, RequestHeaders headers)
        : mName(std::move(name)), mHeaders(std::move(headers)) {}

    std::string name() const override { return mName; }
    RequestHeaders headers() const override { return mHeaders; }
    bool isLocal() const override { return mName[0] == '/'; }
    bool canOpenTwice() const override;
    bool mayReference() const override;

private:
    const std::string mName;
    const RequestHeaders mHeaders;
};

// A range of an open file.
class FdMediaSource : public MediaSource {
public:
    // Takes the descriptor over.
    FdMediaSource(int fd, int64_t offset, int64_t length)
        : mFd(fd), mOffset(offset), mLength(length) {}
    ~FdMediaSource() override;

    std::string name() const override { return kByteSourceName; }
    bool isOfBytes() const override { return true; }
    bool isLocal() const override { return true; }
    std::unique_ptr<ByteSource> openReader() override;
    void close() override;

private:
    const int mFd;
    const int64_t mOffset;
    const int64_t mLength;
    ReaderCount mReaders;
};

// Checks a path or URL as setDataSource promises, without opening it. 0 with
// the name that the media libraries take, which is absolute for files.
int resolveName(const char* url, std::string& name);

}  // namespace orvtarn
