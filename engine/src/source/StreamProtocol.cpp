// SPDX-License-Identifier: Apache-2.0
#include "source/StreamProtocol.h"

#include <limits.h>
#include <mpv/stream_cb.h>
#include <stdint.h>

#include <algorithm>
#include <atomic>
#include <map>
#include <utility>

#include "base/EngineLog.h"

namespace orvtarn {
namespace {

// One opening of the source by mpv.
struct OpenStream {
    std::shared_ptr<MediaSource> source;
    std::unique_ptr<ByteSource> reader;
    std::atomic<bool> cancelled{false};
};

// The openings by the number that mpv has of each. It may cancel one on another thread
// while it closes it, or just after.
class OpenStreams {
public:
    void* add(std::shared_ptr<OpenStream> stream) {
        std::lock_guard<std::mutex> lock(mMutex);
        mStreams[++mLast] = std::move(stream);
        return reinterpret_cast<void*>(mLast);
    }
    // Null once it is closed.
    std::shared_ptr<OpenStream> find(void* cookie) {
        std::lock_guard<std::mutex> lock(mMutex);
        const auto found = mStreams.find(reinterpret_cast<uintptr_t>(cookie));
        return found == mStreams.end() ? nullptr : found->second;
    }
    void remove(void* cookie) {
        const std::shared_ptr<OpenStream> stream = find(cookie);  // goes after the lock
        std::lock_guard<std::mutex> lock(mMutex);
        mStreams.erase(reinterpret_cast<uintptr_t>(cookie));
    }

private:
    std::mutex mMutex;
    std::map<uintptr_t, std::shared_ptr<OpenStream>> mStreams;
    uintptr_t mLast = 0;
};

// Never destroyed: mpv's threads may outlive the program's static objects.
OpenStreams& openStreams() {
    static auto* streams = new OpenStreams;
    return *streams;
}

int64_t onRead(void* cookie, char* buffer, uint64_t length) {
    const std::shared_ptr<OpenStream> stream = openStreams().find(cookie);
    if (stream == nullptr || stream->cancelled) return -1;
    const int limit = static_cast<int>(std::min<uint64_t>(length, INT_MAX));
    const int count = stream->reader->read(reinterpret_cast<uint8_t*>(buffer), limit);
    const bool readFailed = count < 0 && !stream->cancelled;
    if (readFailed && !stream->source->readFailed()) refused("read", "the source failed");
    stream->source->setReadFailed(readFailed);
    return count < 0 ? -1 : count;
}

int64_t onSeek(void* cookie, int64_t offset) {
    const std::shared_ptr<OpenStream> stream = openStreams().find(cookie);
    if (stream == nullptr || !stream->reader->isSeekable()) return MPV_ERROR_UNSUPPORTED;
    return stream->reader->seek(offset) ? offset : static_cast<int64_t>(MPV_ERROR_GENERIC);
}

int64_t onSize(void* cookie) {
    const std::shared_ptr<OpenStream> stream = openStreams().find(cookie);
    const int64_t size = stream == nullptr ? -1 : stream->reader->size();
    return size < 0 ? static_cast<int64_t>(MPV_ERROR_UNSUPPORTED) : size;
}

void onCancel(void* cookie) {
    const std::shared_ptr<OpenStream> stream = openStreams().find(cookie);
    if (stream == nullptr) return;
    stream->cancelled = true;
    stream->source->cancelReads();
}

void onClose(void* cookie) { openStreams().remove(cookie); }

}  // namespace

bool StreamProtocol::install(mpv_handle* mpv) {
    return mpv_stream_cb_add_ro(mpv, kByteSourceProtocol, this, open) == 0;
}

void StreamProtocol::setSource(std::shared_ptr<MediaSource> source) {
    std::lock_guard<std::mutex> lock(mMutex);
    mSource = std::move(source);
}

int StreamProtocol::open(void* self, char*, mpv_stream_cb_info* info) {
    auto* protocol = static_cast<StreamProtocol*>(self);
    auto stream = std::make_shared<OpenStream>();
    {
        std::lock_guard<std::mutex> lock(protocol->mMutex);
        stream->source = protocol->mSource;
    }
    if (stream->source != nullptr) stream->reader = stream->source->openReader();
    if (stream->reader == nullptr) {
        refused("open", "the source gives no reader");
        return MPV_ERROR_LOADING_FAILED;
    }
    info->read_fn = onRead;
    info->seek_fn = onSeek;
    info->size_fn = onSize;
    info->cancel_fn = onCancel;
    info->close_fn = onClose;
    info->cookie = openStreams().add(std::move(stream));
    return 0;
}

}  // namespace orvtarn
