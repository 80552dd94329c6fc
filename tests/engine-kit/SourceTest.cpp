// SPDX-License-Identifier: Apache-2.0
// Where media come from: addresses and descriptors.
#include <fcntl.h>
#include <unistd.h>

#include <fstream>

#include "KitTest.h"

using android::BAD_VALUE;
using android::INVALID_OPERATION;
using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int64_t kBefore = 1000;  // bytes in front of the media
constexpr int kShortMs = 3000;

class SourceTest : public KitTest {
protected:
    android::status_t setAddress(const std::string& address) {
        return player->setDataSource(address.c_str(), nullptr);
    }

    // A file of other bytes with the short film in the middle, whose length it returns.
    static int64_t wrapShortFilm(const std::string& path) {
        std::ofstream wrapped(path, std::ios::binary);
        wrapped << std::string(kBefore, 'x');
        wrapped << std::ifstream(mediaPath("short.mp4"), std::ios::binary).rdbuf();
        const int64_t length = static_cast<int64_t>(wrapped.tellp()) - kBefore;
        wrapped << std::string(kBefore, 'y');
        return length;
    }

    static std::string wrappedPath() {
        const char* folder = getenv("ORV_KIT_FILES");
        return (folder == nullptr ? testing::TempDir() : folder) + std::string("/orv-wrapped-") +
               std::to_string(getpid());
    }
};

TEST_F(SourceTest, AMissingFileIsSaidAtOnce) {
    checks("setDataSource(url, headers)", "Checks what can be checked without opening");
    const android::status_t status = setAddress(mediaPath("nowhere.mp4"));
    ORV_NOT_OFFERED_IF(status == ORV_ERROR_SCHEME, "it opens no files by their names");
    EXPECT_EQ(android::NAME_NOT_FOUND, status);
}

TEST_F(SourceTest, AFolderIsNoMedia) {
    checks("setDataSource(url, headers)", "BAD_VALUE (a directory or an empty name)");
    const android::status_t status = setAddress(mediaPath(""));
    ORV_NOT_OFFERED_IF(status == ORV_ERROR_SCHEME, "it opens no files by their names");
    EXPECT_EQ(BAD_VALUE, status);
    EXPECT_EQ(BAD_VALUE, setAddress(""));
}

TEST_F(SourceTest, AnUnknownSchemeIsRefused) {
    checks("setDataSource(url, headers)", "ORV_ERROR_SCHEME");
    EXPECT_EQ(ORV_ERROR_SCHEME, setAddress("nosuchscheme://host/film"));
    EXPECT_FALSE(isReady());
}

TEST_F(SourceTest, HeadersComeWithTheAddress) {
    checks("setDataSource(url, headers)", "headers may be null");
    android::KeyedVector<android::String8, android::String8> headers;
    headers.add(android::String8("User-Agent"), android::String8("kit"));
    EXPECT_EQ(NO_ERROR, player->setDataSource(film().c_str(), &headers));
    EXPECT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(NO_ERROR, setAddress(film()));
}

TEST_F(SourceTest, ThereIsOneSourceAtATime) {
    checks("setDataSource(url, headers)", "when a source is set already");
    setSource();
    EXPECT_EQ(INVALID_OPERATION, setAddress(film()));
    EXPECT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(INVALID_OPERATION, setAddress(film()));
}

TEST_F(SourceTest, TheFlagOfStereoscopicFilesComesFirst) {
    checks("configPlayer", "Before the data source: whether it is a stereoscopic stream file");
    player->configPlayer(false);
    ORV_OPEN();
    EXPECT_EQ(0, position());
}

TEST_F(SourceTest, ADescriptorsPartIsPlayed) {
    checks("setDataSource(fd, offset, length)", "Reads length bytes from offset");
    const std::string path = wrappedPath();
    const int64_t length = wrapShortFilm(path);
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    unlink(path.c_str());
    ASSERT_GE(fd, 0) << path;
    const android::status_t status = player->setDataSource(fd, kBefore, length);
    close(fd);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it takes no descriptors");
    ASSERT_EQ(NO_ERROR, status);
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_NEAR(kShortMs, duration(), kNearMs);
}

TEST_F(SourceTest, TheDescriptorStaysTheCallers) {
    checks("setDataSource(fd, offset, length)", "The descriptor is duplicated");
    const int fd = ::open(mediaPath("short.mp4").c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_GE(fd, 0);
    constexpr off_t kPlace = 17;
    ASSERT_EQ(kPlace, lseek(fd, kPlace, SEEK_SET));
    const android::status_t status = player->setDataSource(fd, 0, lseek(fd, 0, SEEK_END));
    lseek(fd, kPlace, SEEK_SET);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, (close(fd), "it takes no descriptors"));
    ASSERT_EQ(NO_ERROR, status);
    ASSERT_EQ(NO_ERROR, player->prepare());
    EXPECT_EQ(NO_ERROR, player->reset());
    EXPECT_EQ(kPlace, lseek(fd, 0, SEEK_CUR)) << "the descriptor was moved or closed";
    EXPECT_EQ(0, close(fd));
}

TEST_F(SourceTest, NumbersThatAreNoPartOfAFileAreRefused) {
    checks("setDataSource(fd, offset, length)", "BAD_VALUE for a negative offset or length");
    const int fd = ::open(mediaPath("short.mp4").c_str(), O_RDONLY | O_CLOEXEC);
    ASSERT_GE(fd, 0);
    const android::status_t status = player->setDataSource(fd, -1, 100);
    const android::status_t negativeLength = player->setDataSource(fd, 0, -1);
    close(fd);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it takes no descriptors");
    EXPECT_EQ(BAD_VALUE, status);
    EXPECT_EQ(BAD_VALUE, negativeLength);
    EXPECT_EQ(BAD_VALUE, player->setDataSource(-1, 0, 100));
}

}  // namespace
}  // namespace orvkit
