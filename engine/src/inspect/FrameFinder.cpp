// SPDX-License-Identifier: Apache-2.0
#include "inspect/FrameFinder.h"

#include <orvtarn/PlayerTypes.h>

#include <algorithm>

#include "inspect/AlbumArt.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
}

namespace orvtarn {

using android::OK;
using android::status_t;

namespace {

const int64_t kToleranceUs = 1000;
const int64_t kNextFrameUs = 100 * 1000;
const int64_t kFirstSeekBackUs = 1000 * 1000;
const int64_t kNearUs = 2000 * 1000;

bool isEmbeddedPicture(const AVStream& stream) {
    return (stream.disposition & AV_DISPOSITION_ATTACHED_PIC) != 0;
}

AVStream* firstVideo(const AVFormatContext& media) {
    for (unsigned i = 0; i < media.nb_streams; i++) {
        AVStream* stream = media.streams[i];
        const bool isVideo = stream->codecpar->codec_type == AVMEDIA_TYPE_VIDEO;
        if (isVideo && !isEmbeddedPicture(*stream)) return stream;
    }
    return nullptr;
}

}  // namespace

FrameFinder::FrameFinder(MediaFile& file)
    : mFile(file),
      mPacket(av_packet_alloc()),
      mRead(av_frame_alloc()),
      mFound(av_frame_alloc()),
      mBefore(av_frame_alloc()) {}

FrameFinder::~FrameFinder() {
    avcodec_free_context(&mCodec);
    av_packet_free(&mPacket);
    av_frame_free(&mRead);
    av_frame_free(&mFound);
    av_frame_free(&mBefore);
}

status_t FrameFinder::open(int streamIndex) {
    if (mPacket == nullptr || mRead == nullptr || mFound == nullptr || mBefore == nullptr) {
        return android::NO_MEMORY;
    }
    if (!chooseStream(streamIndex) || !openDecoder()) return ORV_ERROR_UNSUPPORTED;
    return OK;
}

bool FrameFinder::chooseStream(int streamIndex) {
    AVFormatContext* media = mFile.context();
    const int best = av_find_best_stream(media, AVMEDIA_TYPE_VIDEO, streamIndex, -1, nullptr, 0);
    if (best < 0) return false;
    mStream = media->streams[best];
    if (streamIndex < 0 && isEmbeddedPicture(*mStream)) {
        AVStream* cover = coverOf(mFile);
        AVStream* video = firstVideo(*media);
        if (video != nullptr || cover != nullptr) mStream = video != nullptr ? video : cover;
    }
    for (unsigned i = 0; i < media->nb_streams; i++) {
        media->streams[i]->discard =
            media->streams[i] == mStream ? AVDISCARD_DEFAULT : AVDISCARD_ALL;
    }
    return true;
}

bool FrameFinder::openDecoder() {
    const AVCodec* decoder = avcodec_find_decoder(mStream->codecpar->codec_id);
    mCodec = decoder == nullptr ? nullptr : avcodec_alloc_context3(decoder);
    if (mCodec == nullptr) return false;
    if (avcodec_parameters_to_context(mCodec, mStream->codecpar) < 0) return false;
    mCodec->pkt_timebase = mStream->time_base;
    mCodec->thread_count = 0;  // as many as there are cores
    return avcodec_open2(mCodec, decoder, nullptr) >= 0;
}

bool FrameFinder::isLike(const AVFrame& frame) const {
    return frame.width == mFound->width && frame.height == mFound->height &&
           frame.format == mFound->format;
}

const AVFrame* FrameFinder::before() const {
    return mBefore->width > 0 && isLike(*mBefore) ? mBefore : nullptr;
}

const AVFrame* FrameFinder::after() {
    if (isEmbeddedPicture(*mStream)) return nullptr;
    return nextFrame() && isLike(*mRead) ? mRead : nullptr;
}

// From the media's start. What has no time counts as at the start.
int64_t FrameFinder::timeUs(int64_t timestamp) const {
    if (timestamp == AV_NOPTS_VALUE) return 0;
    return av_rescale_q(timestamp, mStream->time_base, AV_TIME_BASE_Q) - mFile.startUs();
}

int64_t FrameFinder::timestamp(int64_t timeUs) const {
    return av_rescale_q(timeUs + mFile.startUs(), AV_TIME_BASE_Q, mStream->time_base);
}

const AVFrame* FrameFinder::find(int64_t positionMs) {
    if (isEmbeddedPicture(*mStream)) {
        return mFound->width > 0 || decodePicture() ? mFound : nullptr;
    }
    int64_t position = std::clamp<int64_t>(positionMs, 0, INT32_MAX) * 1000;
    const int64_t duration = mFile.context()->duration;
    if (duration > 0) position = std::min(position, duration);
    search(position);
    // Where nothing came out, the frame before is the nearest: a still picture
    // is at its end after the first time.
    return mFound->width > 0 ? mFound : nullptr;
}

// Formats without an index are sought by guesses, which may lead past the last
// key frame before the time: this goes further and further back until a frame at
// or before the time comes out.
void FrameFinder::search(int64_t positionUs) {
    const bool canGoOn = positionUs >= mWantedUs && isOnTheWayTo(positionUs);
    mWantedUs = positionUs;
    if (canGoOn) {
        if (!isReached(*mFound)) decodeUpTo(true, true);
        return;
    }
    for (int64_t back = 0;; back = std::max(4 * back, kFirstSeekBackUs)) {
        const int64_t from = std::max<int64_t>(positionUs - back, 0);
        // Reading goes on from where it stands in media that cannot be sought.
        const bool isLast = !seek(from) || from == 0;
        if (decodeUpTo(isLast, false) || isLast || mFile.isInterrupted()) return;
    }
}

// Whether decoding comes to the time from the frame that was found last no later
// than from the key frame before the time: pictures that are asked for in order
// cost their own frames then, and not those since the key frame again.
bool FrameFinder::isOnTheWayTo(int64_t positionUs) const {
    if (!mIsInOrder || mIsAtEnd) return false;
    const int key = av_index_search_timestamp(mStream, timestamp(positionUs), AVSEEK_FLAG_BACKWARD);
    if (key < 0) return positionUs - timeUs(mFound->best_effort_timestamp) < kNearUs;
    const AVIndexEntry* entry = avformat_index_get_entry(mStream, key);
    return entry != nullptr && entry->timestamp <= mFound->best_effort_timestamp;
}

bool FrameFinder::seek(int64_t positionUs) {
    AVFormatContext* media = mFile.context();
    // Broadcast formats are searched by decoding times, which misses the first
    // key frame.
    const bool isToFirstByte = positionUs == 0 && (media->iformat->flags & AVFMT_TS_DISCONT) != 0;
    const int error = isToFirstByte ? av_seek_frame(media, -1, 0, AVSEEK_FLAG_BYTE)
                                    : av_seek_frame(media, mStream->index, timestamp(positionUs),
                                                    AVSEEK_FLAG_BACKWARD);
    if (error < 0) return false;
    avcodec_flush_buffers(mCodec);
    av_frame_unref(mRead);
    mIsInOrder = false;
    mIsAtEnd = false;
    // What depends on frames before the place would come out damaged.
    mAwaitsKey = positionUs > 0;
    return true;
}

// A frame counts as at the time a little earlier, too, since times are rounded.
bool FrameFinder::isReached(const AVFrame& frame) const {
    return timeUs(frame.best_effort_timestamp) - mWantedUs > -kToleranceUs;
}

// takeLater: also takes a first frame that is past the time. hasEarlier: the frame
// that was found last is before the time, and decoding goes on from there.
bool FrameFinder::decodeUpTo(bool takeLater, bool hasEarlier) {
    if (!hasEarlier) av_frame_unref(mBefore);
    while (nextFrame()) {
        const int64_t late = timeUs(mRead->best_effort_timestamp) - mWantedUs;
        if (!hasEarlier && late >= kToleranceUs && !takeLater) return false;
        if (hasEarlier && late > kNextFrameUs) return true;
        av_frame_unref(mBefore);
        if (hasEarlier) av_frame_move_ref(mBefore, mFound);
        av_frame_unref(mFound);
        av_frame_move_ref(mFound, mRead);
        mIsInOrder = true;
        if (isReached(*mFound)) return true;
        hasEarlier = true;
    }
    return hasEarlier && !mFile.isInterrupted();
}

bool FrameFinder::decodePicture() {
    return avcodec_send_packet(mCodec, &mStream->attached_pic) >= 0 &&
           avcodec_send_packet(mCodec, nullptr) >= 0 && avcodec_receive_frame(mCodec, mFound) >= 0;
}

// The one that was looked at but not taken, or another one.
bool FrameFinder::nextFrame() { return mRead->width > 0 || readFrame(); }

bool FrameFinder::readFrame() {
    for (;;) {
        const int error = avcodec_receive_frame(mCodec, mRead);
        if (error >= 0) return true;
        if (error == AVERROR_EOF || !sendPacket()) return false;
    }
}

// Feeds the decoder with the stream's next packet, or the news that there is
// none. A damaged packet costs its frame, not the search.
bool FrameFinder::sendPacket() {
    while (!mFile.isInterrupted() && av_read_frame(mFile.context(), mPacket) >= 0) {
        const bool isOurs = mPacket->stream_index == mStream->index;
        const bool isPast = isOurs && timeUs(mPacket->pts) > mWantedUs;
        mAwaitsKey = mAwaitsKey && !(isOurs && (mPacket->flags & AV_PKT_FLAG_KEY) != 0);
        const bool isWanted = isOurs && !mAwaitsKey;
        if (isWanted) avcodec_send_packet(mCodec, mPacket);
        av_packet_unref(mPacket);
        if (isWanted) return true;
        if (mAwaitsKey && isPast) return false;
    }
    mIsAtEnd = true;
    return !mFile.isInterrupted() && avcodec_send_packet(mCodec, nullptr) >= 0;
}

}  // namespace orvtarn
