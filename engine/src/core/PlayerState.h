// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>
#include <utils/Errors.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <initializer_list>
#include <mutex>
#include <optional>

namespace orvtarn {

enum class Phase {
    Idle,
    Initialized,
    Preparing,
    Prepared,
    Started,
    Paused,
    Stopped,
    Completed,
    Error,
    Released,
};

const char* phaseName(Phase phase);

// What the player knows of itself. Written by the operations and by the event
// loop, read and waited for by anybody.
class PlayerState {
public:
    // What programs ask for again and again, as getCurrentPosition answers it. Aligned by
    // its size, as an atomic one is stored: clang would call libatomic for less.
    struct alignas(8) Position {
        android::status_t status = android::INVALID_OPERATION;
        int32_t msec = 0;
    };

    struct Values {
        Phase phase = Phase::Idle;
        android::status_t error = android::NO_ERROR;  // in the error phase
        // Counts prepare, stop, reset and release: a wait that sees another
        // number than its own has been overtaken.
        uint64_t session = 0;

        // Of the media that is open; see forgetMedia.
        bool fileOpen = false;     // from the load to mpv's word that it ended
        bool fileStarted = false;  // mpv has taken the load up
        bool left = false;         // mpv is on its way to another position
        bool restarted = false;    // playback is ready to go on from the first position
        bool framed = false;       // its first frame was handed out
        bool hasVideo = false;
        bool seekable = false;
        bool buffering = false;
        bool seeking = false;   // one seek at a time
        bool attended = false;  // by a caller who keeps mpv paused meanwhile
        uint64_t seeks = 0;     // begun by mpv
        uint64_t restarts = 0;  // playback gone on after a seek or the load
        uint64_t seeksOf = 0;   // the two numbers when the seek under way was begun
        uint64_t restartsOf = 0;
        std::optional<int64_t> startUs;  // the timestamp that times count from
        double position = 0;             // seconds
        double duration = 0;             // seconds, 0 when unknown
        int width = 0;                   // of the picture as it is meant to be seen, pixels
        int height = 0;
        int bufferPercent = 0;

        bool looping = false;  // outlasts the media

        bool isOneOf(std::initializer_list<Phase> phases) const;
        // Prepared and not stopped: there is media to operate on.
        bool isOpen() const;
        // A seek or the load goes on with mpv paused.
        bool isHeld() const { return attended || phase == Phase::Preparing; }
        Position currentPosition() const;
        // Playback would go on, or begin, if there were more of the media.
        bool awaitsData() const;
        // A seek is about to be given to mpv.
        void beginSeek();
        // mpv has left the place where it was. A restart that is reported before is of
        // an earlier seek.
        void onSeek();
        // It is under way and mpv has not gone on from where it leads.
        bool isArriving() const;
        void forgetMedia();
        // Goes to the error phase unless the media is given up anyway.
        bool fail(android::status_t status);
    };

    template <class Reader>
    auto read(Reader reader) const {
        std::lock_guard<std::mutex> lock(mMutex);
        return reader(mValues);
    }

    // Changes the values and wakes all waits; returns what the writer does.
    template <class Writer>
    auto update(Writer writer) {
        std::lock_guard<std::mutex> lock(mMutex);
        const Publication publication(*this);
        mChanged.notify_all();
        return writer(mValues);
    }

    // Takes no lock.
    Position currentPosition() const { return mPosition.load(std::memory_order_acquire); }

    // Blocks until the condition holds. False when the time was over first.
    template <class Condition>
    bool wait(std::chrono::milliseconds limit, Condition condition) {
        return waitUntil(std::chrono::steady_clock::now() + limit, condition);
    }

    template <class Condition>
    bool waitUntil(std::chrono::steady_clock::time_point deadline, Condition condition) {
        std::unique_lock<std::mutex> lock(mMutex);
        const Publication publication(*this);
        return mChanged.wait_until(lock, deadline, [&] { return condition(mValues); });
    }

    Phase phase() const {
        return read([](const Values& v) { return v.phase; });
    }

    // 0 when the media is prepared and not stopped; otherwise one log line and
    // INVALID_OPERATION.
    android::status_t requireOpen(const char* operation) const;
    // The log line and status of an operation that the phase does not allow.
    static android::status_t wrongPhase(const char* operation, Phase phase);

private:
    // Publishes what can be read without a lock when a change is done, under the lock.
    class Publication {
    public:
        explicit Publication(PlayerState& state) : mState(state) {}
        ~Publication() {
            mState.mPosition.store(mState.mValues.currentPosition(), std::memory_order_release);
        }
        Publication(const Publication&) = delete;
        Publication& operator=(const Publication&) = delete;

    private:
        PlayerState& mState;
    };

    std::atomic<Position> mPosition{Position()};
    mutable std::mutex mMutex;
    std::condition_variable mChanged;
    Values mValues;
};

}  // namespace orvtarn
