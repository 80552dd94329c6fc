// SPDX-License-Identifier: Apache-2.0
#include <fcntl.h>
#include <gtest/gtest.h>
#include <orvtarn/PlayerTypes.h>
#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <random>

#include "TestMedia.h"
#include "inspect/AlbumArt.h"
#include "inspect/ContainerInfo.h"
#include "inspect/MediaFile.h"
#include "inspect/Thumbnailer.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

using orvtest::bytesOf;
using orvtest::mediaPath;
using orvtest::MemorySource;

android::status_t statusOf(const std::string& url, const MediaOpenOptions& options = {}) {
    std::unique_ptr<MediaFile> file;
    const android::status_t status = MediaFile::open(url, options, file);
    EXPECT_EQ(file != nullptr, status == 0);
    return status;
}

android::status_t statusOf(std::unique_ptr<ByteSource> source) {
    std::unique_ptr<MediaFile> file;
    const android::status_t status = MediaFile::open(std::move(source), {}, file);
    EXPECT_EQ(file != nullptr, status == 0);
    return status;
}

TEST(MediaFile, OpensPathsAndFileUrls) {
    const std::string path = mediaPath("video.mp4");
    EXPECT_EQ(statusOf(path), 0);
    EXPECT_EQ(statusOf("file://" + path), 0);
    EXPECT_EQ(statusOf("file://" + path.substr(0, path.size() - 3) + "%6d%70%34"), 0);
}

// Relative, so that nothing but the colon could be taken for a scheme.
TEST(MediaFile, TakesColonsAndPercentsInPathsAsTheyAre) {
    const std::string media = mediaPath("video.mp4");
    const int before = open(".", O_RDONLY | O_DIRECTORY);
    ASSERT_EQ(chdir(testing::TempDir().c_str()), 0);
    unlink("a:b%41.mp4");
    ASSERT_EQ(symlink(media.c_str(), "a:b%41.mp4"), 0);
    EXPECT_EQ(statusOf("a:b%41.mp4"), 0);
    unlink("a:b%41.mp4");
    EXPECT_EQ(fchdir(before), 0);
    close(before);
}

TEST(MediaFile, TellsWhyItCannotOpen) {
    EXPECT_EQ(statusOf("/no/such/file.mp4"), android::NAME_NOT_FOUND);
    EXPECT_EQ(statusOf(""), android::NAME_NOT_FOUND);
    EXPECT_EQ(statusOf(mediaPath("noise.bin")), ORV_ERROR_MALFORMED);
    EXPECT_EQ(statusOf(mediaPath("cut.mp4")), ORV_ERROR_MALFORMED);
    EXPECT_EQ(statusOf("/dev/null"), ORV_ERROR_MALFORMED);
    EXPECT_EQ(statusOf("http://127.0.0.1:1/none.mp4"), ORV_ERROR_IO);
    EXPECT_EQ(statusOf("nosuchscheme://host/file"), ORV_ERROR_IO);
    EXPECT_EQ(statusOf(std::unique_ptr<ByteSource>()), android::BAD_VALUE);
}

TEST(MediaFile, OpensWhatIsThereOfACutFile) { EXPECT_EQ(statusOf(mediaPath("cut.mkv")), 0); }

TEST(MediaFile, ReadsARangeOfADescriptor) {
    const std::string path = testing::TempDir() + "/ranges.bin";
    const std::vector<uint8_t> media = bytesOf(mediaPath("video.mp4"));
    FILE* stream = fopen(path.c_str(), "wb");
    ASSERT_NE(stream, nullptr);
    fputs("before", stream);
    ASSERT_EQ(fwrite(media.data(), 1, media.size(), stream), media.size());
    fputs("behind", stream);
    fclose(stream);
    const int fd = open(path.c_str(), O_RDONLY);
    EXPECT_EQ(statusOf(std::make_unique<FdByteSource>(fd, 6, media.size())), 0);
    EXPECT_EQ(statusOf(std::make_unique<FdByteSource>(fd, 6, INT64_MAX)), 0);
    EXPECT_EQ(statusOf(std::make_unique<FdByteSource>(fd, 6, 20000)), ORV_ERROR_MALFORMED);
    EXPECT_EQ(statusOf(std::make_unique<FdByteSource>(fd, 1 << 30, 100)), ORV_ERROR_MALFORMED);
    EXPECT_EQ(lseek(fd, 0, SEEK_CUR), 0) << "the descriptor's own position moved";
    close(fd);
    EXPECT_EQ(statusOf(std::make_unique<FdByteSource>(fd, 0, 100)), ORV_ERROR_IO);
    unlink(path.c_str());
}

TEST(MediaFile, KeepsToItsRange) {
    const int fd = open(mediaPath("video.mp4").c_str(), O_RDONLY);
    FdByteSource source(fd, 100, 10);
    uint8_t buffer[64];
    EXPECT_EQ(source.size(), 10);
    EXPECT_EQ(source.read(buffer, sizeof(buffer)), 10);
    EXPECT_EQ(source.read(buffer, sizeof(buffer)), 0);
    EXPECT_FALSE(source.seek(-1));
    EXPECT_FALSE(source.seek(11));
    EXPECT_TRUE(source.seek(8));
    EXPECT_EQ(source.read(buffer, sizeof(buffer)), 2);
    close(fd);
}

TEST(MediaFile, ReportsASourceThatFails) {
    auto source = std::make_unique<MemorySource>(bytesOf(mediaPath("video.mp4")));
    source->mFailsAt = 0;
    EXPECT_EQ(statusOf(std::move(source)), ORV_ERROR_IO);
    EXPECT_EQ(statusOf(std::make_unique<MemorySource>(std::vector<uint8_t>())),
              ORV_ERROR_MALFORMED);
}

TEST(MediaFile, EndsWhenCancelledOrLate) {
    const std::atomic<bool> cancel{true};
    MediaOpenOptions options;
    options.cancel = &cancel;
    EXPECT_EQ(statusOf(mediaPath("video.mp4"), options), ORV_ERROR_IO);
    MediaOpenOptions late;
    late.timeLimit = std::chrono::milliseconds(0);
    EXPECT_EQ(statusOf(mediaPath("video.mp4"), late), ORV_ERROR_IO);
}

class CancellingSource : public MemorySource {
public:
    CancellingSource(std::vector<uint8_t> bytes, int reads, std::atomic<bool>& cancel)
        : MemorySource(std::move(bytes)), mReads(reads), mCancel(cancel) {}

    int read(uint8_t* buffer, int length) override {
        if (mReads-- == 0) mCancel = true;
        return MemorySource::read(buffer, length);
    }

private:
    int mReads;
    std::atomic<bool>& mCancel;
};

// Also while the streams are probed, where libavformat makes do with what it has.
TEST(MediaFile, EndsWhenCancelledAtAnyRead) {
    for (int reads = 0; reads < 4; reads++) {
        std::atomic<bool> cancel{false};
        MediaOpenOptions options;
        options.cancel = &cancel;
        auto source =
            std::make_unique<CancellingSource>(bytesOf(mediaPath("video.ts")), reads, cancel);
        source->mLongestRead = 4096;
        std::unique_ptr<MediaFile> file;
        EXPECT_EQ(MediaFile::open(std::move(source), options, file), ORV_ERROR_IO) << reads;
        EXPECT_EQ(file, nullptr);
    }
}

TEST(MediaFile, KnowsItsStreams) {
    const auto file = orvtest::openMedia("video.mp4");
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(file->stream(0), file->context()->streams[0]);
    EXPECT_EQ(file->stream(-1), nullptr);
    EXPECT_EQ(file->stream(2), nullptr);
}

// One of those that the headers name.
bool isKnown(android::status_t status) {
    const android::status_t known[] = {android::OK, android::NO_MEMORY, ORV_ERROR_IO,
                                       ORV_ERROR_MALFORMED, ORV_ERROR_UNSUPPORTED};
    return std::find(std::begin(known), std::end(known), status) != std::end(known);
}

// Draws a small picture, and sees that nothing is written behind its rows.
android::status_t drawSmall(Thumbnailer& thumbnailer) {
    constexpr int kRows = 9;
    constexpr uint8_t kUntouched = 0xA5;
    std::vector<uint8_t> pixels(64 * (kRows + 1), kUntouched);
    const android::status_t status =
        thumbnailer.draw(1000, {pixels.data(), 64 * kRows, ORV_COLOR_MODE_RGB565, 16, kRows});
    EXPECT_TRUE(std::all_of(pixels.begin() + 64 * kRows, pixels.end(),
                            [](uint8_t byte) { return byte == kUntouched; }));
    return status;
}

// Everything that the engine reads from a file, whatever the bytes: what comes out is an
// answer that there is. Returns whether a picture was drawn.
bool readAll(std::vector<uint8_t> bytes) {
    const size_t size = bytes.size();
    std::unique_ptr<MediaFile> file;
    MediaOpenOptions options;
    options.timeLimit = std::chrono::seconds(2);
    android::status_t status =
        MediaFile::open(std::make_unique<MemorySource>(std::move(bytes)), options, file);
    EXPECT_TRUE(isKnown(status)) << status;
    EXPECT_EQ(status == 0, file != nullptr);
    if (file == nullptr) return false;
    MediaAlbumArt* art = extractAlbumArt(*file);
    EXPECT_LE(art == nullptr ? 0 : art->size(), size);
    free(art);
    metaDataInfo(*file);
    SubtitleTrackInfo chapter;
    int chapters = 0;
    while (chapterRecord(*file, chapters, chapter)) chapters++;
    EXPECT_EQ(chapterCount(*file), chapters);
    std::unique_ptr<Thumbnailer> thumbnailer;
    status = Thumbnailer::create(std::move(file), -1, thumbnailer);
    EXPECT_TRUE(isKnown(status)) << status;
    EXPECT_EQ(status == 0, thumbnailer != nullptr);
    if (thumbnailer == nullptr) return false;
    status = drawSmall(*thumbnailer);
    EXPECT_TRUE(isKnown(status)) << status;
    return status == 0;
}

TEST(MediaFile, SurvivesDamagedMedia) {
    std::mt19937 random(1);  // the same damage each time
    int drawn = 0;
    int rounds = 0;
    for (const char* name : {"silent.mkv", "covered.mp3", "covered.m4a", "tagged.ogg",
                             "covered.flac", "alpha.mov", "still.png"}) {
        SCOPED_TRACE(name);
        const std::vector<uint8_t> whole = bytesOf(mediaPath(name));
        for (int round = 0; round < 6; round++, rounds++) {
            std::vector<uint8_t> damaged = whole;
            // Near the start, where the structure is.
            const size_t range =
                round % 2 == 0 ? std::min<size_t>(2000, whole.size()) : whole.size();
            for (int i = 0; i < 20; i++) damaged[random() % range] = static_cast<uint8_t>(random());
            if (round > 3) damaged.resize(random() % whole.size());
            drawn += readAll(std::move(damaged));
        }
        EXPECT_EQ(strcmp(name, "tagged.ogg") != 0, readAll(whole)) << "undamaged";
    }
    EXPECT_GT(drawn, 0) << "the damage leaves some";
    EXPECT_LT(drawn, rounds) << "and not all";
}

}  // namespace
}  // namespace orvtarn
