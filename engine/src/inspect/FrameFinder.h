// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include "inspect/MediaFile.h"

extern "C" {
#include <libavcodec/avcodec.h>
}

namespace orvtarn {

// Seeks and decodes one video stream of a file. One thread at a time.
class FrameFinder {
public:
    // The file is borrowed.
    explicit FrameFinder(MediaFile& file);
    ~FrameFinder();
    FrameFinder(const FrameFinder&) = delete;
    FrameFinder& operator=(const FrameFinder&) = delete;

    // Once, before the rest. -1 takes the best video stream, embedded pictures
    // only without another. 0 or ORV_ERROR_UNSUPPORTED.
    android::status_t open(int streamIndex);

    // The frame at a time from the media's start: the first one that starts at
    // the time or up to 100 ms after it; where frames are further apart than that,
    // the one on screen at the time. A frame that starts less than 1 ms before
    // counts as at the time, since times are whole milliseconds. The nearest one
    // where the media cannot be sought; null when nothing can be decoded. It
    // belongs to the finder and stays as it is until the next call.
    const AVFrame* find(int64_t positionMs);

    // The frames next to the one that was found, of the same size and format; null
    // where there is none or decoding began or ended there. after() may decode and
    // is for one call after find(). They belong to the finder, too.
    const AVFrame* before() const;
    const AVFrame* after();

    // The one that was opened.
    const AVStream& stream() const { return *mStream; }

private:
    bool chooseStream(int streamIndex);
    bool openDecoder();
    void search(int64_t positionUs);
    bool seek(int64_t positionUs);
    bool isLike(const AVFrame& frame) const;
    bool isOnTheWayTo(int64_t positionUs) const;
    bool isReached(const AVFrame& frame) const;
    bool decodeUpTo(bool takeLater, bool hasEarlier);
    bool decodePicture();
    bool nextFrame();
    bool readFrame();
    bool sendPacket();
    int64_t timeUs(int64_t timestamp) const;
    int64_t timestamp(int64_t timeUs) const;

    MediaFile& mFile;
    AVStream* mStream = nullptr;
    AVCodecContext* mCodec = nullptr;
    AVPacket* mPacket;
    AVFrame* mRead;           // the one just decoded, unless it was taken
    AVFrame* mFound;          // the one to show
    AVFrame* mBefore;         // the one that was decoded before that
    int64_t mWantedUs = 0;    // the time that is searched for
    bool mAwaitsKey = false;  // packets before a key frame are not decoded
    bool mIsInOrder = false;  // the found one was decoded since the last seek
    bool mIsAtEnd = false;    // no packet is left, or reading failed
};

}  // namespace orvtarn
