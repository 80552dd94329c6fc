// SPDX-License-Identifier: Apache-2.0
#include "inspect/FrameFinder.h"

#include <math.h>
#include <orvtarn/PlayerTypes.h>

#include <algorithm>
#include <iterator>

#include "base/LibraryVersions.h"

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
#include <libavutil/display.h>
}

namespace orvtarn {

using android::OK;
using android::status_t;

namespace {

const int64_t kToleranceUs = 1000;
const int64_t kNextFrameUs = 100 * 1000;
const int64_t kSeekBackUs[] = {0, 1000 * 1000, 4000 * 1000, 16000 * 1000};

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
    : mFile(file), mPacket(av_packet_alloc()), mRead(av_frame_alloc()), mFound(av_frame_alloc()) {}

FrameFinder::~FrameFinder() {
    avcodec_free_context(&mCodec);
    av_packet_free(&mPacket);
    av_frame_free(&mRead);
    av_frame_free(&mFound);
}

status_t FrameFinder::open(int streamIndex) {
    if (mPacket == nullptr || mRead == nullptr || mFound == nullptr) return android::NO_MEMORY;
    if (!chooseStream(streamIndex) || !openDecoder()) return ORV_ERROR_UNSUPPORTED;
    return OK;
}

bool FrameFinder::chooseStream(int streamIndex) {
    AVFormatContext* media = mFile.context();
    const int best = av_find_best_stream(media, AVMEDIA_TYPE_VIDEO, streamIndex, -1, nullptr, 0);
    if (best < 0) return false;
    mStream = media->streams[best];
    if (streamIndex < 0 && isEmbeddedPicture(*mStream) && firstVideo(*media) != nullptr) {
        mStream = firstVideo(*media);
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

int FrameFinder::rotation() const {
    const int32_t* matrix = displayMatrix(*mStream);
    if (matrix == nullptr) return 0;
    const double counterclockwise = av_display_rotation_get(matrix);
    if (isnan(counterclockwise)) return 0;
    const int quarters = static_cast<int>(lround(-counterclockwise / 90));
    return (quarters % 4 + 4) % 4 * 90;
}

int64_t FrameFinder::startTimeUs() const {
    const int64_t start = mFile.context()->start_time;
    return start == AV_NOPTS_VALUE ? 0 : start;
}

// From the media's start. Frames without a time count as at the start.
int64_t FrameFinder::frameTimeUs(const AVFrame& frame) const {
    if (frame.best_effort_timestamp == AV_NOPTS_VALUE) return 0;
    return av_rescale_q(frame.best_effort_timestamp, mStream->time_base, AV_TIME_BASE_Q) -
           startTimeUs();
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

// Some formats seek to places from where decoding begins only later, so this
// goes further back until a frame at or before the time comes out.
void FrameFinder::search(int64_t positionUs) {
    for (int64_t back : kSeekBackUs) {
        const int64_t from = std::max<int64_t>(positionUs - back, 0);
        // Reading goes on from where it stands in media that cannot be sought.
        seek(from);
        const bool isLast = from == 0 || back == *std::rbegin(kSeekBackUs);
        if (decodeUpTo(positionUs, isLast) || isLast || mFile.isInterrupted()) return;
    }
}

void FrameFinder::seek(int64_t positionUs) {
    AVFormatContext* media = mFile.context();
    // Broadcast formats are searched by decoding times, which misses the first
    // key frame.
    const bool isToFirstByte = positionUs == 0 && (media->iformat->flags & AVFMT_TS_DISCONT) != 0;
    const int64_t time =
        av_rescale_q(positionUs + startTimeUs(), AV_TIME_BASE_Q, mStream->time_base);
    const int error = isToFirstByte
                          ? av_seek_frame(media, -1, 0, AVSEEK_FLAG_BYTE)
                          : av_seek_frame(media, mStream->index, time, AVSEEK_FLAG_BACKWARD);
    if (error >= 0) avcodec_flush_buffers(mCodec);
}

// takeLater: also takes a first frame that is past the time.
bool FrameFinder::decodeUpTo(int64_t positionUs, bool takeLater) {
    bool hasEarlier = false;
    while (readFrame()) {
        const int64_t late = frameTimeUs(*mRead) - positionUs;
        const bool isReached = late > -kToleranceUs;
        if (!hasEarlier && late >= kToleranceUs && !takeLater) return false;
        if (hasEarlier && late > kNextFrameUs) return true;
        av_frame_unref(mFound);
        av_frame_move_ref(mFound, mRead);
        if (isReached) return true;
        hasEarlier = true;
    }
    return hasEarlier && !mFile.isInterrupted();
}

bool FrameFinder::decodePicture() {
    return avcodec_send_packet(mCodec, &mStream->attached_pic) >= 0 &&
           avcodec_send_packet(mCodec, nullptr) >= 0 && avcodec_receive_frame(mCodec, mFound) >= 0;
}

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
        if (isOurs) avcodec_send_packet(mCodec, mPacket);
        av_packet_unref(mPacket);
        if (isOurs) return true;
    }
    return !mFile.isInterrupted() && avcodec_send_packet(mCodec, nullptr) >= 0;
}

}  // namespace orvtarn
