// SPDX-License-Identifier: Apache-2.0
// Data sources: paths, URLs with headers, descriptors, and what they refuse.
#include <fcntl.h>
#include <orvtarn/PictureRecords.h>
#include <orvtarn/PlayerTypes.h>
#include <sys/stat.h>
#include <unistd.h>

#include "HttpServer.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class SourceTest : public PlayerTest {
protected:
    status_t setPath(const std::string& path) {
        return player->setDataSource(path.c_str(), nullptr);
    }

    status_t prepareUrl(const std::string& url) {
        EXPECT_EQ(NO_ERROR, setPath(url));
        return player->prepare();
    }
};

TEST_F(SourceTest, PathsAreCheckedAtOnce) {
    EXPECT_EQ(NAME_NOT_FOUND, setPath("/nowhere/at/all.mkv"));
    EXPECT_EQ(BAD_VALUE, setPath("/tmp"));
    EXPECT_EQ(BAD_VALUE, setPath(""));
    EXPECT_EQ(BAD_VALUE, setPath(""));
    EXPECT_EQ(BAD_VALUE, player->setDataSource(static_cast<const char*>(nullptr), nullptr));
}

// The ways to write the name of one file, a blank and a "%41" in it.
TEST_F(SourceTest, FileUrlsAreDecoded) {
    const std::string path = mediaPath("file url%41.mp4");
    outputOf("cp '" + mediaPath("silent.mp4") + "' '" + path + "'");
    const std::string coded = mediaPath("file%20url%2541%2Emp4");
    for (const char* start : {"file://", "file:", "FILE://", "file://localhost"}) {
        EXPECT_EQ(NO_ERROR, prepareUrl(start + coded)) << start;
        player->reset();
    }
    EXPECT_EQ(NAME_NOT_FOUND, setPath("file://" + path)) << "%41 is an A";
    EXPECT_EQ(NAME_NOT_FOUND, setPath("file://elsewhere" + coded));
    EXPECT_EQ(NAME_NOT_FOUND, setPath("file://" + coded + "%00")) << "nothing is cut off";
    EXPECT_EQ(BAD_VALUE, setPath("file:///"));
}

// mpv 0.35 gives the sound up, too; later ones play it.
TEST_F(SourceTest, APictureWithoutADecoderIsUnsupportedBesideSound) {
    const std::string path = mediaPath("unknown-picture.mkv");
    outputOf("sed 's|V_MPEG4/ISO/AVC|V_QQQQQ/QQQ/QQQ|' '" + mediaPath("tracks.mkv") + "' > '" +
             path + "'");
    const status_t status = prepareUrl(path);
    EXPECT_TRUE(status == ORV_ERROR_UNSUPPORTED || status == NO_ERROR) << status;
    player->reset();
    EXPECT_EQ(NO_ERROR, prepareUrl(mediaPath("tracks.mkv")));
}

// As /dev/stdin does: the path that such a link leads to is none.
TEST_F(SourceTest, LinksToPipesAndDeletedFilesAreOpened) {
    const std::string path = mediaPath("deleted.mp4");
    outputOf("cp '" + mediaPath("silent.mp4") + "' '" + path + "'");
    const int file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_EQ(0, unlink(path.c_str()));
    EXPECT_EQ(NO_ERROR, prepareUrl("/proc/self/fd/" + std::to_string(file)));
    player->reset();
    ::close(file);

    FILE* pipe = popen(("cat '" + mediaPath("short.ts") + "' 2>/dev/null").c_str(), "r");
    ASSERT_NE(nullptr, pipe);
    EXPECT_EQ(NO_ERROR, prepareUrl("/proc/self/fd/" + std::to_string(fileno(pipe))));
    player->reset();
    pclose(pipe);
}

TEST_F(SourceTest, UnreadableFilesAreTold) {
    if (geteuid() == 0) GTEST_SKIP() << "root reads everything";
    const std::string path = mediaPath("unreadable.bin");
    outputOf("touch '" + path + "'; chmod 0 '" + path + "'");
    EXPECT_EQ(PERMISSION_DENIED, setPath(path));
}

TEST_F(SourceTest, NamesMayLookLikeOptionsAndProtocols) {
    const std::string strange = mediaPath("-- edl,a b'%41ü.mp4");
    outputOf("cp '" + mediaPath("silent.mp4") + "' \"" + strange + "\"");
    EXPECT_EQ(NO_ERROR, setPath(strange));
    EXPECT_EQ(NO_ERROR, player->prepare());
}

struct BrokenFile {
    const char* name;
    int status;
};
void PrintTo(const BrokenFile& file, std::ostream* out) { *out << file.name; }

class BrokenFileTest : public SourceTest, public testing::WithParamInterface<BrokenFile> {};

TEST_P(BrokenFileTest, EndsPrepareWithItsStatus) {
    ASSERT_EQ(NO_ERROR, setPath(mediaPath(GetParam().name)));
    EXPECT_EQ(GetParam().status, player->prepare());
    int msec = -1;
    EXPECT_EQ(GetParam().status, player->getCurrentPosition(&msec));
    EXPECT_TRUE(events->waitFor(MEDIA_ERROR));
    EXPECT_EQ(INVALID_OPERATION, player->start());
    EXPECT_EQ(INVALID_OPERATION, player->prepare());
    // The player is as good as new after a reset.
    player->reset();
    open("short.mp4");
}

INSTANTIATE_TEST_SUITE_P(Kinds, BrokenFileTest,
                         testing::Values(BrokenFile{"garbage.bin", ORV_ERROR_MALFORMED},
                                         BrokenFile{"empty.bin", ORV_ERROR_EMPTY},
                                         BrokenFile{"cut.mp4",
                                                    ORV_ERROR_NOTHING_INSIDE - E_ORV_FORMAT_MP4},
                                         BrokenFile{"subtitles-only.mkv", ORV_ERROR_UNSUPPORTED}),
                         [](const auto& info) { return testName(info.param.name); });

struct HollowFile {
    const char* ending;
    const char* codec;
    E_Orv_Format format;
};
void PrintTo(const HollowFile& file, std::ostream* out) { *out << file.ending; }

class HollowFileTest : public SourceTest, public testing::WithParamInterface<HollowFile> {};

// Whole as its format has it, without a single frame or sample.
TEST_P(HollowFileTest, IsCalledByItsFormat) {
    const std::string path = mediaPath(std::string("hollow.") + GetParam().ending);
    const bool hasPicture = GetParam().codec[0] == 'v';
    const std::string input = hasPicture ? "testsrc2=size=64x64:duration=1" : "sine=duration=1";
    outputOf("ffmpeg -nostdin -v error -y -f lavfi -i " + input + " -t 0 -c:" + GetParam().codec +
             " '" + path + "'");
    ASSERT_EQ(NO_ERROR, setPath(path));
    EXPECT_EQ(ORV_ERROR_NOTHING_INSIDE - GetParam().format, player->prepare());
    EXPECT_EQ(0, events->count(MEDIA_PREPARED));
}

INSTANTIATE_TEST_SUITE_P(Kinds, HollowFileTest,
                         testing::Values(HollowFile{"mp4", "v mpeg4", E_ORV_FORMAT_MP4},
                                         HollowFile{"mkv", "a flac", E_ORV_FORMAT_MATROSKA},
                                         HollowFile{"avi", "v mpeg4", E_ORV_FORMAT_AVI},
                                         HollowFile{"flv", "v flv", E_ORV_FORMAT_FLV},
                                         HollowFile{"ogg", "a flac", E_ORV_FORMAT_OGG},
                                         HollowFile{"wav", "a pcm_s16le", E_ORV_FORMAT_WAV},
                                         HollowFile{"flac", "a flac", E_ORV_FORMAT_FLAC},
                                         HollowFile{"aiff", "a pcm_s16be", E_ORV_FORMAT_AIFF}),
                         [](const auto& info) { return std::string(info.param.ending); });

TEST_F(SourceTest, MediaCutShortPlayAsFarAsTheyGo) {
    open("cut.mkv");
    playToEnd();
    EXPECT_EQ(duration(), position());
}

TEST_F(SourceTest, ADescriptorPlays) {
    const int fd = ::open(mediaPath("short.mp4").c_str(), O_RDONLY);
    struct stat status;
    fstat(fd, &status);
    ASSERT_EQ(NO_ERROR, player->setDataSource(fd, 0, status.st_size));
    close(fd);
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_NEAR(3000, duration(), 50);
    EXPECT_EQ(NO_ERROR, player->seekTo(2000, 0));
    EXPECT_EQ(2000, position());
}

TEST_F(SourceTest, ADescriptorsRangeIsAllThatIsRead) {
    const std::string packed = mediaPath("packed.tmp");
    outputOf("(head -c 12345 /dev/zero; cat '" + mediaPath("short.mp4") +
             "'; head -c 5000 /dev/zero) >'" + packed + "'");
    struct stat inner;
    stat(mediaPath("short.mp4").c_str(), &inner);
    const int fd = ::open(packed.c_str(), O_RDONLY);
    lseek(fd, 777, SEEK_SET);
    ASSERT_EQ(NO_ERROR, player->setDataSource(fd, 12345, inner.st_size));
    ASSERT_EQ(NO_ERROR, player->prepare());
    playToEnd();
    EXPECT_EQ(777, lseek(fd, 0, SEEK_CUR)) << "the descriptor's own position is not used";
    close(fd);
}

TEST_F(SourceTest, DescriptorsAreChecked) {
    const int fd = ::open(mediaPath("short.mp4").c_str(), O_RDONLY);
    EXPECT_EQ(BAD_VALUE, player->setDataSource(fd, -1, 100));
    EXPECT_EQ(BAD_VALUE, player->setDataSource(fd, 0, -1));
    EXPECT_EQ(BAD_VALUE, player->setDataSource(-1, 0, 100));
    close(fd);
    EXPECT_EQ(BAD_VALUE, player->setDataSource(fd, 0, 100)) << "closed";
    int ends[2];
    ASSERT_EQ(0, pipe(ends));
    EXPECT_EQ(BAD_VALUE, player->setDataSource(ends[0], 0, 100)) << "no file";
    close(ends[0]);
    close(ends[1]);
}

TEST_F(SourceTest, ARangeBehindTheEndIsEmpty) {
    const int fd = ::open(mediaPath("short.mp4").c_str(), O_RDONLY);
    ASSERT_EQ(NO_ERROR, player->setDataSource(fd, int64_t{1} << 40, 1000));
    EXPECT_EQ(ORV_ERROR_EMPTY, player->prepare());
    close(fd);
}

TEST_F(SourceTest, AUrlPlaysAndSeeks) {
    HttpServer server(mediaPath("short.mp4"));
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url()));
    EXPECT_NEAR(3000, duration(), 50);
    EXPECT_EQ(NO_ERROR, player->seekTo(1500, 0));
    EXPECT_EQ(1000, position());
    playToEnd();
}

TEST_F(SourceTest, HeadersGoWithEachRequestAndNoFurther) {
    HttpServer server(mediaPath("short.mp4"));
    KeyedVector<String8, String8> headers;
    headers.add(String8("X-Token"), String8("a,b; c=\"d\""));
    headers.add(String8("User-Agent"), String8("Set Top/1.0"));
    headers.add(String8("X-Evil"), String8("x\r\nX-Smuggled: yes"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url("first").c_str(), &headers));
    ASSERT_EQ(NO_ERROR, player->prepare());
    // The file is opened once more, for what playback does not know.
    const size_t opened = server.requests().size();
    MetaDataInfo info;
    EXPECT_TRUE(player->getMetaDataInfo(info));
    std::vector<uint8_t> pixels(64 * 9);
    _Media_Thumbnail_Info_T thumbnail = {pixels.data(), static_cast<uint32_t>(pixels.size()),
                                         ORV_COLOR_MODE_RGB565, 16, 9};
    EXPECT_TRUE(player->getThumbnailInfo(&thumbnail));
    EXPECT_GT(server.requests().size(), opened);
    player->reset();
    ASSERT_EQ(NO_ERROR, prepareUrl(server.url("second")));
    for (const std::string& request : server.requests()) {
        const bool first = request.find("/first") != std::string::npos;
        EXPECT_EQ(first, request.find("X-Token: a,b; c=\"d\"\r\n") != std::string::npos) << request;
        EXPECT_EQ(first, request.find("User-Agent: Set Top/1.0\r\n") != std::string::npos)
            << request;
        EXPECT_EQ(std::string::npos, request.find("X-Smuggled")) << request;
    }
}

// The server is asked why, too.
TEST_F(SourceTest, HeadersGoWithTheRequestsAboutAFailure) {
    HttpServer server(mediaPath("noise.bin"));
    KeyedVector<String8, String8> headers;
    headers.add(String8("X-Token"), String8("a"));
    headers.add(String8("User-Agent"), String8("Set Top/1.0"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url("first").c_str(), &headers));
    EXPECT_NE(NO_ERROR, player->prepare());
    EXPECT_GT(server.requests().size(), 1u);
    for (const std::string& request : server.requests()) {
        EXPECT_NE(std::string::npos, request.find("X-Token: a\r\n")) << request;
        EXPECT_NE(std::string::npos, request.find("User-Agent: Set Top/1.0\r\n")) << request;
    }
}

TEST_F(SourceTest, AServerThatIsSilentCanBeLeft) {
    HttpServer server(mediaPath("short.mp4"));
    server.setSilent(true);
    ASSERT_EQ(NO_ERROR, setPath(server.url()));
    ASSERT_EQ(NO_ERROR, player->prepareAsync());
    ASSERT_TRUE(eventually([&] { return !server.requests().empty(); }));
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_EQ(NO_ERROR, player->reset());
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(2));
    open("short.mp4");
}

}  // namespace
