// SPDX-License-Identifier: Apache-2.0
// Servers of the worst kind: media from them end as they should, or in an error
// that says what is wrong.
#include <gmock/gmock.h>
#include <orvtarn/PlayerTypes.h>
#include <stdlib.h>
#include <sys/stat.h>

#include <memory>
#include <vector>

#include "HttpServer.h"
#include "PlayerTest.h"
#include "TlsServer.h"

extern "C" {
#include <libavformat/avformat.h>
}

using namespace android;
using namespace orvtest;

namespace {

class NetworkTest : public PlayerTest {
protected:
    status_t prepareUrl(const std::string& url) {
        EXPECT_EQ(NO_ERROR, player->setDataSource(url.c_str(), nullptr));
        return player->prepare();
    }

    // What ends the playback of media that were prepared: 0 for their end.
    status_t endOf() {
        EXPECT_EQ(NO_ERROR, player->start());
        EXPECT_TRUE(eventually(
            [&] { return events->count(MEDIA_PLAYBACK_COMPLETE) + events->count(MEDIA_ERROR) > 0; },
            60));
        int msec = 0;
        const status_t status = player->getCurrentPosition(&msec);
        EXPECT_EQ(status == NO_ERROR, events->count(MEDIA_PLAYBACK_COMPLETE) == 1);
        return status;
    }

    // As for details and pictures.
    static status_t readAgain(const std::string& url,
                              std::unique_ptr<orvtarn::MediaFile>* opened = nullptr) {
        std::unique_ptr<orvtarn::MediaFile> file;
        const status_t status = orvtarn::MediaFile::open(url, {}, file);
        if (opened != nullptr) *opened = std::move(file);
        return status;
    }
    static bool findsVideo(const std::string& url) {
        std::unique_ptr<orvtarn::MediaFile> file;
        if (readAgain(url, &file) != NO_ERROR) return false;
        for (int i = 0; const AVStream* stream = file->stream(i); i++) {
            if (stream->codecpar->codec_type == AVMEDIA_TYPE_VIDEO) return true;
        }
        return false;
    }

    // A player of the environment as it is now.
    void renewPlayer() {
        player->release();
        player = new TarnPlayer(-1);
        player->setNotifyCallback(events);
        player->setVideoSurfaceTexture(sink);
    }
};

struct BadAnswer {
    const char* name;
    HttpFaults faults;
    int status;
};
void PrintTo(const BadAnswer& answer, std::ostream* out) { *out << answer.name; }

class BadAnswerTest : public NetworkTest, public testing::WithParamInterface<BadAnswer> {};

TEST_P(BadAnswerTest, EndsPrepareWithItsStatus) {
    HttpServer server(mediaPath("short.mp4"), GetParam().faults);
    EXPECT_EQ(GetParam().status, prepareUrl(server.url()));
    EXPECT_TRUE(events->waitFor(MEDIA_ERROR));
    player->reset();
    open("short.mp4");
}

HttpFaults answers(int status) {
    HttpFaults faults;
    faults.status = status;
    return faults;
}

HttpFaults shutsAtOnce() {
    HttpFaults faults;
    faults.shuts = true;
    return faults;
}

HttpFaults redirectsTo(const std::string& url) {
    HttpFaults faults;
    faults.redirect = url;
    return faults;
}

HttpFaults wantsHeader() {
    HttpFaults faults;
    faults.wantsHeader = "X-Ticket: 1\r\n";
    return faults;
}

HttpFaults breaksInTheHead() {
    HttpFaults faults;
    faults.ranges = false;
    faults.breakAt = 200;
    return faults;
}

INSTANTIATE_TEST_SUITE_P(
    Kinds, BadAnswerTest,
    testing::Values(BadAnswer{"Unauthorized", answers(401), ORV_ERROR_HTTP - 401},
                    BadAnswer{"Forbidden", answers(403), ORV_ERROR_HTTP - 403},
                    BadAnswer{"NotFound", answers(404), ORV_ERROR_HTTP - 404},
                    BadAnswer{"Gone", answers(410), ORV_ERROR_HTTP - 410},
                    BadAnswer{"ServerError", answers(500), ORV_ERROR_HTTP - 500},
                    BadAnswer{"Unavailable", answers(503), ORV_ERROR_HTTP - 503},
                    BadAnswer{"Closed", shutsAtOnce(), ORV_ERROR_CONNECTION_LOST},
                    BadAnswer{"NeedsHeader", wantsHeader(), ORV_ERROR_HTTP - 403},
                    BadAnswer{"CutInTheHead", breaksInTheHead(), ORV_ERROR_CUT_SHORT},
                    BadAnswer{"RedirectToAFile", redirectsTo("file://" + mediaPath("short.mp4")),
                              ORV_ERROR_LOCAL_REFERENCE}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(NetworkTest, ARedirectLoopIsCalledOne) {
    HttpServer server(mediaPath("short.mp4"));
    server.setFaults(redirectsTo(server.url("round")));
    EXPECT_EQ(ORV_ERROR_REDIRECTS, prepareUrl(server.url()));
}

TEST_F(NetworkTest, ARedirectIsFollowed) {
    HttpServer server(mediaPath("short.mp4"));
    HttpServer first(mediaPath("lines.srt"), redirectsTo(server.url()));
    ASSERT_EQ(NO_ERROR, prepareUrl(first.url()));
    EXPECT_EQ(NO_ERROR, endOf());
}

TEST_F(NetworkTest, HostsThatAreNotThereAreToldApart) {
    EXPECT_EQ(ORV_ERROR_CANNOT_CONNECT, prepareUrl("http://127.0.0.1:1/refused.mp4"));
    player->reset();
    EXPECT_EQ(ORV_ERROR_CANNOT_CONNECT, prepareUrl("rtsp://127.0.0.1:1/refused"));
    player->reset();
    EXPECT_EQ(ORV_ERROR_UNKNOWN_HOST, prepareUrl("http://no-such-host.invalid/film.mp4"));
}

TEST_F(NetworkTest, CookiesAndHeadersGoWithEveryRequest) {
    HttpFaults faults = wantsHeader();
    faults.wantsCookie = true;
    HttpServer server(mediaPath("short.mp4"), faults);
    KeyedVector<String8, String8> headers;
    headers.add(String8("X-Ticket"), String8("1"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url().c_str(), &headers));
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(NO_ERROR, player->seekTo(2000, 0));
    EXPECT_EQ(NO_ERROR, endOf());
}

struct OddServer {
    const char* name;
    HttpFaults faults;
};
void PrintTo(const OddServer& server, std::ostream* out) { *out << server.name; }

class OddServerTest : public NetworkTest, public testing::WithParamInterface<OddServer> {};

// All of the media come, whatever else the server does.
TEST_P(OddServerTest, MediaPlayToTheirEnd) {
    HttpServer server(mediaPath("silent.mkv"), GetParam().faults);
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    EXPECT_EQ(NO_ERROR, endOf());
    EXPECT_EQ(duration(), position());
}

HttpFaults withoutRanges() {
    HttpFaults faults;
    faults.ranges = false;
    return faults;
}

HttpFaults withoutRangesAndLength() {
    HttpFaults faults = withoutRanges();
    faults.tellsLength = false;
    return faults;
}

HttpFaults announcesTooMuch() {
    HttpFaults faults = withoutRanges();
    faults.extraLength = 50000;
    return faults;
}

HttpFaults drips() {
    HttpFaults faults;
    faults.bytesPerSecond = 60000;
    return faults;
}

HttpFaults fallsSilentAtTheEnd() {
    HttpFaults faults = withoutRanges();
    struct stat status = {};
    stat(mediaPath("silent.mkv").c_str(), &status);
    faults.stallAt = status.st_size;
    return faults;
}

INSTANTIATE_TEST_SUITE_P(Kinds, OddServerTest,
                         testing::Values(OddServer{"NoRanges", withoutRanges()},
                                         OddServer{"NoLength", withoutRangesAndLength()},
                                         OddServer{"AnnouncesTooMuch", announcesTooMuch()},
                                         OddServer{"Drips", drips()},
                                         OddServer{"FallsSilent", fallsSilentAtTheEnd()}),
                         [](const auto& info) { return std::string(info.param.name); });

TEST_F(NetworkTest, AStreamWithoutLengthAndDurationEndsWithItsConnection) {
    HttpServer server(mediaPath("tone.mp3"), withoutRangesAndLength());
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    EXPECT_EQ(NO_ERROR, endOf());
}

// Their bytes are all here by then; nobody asks for more.
TEST_F(NetworkTest, AnAddressThatExpiresDoesNotUndoTheEnd) {
    HttpServer server(mediaPath("short.mp4"));
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    ASSERT_TRUE(eventually([&] { return player->getBufferPercent() >= 99; }));
    server.setStatus(403);
    const size_t requests = server.requests().size();
    EXPECT_EQ(NO_ERROR, endOf());
    EXPECT_EQ(requests, server.requests().size()) << "a connection at the end";
}

TEST_F(NetworkTest, AServerThatIsGoneDoesNotUndoTheEnd) {
    auto server = std::make_unique<HttpServer>(mediaPath("short.mp4"));
    ASSERT_EQ(NO_ERROR, prepareUrl(server->url()));
    ASSERT_TRUE(eventually([&] { return player->getBufferPercent() >= 99; }));
    server.reset();
    EXPECT_EQ(NO_ERROR, endOf());
}

// It takes connections all the same.
TEST_F(NetworkTest, AServerThatFallsSilentIsReported) {
    HttpFaults faults;
    faults.stallAt = 1500000;
    HttpServer server(mediaPath("feature.mkv"), faults);
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    server.setSilent(true);
    EXPECT_EQ(ORV_ERROR_NO_ANSWER, endOf());
}

TEST_F(NetworkTest, WhatBreaksOffIsAnError) {
    HttpFaults faults;
    faults.breakAt = 1500000;
    HttpServer server(mediaPath("feature.mkv"), faults);
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    EXPECT_EQ(ORV_ERROR_CUT_SHORT, endOf());
}

TEST_F(NetworkTest, WhatBreaksOffWithoutRangesIsAnError) {
    for (const bool tellsLength : {true, false}) {
        SCOPED_TRACE(tellsLength);
        HttpFaults faults = withoutRanges();
        faults.tellsLength = tellsLength;
        faults.breakAt = 1500000;
        HttpServer server(mediaPath("feature.mkv"), faults);
        ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
        EXPECT_EQ(ORV_ERROR_CUT_SHORT, endOf());
        renewPlayer();
        events = new EventRecorder;
        player->setNotifyCallback(events);
    }
}

TEST_F(NetworkTest, AnAddressThatExpiresInTheMiddleIsAnError) {
    HttpFaults faults;
    faults.breakAt = 1500000;
    HttpServer server(mediaPath("feature.mkv"), faults);
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    server.setStatus(403);
    EXPECT_EQ(ORV_ERROR_HTTP - 403, endOf());
}

// FFmpeg logs to the player that was made first alone, about the media of all.
TEST_F(NetworkTest, WhatBreaksOffIsAnErrorBesideAPlayerThatWasMadeBefore) {
    const sp<TarnPlayer> first = new TarnPlayer(-1);
    ASSERT_EQ(NO_ERROR, first->setDataSource(mediaPath("silent.mkv").c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, first->prepare());
    HttpFaults faults;
    faults.breakAt = 1500000;
    HttpServer server(mediaPath("feature.mkv"), faults);
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    EXPECT_EQ(ORV_ERROR_CONNECTION_LOST, endOf());
    first->release();
}

TEST_F(NetworkTest, WhatAnotherPlayersServerAnswersIsNotOnesOwnError) {
    HttpFaults faults;
    faults.breakAt = 1500000;
    HttpServer server(mediaPath("feature.mkv"), faults);
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    HttpServer bad(mediaPath("silent.mkv"), answers(500));
    const sp<TarnPlayer> second = new TarnPlayer(-1);
    ASSERT_EQ(NO_ERROR, second->setDataSource(bad.url().c_str(), nullptr));
    EXPECT_EQ(ORV_ERROR_HTTP - 500, second->prepare());
    EXPECT_THAT(endOf(), testing::AnyOf(ORV_ERROR_CUT_SHORT, ORV_ERROR_CONNECTION_LOST));
    second->release();
}

// Silence before the answer, in the head of the media and in their middle. Each
// is a player of its own, as each takes the connection's 20 seconds.
TEST_F(NetworkTest, SilenceEndsInTime) {
    struct Case {
        Case(int64_t position, const HttpFaults& faults)
            : stallAt(position), server(mediaPath("feature.mkv"), faults) {}
        const int64_t stallAt;
        HttpServer server;
        sp<EventRecorder> events = new EventRecorder;
        sp<TarnPlayer> player = new TarnPlayer(-1);
    };
    std::vector<std::unique_ptr<Case>> cases;
    for (const int64_t stallAt : {-1, 100, 1500000}) {
        HttpFaults faults = withoutRanges();
        faults.stallAt = stallAt;
        cases.push_back(std::make_unique<Case>(stallAt, faults));
        Case& now = *cases.back();
        now.player->setNotifyCallback(now.events);
        ASSERT_EQ(NO_ERROR, now.player->setDataSource(now.server.url().c_str(), nullptr));
        ASSERT_EQ(NO_ERROR, now.player->prepareAsync());
    }
    ASSERT_TRUE(cases[2]->events->waitFor(MEDIA_PREPARED));
    ASSERT_EQ(NO_ERROR, cases[2]->player->start());
    for (const auto& now : cases) {
        SCOPED_TRACE(now->stallAt);
        EXPECT_TRUE(eventually([&] { return now->events->count(MEDIA_ERROR) > 0; }, 60));
        EXPECT_EQ(0, now->events->count(MEDIA_PLAYBACK_COMPLETE));
        int msec = 0;
        const status_t status = now->player->getCurrentPosition(&msec);
        const bool plays = now->stallAt > 1000;
        EXPECT_EQ(plays ? ORV_ERROR_CONNECTION_LOST : ORV_ERROR_NO_ANSWER, status);
        now->player->release();
    }
}

TEST_F(NetworkTest, AnIndexAtTheEndNeedsRanges) {
    HttpServer server(mediaPath("video.mp4"), withoutRanges());
    EXPECT_EQ(ORV_ERROR_NEEDS_RANGES, prepareUrl(server.url()));
    EXPECT_EQ(0, events->count(MEDIA_PREPARED));
    player->reset();
    server.setFaults({});
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
}

TEST_F(NetworkTest, WhatIsNotMediaIsCalledSo) {
    HttpServer server(mediaPath("short.mp4"));
    server.addText("page.mp4", "<html>Please log in.</html>");
    server.addText("nothing.mp4", "");
    EXPECT_EQ(ORV_ERROR_MALFORMED, prepareUrl(server.url("page.mp4")));
    player->reset();
    EXPECT_EQ(ORV_ERROR_EMPTY, prepareUrl(server.url("nothing.mp4")));
    player->reset();
    HttpServer cut(mediaPath("cut.mp4"));
    EXPECT_EQ(ORV_ERROR_NOTHING_INSIDE - E_ORV_FORMAT_MP4, prepareUrl(cut.url()));
}

TEST_F(NetworkTest, CertificatesAreChecked) {
    TlsServer server(mediaPath("silent.mkv"), "IP:127.0.0.1");
    EXPECT_EQ(ORV_ERROR_CERTIFICATE, prepareUrl(server.url()));
    setenv("ORV_TLS_VERIFY", "no", 1);
    renewPlayer();
    EXPECT_EQ(NO_ERROR, prepareUrl(server.url())) << "on request they are not";
    unsetenv("ORV_TLS_VERIFY");
    setenv("SSL_CERT_FILE", server.certificate().c_str(), 1);
    renewPlayer();
    EXPECT_EQ(NO_ERROR, prepareUrl(server.url())) << "trusted";
    EXPECT_EQ(NO_ERROR, readAgain(server.url()));
    unsetenv("SSL_CERT_FILE");
    EXPECT_EQ(ORV_ERROR_IO, readAgain(server.url())) << "by the second reading, too";
}

TEST_F(NetworkTest, ACertificateIsForItsHost) {
    TlsServer server(mediaPath("silent.mkv"), "DNS:elsewhere.invalid");
    setenv("SSL_CERT_FILE", server.certificate().c_str(), 1);
    renewPlayer();
    EXPECT_EQ(ORV_ERROR_CERTIFICATE, prepareUrl(server.url()));
    unsetenv("SSL_CERT_FILE");
}

TEST_F(NetworkTest, OtherSchemesAreRefusedAtOnce) {
    const std::string path = mediaPath("short.mp4");
    const std::vector<std::string> names = {
        "fd://0",           "edl://" + path,    "av://lavfi:testsrc",        "lavf://file:" + path,
        "EDL://" + path,    "memory://#EXTM3U", "archive://" + path + "|/x", "nosuch://x",
        "concat:///" + path};
    for (const std::string& name : names) {
        EXPECT_NE(NO_ERROR, player->setDataSource(name.c_str(), nullptr)) << name;
    }
    EXPECT_EQ(ORV_ERROR_SCHEME, player->setDataSource("fd://0", nullptr));
    open("short.mp4");
    EXPECT_FALSE(player->setSubtitleDataSource(("edl://" + path).c_str()));
}

// Not even from a playlist of this machine.
TEST_F(NetworkTest, PlaylistsLeadToNoOtherScheme) {
    const std::string target = mediaPath("short.mp4");
    const std::string path = mediaPath("schemes.m3u");
    for (const std::string& entry : {"edl://" + target + ",0,2", "lavf://file:" + target}) {
        SCOPED_TRACE(entry);
        outputOf("printf '#EXTM3U\n%s\n' '" + entry + "' >'" + path + "'");
        ASSERT_EQ(NO_ERROR, player->setDataSource(path.c_str(), nullptr));
        EXPECT_EQ(ORV_ERROR_SCHEME, player->prepare());
        player->reset();
    }
}

struct Lure {
    const char* name;
    std::string file;
    std::string text;
};
void PrintTo(const Lure& lure, std::ostream* out) { *out << lure.name; }

// What a text from a server leads to. Nothing of this machine is opened by it.
class LureTest : public NetworkTest, public testing::WithParamInterface<Lure> {};

TEST_P(LureTest, OpensNothingLocal) {
    HttpFaults faults;
    faults.onlyTexts = true;
    HttpServer server(mediaPath("short.mp4"), faults);
    server.addText(GetParam().file, GetParam().text);
    EXPECT_NE(NO_ERROR, prepareUrl(server.url(GetParam().file)));
    EXPECT_EQ(0u, sink->frameCount());
    EXPECT_FALSE(findsVideo(server.url(GetParam().file)));
}

const std::string kLocal = mediaPath("short.mp4");

INSTANTIATE_TEST_SUITE_P(
    Kinds, LureTest,
    testing::Values(
        Lure{"Playlist", "a.m3u", "#EXTM3U\nfile://" + kLocal + "\n"},
        Lure{"PlaylistOfEdl", "a.m3u", "#EXTM3U\nedl://" + kLocal + ",0,2\n"},
        Lure{"PlaylistOfLavf", "a.m3u", "#EXTM3U\nlavf://file:" + kLocal + "\n"},
        Lure{"PlaylistOfDescriptors", "a.m3u", "#EXTM3U\nfd://0\n"},
        Lure{"Pls", "a.pls", "[playlist]\nFile1=file://" + kLocal + "\nNumberOfEntries=1\n"},
        Lure{"Edl", "a.edl", "# mpv EDL v0\n" + kLocal + ",0,2\n"},
        Lure{"Cue", "a.cue",
             "FILE \"file://" + kLocal + "\" WAVE\n TRACK 01 AUDIO\n  INDEX 01 00:00:00\n"},
        Lure{"Concat", "a.ffconcat", "ffconcat version 1.0\nfile file://" + kLocal + "\n"},
        Lure{"Hls", "a.m3u8",
             "#EXTM3U\n#EXT-X-TARGETDURATION:3\n#EXTINF:3,\nfile://" + mediaPath("short.ts") +
                 "\n#EXT-X-ENDLIST\n"},
        Lure{"Dash", "a.mpd",
             "<?xml version=\"1.0\"?><MPD xmlns=\"urn:mpeg:dash:schema:mpd:2011\" type=\"static\" "
             "mediaPresentationDuration=\"PT3S\"><Period><AdaptationSet mimeType=\"video/mp4\">"
             "<Representation id=\"0\" bandwidth=\"1000\"><BaseURL>file://" +
                 kLocal + "</BaseURL><SegmentList><SegmentURL media=\"file://" + kLocal +
                 "\"/></SegmentList></Representation></AdaptationSet></Period></MPD>"}),
    [](const auto& info) { return std::string(info.param.name); });

TEST_F(NetworkTest, PlaylistsAndManifestsOfServersPlay) {
    HttpServer server(mediaPath("short.ts"));
    server.addText("a.m3u", "#EXTM3U\n" + server.url() + "\n");
    server.addText("a.m3u8", "#EXTM3U\n#EXT-X-TARGETDURATION:3\n#EXTINF:3,\n" +
                                 server.url("media.ts") + "\n#EXT-X-ENDLIST\n");
    for (const char* name : {"a.m3u", "a.m3u8"}) {
        SCOPED_TRACE(name);
        EXPECT_EQ(NO_ERROR, prepareUrl(server.url(name)));
        player->reset();
    }
}

TEST_F(NetworkTest, SubtitlesThatHangHoldNothingUp) {
    HttpFaults silent;
    silent.stallAt = -1;
    HttpServer hanging(mediaPath("lines.srt"), silent);
    HttpServer served(mediaPath("lines.srt"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(mediaPath("silent.mp4").c_str(), nullptr));
    ASSERT_TRUE(player->setSubtitleDataSource(served.url("good.srt").c_str()));
    ASSERT_TRUE(player->setSubtitleDataSource(hanging.url("one.srt").c_str()));
    ASSERT_TRUE(player->setSubtitleDataSource(hanging.url("two.srt").c_str()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_TRUE(eventually([&] { return !hanging.requests().empty(); }));
    EXPECT_EQ(NO_ERROR, endOf());
    int count = 0;
    EXPECT_TRUE(player->getSubtitleTrackCount(count));
    EXPECT_EQ(1, count) << "that which came";
}

TEST_F(NetworkTest, SubtitlesThatHangAreGivenUp) {
    HttpFaults silent;
    silent.stallAt = -1;
    HttpServer hanging(mediaPath("lines.srt"), silent);
    open("plain.mp4");
    EXPECT_FALSE(player->setSubtitleDataSource(hanging.url("one.srt").c_str()));
    EXPECT_EQ(1u, hanging.requests().size()) << "once";
}

}  // namespace
