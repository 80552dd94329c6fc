// SPDX-License-Identifier: Apache-2.0
#include "playback/BytePosition.h"

#include <math.h>

#include <optional>

#include "base/EngineLog.h"
#include "inspect/PacketPosition.h"

namespace orvtarn {
android::status_t BytePosition::get(int* position) {
    if (position == nullptr) {
        return failed(android::BAD_VALUE, "getCurrentBytePosition", "null argument");
    }
    const android::status_t open = mState.requireOpen("getCurrentBytePosition");
    if (open != android::NO_ERROR) return open;
    const std::shared_ptr<MediaSource> source = mLoader.source();
    const double now = mMpv.getDouble("time-pos").value_or(0);
    const int bytesPerSecond = mLoader.rawBytesPerSecond();
    std::optional<int64_t> found;
    if (bytesPerSecond > 0) {
        found = llround(now * bytesPerSecond);
    } else if (source != nullptr && source->isLocal()) {
        mLoader.secondReading()->withFile([&](MediaFile& file) { found = byteAtTime(file, now); });
    }
    if (!found) found = mMpv.getInt("stream-pos");
    if (!found) {
        return failed(android::INVALID_OPERATION, "getCurrentBytePosition", "no byte positions");
    }
    *position = static_cast<int>(static_cast<uint32_t>(*found));
    return android::NO_ERROR;
}

bool BytePosition::seekTo(unsigned long long position) {
    if (mState.requireOpen("seekToPosition") != android::NO_ERROR) return false;
    const auto size = mMpv.getInt("file-size");
    // Negative positions arrive here as very large ones.
    if (position > INT64_MAX || (size && static_cast<int64_t>(position) > *size)) {
        return refused("seekToPosition", "outside of the media");
    }
    const int bytesPerSecond = mLoader.rawBytesPerSecond();
    std::optional<double> time;
    if (bytesPerSecond > 0) time = static_cast<double>(position) / bytesPerSecond;
    mLoader.secondReading()->withFile(
        [&](MediaFile& file) { time = timeAtByte(file, static_cast<int64_t>(position)); });
    if (!time) return refused("seekToPosition", "no frame is known there");
    return mSeeker.seekToTime("seekToPosition", *time) == android::NO_ERROR;
}

}  // namespace orvtarn
