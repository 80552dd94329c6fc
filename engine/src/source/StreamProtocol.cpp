// SPDX-License-Identifier: Apache-2.0
#include "source/StreamProtocol.h"

#include <limits.h>
#include <mpv/stream_cb.h>

#include <algorithm>
#include <atomic>
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

int64_t onRead(void* cookie, char* buffer, uint64_t length) {
    auto* stream = static_cast<OpenStream*>(cookie);
    if (stream->cancelled) return -1;
    const int limit = static_cast<int>(std::min<uint64_t>(length, INT_MAX));
    const int count = stream->reader->read(reinterpret_cast<uint8_t*>(buffer), limit);
    const bool readFailed = count < 0 && !stream->cancelled;
    if (readFailed && !stream->source->readFailed()) refused("read", "the source failed");
    stream->source->setReadFailed(readFailed);
    return count < 0 ? -1 : count;
}

int64_t onSeek(void* cookie, int64_t offset) {
    auto* stream = static_cast<OpenStream*>(cookie);
    if (!stream->reader->isSeekable()) return MPV_ERROR_UNSUPPORTED;
    return stream->reader->seek(offset) ? offset : static_cast<int64_t>(MPV_ERROR_GENERIC);
}

int64_t onSize(void* cookie) {
    const int64_t size = static_cast<OpenStream*>(cookie)->reader->size();
    return size < 0 ? static_cast<int64_t>(MPV_ERROR_UNSUPPORTED) : size;
}

void onCancel(void* cookie) {
    auto* stream = static_cast<OpenStream*>(cookie);
    stream->cancelled = true;
    stream->source->cancelReads();
}

void onClose(void* cookie) { delete static_cast<OpenStream*>(cookie); }

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
    auto stream = std::make_unique<OpenStream>();
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
    info->cookie = stream.release();
    return 0;
}

}  // namespace orvtarn
