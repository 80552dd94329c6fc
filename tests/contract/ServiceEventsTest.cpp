// SPDX-License-Identifier: Apache-2.0
// Events in the service: its lines, its listener, and the death of the server.
#include <binder/Parcel.h>
#include <jni/media-service/OrvMediaServiceListener.h>
#include <unistd.h>

#include <functional>
#include <sstream>

#include "ServiceFixture.h"

namespace orvtest {
namespace {

using android::OrvMediaService;
using android::Parcel;
using android::sp;
using testing::ElementsAre;
using testing::IsEmpty;

class RecordingListener : public android::OrvMediaServiceListener {
public:
    explicit RecordingListener(std::vector<std::string>* events) : mEvents(events) {}
    ~RecordingListener() override { mEvents->push_back("destroyed"); }

    void notify(int msg, int ext1, int ext2, const Parcel* obj) override {
        std::ostringstream text;
        text << msg << ' ' << ext1 << ' ' << ext2 << ' ' << pointerText(obj);
        mEvents->push_back(text.str());
        if (whenNotified) whenNotified();
        mEvents->push_back("done");
    }

    std::function<void()> whenNotified;

private:
    std::vector<std::string>* mEvents;
};

class ServiceEventsTest : public ServiceFixture {
protected:
    sp<RecordingListener> listen() {
        sp<RecordingListener> listener = new RecordingListener(&events);
        service->setListener(listener);
        log.clear();
        return listener;
    }
    void TearDown() override {
        service->setListener(nullptr);
        ServiceFixture::TearDown();
    }
    // "this=0x..." of the service.
    std::string self() const { return "this=" + pointerText(service.get()); }
    std::vector<ExpectedLine> withCallback(std::vector<ExpectedLine> lines) const {
        lines.push_back(info(" " + self() + ", callback application"));
        lines.push_back(info(" " + self() + ", back from callback"));
        return lines;
    }

    std::vector<std::string> events;
};

// What the service logs of one event; SELF stands for its own address.
struct Event {
    int msg, ext1, ext2;
    std::vector<ExpectedLine> lines;
};
void PrintTo(const Event& event, std::ostream* out) { *out << event.msg << ", " << event.ext1; }

class EventLineTest : public ServiceEventsTest, public testing::WithParamInterface<Event> {
protected:
    std::vector<ExpectedLine> eventLines() const {
        std::vector<ExpectedLine> lines = GetParam().lines;
        for (ExpectedLine& line : lines) {
            line.text.replace(line.text.find("SELF"), 4, self());
            line.tag = "OrvMediaService";
        }
        return lines;
    }
};

TEST_P(EventLineTest, IsLoggedWithoutListener) {
    service->notify(GetParam().msg, GetParam().ext1, GetParam().ext2, nullptr);
    EXPECT_THAT(log.take(), LinesAre(eventLines()));
}

TEST_P(EventLineTest, ReachesTheListener) {
    listen();
    service->notify(GetParam().msg, GetParam().ext1, GetParam().ext2, nullptr);
    EXPECT_THAT(log.take(), LinesAre(withCallback(eventLines())));
    std::ostringstream text;
    text << GetParam().msg << ' ' << GetParam().ext1 << ' ' << GetParam().ext2 << " null";
    EXPECT_THAT(events, ElementsAre(text.str(), "done"));
}

std::vector<Event> everyCode() {
    return {
        {0, 0, 0, {}},
        {1, 5, 6, {info("MEDIA_PREPARED, SELF, prepared")}},
        {2, 5, 6, {info("MEDIA_PLAYBACK_COMPLETE, SELF, playback complete")}},
        {3, 42, 6, {info(" MEDIA_BUFFERING_UPDATE, SELF, buffering 42")}},
        {4, 5, 6, {info(" MEDIA_SEEK_COMPLETE, SELF, Received seek complete")}},
        {5, 1920, 1080, {info(" MEDIA_SET_VIDEO_SIZE, SELF, New video size 1920 x 1080")}},
        {99, 5, 6, {info(" MEDIA_TIMED_TEXT, SELF, Received timed text message")}},
        {100, 1, -1004, {error("MEDIA_ERROR, SELF, error (1, -1004)")}},
        {200, 701, 9, {warning(" MEDIA_INFO, SELF, info/warning (701, 9)")}},
        {200, 700, 0, {}},
        {7, 1, 2, {info(" default, SELF, unrecognized message: (7, 1, 2)")}},
        {700, 3, 4, {info(" default, SELF, unrecognized message: (700, 3, 4)")}},
        {-1, 3, 4, {info(" default, SELF, unrecognized message: (-1, 3, 4)")}},
    };
}

INSTANTIATE_TEST_SUITE_P(Codes, EventLineTest, testing::ValuesIn(everyCode()));

// The lines around the callback say when it runs.
TEST_F(ServiceEventsTest, CallbackRunsBetweenItsLines) {
    sp<RecordingListener> listener = listen();
    listener->whenNotified = [&] {
        EXPECT_THAT(log.take(), LinesAre({info("MEDIA_PREPARED, " + self() + ", prepared"),
                                          info(" " + self() + ", callback application")}));
    };
    service->notify(1, 0, 0, nullptr);
    EXPECT_THAT(log.take(), LinesAre({info(" " + self() + ", back from callback")}));
}

TEST_F(ServiceEventsTest, ListenerIsLookedUpBehindTheEventsLine) {
    listen();
    log.whenLogged(info("MEDIA_PREPARED, " + self() + ", prepared"),
                   [&] { service->setListener(nullptr); });
    service->notify(1, 0, 0, nullptr);
    EXPECT_THAT(events, ElementsAre("destroyed"));
}

TEST_F(ServiceEventsTest, ParcelIsHandedOnAsItCame) {
    listen();
    Parcel parcel;
    service->notify(99, 1, 2, &parcel);
    EXPECT_THAT(events, ElementsAre("99 1 2 " + pointerText(&parcel), "done"));
}

// The service's metadata filters and updates are no matter of its events.
TEST_F(ServiceEventsTest, EventsPassTheMetadataFiltersAndLeaveNoUpdate) {
    attachPlayer();
    listen();
    Parcel filter;
    for (int32_t word : {0, 3, 200, 802, 0}) filter.writeInt32(word);
    filter.setDataPosition(0);
    ASSERT_EQ(service->setMetadataFilter(filter), android::NO_ERROR);
    service->notify(200, 802, 0, nullptr);
    EXPECT_THAT(events, ElementsAre("200 802 0 null", "done"));
    engine->takeCalls();
    Parcel reply;
    service->getMetadata(true, false, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({})"));
}

TEST_F(ServiceEventsTest, ListenerLivesThroughItsOwnRemoval) {
    sp<RecordingListener> listener = listen();
    listener->whenNotified = [this] { service->setListener(nullptr); };
    listener.clear();
    service->notify(1, 0, 0, nullptr);
    EXPECT_THAT(events, ElementsAre("1 0 0 null", "done", "destroyed"));
    service->notify(1, 0, 0, nullptr);
    EXPECT_EQ(events.size(), 3u);
}

TEST_F(ServiceEventsTest, EngineEventsEndInTheEnginesListener) {
    attachPlayer();
    listen();
    Parcel parcel;
    for (int msg : {0, 1, 5, 100, 200}) engine->sendEvent(msg, 1, 2, &parcel);
    EXPECT_THAT(events, IsEmpty());
    EXPECT_THAT(log.take(), IsEmpty());
}

TEST_F(ServiceEventsTest, DeathOfTheServerIsAnErrorEvent) {
    listen();
    service->died();
    EXPECT_THAT(events, ElementsAre("100 100 0 null", "done"));
    std::vector<ExpectedLine> lines =
        withCallback({info("OrvMediaService::died(): died"),
                      error("MEDIA_ERROR, " + self() + ", error (100, 0)")});
    EXPECT_THAT(log.take(), LinesAre(lines));
}

class DiedTest : public ServiceEventsTest {
protected:
    // As before any service of the process was attached or given a listener.
    void SetUp() override {
        service->setListener(nullptr);
        log.clear();
    }
    void expectUnnoticed() {
        service->died();
        EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::died(): died"),
                                          debug("OrvMediaService Issue Handle. Line:1192")}));
    }
    void expectNoticed() {
        service->died();
        EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::died(): died"),
                                          error("MEDIA_ERROR, " + self() + ", error (100, 0)")}));
    }
};

TEST_F(DiedTest, IsNotSentWhileNoServiceIsWired) { expectUnnoticed(); }

TEST_F(DiedTest, IsSentOnceAPlayerIsAttached) {
    attachPlayer();
    expectNoticed();
}

TEST_F(DiedTest, IsSentForWhicheverServiceIsWired) {
    sp<OrvMediaService> other = new OrvMediaService;
    other->setListener(new RecordingListener(&events));
    log.clear();
    expectNoticed();
    EXPECT_THAT(events, IsEmpty());
}

TEST_F(DiedTest, IsNotSentAfterAnyServiceLostItsListener) {
    attachPlayer();
    sp<RecordingListener> listener = listen();
    sp<OrvMediaService> other = new OrvMediaService;
    other->setListener(nullptr);
    log.clear();
    expectUnnoticed();
    EXPECT_THAT(events, IsEmpty());
}

// In a process of its own, where no service was ever wired.
TEST(FirstDiedTest, IsNotSentBeforeAnyServiceWasWired) {
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    const auto die = [] {
        LogCapture log;
        sp<OrvMediaService> service = new OrvMediaService;
        log.clear();
        service->died();
        const auto unnoticed = LinesAre({info("OrvMediaService::died(): died"),
                                         debug("OrvMediaService Issue Handle. Line:1192")});
        _exit(testing::Value(log.take(), unnoticed) ? 0 : 1);
    };
    EXPECT_EXIT(die(), testing::ExitedWithCode(0), "");
}

}  // namespace
}  // namespace orvtest
