// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/TarnPlayer.h>

#include <deque>
#include <functional>
#include <initializer_list>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

namespace orvtest {

// The playback engine of the tests: the test program defines
// android::TarnPlayer by it. Every operation is written down as text, such as
// "seekTo(1000, 0)", and answered from the script; an operation without a
// scripted answer succeeds: 0, or true. Scripts are written before the calls
// come; the record may be read from any thread.
class ScriptedEngine {
public:
    // All engines of this process, in the order of their creation. They stay
    // readable after the player itself is gone, until forgetAll.
    static std::shared_ptr<ScriptedEngine> last();
    static std::vector<std::shared_ptr<ScriptedEngine>> all();
    static void forgetAll();
    // Runs for each engine from now on as it is made, on the thread that makes it;
    // nullptr for nothing. Set while no engine is being made.
    static void whenMade(std::function<void(ScriptedEngine&)> script);
    // Players that were made and not destroyed, forgotten or not.
    static int live();

    // The constructor's argument.
    int decoder() const { return mDecoder; }
    bool alive() const { return mPlayer != nullptr; }
    android::TarnPlayer* player() const { return mPlayer; }
    // The listener installed on the player now. The player must be alive.
    android::sp<android::MediaPlayerBase::Listener> listener() const;
    // Sends an event to that listener, as the engine does. The player must be alive.
    void sendEvent(int msg, int ext1, int ext2, const android::Parcel* obj) const;

    // The script. Results, one for each call; the last one goes on. Overloads
    // share their name.
    void answer(const std::string& operation, std::initializer_list<int> results);
    // What the operation writes through its int pointer or reference, whatever
    // it answers. Without it the operation writes nothing.
    void put(const std::string& operation, int value) { mOutValues[operation] = value; }
    // What the operation writes into its reply parcel.
    void reply(const std::string& operation, std::vector<int32_t> words);
    // Runs inside the operation, on its caller's thread, after it was recorded.
    void whenCalled(const std::string& operation, std::function<void()> action);

    // Records to hand out. A getter without its record leaves the caller's
    // record as it is and, without a scripted answer, fails.
    std::optional<VideoCodecInfo> currentVideoCodec;
    std::map<int, VideoCodecInfo> videoCodecs;
    std::map<int, SubtitleTrackInfo> subtitleTracks;
    std::map<int, AudioTrackInfo> audioTracks;
    std::optional<MetaDataInfo> metaDataInfo;
    // Gets each stream that is to be played.
    std::function<void(IOrvStreamSource*)> takeStream;
    // Draws into the request's buffer.
    std::function<void(_Media_Thumbnail_Info_T*)> drawThumbnail;
    // extractAlbumArt makes a block of these bytes; null without a value.
    std::optional<std::vector<uint8_t>> albumArt;

    // The record.
    std::vector<std::string> calls() const;
    std::vector<std::string> takeCalls();
    // Records as they came in, before they were filled.
    std::vector<SubtitleTrackInfo> receivedSubtitleTracks;
    std::vector<AudioTrackInfo> receivedAudioTracks;
    std::vector<MetaDataInfo> receivedMetaDataInfos;
    std::vector<_Media_Thumbnail_Info_T> receivedThumbnails;
    std::vector<IORV_PB_CTRL_SET_MEDIA_INFO_T> receivedPcmInfos;

private:
    friend class android::TarnPlayer;

    ScriptedEngine(android::TarnPlayer* player, int decoder) : mPlayer(player), mDecoder(decoder) {}
    static std::shared_ptr<ScriptedEngine> make(android::TarnPlayer* player, int decoder);
    void playerGone();

    // Writes the call down and gives the scripted result, or the other.
    int call(const std::string& operation, const std::string& arguments, int unscripted);
    // Adds a record that came in.
    template <class Record>
    void keep(std::vector<Record>& records, const Record& record) {
        std::lock_guard<std::mutex> lock(mMutex);
        records.push_back(record);
    }
    void writeOut(const std::string& operation, int* out) const;
    void writeReply(const std::string& operation, android::Parcel* out) const;

    android::TarnPlayer* mPlayer;
    const int mDecoder;
    mutable std::mutex mMutex;
    std::vector<std::string> mCalls;
    std::map<std::string, std::deque<int>> mAnswers;
    std::map<std::string, int> mOutValues;
    std::map<std::string, std::vector<int32_t>> mReplies;
    std::map<std::string, std::function<void()>> mActions;
};

// How a pointer stands in a recorded call.
std::string pointerText(const void* pointer);

}  // namespace orvtest
