// SPDX-License-Identifier: Apache-2.0
// The native method that makes a Java player its own source of media bytes.
#include "AllocationFailure.h"
#include "JavaInputStreamFixture.h"

namespace orvtest {
namespace {

constexpr char kFunction[] = "OrvMediaClient_setDataSourceByInputStream";

class StreamSourceTest : public JavaInputStreamFixture {
protected:
    Outcome set() { return call<void>("native_setDataSourceByInputStream", "()V"); }

    // Deletes the stream that the engine got, which nothing else does.
    void takeStream(const Outcome& outcome) {
        void* address = nullptr;
        ASSERT_EQ(outcome.engine.size(), 1u);
        ASSERT_EQ(sscanf(outcome.engine[0].c_str(), "setDataSource(%p)", &address), 1);
        stream.reset(static_cast<JavaInputStream*>(static_cast<IOrvStreamSource*>(address)));
    }

    std::vector<ExpectedLine> lines(std::vector<ExpectedLine> failure = {}) {
        std::vector<ExpectedLine> all = {
            enter(kFunction), enter(kConstructor),
            bridgeInfo(std::string(kConstructor) + "(): E_Orv_Stream_Source_Type is 0\n"),
            leave(kConstructor), serviceInfo("OrvMediaService::setDataSource(IOrvStreamSource):")};
        all.insert(all.end(), failure.begin(), failure.end());
        all.push_back(leave(kFunction));
        return all;
    }
};

TEST_F(StreamSourceTest, HandsAStreamOverThePlayerToTheEngine) {
    setUpPlayer();
    Outcome outcome = set();
    takeStream(outcome);
    outcome.engine.clear();
    EXPECT_THAT(outcome, ReturnsNothing().logs(lines()).makesGlobals(2));
    EXPECT_TRUE(stream->isValid());
    player->set("mStreamCurPos", fakejni::Value::ofLong(17));
    vm.onNativeThread([&] { EXPECT_EQ(stream->getCurrentPosition(), 17); });
}

TEST_F(StreamSourceTest, RefusalIsLoggedAndTheStreamIsKept) {
    setUpPlayer().answer("setDataSource", {-38});
    Outcome outcome = set();
    takeStream(outcome);
    outcome.engine.clear();
    EXPECT_THAT(outcome,
                ReturnsNothing()
                    .logs(lines({bridgeError(std::string(kFunction) + "(): service set failed\n")}))
                    .makesGlobals(2));
}

TEST_F(StreamSourceTest, MissingServiceThrowsNothingDespiteItsText) {
    EXPECT_THAT(set(), ReturnsNothing().logs(
                           {enter(kFunction),
                            bridgeError("service not exist,throw exception. Line:3471\n")}));
}

TEST_F(StreamSourceTest, MissingMemoryThrows) {
    setUpPlayer();
    AllocationFailure failure = AllocationFailure::of<JavaInputStream>();
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs({enter(kFunction),
                                  bridgeError(std::string(kFunction) +
                                              "(): out of memory, new JavaInputStream failed, "
                                              "throw exception\n")})
                           .throws(kRuntime, "Out of memory"));
}

}  // namespace
}  // namespace orvtest
