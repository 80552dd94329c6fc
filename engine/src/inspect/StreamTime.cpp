// SPDX-License-Identifier: Apache-2.0
#include "inspect/StreamTime.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {

int64_t StreamTime::of(int64_t timestamp) const {
    return av_rescale_q(timestamp, mStream.time_base, AV_TIME_BASE_Q) - mFile.startUs();
}

// Formats without an index search by decoding times, and miss the first key frame.
bool StreamTime::seek(int64_t us) {
    AVFormatContext* media = mFile.context();
    if (us == 0 && (media->iformat->flags & AVFMT_TS_DISCONT) != 0) {
        return av_seek_frame(media, -1, 0, AVSEEK_FLAG_BYTE) >= 0;
    }
    const int64_t time = av_rescale_q(us + mFile.startUs(), AV_TIME_BASE_Q, mStream.time_base);
    return av_seek_frame(media, mStream.index, time, AVSEEK_FLAG_BACKWARD) >= 0;
}

}  // namespace orvtarn
