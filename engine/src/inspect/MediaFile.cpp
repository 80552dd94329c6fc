// SPDX-License-Identifier: Apache-2.0
#include "inspect/MediaFile.h"

#include <errno.h>
#include <orvtarn/PlayerTypes.h>

#include <new>

#include "source/FileName.h"
#include "source/TlsSettings.h"
#include "source/UrlScheme.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {

using android::BAD_VALUE;
using android::NAME_NOT_FOUND;
using android::NO_MEMORY;
using android::OK;
using android::PERMISSION_DENIED;
using android::status_t;

namespace {

const int kBufferSize = 32 * 1024;

int readSource(void* opaque, uint8_t* buffer, int length) {
    const int count = static_cast<ByteSource*>(opaque)->read(buffer, length);
    if (count == 0) return AVERROR_EOF;
    return count < 0 || count > length ? AVERROR(EIO) : count;
}

// AVIOContext turns the offsets from elsewhere into ones from the start.
int64_t seekSource(void* opaque, int64_t offset, int whence) {
    ByteSource& source = *static_cast<ByteSource*>(opaque);
    if (whence == AVSEEK_SIZE) {
        const int64_t size = source.size();
        return size < 0 ? AVERROR(ENOSYS) : size;
    }
    if ((whence & ~AVSEEK_FORCE) != SEEK_SET || !source.seek(offset)) return AVERROR(EIO);
    return offset;
}

int isInterruptedCallback(void* opaque) {
    return static_cast<const MediaFile*>(opaque)->isInterrupted();
}

status_t statusOf(int error) {
    switch (error) {
        case AVERROR(ENOENT):
            return NAME_NOT_FOUND;
        case AVERROR(EACCES):
            return PERMISSION_DENIED;
        case AVERROR(ENOMEM):
            return NO_MEMORY;
        case AVERROR_INVALIDDATA:
        case AVERROR_EOF:  // too short for any format
            return ORV_ERROR_MALFORMED;
        default:
            return ORV_ERROR_IO;
    }
}

// libavformat takes a path with a colon for a URL, and "file:" URLs undecoded.
std::string libavUrl(const std::string& name) {
    std::string path;
    return filePath(name, path) ? "file:" + path : name;
}

}  // namespace

MediaFile::MediaFile(const MediaOpenOptions& options)
    : mCancel(options.cancel),
      mTimeLimit(options.timeLimit),
      mHeaders(headerLines(options.headers)) {
    restartTimeLimit();
}

MediaFile::~MediaFile() {
    avformat_close_input(&mContext);
    if (mSourceContext != nullptr) av_freep(&mSourceContext->buffer);
    avio_context_free(&mSourceContext);
}

status_t MediaFile::open(const std::string& url, const MediaOpenOptions& options,
                         std::unique_ptr<MediaFile>& file) {
    std::unique_ptr<MediaFile> opened(new (std::nothrow) MediaFile(options));
    if (opened == nullptr) return NO_MEMORY;
    const status_t status = opened->openInput(libavUrl(url).c_str());
    if (status == OK) file = std::move(opened);
    return status;
}

status_t MediaFile::open(std::unique_ptr<ByteSource> source, const MediaOpenOptions& options,
                         std::unique_ptr<MediaFile>& file) {
    if (source == nullptr) return BAD_VALUE;
    std::unique_ptr<MediaFile> opened(new (std::nothrow) MediaFile(options));
    if (opened == nullptr) return NO_MEMORY;
    status_t status = opened->attachSource(std::move(source));
    if (status == OK) status = opened->openInput("");
    if (status == OK) file = std::move(opened);
    return status;
}

status_t MediaFile::attachSource(std::unique_ptr<ByteSource> source) {
    mSource = std::move(source);
    uint8_t* buffer = static_cast<uint8_t*>(av_malloc(kBufferSize));
    if (buffer == nullptr) return NO_MEMORY;
    mSourceContext = avio_alloc_context(buffer, kBufferSize, 0, mSource.get(), readSource, nullptr,
                                        mSource->isSeekable() ? seekSource : nullptr);
    if (mSourceContext != nullptr) return OK;
    av_free(buffer);
    return NO_MEMORY;
}

status_t MediaFile::openInput(const char* url) {
    mContext = avformat_alloc_context();
    if (mContext == nullptr) return NO_MEMORY;
    mContext->pb = mSourceContext;
    mContext->interrupt_callback = {isInterruptedCallback, this};
    mContext->opaque = this;
    mOpenNested = mContext->io_open;
    mContext->io_open = openNested;
    AVDictionary* options = nullptr;
    std::string path;
    const bool isFile = mSource == nullptr && filePath(url, path);
    av_dict_set(&options, "protocol_whitelist", protocolWhitelist(isFile), 0);
    addNetworkOptions(&options);
    int error = avformat_open_input(&mContext, url, nullptr, &options);
    av_dict_free(&options);
    if (error >= 0) error = avformat_find_stream_info(mContext, nullptr);
    if (isInterrupted()) return ORV_ERROR_IO;
    return error < 0 ? statusOf(error) : OK;
}

// Those that libavformat has no names for are left in it.
void MediaFile::addNetworkOptions(AVDictionary** options) const {
    const std::string certificates = certificateFile();
    av_dict_set(options, "tls_verify", verifiesCertificates() ? "1" : "0", 0);
    if (!certificates.empty()) av_dict_set(options, "ca_file", certificates.c_str(), 0);
    // Unless the headers have one; as playback has it.
    av_dict_set(options, "user_agent", "orvtarn", 0);
    if (!mHeaders.empty()) av_dict_set(options, "headers", mHeaders.c_str(), 0);
}

// A manifest's segments are opened as the manifest is.
int MediaFile::openNested(AVFormatContext* context, AVIOContext** io, const char* url, int flags,
                          AVDictionary** options) {
    const auto* file = static_cast<const MediaFile*>(context->opaque);
    AVDictionary* own = nullptr;
    if (options != nullptr) av_dict_copy(&own, *options, 0);
    file->addNetworkOptions(&own);
    const int error = file->mOpenNested(context, io, url, flags, &own);
    av_dict_free(&own);
    return error;
}

const AVStream* MediaFile::stream(int index) const {
    if (index < 0 || static_cast<unsigned>(index) >= mContext->nb_streams) return nullptr;
    return mContext->streams[index];
}

int64_t MediaFile::startUs() const {
    const int64_t byContainer = mContext->start_time == AV_NOPTS_VALUE ? 0 : mContext->start_time;
    return mStartUs.value_or(byContainer);
}

bool MediaFile::isInterrupted() const {
    return (mCancel != nullptr && mCancel->load(std::memory_order_relaxed)) ||
           std::chrono::steady_clock::now() >= mDeadline;
}

void MediaFile::restartTimeLimit() { mDeadline = std::chrono::steady_clock::now() + mTimeLimit; }

}  // namespace orvtarn
