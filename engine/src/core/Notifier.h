// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>
#include <memory>
#include <thread>

namespace orvtarn {

// Delivers events to the listener, in order, on a thread of its own, so that a
// listener may call the player and may take its time.
class Notifier {
public:
    using Deliver = std::function<void(int msg, int ext1, int ext2)>;

    explicit Notifier(Deliver deliver);
    ~Notifier() { stop(); }

    // Once, before anything is posted.
    void start();
    // Any thread; never blocks.
    void post(int msg, int ext1 = 0, int ext2 = 0);
    // Drops what was not delivered yet. Waits for a delivery under way, unless it
    // is called from that delivery.
    void stop();
    // Whether this is the thread that calls the listener.
    bool isDelivering() const;

private:
    // Outlives the notifier while a delivery that stopped it returns.
    struct Queue;

    static void run(std::shared_ptr<Queue> queue);

    std::shared_ptr<Queue> mQueue;
    std::thread mThread;
};

}  // namespace orvtarn
