// SPDX-License-Identifier: Apache-2.0
#include "inspect/KeyFrames.h"

#include <algorithm>
#include <utility>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
}

#include "inspect/StreamTime.h"

namespace orvtarn {
namespace {

constexpr int64_t kKeyFrameRunUpUs = 2 * 1000 * 1000;

class Search {
public:
    Search(MediaFile& file, const AVStream& stream)
        : mFile(file), mStream(stream), mTime(file, stream) {}

    // Of packets from one time to another; both from the media's start.
    std::optional<int64_t> lastKeyFrame(int64_t fromUs, int64_t toUs) {
        std::optional<int64_t> last;
        mUntimed = false;
        if (!mTime.seek(fromUs)) return last;
        AVPacket* packet = av_packet_alloc();
        bool goesOn = packet != nullptr;
        while (goesOn && !mFile.isInterrupted() && av_read_frame(mFile.context(), packet) >= 0) {
            if (packet->stream_index == mStream.index) goesOn = look(*packet, toUs, last);
            av_packet_unref(packet);
        }
        av_packet_free(&packet);
        return last;
    }

private:
    // False once there can be no more.
    bool look(const AVPacket& packet, int64_t toUs, std::optional<int64_t>& last) {
        const std::optional<int64_t> shown = timeOfKeyFrame(packet);
        if (shown && *shown <= toUs) last = shown;
        const int64_t decoded = packet.dts == AV_NOPTS_VALUE ? packet.pts : packet.dts;
        return decoded == AV_NOPTS_VALUE || mTime.of(decoded) <= toUs;
    }

    // When this packet's key frame, or one before it, is shown. Program streams do
    // not give each frame a time: a frame that others refer to is shown when the next
    // of its kind is decoded.
    std::optional<int64_t> timeOfKeyFrame(const AVPacket& packet) {
        const bool isKey = (packet.flags & AV_PKT_FLAG_KEY) != 0;
        if (isKey && packet.pts != AV_NOPTS_VALUE) return mTime.of(packet.pts);
        if (packet.dts == AV_NOPTS_VALUE) return {};
        if (isKey && mStream.codecpar->video_delay == 0) return mTime.of(packet.dts);
        if (isKey) mUntimed = true;
        const bool isReferredTo = packet.pts != AV_NOPTS_VALUE && packet.pts > packet.dts;
        if (!isReferredTo || !std::exchange(mUntimed, false)) return {};
        return mTime.of(packet.dts);
    }

    MediaFile& mFile;
    const AVStream& mStream;
    StreamTime mTime;
    bool mUntimed = false;  // the newest key frame has no time yet
};

}  // namespace

std::optional<double> keyFrameBefore(MediaFile& file, double seconds) {
    const int best = av_find_best_stream(file.context(), AVMEDIA_TYPE_VIDEO, -1, -1, nullptr, 0);
    if (best < 0) return {};
    Search search(file, *file.stream(best));
    const auto target = static_cast<int64_t>(seconds * 1e6) + StreamTime::kRoundingUs;
    for (int64_t ahead = kKeyFrameRunUpUs; !file.isInterrupted(); ahead *= 4) {
        const int64_t from = std::max<int64_t>(target - ahead, 0);
        const std::optional<int64_t> found = search.lastKeyFrame(from, target);
        if (found) return static_cast<double>(*found) / 1e6;
        if (from == 0) return {};
    }
    return {};
}

}  // namespace orvtarn
