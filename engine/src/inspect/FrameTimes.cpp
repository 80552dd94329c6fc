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

#include "inspect/StreamTime.h"

namespace orvtarn {
namespace {

constexpr int64_t kFrameRunUpUs = 1000 * 1000;

class FrameCounter {
public:
    FrameCounter(MediaFile& file, const AVStream& stream)
        : mFile(file), mStream(stream), mTime(file, stream) {}

    std::optional<FrameAt> find(int64_t timeUs, int amount) {
        for (int64_t ahead = kFrameRunUpUs; !mFile.isInterrupted(); ahead *= 4) {
            const int64_t fromUs = std::max<int64_t>(timeUs - ahead, 0);
            if (!mTime.seek(fromUs) || !read(timeUs, amount)) return {};
            const auto now = mTimes.upper_bound(timeUs + StreamTime::kRoundingUs);
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

    // Keeps the times of packets from here on, until those of so many frames after
    // the time are known. Frames are not stored in the order of their times. False
    // when one has no time, as in program streams: it would not be counted.
    bool read(int64_t timeUs, int amount) {
        mTimes.clear();
        AVPacket* packet = av_packet_alloc();
        if (packet == nullptr) return false;
        int after = 0;
        bool goesOn = true;
        bool areTimed = true;
        while (goesOn && areTimed && !mFile.isInterrupted() &&
               av_read_frame(mFile.context(), packet) >= 0) {
            const bool isPicture = packet->stream_index == mStream.index;
            areTimed = !isPicture || packet->pts != AV_NOPTS_VALUE;
            if (isPicture && areTimed) {
                const int64_t us = mTime.of(packet->pts);
                const bool isNew = mTimes.insert(us).second;
                after += isNew && us > timeUs + StreamTime::kRoundingUs;
                goesOn = after < std::max(amount, 1) || !isSettled(*packet, timeUs, amount);
            }
            av_packet_unref(packet);
        }
        av_packet_free(&packet);
        return areTimed;
    }

    // Whether no packet to come is shown before the frame that is wanted.
    bool isSettled(const AVPacket& packet, int64_t timeUs, int amount) const {
        if (packet.dts == AV_NOPTS_VALUE) return true;
        auto wanted = mTimes.upper_bound(timeUs + StreamTime::kRoundingUs);
        std::advance(wanted, std::max(amount, 1) - 1);
        return mTime.of(packet.dts) >= *wanted;
    }

    MediaFile& mFile;
    const AVStream& mStream;
    StreamTime mTime;
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
