// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "Calls.h"
#include "Meaning.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace orvtrace {
namespace {

// What ended, as "name begin-end", "name begin-?" without a line that leaves it.
class Ended : public Sink {
public:
    void track(Track, std::string_view) override { ++tracks; }
    void span(const Span& span) override {
        spans.push_back(std::string(span.name) + " " + std::to_string(span.begin.ns) + "-" +
                        (span.leaveMissing ? "?" : std::to_string(span.end)) +
                        (span.failed ? " failed" : "") + (span.timed ? "" : " untimed"));
    }
    void mark(const MarkAt& mark) override { marks.emplace_back(mark.text); }

    std::vector<std::string> spans;
    std::vector<std::string> marks;
    int tracks = 0;
};

class CallsTest : public testing::Test {
protected:
    // A line a nanosecond.
    void log(const std::string& text, int tid = 1, char priority = 'I') {
        LogLine line;
        line.time.known = true;
        line.time.text = "time";
        line.pid = 1;
        line.tid = tid;
        line.priority = priority;
        line.tag = "OrvMediaClient-JNI";
        line.text = text;
        calls.line(line, meaningOf(line), ++now);
    }
    void enter(const std::string& name, int tid = 1) {
        log("OrvMediaClient_" + name + "(): Enter", tid);
    }
    void leave(const std::string& name, int tid = 1) {
        log("OrvMediaClient_" + name + "(): Leave", tid);
    }

    Ended ended;
    Calls calls{ended};
    int64_t now = 0;
};

TEST_F(CallsTest, ACallIsFromItsFirstLineToItsLast) {
    enter("start");
    log("something");
    leave("start");
    EXPECT_THAT(ended.spans, ElementsAre("start 1-3"));
    EXPECT_EQ(calls.strayLeaves(), 0u);
}

TEST_F(CallsTest, ThreadsHaveTheirOwn) {
    enter("start", 1);
    enter("start", 2);
    leave("start", 1);
    leave("start", 2);
    EXPECT_THAT(ended.spans, ElementsAre("start 1-3", "start 2-4"));
    EXPECT_EQ(ended.tracks, 2);
}

TEST_F(CallsTest, TheNextCallEndsOneThatDidNotLeave) {
    enter("prepare");
    log("service not exist, throw exception. Line:1", 1, 'E');
    enter("start");
    leave("start");
    EXPECT_THAT(ended.spans, ElementsAre("prepare 1-? failed untimed", "start 3-4"));
    EXPECT_THAT(ended.marks, SizeIs(1));
}

TEST_F(CallsTest, WhatACallCallsIsInside) {
    enter("setDataSource");
    enter("setDataSourceAndHeaders");
    log("process_media_player_call(): else 2, throw exception", 1, 'E');
    leave("setDataSourceAndHeaders");
    leave("setDataSource");
    EXPECT_THAT(ended.spans,
                ElementsAre("setDataSourceAndHeaders 2-4 failed", "setDataSource 1-5 failed"));
}

TEST_F(CallsTest, ACallBackFromJavaIsInside) {
    log("MsgDispatcher::notify(): Enter");
    enter("start");
    leave("start");
    log("MsgDispatcher::notify(): Leave");
    EXPECT_THAT(ended.spans, ElementsAre("start 2-3", "MsgDispatcher::notify 1-4"));
}

TEST_F(CallsTest, AnInnerStepOfTheMethodsNameIsNotTheMethod) {
    enter("setVideoSurface");
    log("setVideoSurface(): Enter");
    log("setVideoSurface(): Leave");
    leave("setVideoSurface");
    EXPECT_THAT(ended.spans, ElementsAre("setVideoSurface 2-3", "setVideoSurface 1-4"));
}

TEST_F(CallsTest, AnInnerStepThatDidNotLeaveEndsWithItsCall) {
    enter("release");
    log("decVideoSurfaceRef(): Enter");
    leave("release");
    EXPECT_THAT(ended.spans, ElementsAre("decVideoSurfaceRef 2-? untimed", "release 1-3"));
}

TEST_F(CallsTest, MisnamedLinesAreKnown) {
    enter("setPlayMode");
    leave("setPlayModeEx");
    enter("getDivxChapInfo");
    leave("getDivxPlayListInfo");
    enter("getDivxChapInfo");
    leave("getDivxChapInfo");
    EXPECT_THAT(ended.spans,
                ElementsAre("setPlayMode 1-2", "getDivxPlayListInfo 3-4", "getDivxChapInfo 5-6"));
}

TEST_F(CallsTest, ALineThatOccursIsACallWithoutATime) {
    log("OrvMediaClient_isLooping(): occur");
    enter("start");
    leave("start");
    EXPECT_THAT(ended.spans, ElementsAre("isLooping 1-1 untimed", "start 2-3"));
}

TEST_F(CallsTest, LeavingWhatWasNotEnteredIsCounted) {
    leave("start");
    enter("stop");
    leave("start");
    leave("stop");
    EXPECT_EQ(calls.strayLeaves(), 2u);
    EXPECT_THAT(ended.spans, ElementsAre("stop 2-4"));
}

TEST_F(CallsTest, TheEndOfTheLogEndsWhatIsOpen) {
    enter("finalize");
    enter("release");
    EXPECT_THAT(ended.spans, IsEmpty());
    calls.finish();
    EXPECT_THAT(ended.spans, ElementsAre("release 2-? untimed", "finalize 1-? untimed"));
}

TEST_F(CallsTest, ManyThreadsAreForgottenThatDoNothing) {
    enter("prepare", 1);
    const int threads = static_cast<int>(Calls::kMaxThreads) + 10;
    for (int tid = 2; tid < threads; ++tid) log("something", tid);
    leave("prepare", 1);
    EXPECT_THAT(ended.spans, SizeIs(1));
    EXPECT_EQ(calls.strayLeaves(), 0u);
}

}  // namespace
}  // namespace orvtrace
