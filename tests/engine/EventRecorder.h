// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <media/MediaPlayerInterface.h>

#include <condition_variable>
#include <functional>
#include <mutex>
#include <vector>

namespace orvtest {

struct Event {
    int msg;
    int ext1;
    int ext2;
    bool operator==(const Event& other) const {
        return msg == other.msg && ext1 == other.ext1 && ext2 == other.ext2;
    }
};

// A player's listener that writes everything down.
class EventRecorder : public android::MediaPlayerBase::Listener {
public:
    void notify(int msg, int ext1, int ext2, const android::Parcel* obj) override;

    std::vector<Event> events() const;
    int count(int msg) const;
    // Waits for that many events of a kind; false after a long while.
    bool waitFor(int msg, int count = 1) const;
    // Called on the delivering thread for each event.
    void setReaction(std::function<void(const Event&)> reaction);

private:
    mutable std::mutex mMutex;
    mutable std::condition_variable mArrived;
    std::vector<Event> mEvents;
    std::function<void(const Event&)> mReaction;
};

}  // namespace orvtest
