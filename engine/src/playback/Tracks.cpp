// SPDX-License-Identifier: Apache-2.0
#include "playback/Tracks.h"

#include <algorithm>
#include <string>

#include "base/EngineLog.h"
#include "inspect/ContainerInfo.h"
#include "inspect/MediaDescription.h"

namespace orvtarn {
namespace {

template <class Record>
bool isIndex(const std::vector<Track<Record>>& table, int index) {
    return index >= 0 && static_cast<size_t>(index) < table.size();
}

// -1 for none.
template <class Record>
int selectedIn(const std::vector<Track<Record>>& table) {
    const auto found = std::find_if(table.begin(), table.end(),
                                    [](const Track<Record>& track) { return track.selected; });
    return found == table.end() ? -1 : static_cast<int>(found - table.begin());
}

}  // namespace

bool Tracks::tables(const char* operation, TrackTables& tables) {
    if (mState.requireOpen(operation) != android::NO_ERROR) return false;
    MpvNode list;
    if (!mMpv.getNode("track-list", list)) return refused(operation, "no list of tracks");
    tables = trackTables(*list);
    return true;
}

bool Tracks::videoCount(int& count) {
    return countOf("getVideoTrackCount", &TrackTables::video, count);
}

bool Tracks::audioCount(int& count) {
    return countOf("getAudioTrackCount", &TrackTables::audio, count);
}

bool Tracks::subtitleCount(int& count) {
    return countOf("getSubtitleTrackCount", &TrackTables::subtitles, count);
}

template <class Table>
bool Tracks::countOf(const char* operation, Table TrackTables::* table, int& count) {
    TrackTables all;
    if (!tables(operation, all)) return false;
    count = static_cast<int>((all.*table).size());
    return true;
}

bool Tracks::Stand::operator==(const Stand& other) const {
    return session == other.session && count == other.count && video == other.video &&
           audio == other.audio && subtitle == other.subtitle;
}

Tracks::Stand Tracks::stand() const {
    return {mState.read([](const PlayerState::Values& v) { return v.session; }),
            mMpv.getInt("track-list/count"), mMpv.getInt("vid"), mMpv.getInt("aid"),
            mMpv.getInt("sid")};
}

std::shared_ptr<const TrackTables> Tracks::keptDetails(const Stand& now) {
    std::lock_guard<std::mutex> lock(mKeptMutex);
    return mKept != nullptr && mKeptStand == now ? mKept : nullptr;
}

std::shared_ptr<const TrackTables> Tracks::details(const char* operation) {
    if (mState.requireOpen(operation) != android::NO_ERROR) return nullptr;
    const Stand now = stand();
    if (auto kept = keptDetails(now)) return kept;
    const auto all = std::make_shared<TrackTables>();
    if (!tables(operation, *all)) return nullptr;
    mLoader.secondReading()->withFile([&](MediaFile& file) { addContainerDetails(file, *all); });
    // Those that changed meanwhile are not kept.
    if (!(stand() == now)) return all;
    std::lock_guard<std::mutex> lock(mKeptMutex);
    mKeptStand = now;
    mKept = all;
    return all;
}

bool Tracks::videoInfo(int index, VideoCodecInfo& info) {
    const auto all = details("getVideoCodecInfo");
    if (all == nullptr) return false;
    if (!isIndex(all->video, index)) return refused("getVideoCodecInfo", "no such track");
    info = all->video[index].record;
    return true;
}

bool Tracks::currentVideoInfo(VideoCodecInfo& info) {
    TrackTables all;
    if (!tables("getVideoCodecInfo", all)) return false;
    return videoInfo(std::max(selectedIn(all.video), 0), info);
}

int Tracks::shownVideoStream() {
    TrackTables all;
    if (!tables("getThumbnailInfo", all)) return -1;
    const int shown = selectedIn(all.video);
    return shown < 0 ? -1 : all.video[shown].streamIndex;
}

bool Tracks::audioInfo(bool withTexts, int index, AudioTrackInfo& info) {
    const auto all = details("getAudioTrackInfo");
    if (all == nullptr) return false;
    if (!isIndex(all->audio, index)) return refused("getAudioTrackInfo", "no such track");
    Track<AudioTrackInfo> track = all->audio[index];
    if (withTexts) {
        mLoader.secondReading()->withFile([&](MediaFile& file) { addAudioTexts(file, track); });
    }
    info = track.record;
    return true;
}

bool Tracks::subtitleInfo(int index, SubtitleTrackInfo& info) {
    if (index >= ORV_DESCRIPTION_INDEX_BASE) {
        return descriptionPiece(index - ORV_DESCRIPTION_INDEX_BASE, info);
    }
    if (index >= ORV_CHAPTER_INDEX_BASE) return chapterInfo(index - ORV_CHAPTER_INDEX_BASE, info);
    const auto all = details("getSubtitleTrackInfo");
    if (all == nullptr) return false;
    if (!isIndex(all->subtitles, index)) return refused("getSubtitleTrackInfo", "no such track");
    info = all->subtitles[index].record;
    return true;
}

// Chapters are read until there is no more: that is no failure to log.
bool Tracks::chapterInfo(int chapter, SubtitleTrackInfo& info) {
    if (mState.requireOpen("getSubtitleTrackInfo") != android::NO_ERROR) return false;
    bool found = false;
    mLoader.secondReading()->withFile(
        [&](MediaFile& file) { found = chapterRecord(file, chapter, info); });
    return found;
}

// Pieces are read until there is no more, too.
bool Tracks::descriptionPiece(int piece, SubtitleTrackInfo& info) {
    TrackTables all;
    if (!tables("getSubtitleTrackInfo", all)) return false;
    bool found = false;
    mLoader.secondReading()->withFile(
        [&](MediaFile& file) { found = descriptionRecord(describeMedia(file, all), piece, info); });
    return found;
}

bool Tracks::currentAudio(int* index) {
    return currentOf("getCurrentAudioIndex", &TrackTables::audio, index);
}

bool Tracks::currentSubtitle(int* index) {
    return currentOf("getCurrentSubtitleIndex", &TrackTables::subtitles, index);
}

template <class Table>
bool Tracks::currentOf(const char* operation, Table TrackTables::* table, int* index) {
    TrackTables all;
    if (index == nullptr) return refused(operation, "null argument");
    if (!tables(operation, all)) return false;
    *index = selectedIn(all.*table);
    return true;
}

bool Tracks::selectAudio(int index) {
    TrackTables all;
    if (!tables("selectAudioTrack", all)) return false;
    if (!isIndex(all.audio, index)) return refused("selectAudioTrack", "no such track");
    return choose("selectAudioTrack", "aid", all.audio[index].id);
}

bool Tracks::selectSubtitle(int index) {
    TrackTables all;
    if (!tables("onSubtitleTrack", all)) return false;
    if (!isIndex(all.subtitles, index)) return refused("onSubtitleTrack", "no such track");
    return showSubtitle("onSubtitleTrack", all.subtitles[index].id);
}

bool Tracks::subtitlesOff() {
    if (mState.requireOpen("offSubtitleTrack") != android::NO_ERROR) return false;
    return choose("offSubtitleTrack", "sid", 0);
}

bool Tracks::select(int number) {
    TrackTables all;
    if (!tables("selectTrack", all)) return false;
    const int audio = number - static_cast<int>(all.video.size());
    const int subtitle = audio - static_cast<int>(all.audio.size());
    if (isIndex(all.video, number)) return chooseVideo(all.video[number].id);
    if (isIndex(all.audio, audio)) return choose("selectTrack", "aid", all.audio[audio].id);
    if (!isIndex(all.subtitles, subtitle)) return refused("selectTrack", "no such track");
    return showSubtitle("selectTrack", all.subtitles[subtitle].id);
}

bool Tracks::deselect(int number) {
    TrackTables all;
    if (!tables("deselectTrack", all)) return false;
    const int video = selectedIn(all.video);
    const int audio = selectedIn(all.audio);
    const int subtitle = selectedIn(all.subtitles);
    const int firstAudio = static_cast<int>(all.video.size());
    const int firstSubtitle = firstAudio + static_cast<int>(all.audio.size());
    const bool isVideo = video >= 0 && number == video;
    const bool isAudio = audio >= 0 && number == firstAudio + audio;
    // Without picture and sound, playback would be at its end.
    if ((isVideo && audio < 0) || (isAudio && video < 0)) {
        return refused("deselectTrack", "nothing else is playing");
    }
    if (isVideo) return choose("deselectTrack", "vid", 0);
    if (isAudio) return choose("deselectTrack", "aid", 0);
    if (subtitle < 0 || number != firstSubtitle + subtitle) {
        return refused("deselectTrack", "the track is not selected");
    }
    return choose("deselectTrack", "sid", 0);
}

bool Tracks::showSubtitle(const char* operation, int64_t id) {
    return choose(operation, "sid", id) && mSeeker.refresh() == android::NO_ERROR;
}

bool Tracks::chooseVideo(int64_t id) {
    mFilters.beforeTrack(id);
    return choose("selectTrack", "vid", id);
}

// id 0 stands for none.
bool Tracks::choose(const char* operation, const char* property, int64_t id) {
    const int error = id > 0 ? mMpv.set(property, id) : mMpv.set(property, "no");
    return error >= 0 || refused(operation, mpv_error_string(error));
}

}  // namespace orvtarn
