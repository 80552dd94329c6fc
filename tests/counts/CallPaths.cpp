// SPDX-License-Identifier: Apache-2.0
// Native methods of the Java player: loading, queries, tables of tracks.
#include "Counting.h"
#include "Machine.h"
#include "Paths.h"
#include "RecordTexts.h"

namespace orvcounts {
namespace {

void load(int times) {
    Machine machine;
    repeat(times, [&](const Runner& counted) { counted([&] { machine.load(); }); });
}

// A query that the engine answers with 1234.
void query(int times, const char* method, const char* operation) {
    Machine machine;
    const fakejni::ObjectPtr player = machine.newPlayer();
    machine.engine->put(operation, 1234);
    repeat(times, [&](const Runner& counted) {
        counted([&] {
            require(machine.call<jint>(player, method, "()I").integer == 1234,
                    "a query has another result");
        });
    });
    machine.release(player);
}

void position(int times) { query(times, "native_getCurrentPosition", "getCurrentPosition"); }
void duration(int times) { query(times, "native_getDuration", "getDuration"); }

AudioTrackInfo audioTrack(int id) {
    AudioTrackInfo info;
    info.mTrackId = id;
    for (OrvWideText* text : {&info.mTitle, &info.mCodecName, &info.mChannelLayout, &info.mProfile,
                              &info.mComment, &info.mEncoder, &info.mHandler}) {
        orvtest::setText(*text, u"a text of usual length");
    }
    orvtest::setText(info.mLanguage, "eng");
    return info;
}

SubtitleTrackInfo subtitleTrack(int id) {
    SubtitleTrackInfo info;
    info.mTrackId = id;
    orvtest::setText(info.mText, "eng;for the hard of hearing");
    orvtest::setText(info.mLanguage, "eng");
    return info;
}

// The names of one table, in Java and in the engine.
struct Table {
    const char* callback;
    const char* callbackSignature;
    const char* countOperation;
};

// How often Java got an entry must be how many there are, each time.
template <typename Fetch>
void table(int times, int count, const Table& names, Fetch fetch) {
    Machine machine;
    machine.playerClass.method(names.callback, names.callbackSignature);
    const fakejni::ObjectPtr player = machine.newPlayer();
    machine.engine->put(names.countOperation, count);
    for (int i = 0; i < count; ++i) {
        machine.engine->audioTracks[i] = audioTrack(i);
        machine.engine->subtitleTracks[i] = subtitleTrack(i);
        machine.engine->videoCodecs[i] = VideoCodecInfo();
    }
    repeat(times, [&](const Runner& counted) {
        machine.vm.forgetCalls();
        counted([&] { fetch(machine, player); });
        require(machine.vm.javaCalls().size() == static_cast<size_t>(count),
                "a table has another length");
    });
    machine.release(player);
}

template <int Count>
void audioTable(int times) {
    const Table names = {"setAllAudioTrackInfo",
                         "(IIIIIIIILjava/lang/String;Ljava/lang/String;Ljava/lang/String;"
                         "Ljava/lang/String;ILjava/lang/String;Ljava/lang/String;"
                         "Ljava/lang/String;Ljava/lang/String;)V",
                         "getAudioTrackCount"};
    table(times, Count, names, [](Machine& machine, const fakejni::ObjectPtr& player) {
        machine.call<jint>(player, "native_getAllAudioTrackInfo", "(Z)I", jboolean{JNI_TRUE});
    });
}

template <int Count>
void subtitleTable(int times) {
    const Table names = {"setAllSubtitleTrackInfo", "(IIIILjava/lang/String;I)V",
                         "getSubtitleTrackCount"};
    table(times, Count, names, [](Machine& machine, const fakejni::ObjectPtr& player) {
        machine.call<jint>(player, "native_getAllSubtitleTrackInfo", "()I");
    });
}

template <int Count>
void videoTable(int times) {
    const Table names = {"setAllVideoCodecInfo", "(IIIIIIII)V", "getVideoTrackCount"};
    table(times, Count, names, [](Machine& machine, const fakejni::ObjectPtr& player) {
        machine.call<jint>(player, "native_getAllVideoTrackInfo", "()I");
    });
}

}  // namespace

const Path kCallPaths[] = {
    {"library_load", load},
    {"current_position", position},
    {"duration_log_off", duration},
    {"audio_track/10", audioTable<10>},
    {"audio_track/0", audioTable<0>},
    {"video_track/10", videoTable<10>},
    {"video_track/0", videoTable<0>},
    {"subtitle_track/10", subtitleTable<10>},
    {"subtitle_track/0", subtitleTable<0>},
};

}  // namespace orvcounts
