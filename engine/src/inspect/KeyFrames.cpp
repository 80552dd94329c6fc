// SPDX-License-Identifier: Apache-2.0
#include "inspect/KeyFrames.h"

#include <algorithm>

extern "C" {
#include <libavcodec/avcodec.h>
#include <libavformat/avformat.h>
}

#include "inspect/StreamTime.h"

namespace orvtarn {
namespace {

constexpr int64_t kRoundingUs = StreamTime::kRoundingUs;
constexpr int64_t kFirstRunUpUs = 2 * 1000 * 1000;

class Search {
public:
    Search(MediaFile& file, const AVStream& stream)
        : mFile(file), mStream(stream), mTime(file, stream) {}

    // Of packets from one time to another; both from the media's start.
    std::optional<int64_t> lastKeyFrame(int64_t fromUs, int64_t toUs) {
        std::optional<int64_t> last;
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
    // Program streams do not give each frame a time: it is shown soon after it
    // is decoded, then. False once there can be no more.
    bool look(const AVPacket& packet, int64_t toUs, std::optional<int64_t>& last) const {
        const int64_t shown = packet.pts == AV_NOPTS_VALUE ? packet.dts : packet.pts;
        const int64_t decoded = packet.dts == AV_NOPTS_VALUE ? packet.pts : packet.dts;
        if (shown == AV_NOPTS_VALUE) return true;
        const bool isKey = (packet.flags & AV_PKT_FLAG_KEY) != 0;
        if (isKey && mTime.of(shown) <= toUs) last = mTime.of(shown);
        return mTime.of(decoded) <= toUs;
    }

    MediaFile& mFile;
    const AVStream& mStream;
    StreamTime mTime;
};

}  // namespace

std::optional<double> keyFrameBefore(MediaFile& file, double seconds) {
    const int best = av_find_best_stream(file.context(), AVMEDIA_TYPE_VIDEO, -1, -1, nullptr, 0);
    if (best < 0) return {};
    Search search(file, *file.stream(best));
    const auto target = static_cast<int64_t>(seconds * 1e6) + kRoundingUs;
    for (int64_t ahead = kFirstRunUpUs; !file.isInterrupted(); ahead *= 4) {
        const int64_t from = std::max<int64_t>(target - ahead, 0);
        const std::optional<int64_t> found = search.lastKeyFrame(from, target);
        if (found) return static_cast<double>(*found) / 1e6;
        if (from == 0) return {};
    }
    return {};
}

}  // namespace orvtarn
