// SPDX-License-Identifier: Apache-2.0
// What the service keeps to itself: settings that no operation gives back, and
// the two values that all services share.
#include <jni/media-service/OrvMediaServiceListener.h>

#include "PrivateMember.h"
#include "ServiceFixture.h"

namespace orvtest {

using android::OrvMediaService;

ORV_OPEN_MEMBER(StreamType, OrvMediaService, mStreamType);
ORV_OPEN_MEMBER(Speed, OrvMediaService, mSpeed);
ORV_OPEN_MEMBER(Loop, OrvMediaService, mLoop);
ORV_OPEN_MEMBER(ServiceFlag, OrvMediaService, sServiceFlag);
ORV_OPEN_MEMBER(NotifyCookie, OrvMediaService, sNotifyCookie);

namespace {

using android::sp;
using android::TarnPlayer;
using testing::ElementsAre;

class ServiceStateTest : public ServiceFixture {
protected:
    int32_t streamType() const { return service.get()->*memberOf(StreamType{}); }
    int32_t speed() const { return service.get()->*memberOf(Speed{}); }
    bool loop() const { return service.get()->*memberOf(Loop{}); }

    static os::Relaxed<bool>& flag() { return *memberOf(ServiceFlag{}); }
    static uint64_t cookie() { return *memberOf(NotifyCookie{}); }
    static uint64_t addressOf(const sp<OrvMediaService>& object) {
        return reinterpret_cast<uintptr_t>(object.get());
    }
};

TEST_F(ServiceStateTest, StreamTypeIsMusicUntilAPlayersIsSet) {
    EXPECT_EQ(streamType(), 3);
    EXPECT_EQ(service->setAudioStreamType(5), android::NO_INIT);
    EXPECT_EQ(streamType(), 3);
    attachPlayer();
    EXPECT_EQ(service->setAudioStreamType(5), android::NO_ERROR);
    EXPECT_EQ(streamType(), 5);
}

TEST_F(ServiceStateTest, SpeedIsKeptBeforeTheEngineIsAsked) {
    EXPECT_EQ(speed(), 0);
    EXPECT_EQ(service->setSpeed(2000), android::UNKNOWN_ERROR);
    EXPECT_EQ(speed(), 0);
    attachPlayer().answer("setSpeed", {-38});
    engine->whenCalled("setSpeed", [&] { EXPECT_EQ(speed(), 2000); });
    EXPECT_EQ(service->setSpeed(2000), -38);
    EXPECT_EQ(speed(), 2000);
    EXPECT_THAT(engine->calls(), ElementsAre("setSpeed(2000)"));
}

TEST_F(ServiceStateTest, LoopingIsKeptBeforeTheEngineIsAsked) {
    attachPlayer();
    engine->whenCalled("setLooping", [&] { EXPECT_TRUE(loop()); });
    service->setLooping(1);
    EXPECT_THAT(engine->calls(), ElementsAre("setLooping(1)"));
}

class SilentListener : public android::OrvMediaServiceListener {
public:
    void notify(int, int, int, const android::Parcel*) override {}
};

TEST_F(ServiceStateTest, CookieIsTheServiceWiredLast) {
    const sp<OrvMediaService> other = new OrvMediaService;
    service->attachPlayer(new TarnPlayer(-1));
    EXPECT_EQ(cookie(), addressOf(service));
    other->attachPlayer(new TarnPlayer(-1));
    EXPECT_EQ(cookie(), addressOf(other));
    service->setListener(new SilentListener);
    EXPECT_EQ(cookie(), addressOf(service));
    other->setListener(new SilentListener);
    EXPECT_EQ(cookie(), addressOf(other));
    service->setListener(nullptr);
    EXPECT_EQ(cookie(), 0u);
}

// Reads the cookie as it goes.
class LeavingListener : public SilentListener {
public:
    explicit LeavingListener(std::function<void()> leave) : mLeave(std::move(leave)) {}
    ~LeavingListener() override { mLeave(); }

private:
    const std::function<void()> mLeave;
};

TEST_F(ServiceStateTest, TheOldListenerGoesBeforeTheCookieChanges) {
    uint64_t then = 0;
    service->setListener(new LeavingListener([&] { then = cookie(); }));
    service->setListener(nullptr);
    EXPECT_EQ(then, addressOf(service));
}

TEST_F(ServiceStateTest, TheEngineGoesBeforeTheServicesListener) {
    attachPlayer();
    int engines = -1;
    service->setListener(new LeavingListener([&] { engines = ScriptedEngine::live(); }));
    service.clear();
    EXPECT_EQ(engines, 0);
}

TEST_F(ServiceStateTest, TheEnginesListenerIsTakenBackBehindItsLine) {
    attachPlayer();
    bool hadListener = false;
    log.whenLogged(info("setNotifyCallback"), [&] { hadListener = engine->listener() != nullptr; });
    service.clear();
    EXPECT_TRUE(hadListener);
}

TEST_F(ServiceStateTest, FlagFollowsConstructionAndAnyDestruction) {
    flag() = false;
    sp<OrvMediaService> other = new OrvMediaService;
    EXPECT_TRUE(flag());
    other.clear();
    EXPECT_FALSE(flag());
}

TEST_F(ServiceStateTest, EveryDataSourceThatReachesAPlayerSetsTheFlag) {
    const std::function<void()> sources[] = {
        [&] { service->setDataSource("/a.mp4", nullptr); },
        [&] { service->setDataSource(7, 0, 9); },
        [&] { service->setDataSource(static_cast<android::IStreamSource*>(nullptr)); },
        [&] { service->setDataSource(static_cast<IOrvStreamSource*>(nullptr)); },
    };
    for (const bool player : {false, true}) {
        if (player) attachPlayer();
        for (const auto& set : sources) {
            flag() = false;
            set();
            EXPECT_EQ(flag(), player) << "source " << &set - sources;
        }
    }
    flag() = false;
    service->setDataSource(static_cast<const char*>(nullptr), nullptr);
    EXPECT_FALSE(flag());
}

}  // namespace
}  // namespace orvtest
