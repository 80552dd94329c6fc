// SPDX-License-Identifier: Apache-2.0
#include "EventRecorder.h"

#include <algorithm>
#include <chrono>

namespace orvtest {
namespace {

int countOf(const std::vector<Event>& events, int msg) {
    return static_cast<int>(std::count_if(events.begin(), events.end(),
                                          [msg](const Event& event) { return event.msg == msg; }));
}

}  // namespace

void EventRecorder::notify(int msg, int ext1, int ext2, const android::Parcel*) {
    std::function<void(const Event&)> reaction;
    {
        std::lock_guard<std::mutex> lock(mMutex);
        mEvents.push_back({msg, ext1, ext2});
        reaction = mReaction;
        mArrived.notify_all();
    }
    if (reaction) reaction({msg, ext1, ext2});
}

std::vector<Event> EventRecorder::events() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mEvents;
}

int EventRecorder::count(int msg) const {
    std::lock_guard<std::mutex> lock(mMutex);
    return countOf(mEvents, msg);
}

bool EventRecorder::waitFor(int msg, int count) const {
    std::unique_lock<std::mutex> lock(mMutex);
    return mArrived.wait_for(lock, std::chrono::seconds(30),
                             [&] { return countOf(mEvents, msg) >= count; });
}

void EventRecorder::setReaction(std::function<void(const Event&)> reaction) {
    std::lock_guard<std::mutex> lock(mMutex);
    mReaction = std::move(reaction);
}

}  // namespace orvtest
