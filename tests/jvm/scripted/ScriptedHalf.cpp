// SPDX-License-Identifier: Apache-2.0
// What ScriptedHalf.java asks of the native half with the engine by script.
#include <binder/Parcel.h>
#include <jni.h>

#include <memory>
#include <sstream>
#include <thread>

#include "DivxService.h"
#include "RecordTexts.h"
#include "ScriptedEngine.h"
#include "dispatch/MsgDispatcher.h"
#include "stream/JavaInputStream.h"

using orvtest::DivxService;
using orvtest::ScriptedEngine;
using orvtest::setText;

namespace {

std::unique_ptr<DivxService> sDivx;

AudioTrackInfo audioTrack(int number) {
    AudioTrackInfo info;
    info.mTrackId = number;
    info.mChannels = 2;
    info.mSampleRate = 48000;
    setText(info.mTitle, u"title");
    setText(info.mCodecName, u"codec");
    setText(info.mChannelLayout, u"stereo");
    setText(info.mProfile, u"profile");
    setText(info.mComment, u"comment");
    setText(info.mEncoder, u"encoder");
    setText(info.mHandler, u"handler");
    setText(info.mLanguage, "eng");
    return info;
}

SubtitleTrackInfo subtitleTrack(int number) {
    SubtitleTrackInfo info;
    info.mTrackId = number;
    setText(info.mText, "deu;Titel");
    return info;
}

void scriptTracks(ScriptedEngine& engine, int count) {
    for (const char* table : {"getAudioTrackCount", "getVideoTrackCount", "getSubtitleTrackCount"})
        engine.put(table, count);
    for (int i = 0; i < count; ++i) {
        engine.audioTracks[i] = audioTrack(i);
        engine.subtitleTracks[i] = subtitleTrack(i);
        engine.videoCodecs[i].mWidth = 100 + i;
    }
    engine.currentVideoCodec = VideoCodecInfo();
    engine.currentVideoCodec->mWidth = 640;
    engine.metaDataInfo = MetaDataInfo();
    setText(engine.metaDataInfo->mTitle, u"film");
}

void scriptPictures(ScriptedEngine& engine) {
    engine.albumArt = std::vector<uint8_t>{1, 2, 3};
    engine.drawThumbnail = [](_Media_Thumbnail_Info_T* request) {
        memset(request->pBuffer, 7, request->u4BufferSize);
    };
}

void scriptDivx(DivxService& divx) {
    divx.title.mTitle = 1;
    divx.title.mPlayListCount = -2;
    divx.title.mChapterCount = 3;
    divx.chapter.mTitle = 4;
    divx.chapter.mPlayList = 5;
    divx.chapter.mChapter = 6;
    divx.chapter.mStart = -7;
    divx.number = 9;
}

// One call of each of the stream's, as an engine's thread makes them.
std::string useStream(JavaInputStream& stream) {
    char bytes[8] = {};
    int count = -1;
    std::ostringstream results;
    results << "read " << stream.read(bytes, sizeof(bytes), count) << " " << count << " "
            << int{bytes[0]};
    results << ", seek " << stream.byteSeek(E_Orv_Stream_Seek_Type{}, 5);
    results << ", time " << stream.timeSeek(2, 3) << ", type " << stream.getSeekType();
    results << ", size " << stream.getFileLength() << ", at " << stream.getCurrentPosition();
    results << ", " << stream.isSeekable() << stream.isStallingSupport() << stream.getDuration();
    stream.cancelRead();
    stream.closeStream();
    return results.str();
}

std::string textOf(JNIEnv* env, jstring text) {
    const char* chars = env->GetStringUTFChars(text, nullptr);
    std::string copy = chars;
    env->ReleaseStringUTFChars(text, chars);
    return copy;
}

}  // namespace

#define HALF_METHOD(type, name) \
    extern "C" JNIEXPORT type JNICALL Java_com_quintora_mmp_ScriptedHalf_##name

HALF_METHOD(void, script)(JNIEnv*, jclass, jint tracks) {
    ScriptedEngine& engine = *ScriptedEngine::last();
    scriptTracks(engine, tracks);
    scriptPictures(engine);
}

HALF_METHOD(void, answer)(JNIEnv* env, jclass, jstring operation, jint result) {
    ScriptedEngine::last()->answer(textOf(env, operation), {result});
}

HALF_METHOD(void, answerWhenMade)(JNIEnv* env, jclass, jstring operation, jint result) {
    if (operation == nullptr) {
        ScriptedEngine::whenMade(nullptr);
        return;
    }
    ScriptedEngine::whenMade([name = textOf(env, operation), result](ScriptedEngine& engine) {
        engine.answer(name, {result});
    });
}

// Without an answer the service refuses, as it does with every engine.
HALF_METHOD(void, answerDivx)(JNIEnv*, jclass, jboolean answer) {
    sDivx.reset();
    if (answer == JNI_FALSE) return;
    sDivx = std::make_unique<DivxService>();
    scriptDivx(*sDivx);
}

// The calls that the engine and the service in its place were given, a line each.
HALF_METHOD(jstring, takeCalls)(JNIEnv* env, jclass) {
    std::string lines;
    for (const std::string& call : ScriptedEngine::last()->takeCalls()) lines += call + "\n";
    if (sDivx != nullptr) {
        for (const std::string& call : sDivx->calls) lines += call + "\n";
        sDivx->calls.clear();
    }
    return env->NewStringUTF(lines.c_str());
}

HALF_METHOD(jint, livePlayers)(JNIEnv*, jclass) { return ScriptedEngine::live(); }

// The results of the stream's calls on a thread that Java did not start.
HALF_METHOD(jstring, useStream)(JNIEnv* env, jclass, jobject player) {
    JavaInputStream stream(env, player);
    std::string results;
    std::thread([&] { results = useStream(stream); }).join();
    return env->NewStringUTF(results.c_str());
}

// Posts an event with a word as its payload from a thread that Java did not start.
HALF_METHOD(void, post)(JNIEnv* env, jclass, jobject player, jobject weak, jint what, jint word) {
    const android::sp<ORV::MsgDispatcher> poster = new ORV::MsgDispatcher(env, player, weak);
    android::Parcel payload;
    payload.writeInt32(word);
    std::thread([&] { poster->notify(what, 0, 0, &payload); }).join();
}
