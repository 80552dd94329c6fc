// SPDX-License-Identifier: Apache-2.0
// Pictures drawn by OpenGL on a window of the desktop.
#include <gmock/gmock.h>
#include <math.h>

#include <algorithm>
#include <atomic>
#include <memory>
#include <mutex>
#include <vector>

#include "CountedFrames.h"
#include "LogCapture.h"
#include "OtherThread.h"
#include "PlayerTest.h"
#include "TestWindow.h"
#include "core/EglLibrary.h"
#include "core/XConnection.h"

namespace orvtest {
namespace {

using android::NativeWindow;
using android::sp;

constexpr double kAlike = 35;  // dB
constexpr int kBlock = 16;     // pixels

double decibels(double squares, double count) {
    return squares == 0 ? 99 : 10 * log10(255.0 * 255.0 * count / squares);
}

double luma(const Picture& picture, int x, int y) {
    const uint8_t* const pixel = &picture.pixels[(size_t(y) * picture.width + x) * 4];
    return 0.114 * pixel[0] + 0.587 * pixel[1] + 0.299 * pixel[2];
}

// The mean of a colour's values in a square.
double mean(const Picture& picture, int left, int top, int colour) {
    double sum = 0;
    for (int y = top; y < top + kBlock; y++) {
        for (int x = left; x < left + kBlock; x++) {
            sum += picture.pixels[(size_t(y) * picture.width + x) * 4 + colour];
        }
    }
    return sum / (kBlock * kBlock);
}

double lumaLikeness(const Picture& one, const Picture& other) {
    double squares = 0;
    for (int y = 0; y < one.height; y++) {
        for (int x = 0; x < one.width; x++) {
            squares += pow(luma(one, x, y) - luma(other, x, y), 2);
        }
    }
    return decibels(squares, double(one.width) * one.height);
}

double colourLikeness(const Picture& one, const Picture& other) {
    double squares = 0;
    double count = 0;
    for (int y = 0; y + kBlock <= one.height; y += kBlock) {
        for (int x = 0; x + kBlock <= one.width; x += kBlock) {
            for (int c = 0; c < 3; c++, count++) {
                squares += pow(mean(one, x, y, c) - mean(other, x, y, c), 2);
            }
        }
    }
    return decibels(squares, count);
}

// PSNR in dB of each pixel's luma, or of the colours of small squares if that is
// less: the quick conversion by software shifts the chroma of sharp edges.
double likeness(const Picture& one, const Picture& other) {
    if (one.width != other.width || one.height != other.height || one.width == 0) return 0;
    return std::min(lumaLikeness(one, other), colourLikeness(one, other));
}

bool isLit(const Picture& picture) { return picture.brightness() > 20; }

class WindowTest : public PlayerTest {
protected:
    void SetUp() override {
        if (!TestWindow::isPossible()) GTEST_SKIP() << "there is no display";
        make(320, 180);
    }

    // A window and a surface for it; Xvfb's OpenGL is software.
    void make(int width, int height, bool acceptsSoftwareGl = true) {
        window = std::make_unique<TestWindow>(width, height);
        native = new NativeWindow(window->id(), acceptsSoftwareGl);
        surface = new WindowSink(native);
    }

    void TearDown() override {
        if (native != nullptr) native->close();
    }

    void use(const sp<FrameSink>& to) {
        ASSERT_EQ(android::NO_ERROR, player->setVideoSurfaceTexture(to));
    }

    // Opens media on the window.
    void openOnWindow(const std::string& name) {
        use(surface);
        ASSERT_TRUE(native->drawing().byGpu) << native->drawing().description;
        open(name);
    }

    std::unique_ptr<TestWindow> window;
    sp<NativeWindow> native;
    sp<WindowSink> surface;
};

class SamePictureTest : public WindowTest, public testing::WithParamInterface<const char*> {};

TEST_P(SamePictureTest, AsBySoftware) {
    open(GetParam());
    ASSERT_TRUE(sink->waitFor(0));
    make(sink->newest().width, sink->newest().height);
    const sp<android::TarnPlayer> bySoftware = player;
    player = new android::TarnPlayer(-1);
    openOnWindow(GetParam());
    ASSERT_EQ(android::NO_ERROR, bySoftware->seekTo(400, 3));
    ASSERT_EQ(android::NO_ERROR, player->seekTo(400, 3));
    double best = 0;
    EXPECT_TRUE(eventually([&] {
        best = std::max(best, likeness(window->look(), sink->newest()));
        return best >= kAlike && sink->newest().timestampUs > 300000;
    })) << best
        << " dB";
    bySoftware->release();
}

// None of BT.2020 in the standard range: from mpv 0.40 on OpenGL converts its colours,
// which software does not.
INSTANTIATE_TEST_SUITE_P(Media, SamePictureTest,
                         testing::Values("video.mp4", "lying90.mp4", "lying180.mp4", "mirrored.mp4",
                                         "anamorphic.mkv", "bt601.mkv", "bt709-full.mkv", "pq.mkv",
                                         "hlg.mkv", "yuv420p10.mkv", "yuv444p.mkv"),
                         [](const auto& tested) { return testName(tested.param); });

TEST_F(WindowTest, CountsFramesWithTheirTimes) {
    openOnWindow("video.mp4");
    const uint64_t atFirst = native->awaitFrame(0, 10000).number;
    ASSERT_GT(atFirst, 0u);
    ASSERT_EQ(android::NO_ERROR, player->start());
    const NativeWindow::Frame later = native->awaitFrame(atFirst + 20, 10000);
    EXPECT_GT(later.number, atFirst + 20);
    EXPECT_GE(later.timeUs, 40000 * 15);
    EXPECT_EQ(0u, sink->frameCount());
    EXPECT_EQ(0u, surface->frameCount());
}

TEST_F(WindowTest, FollowsTheWindowsSizeWhilePaused) {
    openOnWindow("video.mp4");
    ASSERT_TRUE(window->waitFor(isLit));
    window->resize(640, 360);
    EXPECT_TRUE(window->waitFor([](const Picture& picture) {
        return picture.width == 640 && picture.brightness(0, 0, 300, 300) > 20 &&
               picture.brightness(700, 700, 1000, 1000) > 20;
    }));
    // A window of another shape has bars beside the picture.
    window->resize(640, 200);
    EXPECT_TRUE(window->waitFor([](const Picture& picture) {
        return picture.height == 200 && picture.brightness(0, 0, 150, 1000) == 0 &&
               picture.brightness(850, 0, 1000, 1000) == 0 &&
               picture.brightness(300, 600, 700, 1000) > 20;
    }));
}

TEST_F(WindowTest, DrawsAnewWhatWasLost) {
    openOnWindow("video.mp4");
    ASSERT_TRUE(window->waitFor(isLit));
    window->erase();
    ASSERT_FALSE(isLit(window->look()));
    native->redraw();
    EXPECT_TRUE(window->waitFor(isLit));
}

TEST_F(WindowTest, KeepsItsPictureWhileItIsHeld) {
    openOnWindow("counted.ts");
    const auto shows = [this](int number) {
        return window->waitFor([=](const Picture& now) { return numberIn(now) == number; });
    };
    const auto seekToFrame = [this](int number) {
        ASSERT_EQ(android::NO_ERROR, player->seekTo(number * 40, 3));
    };
    seekToFrame(20);
    ASSERT_TRUE(shows(20));
    uint64_t before = 0;
    ASSERT_TRUE(eventually([&] {
        const NativeWindow::Frame next = native->awaitFrame(before, 100);
        if (next.number > 0) before = next.number;
        return next.timeUs == 800000;
    }));
    native->hold(true);
    seekToFrame(50);
    seekToFrame(60);
    EXPECT_EQ(before, native->frameCount());
    EXPECT_EQ(20, numberIn(window->look()));
    native->hold(false);
    EXPECT_TRUE(shows(60));
}

TEST_F(WindowTest, PlaysOnWhileTheWindowIsHidden) {
    openOnWindow("video.mp4");
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(window->waitFor(isLit));
    window->hide();
    const uint64_t hidden = native->frameCount();
    EXPECT_GT(native->awaitFrame(hidden + 10, 10000).number, hidden + 10);
    window->show();
    EXPECT_TRUE(window->waitFor(isLit));
}

TEST_F(WindowTest, LetsGoOfAWindowThatCloses) {
    openOnWindow("silent.mkv");
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(window->waitFor(isLit));
    native->close();
    const uint64_t atEnd = native->frameCount();
    window->destroy();
    playToEnd();
    EXPECT_EQ(atEnd, native->frameCount());
}

TEST_F(WindowTest, SurvivesAWindowThatIsGone) {
    openOnWindow("silent.mkv");
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(window->waitFor(isLit));
    window->destroy();
    playToEnd();
}

TEST_F(WindowTest, GoesOnInAnotherWindowAtTheSamePlace) {
    openOnWindow("video.mp4");
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(window->waitFor(isLit));
    const int before = position();
    native->close();
    use(nullptr);
    make(480, 270);
    use(surface);
    EXPECT_TRUE(native->drawing().byGpu);
    EXPECT_TRUE(window->waitFor(isLit));
    EXPECT_GE(position(), before);
    EXPECT_EQ(0u, surface->frameCount());
}

TEST_F(WindowTest, GoesFromBuffersToAWindowAndBack) {
    open("silent.mkv");
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(sink->waitFor(sink->frameCount() + 10));
    const int before = position();
    use(surface);
    EXPECT_TRUE(native->drawing().byGpu);
    EXPECT_TRUE(window->waitFor(isLit));
    EXPECT_GE(position(), before - 100);
    const uint64_t inBuffers = sink->frameCount();
    const uint64_t drawn = native->frameCount();
    EXPECT_GT(native->awaitFrame(drawn + 5, 10000).number, drawn + 5);
    EXPECT_EQ(inBuffers, sink->frameCount());
    use(sink);
    EXPECT_TRUE(sink->waitFor(inBuffers + 5));
    playToEnd();
    EXPECT_EQ(1, events->count(android::MEDIA_PLAYBACK_COMPLETE));
}

TEST_F(WindowTest, ChangesTheSurfaceWhilePaused) {
    open("silent.mkv");
    ASSERT_EQ(android::NO_ERROR, player->seekTo(1000, 3));
    use(surface);
    EXPECT_TRUE(window->waitFor(isLit));
    EXPECT_NEAR(1000, position(), 40);
    const uint64_t before = sink->frameCount();
    use(sink);
    EXPECT_TRUE(sink->waitFor(before));
    EXPECT_NEAR(1000, position(), 40);
}

TEST_F(WindowTest, LeavesSoftwareOpenGlUnlessItIsAskedFor) {
    make(320, 180, false);
    use(surface);
    EXPECT_FALSE(native->drawing().byGpu);
    EXPECT_THAT(native->drawing().description, testing::HasSubstr("software"));
    open("video.mp4");
    EXPECT_TRUE(surface->waitFor(0));
}

TEST_F(WindowTest, HasOneUserAtATime) {
    use(surface);
    const sp<android::TarnPlayer> other = new android::TarnPlayer(-1);
    ASSERT_EQ(android::NO_ERROR, other->setVideoSurfaceTexture(surface));
    ASSERT_EQ(android::NO_ERROR, other->setDataSource(mediaPath("video.mp4").c_str(), nullptr));
    ASSERT_EQ(android::NO_ERROR, other->prepare());
    EXPECT_TRUE(surface->waitFor(0));
    EXPECT_TRUE(native->drawing().byGpu);
    other->release();
}

// A window that notes the number of each frame when it is reported to be drawn.
class CountingWindow : public NativeWindow {
public:
    explicit CountingWindow(TestWindow& window)
        : NativeWindow(window.id(), true), mWindow(window) {}

    void reportFrame(int64_t timeUs) override {
        NativeWindow::reportFrame(timeUs);
        const CountedFrame frame = {numberIn(mWindow.look()), timeUs};
        std::lock_guard<std::mutex> lock(mMutex);
        mFrames.push_back(frame);
    }

    std::vector<CountedFrame> frames() const {
        std::lock_guard<std::mutex> lock(mMutex);
        return mFrames;
    }

private:
    TestWindow& mWindow;
    mutable std::mutex mMutex;
    std::vector<CountedFrame> mFrames;
};

EGLDisplay noDisplay(EGLenum, void*, const EGLAttrib*) { return EGL_NO_DISPLAY; }
EGLBoolean failedSwap(EGLDisplay, EGLSurface) { return EGL_FALSE; }

orvtarn::EglLibrary gWhole;

// EGL with some functions exchanged.
class ChangedEglTest : public WindowTest {
protected:
    void SetUp() override {
        WindowTest::SetUp();
        if (IsSkipped()) return;
        ASSERT_NE(nullptr, orvtarn::eglLibrary());
        gWhole = *orvtarn::eglLibrary();
    }

    void TearDown() override {
        if (!IsSkipped()) *orvtarn::eglLibrary() = gWhole;
        WindowTest::TearDown();
    }
};

using BrokenEglTest = ChangedEglTest;

std::atomic<int> gSwaps;
std::atomic<int> gSwapInterval;
std::atomic<bool> gMaySwap;
std::atomic<bool> gIsSwapping;

EGLBoolean countedSwap(EGLDisplay display, EGLSurface surface) {
    gSwaps++;
    return gWhole.swapBuffers(display, surface);
}

EGLBoolean notedInterval(EGLDisplay display, EGLint interval) {
    gSwapInterval = interval;
    return gWhole.swapInterval(display, interval);
}

EGLBoolean swapWhileItCloses(EGLDisplay display, EGLSurface surface) {
    gIsSwapping = true;
    eventually([] { return gMaySwap.load(); });
    const EGLBoolean swapped = gWhole.swapBuffers(display, surface);
    gIsSwapping = false;
    return swapped;
}

class WatchedEglTest : public ChangedEglTest {
protected:
    void SetUp() override {
        ChangedEglTest::SetUp();
        if (IsSkipped()) return;
        gSwaps = gSwapInterval = 0;
        orvtarn::eglLibrary()->swapBuffers = countedSwap;
        orvtarn::eglLibrary()->swapInterval = notedInterval;
    }

    void playOnWindow() {
        openOnWindow("video.mp4");
        ASSERT_EQ(android::NO_ERROR, player->start());
        ASSERT_TRUE(window->waitFor(isLit));
    }

    // Whether frames are counted, and none of them is drawn.
    void expectNothingIsDrawn() {
        uint64_t seen = native->frameCount();
        seen = native->awaitFrame(seen + 2, 10000).number;  // one may be under way
        const int before = gSwaps;
        EXPECT_GT(native->awaitFrame(seen + 10, 10000).number, seen + 10);
        EXPECT_EQ(before, gSwaps);
    }
};

TEST_F(WatchedEglTest, FramesChangeBetweenTheScreensPictures) {
    use(surface);
    EXPECT_EQ(1, gSwapInterval);
}

TEST_F(WatchedEglTest, NothingIsDrawnOnAHiddenWindow) {
    playOnWindow();
    window->hide();
    expectNothingIsDrawn();
    ASSERT_EQ(android::NO_ERROR, player->pause());
    window->show();
    EXPECT_TRUE(window->waitFor(isLit));
}

TEST_F(WatchedEglTest, NothingIsDrawnOnACoveredWindow) {
    playOnWindow();
    {
        TestWindow cover(800, 600);
        expectNothingIsDrawn();
        ASSERT_EQ(android::NO_ERROR, player->pause());
    }
    EXPECT_TRUE(window->waitFor(isLit));
}

// What draws may touch the window until close returns, and not afterwards.
TEST_F(WatchedEglTest, AWindowThatClosesIsWaitedFor) {
    openOnWindow("video.mp4");
    gMaySwap = false;
    ASSERT_TRUE(window->waitFor(isLit));
    orvtarn::eglLibrary()->swapBuffers = swapWhileItCloses;
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(eventually([] { return gIsSwapping.load(); }));
    bool wasSwapping = true;
    OtherThread closing([&] {
        native->close();
        wasSwapping = gIsSwapping;
    });
    EXPECT_TRUE(closing.isAsleep());
    EXPECT_TRUE(native->isClosing());
    gMaySwap = true;
    closing.join();
    EXPECT_FALSE(wasSwapping);
}

Display* gEngines;

EGLDisplay notedDisplay(EGLenum platform, void* display, const EGLAttrib* attributes) {
    gEngines = static_cast<Display*>(display);
    return gWhole.getPlatformDisplay(platform, display, attributes);
}

// Returns when the screen has the picture.
EGLBoolean finishedSwap(EGLDisplay display, EGLSurface surface) {
    const EGLBoolean swapped = gWhole.swapBuffers(display, surface);
    XSync(gEngines, 0);
    return swapped;
}

class WindowFrameTimeTest : public ChangedEglTest, public testing::WithParamInterface<int> {};

TEST_P(WindowFrameTimeTest, IsTheFilesOwn) {
    orvtarn::eglLibrary()->getPlatformDisplay = notedDisplay;
    orvtarn::eglLibrary()->swapBuffers = finishedSwap;
    make(128, 32);
    const sp<CountingWindow> counting = new CountingWindow(*window);
    native = counting;
    surface = new WindowSink(native);
    openOnWindow("counted.ts");
    ASSERT_EQ(android::NO_ERROR, player->setSpeed(GetParam()));
    playToEnd();
    EXPECT_TRUE(eventually([&] { return counting->frames().back().number == 99; }, 3));
    const std::vector<CountedFrame> frames = counting->frames();
    EXPECT_GT(frames.size(), 20u);
    for (const CountedFrame& frame : frames) {
        EXPECT_NEAR(frame.number * 40, static_cast<double>(frame.timestampUs) / 1000, 1)
            << "frame " << frame.number;
    }
}

INSTANTIATE_TEST_SUITE_P(Speeds, WindowFrameTimeTest, testing::Values(500, 1000, 1500, 4000));

TEST_F(BrokenEglTest, WithoutADisplaySoftwareDraws) {
    orvtarn::eglLibrary()->getPlatformDisplay = noDisplay;
    use(surface);
    EXPECT_FALSE(native->drawing().byGpu);
    EXPECT_EQ("EGL does not know the display", native->drawing().description);
    open("video.mp4");
    EXPECT_TRUE(surface->waitFor(0));
}

TEST_F(BrokenEglTest, WhatFailsLaterIsReplacedBySoftware) {
    openOnWindow("silent.mkv");
    LogCapture log;
    ASSERT_EQ(android::NO_ERROR, player->start());
    ASSERT_TRUE(window->waitFor(isLit));
    orvtarn::eglLibrary()->swapBuffers = failedSwap;
    EXPECT_TRUE(surface->waitFor(10, isLit));
    EXPECT_FALSE(native->drawing().byGpu);
    playToEnd();
    EXPECT_EQ(1, events->count(android::MEDIA_PLAYBACK_COMPLETE));
    const std::vector<LogLine> lines = log.lines();
    EXPECT_EQ(1, std::count_if(lines.begin(), lines.end(), [](const LogLine& line) {
                  return line.text.find("software draws from now on") != std::string::npos;
              }));
}

}  // namespace
}  // namespace orvtest
