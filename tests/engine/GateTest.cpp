// SPDX-License-Identifier: Apache-2.0
// Who is inside of the gate, and who waits for whom.
#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <thread>
#include <vector>

#include "Gate.h"
#include "OtherThread.h"

using orvtarn::Gate;
using orvtest::OtherThread;

namespace {

TEST(GateTest, ClosesOnceAndLetsNobodyIn) {
    Gate gate;
    EXPECT_TRUE(Gate::Pass(gate));
    EXPECT_TRUE(gate.close());
    EXPECT_FALSE(gate.close());
    EXPECT_FALSE(Gate::Pass(gate));
    gate.awaitEmpty();
}

TEST(GateTest, IsEmptyWhenTheLastHasLeft) {
    Gate gate;
    std::unique_ptr<OtherThread> waiting;
    {
        const Gate::Pass first(gate);
        {
            const Gate::Pass second(gate);
            gate.close();
            waiting = std::make_unique<OtherThread>([&] { gate.awaitEmpty(); });
            EXPECT_TRUE(waiting->isAsleep()) << "two are inside";
        }
        EXPECT_TRUE(waiting->isAsleep()) << "one is inside";
    }
    waiting->join();
}

TEST(GateTest, IsDoneWhenItIsSaidToBe) {
    Gate gate;
    gate.close();
    OtherThread waiting([&] { gate.awaitDone(); });
    EXPECT_TRUE(waiting.isAsleep());
    gate.setDone();
    waiting.join();
    gate.awaitDone();
}

// What is inside may be taken apart, and the gate with it, as soon as it is empty.
TEST(GateTest, NobodyIsInsideOfWhatIsTakenApart) {
    constexpr int kRounds = 300;
    constexpr int kVisitors = 3;
    for (int round = 0; round < kRounds; round++) {
        auto gate = std::make_unique<Gate>();
        std::atomic<int> ready{0};
        std::atomic<int> stillInside{0};
        std::atomic<bool> apart{false};
        std::atomic<bool> metApart{false};
        std::vector<std::thread> visitors;
        for (int i = 0; i < kVisitors; i++) {
            visitors.emplace_back([&, visited = gate.get()] {
                auto pass = std::make_unique<Gate::Pass>(*visited);
                ready++;
                while (*pass && ready < kVisitors + 1) std::this_thread::yield();
                if (apart) metApart = true;
                stillInside++;
            });
        }
        while (ready < kVisitors) std::this_thread::yield();
        gate->close();
        ready++;
        gate->awaitEmpty();
        apart = true;
        EXPECT_EQ(kVisitors, stillInside);
        gate.reset();
        for (std::thread& visitor : visitors) visitor.join();
        EXPECT_FALSE(metApart);
    }
}

}  // namespace
