// SPDX-License-Identifier: Apache-2.0
#include "inspect/FrameTimes.h"

#include <stdlib.h>

#include <algorithm>
#include <iterator>
#include <set>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

// A frame that a time just misses by rounding is still meant.
constexpr int64_t kRoundingUs = 1000;
constexpr int64_t kFirstRunUpUs = 1000 * 1000;

class FrameCounter {
public:
    FrameCounter(MediaFile& file, const AVStream& stream) : mFile(file), mStream(stream) {
        const int64_t start = file.context()->start_time;
        mStartUs = start == AV_NOPTS_VALUE ? 0 : start;
    }

    std::optional<FrameAt> find(int64_t timeUs, int amount) {
        for (int64_t ahead = kFirstRunUpUs; !mFile.isInterrupted(); ahead *= 4) {
            const int64_t fromUs = std::max<int64_t>(timeUs - ahead, 0);
            if (!seek(fromUs) || !read(timeUs, amount)) return {};
            const auto now = mTimes.upper_bound(timeUs + kRoundingUs);
            const auto before = static_cast<int>(std::distance(mTimes.begin(), now)) - 1;
            const bool isEnough = before >= std::max(-amount, 0);
            if (isEnough || fromUs == 0) return at(before + amount);
        }
        return {};
    }

private:
    std::optional<FrameAt> at(int index) const {
        if (mTimes.empty()) return {};
        const int last = static_cast<int>(mTimes.size()) - 1;
        const int found = std::clamp(index, 0, last);
        const auto timeUs = static_cast<double>(*std::next(mTimes.begin(), found));
        return FrameAt{timeUs / 1e6, found == index};
    }

    bool seek(int64_t us) {
        AVFormatContext* media = mFile.context();
        if (us == 0 && (media->iformat->flags & AVFMT_TS_DISCONT) != 0) {
            return av_seek_frame(media, -1, 0, AVSEEK_FLAG_BYTE) >= 0;
        }
        const int64_t time = av_rescale_q(us + mStartUs, AV_TIME_BASE_Q, mStream.time_base);
        return av_seek_frame(media, mStream.index, time, AVSEEK_FLAG_BACKWARD) >= 0;
    }

    // Keeps the times of packets from here on, until those of so many frames after
    // the time are known. Frames are not stored in the order of their times.
    bool read(int64_t timeUs, int amount) {
        mTimes.clear();
        AVPacket* packet = av_packet_alloc();
        if (packet == nullptr) return false;
        int after = 0;
        bool goesOn = true;
        while (goesOn && !mFile.isInterrupted() && av_read_frame(mFile.context(), packet) >= 0) {
            if (packet->stream_index == mStream.index && packet->pts != AV_NOPTS_VALUE) {
                const int64_t us = usOf(packet->pts);
                const bool isNew = mTimes.insert(us).second;
                after += isNew && us > timeUs + kRoundingUs;
                goesOn = after < std::max(amount, 1) || !isSettled(*packet, timeUs, amount);
            }
            av_packet_unref(packet);
        }
        av_packet_free(&packet);
        return true;
    }

    // Whether no packet to come is shown before the frame that is wanted.
    bool isSettled(const AVPacket& packet, int64_t timeUs, int amount) const {
        if (packet.dts == AV_NOPTS_VALUE) return true;
        auto wanted = mTimes.upper_bound(timeUs + kRoundingUs);
        std::advance(wanted, std::max(amount, 1) - 1);
        return usOf(packet.dts) >= *wanted;
    }

    int64_t usOf(int64_t timestamp) const {
        return av_rescale_q(timestamp, mStream.time_base, AV_TIME_BASE_Q) - mStartUs;
    }

    MediaFile& mFile;
    const AVStream& mStream;
    int64_t mStartUs;
    std::set<int64_t> mTimes;
};

}  // namespace

std::optional<FrameAt> frameFrom(MediaFile& file, int streamIndex, double seconds, int amount) {
    const int index = streamIndex >= 0 ? streamIndex
                                       : av_find_best_stream(file.context(), AVMEDIA_TYPE_VIDEO, -1,
                                                             -1, nullptr, 0);
    const AVStream* stream = index >= 0 ? file.stream(index) : nullptr;
    if (stream == nullptr) return {};
    return FrameCounter(file, *stream).find(static_cast<int64_t>(seconds * 1e6), amount);
}

}  // namespace orvtarn
