// SPDX-License-Identifier: Apache-2.0
#include "playback/VideoFilters.h"

#include <algorithm>
#include <optional>

#include "base/EngineLog.h"
#include "records/TrackRecords.h"

namespace orvtarn {
namespace {

using VideoTrack = Track<VideoCodecInfo>;

// The track that mpv selects by itself.
const VideoTrack* usualTrack(const std::vector<VideoTrack>& tracks) {
    const auto isDefault = [](const VideoTrack& track) {
        return (track.record.mFlags & ORV_TRACK_FLAG_DEFAULT) != 0;
    };
    const auto found = std::find_if(tracks.begin(), tracks.end(), isDefault);
    if (found != tracks.end()) return &*found;
    return tracks.empty() ? nullptr : &tracks.front();
}

template <class Value>
struct Name {
    const char* name;  // mpv's
    Value value;
};

// Those that video of a high dynamic range comes with.
const Name<AVColorTransferCharacteristic> kTransfers[] = {
    {"pq", AVCOL_TRC_SMPTE2084},
    {"hlg", AVCOL_TRC_ARIB_STD_B67},
};
const Name<AVColorPrimaries> kPrimaries[] = {
    {"bt.709", AVCOL_PRI_BT709},
    {"bt.2020", AVCOL_PRI_BT2020},
    {"dci-p3", AVCOL_PRI_SMPTE431},
    {"display-p3", AVCOL_PRI_SMPTE432},
};
const Name<AVColorSpace> kMatrices[] = {
    {"bt.709", AVCOL_SPC_BT709},
    {"bt.2020-ncl", AVCOL_SPC_BT2020_NCL},
    {"bt.2020-cl", AVCOL_SPC_BT2020_CL},
    {"rgb", AVCOL_SPC_RGB},
};

template <class Value, size_t kCount>
Value named(const Name<Value> (&names)[kCount], const std::optional<std::string>& text,
            Value missing) {
    for (const Name<Value>& name : names) {
        if (text == name.name) return name.value;
    }
    return missing;
}

// mpv counts light in this many cd/m², and takes PQ whose peak is unknown as the
// brightest there can be.
constexpr double kMpvWhite = 203;
constexpr double kUnknownPeak = 10000;

double peakLuminance(double ofMpv) {
    const double peak = ofMpv * kMpvWhite;
    return peak < kUnknownPeak - 1 ? peak : 0;
}

// mpv goes on to take what was hybrid log-gamma as scene light, whatever became of
// it; OpenGL would make it darker.
std::string filterChain(const std::string& graph, const PictureTraits& traits) {
    if (graph.empty()) return graph;
    const bool wasSceneLight = traits.transfer == AVCOL_TRC_ARIB_STD_B67;
    return "lavfi=[" + graph + "]" + (wasSceneLight ? ",format=light=display" : "");
}

}  // namespace

void VideoFilters::onOpened() {
    MpvNode list;
    if (!mMpv.getNode("track-list", list)) return;
    const TrackTables tables = trackTables(*list);
    const VideoTrack* track = usualTrack(tables.video);
    begin(track == nullptr ? Orientation() : Orientation{track->rotation, false});
}

void VideoFilters::beforeTrack(int64_t id) {
    MpvNode list;
    if (!mMpv.getNode("track-list", list)) return;
    const TrackTables tables = trackTables(*list);
    for (const VideoTrack& track : tables.video) {
        if (track.id == id) begin({track.rotation, false});
    }
}

void VideoFilters::begin(Orientation orientation) {
    std::lock_guard<std::mutex> lock(mMutex);
    mTraits = PictureTraits();
    mTraits.orientation = orientation;
    apply();
}

bool VideoFilters::adapt() {
    std::lock_guard<std::mutex> lock(mMutex);
    PictureTraits& now = mTraits;
    now.width = static_cast<int>(mMpv.getInt("video-params/w").value_or(0));
    now.height = static_cast<int>(mMpv.getInt("video-params/h").value_or(0));
    now.transfer = named(kTransfers, mMpv.getString("video-params/gamma"), AVCOL_TRC_UNSPECIFIED);
    now.primaries =
        named(kPrimaries, mMpv.getString("video-params/primaries"), AVCOL_PRI_UNSPECIFIED);
    now.matrix =
        named(kMatrices, mMpv.getString("video-params/colormatrix"), AVCOL_SPC_UNSPECIFIED);
    now.range = mMpv.getString("video-params/colorlevels") == "full" ? AVCOL_RANGE_JPEG
                                                                     : AVCOL_RANGE_UNSPECIFIED;
    now.peakLuminance = peakLuminance(mMpv.getDouble("video-params/sig-peak").value_or(0));
    // Deinterlaced pictures are no longer marked, but those to come may be.
    now.isInterlaced =
        now.isInterlaced || mMpv.getFlag("video-frame-info/interlaced").value_or(false);
    keepChroma();
    return apply();
}

// mpv's quick conversion halves the chroma of each row and shifts it. Where the
// pictures have chroma for each pixel, the exact one is worth its time.
void VideoFilters::keepChroma() {
    const std::string format = mMpv.getString("video-params/pixelformat").value_or("");
    const bool isWhole = format.find("444") != std::string::npos || isHighDynamicRange(mTraits);
    mMpv.set("sws-allow-zimg", isWhole);
}

bool VideoFilters::apply() {
    const std::string graph = pictureFilters(mTraits);
    if (graph == mGraph) return false;
    mDecoding.setFiltered(!graph.empty());
    const int error = mMpv.set("vf", filterChain(graph, mTraits));
    if (error < 0) {
        ALOGW("picture: mpv refuses the filters %s: %s", graph.c_str(), mpv_error_string(error));
        return false;
    }
    mGraph = graph;
    return true;
}

}  // namespace orvtarn
