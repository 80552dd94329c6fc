// SPDX-License-Identifier: Apache-2.0
#include "core/Notifier.h"

#include <atomic>
#include <condition_variable>
#include <deque>
#include <mutex>
#include <utility>

#include "base/ThreadName.h"

namespace orvtarn {

struct Notifier::Queue {
    struct Event {
        int msg;
        int ext1;
        int ext2;
    };

    std::mutex mutex;
    std::condition_variable changed;
    std::deque<Event> events;
    bool stopped = false;
    Deliver deliver;
    std::atomic<std::thread::id> thread{std::thread::id()};
};

Notifier::Notifier(Deliver deliver) : mQueue(std::make_shared<Queue>()) {
    mQueue->deliver = std::move(deliver);
}

void Notifier::start() { mThread = std::thread(run, mQueue); }

void Notifier::post(int msg, int ext1, int ext2) {
    std::lock_guard<std::mutex> lock(mQueue->mutex);
    if (mQueue->stopped) return;
    mQueue->events.push_back({msg, ext1, ext2});
    mQueue->changed.notify_one();
}

void Notifier::stop() {
    {
        std::lock_guard<std::mutex> lock(mQueue->mutex);
        mQueue->stopped = true;
        mQueue->events.clear();
        mQueue->changed.notify_one();
    }
    if (!mThread.joinable()) return;
    if (isDelivering()) {
        mThread.detach();
    } else {
        mThread.join();
    }
}

bool Notifier::isDelivering() const { return mQueue->thread == std::this_thread::get_id(); }

void Notifier::run(std::shared_ptr<Queue> queue) {
    nameThisThread("orv-notify");
    queue->thread = std::this_thread::get_id();
    std::unique_lock<std::mutex> lock(queue->mutex);
    while (true) {
        queue->changed.wait(lock, [&] { return queue->stopped || !queue->events.empty(); });
        if (queue->stopped) return;
        const Queue::Event event = queue->events.front();
        queue->events.pop_front();
        lock.unlock();
        queue->deliver(event.msg, event.ext1, event.ext2);
        lock.lock();
    }
}

}  // namespace orvtarn
