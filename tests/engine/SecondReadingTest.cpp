// SPDX-License-Identifier: Apache-2.0
// The details that are read from the source once more, beside playback.
#include <sys/stat.h>
#include <unistd.h>

#include <thread>

#include "FakeStream.h"
#include "HttpServer.h"
#include "LogCapture.h"
#include "PlayerTest.h"

using namespace android;
using namespace orvtest;

namespace {

class SecondReadingTest : public PlayerTest {
protected:
    void askAll() {
        MetaDataInfo info;
        AudioTrackInfo track;
        EXPECT_TRUE(player->getMetaDataInfo(info));
        EXPECT_TRUE(player->getAudioTrackInfo(true, 0, track));
        uint8_t pixels[64];
        _Media_Thumbnail_Info_T request = {pixels, 64, ORV_COLOR_MODE_XRGB8888, 4, 1};
        thumbnailDrawn = player->getThumbnailInfo(&request);
    }

    bool thumbnailDrawn = false;
};

TEST_F(SecondReadingTest, APipeIsReadOnce) {
    const std::string pipe = mediaPath("pipe.ts");
    unlink(pipe.c_str());
    ASSERT_EQ(0, mkfifo(pipe.c_str(), 0600));
    std::thread writer([&] { outputOf("cat '" + mediaPath("short.ts") + "' >'" + pipe + "'"); });
    ASSERT_EQ(NO_ERROR, player->setDataSource(pipe.c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, player->prepare());
    askAll();
    EXPECT_FALSE(thumbnailDrawn);
    playToEnd();
    writer.join();
    EXPECT_NEAR(3000, position(), 100) << "nobody else took bytes";
    // With the writer gone, who opens the pipe again waits for ever.
    askAll();
    unlink(pipe.c_str());
}

TEST_F(SecondReadingTest, WhatCanOnlyBeReadOnceIsNoErrorToLog) {
    FakeStream stream(mediaPath("short.ts"));
    stream.mSeekable = false;
    ASSERT_EQ(NO_ERROR, player->setDataSource(stream.forEngine()));
    ASSERT_EQ(NO_ERROR, player->prepare());
    {
        LogCapture log;
        MetaDataInfo info;
        EXPECT_TRUE(player->getMetaDataInfo(info));
        EXPECT_EQ(0u, log.lines("TarnPlayer").size());
    }
    player->release();
}

TEST_F(SecondReadingTest, AServerThatRefusesIsAskedAgainOnlyAfterTheNextLoad) {
    HttpServer server(mediaPath("short.mp4"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url().c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, player->prepare());
    server.setStatus(404);
    askAll();
    const size_t refused = server.requests().size();
    askAll();
    EXPECT_EQ(refused, server.requests().size());
    EXPECT_FALSE(thumbnailDrawn);
    server.setStatus(200);
    ASSERT_EQ(NO_ERROR, player->stop());
    ASSERT_EQ(NO_ERROR, player->prepare());
    askAll();
    EXPECT_TRUE(thumbnailDrawn);
}

TEST_F(SecondReadingTest, MediaWithoutPicturesAreOpenedForOneOnlyOnce) {
    HttpServer server(mediaPath("tone.mp3"));
    ASSERT_EQ(NO_ERROR, player->setDataSource(server.url().c_str(), nullptr));
    ASSERT_EQ(NO_ERROR, player->prepare());
    askAll();
    EXPECT_FALSE(thumbnailDrawn);
    const size_t opened = server.requests().size();
    askAll();
    EXPECT_EQ(opened, server.requests().size());
}

}  // namespace
