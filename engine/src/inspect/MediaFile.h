// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include <atomic>
#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "source/ByteSource.h"
#include "source/RequestHeaders.h"

struct AVDictionary;
struct AVFormatContext;
struct AVIOContext;
struct AVStream;

namespace orvtarn {

struct MediaOpenOptions {
    // Request headers for URLs. Entries with line breaks are left out: they
    // would smuggle in headers of their own.
    RequestHeaders headers;
    // Set to true by another thread, ends an open or a read that blocks. Not
    // owned; must outlive the file.
    const std::atomic<bool>* cancel = nullptr;
    // For opening, and again for each later picture. Does not reach into a
    // ByteSource that blocks.
    std::chrono::milliseconds timeLimit{10000};
};

// An opened media file: its streams, tags, chapters and packets. Movable by its
// unique_ptr only; one thread at a time uses it.
class MediaFile {
public:
    // A path, a "file:" URL or any URL that libavformat reads. Blocks until the
    // streams are known. 0 with the file, or ORV_ERROR_IO (missing, refused,
    // cancelled or late), NAME_NOT_FOUND (no such file), PERMISSION_DENIED or
    // ORV_ERROR_MALFORMED (no format it knows).
    static android::status_t open(const std::string& url, const MediaOpenOptions& options,
                                  std::unique_ptr<MediaFile>& file);
    // From a source. Any source does; one that cannot seek is read on from
    // where it stands. A null source is BAD_VALUE.
    static android::status_t open(std::unique_ptr<ByteSource> source,
                                  const MediaOpenOptions& options,
                                  std::unique_ptr<MediaFile>& file);

    ~MediaFile();
    MediaFile(const MediaFile&) = delete;
    MediaFile& operator=(const MediaFile&) = delete;

    AVFormatContext* context() { return mContext; }
    const AVFormatContext* context() const { return mContext; }
    // What times count from, as a timestamp in microseconds: the container's start
    // unless another was set. Players need not agree with libavformat about it.
    int64_t startUs() const;
    void setStartUs(int64_t startUs) { mStartUs = startUs; }
    // Null for an index that is not one.
    const AVStream* stream(int index) const;

    // Whether the owner cancelled or the time limit has passed.
    bool isInterrupted() const;
    // Gives the next operation the whole time limit again.
    void restartTimeLimit();

private:
    explicit MediaFile(const MediaOpenOptions& options);
    android::status_t attachSource(std::unique_ptr<ByteSource> source);
    android::status_t openInput(const char* url);
    void addNetworkOptions(AVDictionary** options) const;
    static int openNested(AVFormatContext* context, AVIOContext** io, const char* url, int flags,
                          AVDictionary** options);

    const std::atomic<bool>* mCancel;
    std::chrono::milliseconds mTimeLimit;
    std::chrono::steady_clock::time_point mDeadline;
    std::optional<int64_t> mStartUs;
    std::string mHeaders;
    std::unique_ptr<ByteSource> mSource;
    AVIOContext* mSourceContext = nullptr;
    AVFormatContext* mContext = nullptr;
    decltype(&MediaFile::openNested) mOpenNested = nullptr;  // libavformat's own
};

}  // namespace orvtarn
