// SPDX-License-Identifier: Apache-2.0
// An engine of its own: plays addresses like pattern://60, a minute of wandering stripes.
#include <gui/IGraphicBufferProducer.h>
#include <log/log.h>
#include <orvtarn/TarnPlayer.h>
#include <stdio.h>
#include <stream/IOrvStreamSource.h>

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>

namespace android {
using namespace std::chrono_literals;
using Time = std::chrono::nanoseconds;
constexpr Time kFrame = 40ms;
enum : int { kWidth = 640, kHeight = 360 };

// The picture of a frame: stripes that wander. Put your own here.
static void draw(const IGraphicBufferProducer::PixelBuffer& to, int64_t frame) {
    for (int64_t y = 0; y < to.height; y++) {
        auto* const row = reinterpret_cast<uint32_t*>(to.pixels + y * to.stride);
        for (int64_t x = 0; x < to.width; x++) {
            row[x] = (x + y + 4 * frame) % 128 < 64 ? 0xE8A020 : 0x204880 + (y & 0x7F);
        }
    }
}

static status_t refuse(const char* operation) {
    ALOGE("%s: not in this engine", operation);
    return INVALID_OPERATION;
}

// Where a player stands. An operation names all phases in which it is allowed.
enum : unsigned { IDLE = 1, INITIALIZED = 2, PREPARED = 4, STARTED = 8, PAUSED = 16 };
enum : unsigned { COMPLETED = 32, STOPPED = 64, OPEN = 60, ALIVE = 127, RELEASED = 128 };

// A player's state, and the thread that draws while it plays and calls the listener. One lock
// guards all of it, and is free while the listener runs: that may call the player.
class TarnPlayer::Engine {
public:
    explicit Engine(std::function<void(int, int, int)> listener) : mListener(std::move(listener)) {}
    // Runs an operation under the lock and returns its status, in other phases INVALID_OPERATION.
    // With a name, a failure is logged. The surface has the frame of the time afterwards.
    status_t run(const char* name, unsigned phases, const std::function<void(Engine&)>& operation) {
        std::lock_guard<std::mutex> lock(mMutex);
        settle();
        status = (phase & phases) != 0 ? NO_ERROR : INVALID_OPERATION;
        if (status == NO_ERROR && operation) operation(*this);
        if (status != NO_ERROR && name != nullptr) ALOGE("%s: %d in phase %u", name, status, phase);
        settle();
        mChanged.notify_all();
        return status;
    }
    bool is(unsigned phases) { return run(nullptr, phases, nullptr) == NO_ERROR; }
    status_t go(const char* name, unsigned from, unsigned to) {
        return run(name, from, [=](Engine& e) { e.phase = to; });
    }

    // For good. Waits for the thread, but in the listener, which runs there.
    void release() {
        std::unique_lock<std::mutex> lock(mMutex);
        phase = RELEASED;
        surface = nullptr;
        mEvents.clear();
        mChanged.notify_all();
        if (mThread != std::this_thread::get_id()) mChanged.wait(lock, [&] { return !mRunning; });
    }

    // What follows is for operations.
    status_t status = NO_ERROR;
    unsigned phase = IDLE;
    Time duration{0}, time{0};  // of the media, and in it
    bool looping = false, visible = true;
    sp<IGraphicBufferProducer> surface;
    int64_t shown = -1;  // the frame that the surface has
    int64_t frame() const { return std::min(time, duration - kFrame) / kFrame; }
    void post(int msg, int ext1 = 0, int ext2 = 0) {
        mEvents.emplace_back([=] { mListener(msg, ext1, ext2); });
    }
    void startThread() {
        if (!mRunning) std::thread([this] { work(); }).detach();
        mRunning = true;
    }

private:
    // Lets the time that has passed count. True when there was no buffer for its frame.
    bool settle() {
        const auto now = std::chrono::steady_clock::now();
        if (phase == STARTED) time += now - mSettled;
        mSettled = now;
        if (phase == STARTED && looping) time %= duration;
        if (phase == STARTED && time >= duration) {
            time = duration;
            phase = COMPLETED;
            post(MEDIA_PLAYBACK_COMPLETE);
        }
        if (phase != STARTED && time < duration) time = frame() * kFrame;
        const bool lacksFrame = surface != nullptr && visible && shown != frame();
        return lacksFrame && (phase & OPEN) != 0 && !show();
    }

    bool show() {
        int width = 0, height = 0;
        surface->getDefaultSize(&width, &height);
        if (width <= 0 || height <= 0) width = kWidth, height = kHeight;
        IGraphicBufferProducer::PixelBuffer buffer = {};
        const status_t dequeued = surface->dequeueBuffer(width, height, &buffer);
        if (dequeued == NO_INIT) surface = nullptr;  // nobody consumes it any more
        if (dequeued != NO_ERROR) return dequeued == NO_INIT;
        draw(buffer, frame());
        shown = frame();
        return surface->queueBuffer(buffer.slot, shown * kFrame / 1us) == NO_ERROR;
    }

    void work() {
        std::unique_lock<std::mutex> lock(mMutex);
        mThread = std::this_thread::get_id();
        while (phase != RELEASED) {
            const bool lacksBuffer = settle();
            if (!mEvents.empty()) {
                const std::function<void()> deliver = mEvents.front();
                mEvents.pop_front();
                lock.unlock();
                deliver();
                lock.lock();
            } else if (phase == STARTED || lacksBuffer) {
                mChanged.wait_for(lock, 5ms);
            } else {
                mChanged.wait(lock);
            }
        }
        mRunning = false;
        mChanged.notify_all();
    }

    const std::function<void(int, int, int)> mListener;
    std::mutex mMutex;
    std::condition_variable mChanged;
    std::deque<std::function<void()>> mEvents;
    std::chrono::steady_clock::time_point mSettled;  // when it was that time
    std::thread::id mThread;
    bool mRunning = false;
};

TarnPlayer::TarnPlayer(int)
    : mEngine(new Engine([this](int msg, int ext1, int ext2) { sendEvent(msg, ext1, ext2); })) {}
TarnPlayer::~TarnPlayer() { mEngine->release(); }

status_t TarnPlayer::setDataSource(const char* url, const KeyedVector<String8, String8>*) {
    return mEngine->run(__func__, IDLE, [=](Engine& e) {
        int seconds = 0;
        char rest = 0;
        const bool whole = sscanf(url, "pattern://%5d%c", &seconds, &rest) == 1;
        e.status = whole && seconds > 0 ? status_t{NO_ERROR} : ORV_ERROR_SCHEME;
        e.duration = std::chrono::seconds(seconds);
        if (e.status == NO_ERROR) e.phase = INITIALIZED;
    });
}
status_t TarnPlayer::setVideoSurfaceTexture(const sp<IGraphicBufferProducer>& bufferProducer) {
    return mEngine->run(__func__, ALIVE, [&](Engine& e) {
        e.surface = bufferProducer;
        e.shown = -1;
    });
}
status_t TarnPlayer::prepare() {
    return mEngine->run(__func__, INITIALIZED | STOPPED, [](Engine& e) {
        e.phase = PREPARED;
        e.time = 0ms;
        e.shown = -1;
        e.startThread();
        e.post(MEDIA_SET_VIDEO_SIZE, kWidth, kHeight);
        e.post(MEDIA_PREPARED);
    });
}
status_t TarnPlayer::prepareAsync() { return prepare(); }
status_t TarnPlayer::start() {
    return mEngine->run(__func__, OPEN, [](Engine& e) {
        if (e.phase == COMPLETED) e.time = 0ms;
        e.phase = STARTED;
    });
}
status_t TarnPlayer::pause() {
    return mEngine->run(__func__, STARTED | PAUSED | COMPLETED, [](Engine& e) {
        if (e.phase == STARTED) e.phase = PAUSED;
    });
}
status_t TarnPlayer::stop() { return mEngine->go(__func__, OPEN | STOPPED, STOPPED); }
status_t TarnPlayer::reset() { return mEngine->go(__func__, ALIVE, IDLE); }
status_t TarnPlayer::release() { return mEngine->release(), NO_ERROR; }
// Every frame is a key frame, to which all modes lead.
status_t TarnPlayer::seekTo(int msec, int mode) {
    if (mode < 0 || mode > 3) return refuse(__func__), BAD_VALUE;
    return mEngine->run(__func__, OPEN, [=](Engine& e) {
        if (e.phase == COMPLETED) e.phase = PAUSED;
        e.time = std::clamp<Time>(msec * 1ms, 0ms, e.duration);
        e.post(MEDIA_SEEK_COMPLETE);
    });
}
bool TarnPlayer::step(int amount) {
    return NO_ERROR == mEngine->run(__func__, OPEN, [=](Engine& e) {
        const Time to = (e.frame() + amount) * kFrame;
        e.phase = PAUSED;
        e.status = to >= 0ms && to < e.duration ? NO_ERROR : BAD_VALUE;
        if (e.status == NO_ERROR) e.time = to;
    });
}
bool TarnPlayer::canDoSeek(int) { return mEngine->is(OPEN); }
bool TarnPlayer::isPlaying() { return mEngine->is(STARTED); }
int TarnPlayer::getBufferPercent() { return mEngine->is(OPEN) ? 100 : 0; }
status_t TarnPlayer::getCurrentPosition(int* msec) {
    return mEngine->run(nullptr, OPEN, [=](Engine& e) { *msec = int(e.time / 1ms); });
}
status_t TarnPlayer::getDuration(int* to) {
    return mEngine->run(__func__, OPEN | STOPPED, [=](Engine& e) { *to = int(e.duration / 1ms); });
}
status_t TarnPlayer::getVideoWidth(int* w) { return *w = mEngine->is(OPEN) * kWidth, NO_ERROR; }
status_t TarnPlayer::getVideoHeight(int* h) { return *h = mEngine->is(OPEN) * kHeight, NO_ERROR; }
status_t TarnPlayer::setLooping(int loop) {
    return mEngine->run(__func__, ALIVE, [=](Engine& e) { e.looping = loop != 0; });
}
status_t TarnPlayer::setPlayerRole(E_Orv_Player_Role_Type role) {
    return mEngine->run(__func__, ALIVE,
                        [=](Engine& e) { e.visible = role != E_ORV_PLAYER_ROLE_BACKGROUND; });
}
// One video track, neither sound nor subtitles.
bool TarnPlayer::getVideoTrackCount(int& count) { return count = 1, mEngine->is(OPEN); }
bool TarnPlayer::getAudioTrackCount(int& count) { return count = 0, mEngine->is(OPEN); }
bool TarnPlayer::getSubtitleTrackCount(int& count) { return count = 0, mEngine->is(OPEN); }
bool TarnPlayer::getVideoCodecInfo(int index, VideoCodecInfo& info) {
    const int32_t codec = 'r' | 'a' << 8 | 'w' << 16 | ' ' << 24;
    info = {codec, kWidth, kHeight, 25000, 0, ORV_TRACK_FLAG_DEFAULT | ORV_TRACK_FLAG_SELECTED};
    return index == 0 && mEngine->is(OPEN);
}
bool TarnPlayer::getVideoCodecInfo(VideoCodecInfo& info) { return getVideoCodecInfo(0, info); }
bool TarnPlayer::selectTrack(int index) { return index == 0 && mEngine->is(OPEN); }
status_t TarnPlayer::getCurrentAudioIndex(int* index) { return *index = -1, mEngine->is(OPEN); }
status_t TarnPlayer::getCurrentSubtitleIndex(int* index) { return *index = -1, mEngine->is(OPEN); }
bool TarnPlayer::offSubtitleTrack() { return mEngine->is(OPEN); }
// What has no meaning here, and what this engine does not do.
void TarnPlayer::configPlayer(bool) {}
status_t TarnPlayer::setVolume(float l, float r) { return l + r >= 0 ? NO_ERROR : BAD_VALUE; }
status_t TarnPlayer::getMetadata(const SortedVector<int>&, Parcel*) { return NO_ERROR; }
status_t TarnPlayer::setDataSource(IOrvStreamSource* s) { return delete s, refuse(__func__); }
status_t TarnPlayer::setDataSource(int, int64_t, int64_t) { return refuse(__func__); }
status_t TarnPlayer::setParameter(int, const Parcel&) { return refuse(__func__), BAD_VALUE; }
status_t TarnPlayer::getParameter(int, Parcel*) { return refuse(__func__), BAD_VALUE; }
status_t TarnPlayer::invoke(const Parcel&, Parcel*) { return refuse(__func__), BAD_VALUE; }
status_t TarnPlayer::getCurrentBytePosition(int*) { return refuse(__func__); }
status_t TarnPlayer::setPCMMediaInfo(IORV_PB_CTRL_SET_MEDIA_INFO_T*) { return refuse(__func__); }
status_t TarnPlayer::setUnLockPin(int) { return refuse(__func__); }
void TarnPlayer::setPcmFlag() { refuse(__func__); }
bool TarnPlayer::canDoTrick(int speed) { return speed == ORV_SPEED_NORMAL && mEngine->is(OPEN); }
status_t TarnPlayer::setSpeed(int speed) {
    return canDoTrick(speed) ? NO_ERROR : (refuse(__func__), BAD_VALUE);
}
bool TarnPlayer::getSpeed(int& speed) { return speed = ORV_SPEED_NORMAL, true; }
int TarnPlayer::setABRepeat(int) { return !refuse(__func__); }
bool TarnPlayer::setTS(unsigned short) { return !refuse(__func__); }
bool TarnPlayer::seekToPosition(unsigned long long) { return !refuse(__func__); }
bool TarnPlayer::getThumbnailInfo(_Media_Thumbnail_Info_T*) { return !refuse(__func__); }
MediaAlbumArt* TarnPlayer::extractAlbumArt() { return refuse(__func__), nullptr; }
bool TarnPlayer::getMetaDataInfo(MetaDataInfo&) { return !refuse(__func__); }
bool TarnPlayer::getAudioTrackInfo(bool, int, AudioTrackInfo&) { return refuse(__func__), false; }
bool TarnPlayer::selectAudioTrack(int) { return !refuse(__func__); }
bool TarnPlayer::getSubtitleTrackInfo(int, SubtitleTrackInfo&) { return refuse(__func__), false; }
bool TarnPlayer::onSubtitleTrack(int) { return !refuse(__func__); }
bool TarnPlayer::deselectTrack(int) { return !refuse(__func__); }
bool TarnPlayer::addTimedTextSource(const char*) { return !refuse(__func__); }
bool TarnPlayer::setSubtitleDataSource(const char*) { return !refuse(__func__); }
bool TarnPlayer::setSubtitleDataSourceEx(const char*, const char*) { return !refuse(__func__); }
bool TarnPlayer::setSubtitleAttr(int, void*) { return !refuse(__func__); }
bool TarnPlayer::flushSubtitleAttr() { return !refuse(__func__); }
}  // namespace android
