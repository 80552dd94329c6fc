// SPDX-License-Identifier: Apache-2.0
#include "AllocationFailure.h"
#include "JniFixture.h"
#include "dispatch/SyncToAsync.h"
#include "jni/PlayerContext.h"

namespace orvtest {
namespace {

using android::getMediaService;
using android::OrvMediaService;
using android::sp;

ExpectedLine dispatcherLine(const std::string& text) {
    return info("SyncToAsync::" + text).tagged("ORV::SyncToAsync");
}

// Joins lists of lines.
std::vector<ExpectedLine> lines(std::initializer_list<std::vector<ExpectedLine>> parts) {
    std::vector<ExpectedLine> all;
    for (const auto& part : parts) all.insert(all.end(), part.begin(), part.end());
    return all;
}

ExpectedLine posterLine(const char* word) {
    return bridgeInfo(
        std::string("MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz): ") +
        word + "\n");
}

ExpectedLine listenerLine(const char* word) {
    return bridgeInfo(std::string("MediaClientListener::MediaClientListener(JNIEnv, jobject thiz, "
                                  "jobject weak_thiz): ") +
                      word + "\n");
}

// Setup up to the creation of the engine player.
std::vector<ExpectedLine> setupBegins() {
    return {enter("OrvMediaClient_setup"),
            serviceInfo("OrvMediaService::OrvMediaService()"),
            posterLine("Enter"),
            posterLine("Leave"),
            dispatcherLine("addMsgHandler(): Enter"),
            dispatcherLine("addMsgHandler(): Leave"),
            listenerLine("Enter"),
            listenerLine("Leave"),
            serviceInfo("OrvMediaService::setListener()"),
            enter("createPlayer")};
}

std::vector<ExpectedLine> setupEnds() {
    return {enter("setMediaService"), leave("setMediaService"), leave("OrvMediaClient_setup")};
}

Expected wholeSetup() {
    return ReturnsNothing()
        .logs(lines({setupBegins(),
                     {serviceInfo("OrvMediaService::attachPlayer(player)"), leave("createPlayer")},
                     setupEnds()}))
        .makesGlobals(2);
}

// Release from the abort on, up to the leave line.
std::vector<ExpectedLine> takesApart() {
    return {dispatcherLine("abortAllActions(): Enter"),
            dispatcherLine("abortAllActions(): Leave"),
            dispatcherLine("delMsgHandler(): Enter"),
            dispatcherLine("m_deleteMsgHandler(): Enter"),
            enter("MsgDispatcher::~MsgDispatcher"),
            leave("MsgDispatcher::~MsgDispatcher"),
            dispatcherLine("m_deleteMsgHandler(): Leave"),
            dispatcherLine("delMsgHandler(): leave"),
            serviceInfo("OrvMediaService::setListener()"),
            enter("MediaClientListener::~MediaClientListener"),
            leave("MediaClientListener::~MediaClientListener"),
            serviceInfo("OrvMediaService::disconnect()")};
}

std::vector<ExpectedLine> releaseBegins() {
    return {enter("OrvMediaClient_release"), enter("decVideoSurfaceRef"),
            leave("decVideoSurfaceRef"),     enter("setMediaService"),
            leave("setMediaService"),        serviceInfo("OrvMediaService::release()")};
}

// The service goes last, with the native method's own reference.
std::vector<ExpectedLine> releaseEnds() {
    return {leave("OrvMediaClient_release"), serviceInfo("OrvMediaService::~OrvMediaService()"),
            serviceInfo("setNotifyCallback")};
}

std::vector<ExpectedLine> releaseWithoutService() {
    return {enter("OrvMediaClient_release"), enter("decVideoSurfaceRef"), enter("setMediaService"),
            leave("setMediaService"), leave("OrvMediaClient_release")};
}

class PlayerContextTest : public JniFixture {
protected:
    Outcome setup() {
        jobject weak = vm.local(vm.newObject("java/lang/ref/WeakReference"));
        return call<void>("native_setup", "(Ljava/lang/Object;)V", weak);
    }
    Outcome release() { return call<void>("native_release", "()V"); }
    Outcome reset() { return call<void>("native_reset", "()V"); }
    Outcome finalize() { return call<void>("native_finalize", "()V"); }

    jlong context() { return player->get("mNativeContext").integer; }
    sp<OrvMediaService> service() { return getMediaService(vm.env(), vm.local(player)); }
};

TEST_F(PlayerContextTest, SetupWiresAServiceToTheJavaObject) {
    EXPECT_THAT(setup(), wholeSetup());
    EXPECT_EQ(ScriptedEngine::live(), 1);
    EXPECT_EQ(ScriptedEngine::last()->decoder(), -1);
    EXPECT_NE(ScriptedEngine::last()->listener(), nullptr);
    EXPECT_TRUE(service()->isPlayerExists());
}

TEST_F(PlayerContextTest, FieldHoldsTheServicesAddressAndOneReference) {
    setUpPlayer();
    const sp<OrvMediaService> held = service();
    EXPECT_EQ(context(), static_cast<jlong>(reinterpret_cast<uintptr_t>(held.get())));
    // The Java object's, the event handler's and this test's.
    EXPECT_EQ(held->getStrongCount(), 3);
}

TEST_F(PlayerContextTest, ReleaseTakesEverythingApartInOrder) {
    setUpPlayer();
    EXPECT_THAT(release(), ReturnsNothing()
                               .logs(lines({releaseBegins(), takesApart(), releaseEnds()}))
                               .engine({"release()"})
                               .makesGlobals(-2));
    EXPECT_EQ(context(), 0);
    EXPECT_EQ(ScriptedEngine::live(), 0);
}

TEST_F(PlayerContextTest, EveryFailureOfReleaseThrowsAndCarriesOn) {
    for (int status : {-19, -1, 1}) {
        setUpPlayer().answer("release", {status});
        EXPECT_THAT(
            release(),
            ReturnsNothing()
                .logs(lines({releaseBegins(),
                             {bridgeError("OrvMediaClient_release(): throw exception. Line:%d\n")},
                             takesApart(),
                             releaseEnds()}))
                .throws(kIllegalState)
                .engine({"release()"})
                .makesGlobals(-2));
        EXPECT_EQ(context(), 0);
    }
}

TEST_F(PlayerContextTest, SecondReleaseLogsEnterAndLeaveOnly) {
    setUpPlayer();
    release();
    EXPECT_THAT(release(), ReturnsNothing().logs(releaseWithoutService()));
}

TEST_F(PlayerContextTest, FinalizeWithoutReleaseWarnsAndReleases) {
    setUpPlayer();
    const std::vector<ExpectedLine> begins = {
        enter("OrvMediaClient_finalize"),
        bridgeWarning("OrvMediaClient_finalize(): MediaPlayer finalized without being released")};
    EXPECT_THAT(finalize(), ReturnsNothing()
                                .logs(lines({begins,
                                             releaseBegins(),
                                             takesApart(),
                                             releaseEnds(),
                                             {leave("OrvMediaClient_finalize")}}))
                                .engine({"release()"})
                                .makesGlobals(-2));
    EXPECT_EQ(context(), 0);
}

TEST_F(PlayerContextTest, FinalizeAfterReleaseDoesNotWarn) {
    setUpPlayer();
    release();
    EXPECT_THAT(finalize(), ReturnsNothing().logs(lines({{enter("OrvMediaClient_finalize")},
                                                         releaseWithoutService(),
                                                         {leave("OrvMediaClient_finalize")}})));
}

TEST_F(PlayerContextTest, SecondSetupOnlyDropsTheOldReference) {
    setUpPlayer();
    sp<OrvMediaService> first = service();
    EXPECT_THAT(setup(), wholeSetup());  // not a line about the first one
    EXPECT_NE(service(), first);
    EXPECT_EQ(first->getStrongCount(), 2);  // the event handler's and this test's
    EXPECT_EQ(ScriptedEngine::live(), 2);
    EXPECT_THAT(ScriptedEngine::all()[0]->calls(), testing::IsEmpty());

    // Java cannot release the first one any more; its registration keeps it.
    ORV::SyncToAsync::getInstance()->delMsgHandler(first);
}

TEST_F(PlayerContextTest, SetupWithoutMemoryForTheServiceChangesNothing) {
    setUpPlayer();
    const jlong before = context();
    AllocationFailure failure = AllocationFailure::of<OrvMediaService>();
    EXPECT_THAT(setup(), ReturnsNothing()
                             .logs({enter("OrvMediaClient_setup"),
                                    bridgeError("OrvMediaClient_setup(): out of memory, new "
                                                "OrvMediaService failed, throw exception\n")})
                             .throws(kRuntime, "Out of memory"));
    EXPECT_EQ(context(), before);
    EXPECT_EQ(failure.failed(), 1);
}

TEST_F(PlayerContextTest, SetupWithoutMemoryForTheEngineAttachesTheServiceAlone) {
    // Setup goes on behind the exception, and writes the Java field.
    vm.tolerate("LongField: called with a pending java/lang/RuntimeException");
    {
        AllocationFailure failure = AllocationFailure::of<android::TarnPlayer>();
        EXPECT_THAT(setup(),
                    ReturnsNothing()
                        .logs(lines({setupBegins(),
                                     {bridgeError("createPlayer(): out of memory, new TarnPlayer "
                                                  "failed, throw exception\n")},
                                     setupEnds()}))
                        .throws(kRuntime, "Out of memory")
                        .makesGlobals(2));
    }
    EXPECT_FALSE(service()->isPlayerExists());
    // Without an engine every operation answers that it is not initialised.
    EXPECT_THAT(release().thrown, testing::Optional(fakejni::Thrown{kIllegalState, {}}));
    EXPECT_EQ(context(), 0);
}

TEST_F(PlayerContextTest, CreatePlayerWithoutServiceOrEnvironmentLogs) {
    EXPECT_THAT(
        observeAction([&] { android::createPlayer(vm.env(), nullptr, E_ORV_PLAYER_TYPE_TARN); }),
        ReturnsNothing().logs(
            {enter("createPlayer"), bridgeError("createPlayer(): OrvMediaService==NULL\n")}));
    sp<OrvMediaService> made = new OrvMediaService;
    EXPECT_THAT(
        observeAction([&] { android::createPlayer(nullptr, made, E_ORV_PLAYER_TYPE_TARN); }),
        ReturnsNothing().logs({enter("createPlayer"), bridgeError("createPlayer(): env==NULL\n")}));
    EXPECT_THAT(
        observeAction([&] { android::createPlayer(nullptr, nullptr, E_ORV_PLAYER_TYPE_TARN); }),
        ReturnsNothing().logs(
            {enter("createPlayer"), bridgeError("createPlayer(): OrvMediaService==NULL\n")}));
    EXPECT_THAT(ScriptedEngine::all(), testing::IsEmpty());
}

TEST_F(PlayerContextTest, CreatePlayerIgnoresTheType) {
    sp<OrvMediaService> made = new OrvMediaService;
    for (int type : {0, 1, 7}) {
        android::createPlayer(vm.env(), made, static_cast<E_OrvPlayer_Type>(type));
        EXPECT_EQ(ScriptedEngine::last()->decoder(), -1);
    }
    EXPECT_EQ(ScriptedEngine::live(), 1);  // each replaced the one before
}

TEST_F(PlayerContextTest, GetMediaServiceIsSilentAndTakesOneReference) {
    setUpPlayer();
    jobject thiz = vm.local(player);
    sp<OrvMediaService> held;
    EXPECT_THAT(observeAction([&] { held = getMediaService(vm.env(), thiz); }), ReturnsNothing());
    EXPECT_EQ(held->getStrongCount(), 3);
    EXPECT_EQ(getMediaService(vm.env(), vm.local(newPlayer())), nullptr);
}

TEST_F(PlayerContextTest, SetMediaServiceSwapsAndReturnsTheOldOneAlive) {
    jobject thiz = vm.local(player);
    sp<OrvMediaService> first = new OrvMediaService;
    sp<OrvMediaService> second = new OrvMediaService;
    sp<OrvMediaService> old;
    const auto set = [&](const sp<OrvMediaService>& next) {
        return observeAction([&] { old = android::setMediaService(vm.env(), thiz, next); });
    };
    const Expected swapped =
        ReturnsNothing().logs({enter("setMediaService"), leave("setMediaService")});

    EXPECT_THAT(set(first), swapped);
    EXPECT_EQ(old, nullptr);
    EXPECT_EQ(first->getStrongCount(), 2);
    EXPECT_THAT(set(second), swapped);
    EXPECT_EQ(old, first);
    EXPECT_EQ(first->getStrongCount(), 2);  // this test's and the returned one
    EXPECT_EQ(second->getStrongCount(), 2);
    EXPECT_THAT(set(nullptr), swapped);
    EXPECT_EQ(old, second);
    EXPECT_EQ(context(), 0);
}

// The field is read before a reference is taken, and written when both have changed.
TEST_F(PlayerContextTest, SetMediaServiceCountsBetweenItsReadAndItsWrite) {
    jobject thiz = vm.local(player);
    sp<OrvMediaService> first = new OrvMediaService;
    sp<OrvMediaService> second = new OrvMediaService;
    android::setMediaService(vm.env(), thiz, first);
    std::vector<int> counts;
    const auto count = [&] {
        counts.push_back(first->getStrongCount());
        counts.push_back(second->getStrongCount());
    };
    vm.whenCalled("GetLongField", count);
    vm.whenCalled("SetLongField", count);
    const sp<OrvMediaService> old = android::setMediaService(vm.env(), thiz, second);
    for (const char* function : {"GetLongField", "SetLongField"}) vm.whenCalled(function, [] {});
    // At the write, the first one has the test's reference and the one to be returned.
    EXPECT_THAT(counts, testing::ElementsAre(2, 1, 2, 2));
    android::setMediaService(vm.env(), thiz, nullptr);
}

TEST_F(PlayerContextTest, ResetForwardsAndKeepsTheService) {
    setUpPlayer();
    EXPECT_THAT(reset(),
                ReturnsNothing()
                    .logs({enter("OrvMediaClient_reset"), serviceInfo("OrvMediaService::reset()"),
                           leave("OrvMediaClient_reset")})
                    .engine({"reset()"}));
    EXPECT_NE(context(), 0);
}

TEST_F(PlayerContextTest, EveryFailureOfResetIsAnIoException) {
    setUpPlayer();
    for (int status : {-38, -1, -19, 1}) {
        engine->answer("reset", {status});
        EXPECT_THAT(reset(), ReturnsNothing()
                                 .logs({enter("OrvMediaClient_reset"),
                                        serviceInfo("OrvMediaService::reset()"),
                                        bridgeInfo("OrvMediaClient_reset(): jniThrowException\n"),
                                        leave("OrvMediaClient_reset")})
                                 .throws(kIo)
                                 .engine({"reset()"}));
        EXPECT_NE(context(), 0);
    }
}

TEST_F(PlayerContextTest, ResetWithoutServiceIsAnIllegalState) {
    EXPECT_THAT(reset(), ReturnsNothing()
                             .logs({enter("OrvMediaClient_reset"),
                                    bridgeError("service not exist, throw exception. Line:%d\n")})
                             .throws(kIllegalState));
}

TEST_F(PlayerContextTest, PlayersAreIndependent) {
    setUpPlayer();
    const fakejni::ObjectPtr other = newPlayer();
    setUp(other);
    release();
    EXPECT_EQ(ScriptedEngine::live(), 1);
    EXPECT_NE(getMediaService(vm.env(), vm.local(other)), nullptr);
}

TEST_F(PlayerContextTest, ThousandsOfPlayersLeaveNothingBehind) {
    const Untraced repeated(*this);
    for (int i = 0; i < 2000; ++i) {
        setUp(player);
        call<void>("native_release", "()V");
        ScriptedEngine::forgetAll();
    }
    EXPECT_EQ(vm.globalReferences(), 0u);
}

}  // namespace
}  // namespace orvtest
