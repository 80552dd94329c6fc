// SPDX-License-Identifier: Apache-2.0
#include <string.h>

#include <set>

#include "AllocationFailure.h"
#include "PlaybackCommandTable.h"
#include "ServiceFailure.h"

namespace orvtest {
namespace {

std::string shortName(const std::string& function) {
    return function.substr(strlen("OrvMediaClient_"));
}

class PlaybackCommandTest : public JniFixture, public testing::WithParamInterface<Command> {};

TEST_P(PlaybackCommandTest, ForwardsToTheService) {
    const Command& command = GetParam();
    setUpPlayer();
    EXPECT_THAT(command.call(*this),
                Returns(command.good).logs(command.whole()).engine(command.engine));
}

TEST_P(PlaybackCommandTest, WithoutServiceIsAnIllegalState) {
    const Command& command = GetParam();
    const bool headers = command.function == "OrvMediaClient_setDataSourceAndHeaders";
    std::vector<ExpectedLine> lines = command.first();
    lines.push_back(
        bridgeError(headers ? "service not exist, throw exception. Line:%d \n" : kMissingLine));
    EXPECT_THAT(command.call(*this), Returns(command.zero).logs(lines).throws(kIllegalState));
}

TEST_P(PlaybackCommandTest, ReleasedPlayerHasNoService) {
    setUpPlayer();
    call<void>("native_release", "()V");
    EXPECT_THAT(GetParam().call(*this).thrown,
                testing::Optional(fakejni::Thrown{kIllegalState, {}}));
}

INSTANTIATE_TEST_SUITE_P(Commands, PlaybackCommandTest, testing::ValuesIn(playbackCommands()),
                         [](const testing::TestParamInfo<Command>& info) {
                             return shortName(info.param.function);
                         });

// A command whose failure goes through the status mapping.
struct Failure {
    const char* function;
    const char* operation;  // the engine's
    const char* exception;
    const char* message;  // null for none
};
void PrintTo(const Failure& failure, std::ostream* out) { *out << failure.function; }

const Failure kFailures[] = {
    {"setDataSourceAndHeaders", "setDataSource", kIo, "setDataSource failed."},
    {"setDataSourceFD", "setDataSource", kIo, "setDataSourceFD failed."},
    {"prepare", "prepare", kIo, "Prepare failed."},
    {"prepareAsync", "prepareAsync", kIo, "Prepare Async failed."},
    {"start", "start", kIllegalState, nullptr},
    {"stop", "stop", kIllegalState, nullptr},
    {"pause", "pause", kIo, "pause failed."},
    {"getCurrentPosition", "getCurrentPosition", kIo, "getCurrentPosition failed."},
    {"setLooping", "setLooping", kIo, "OrvMediaClient_setLooping failed."},
    {"setVolume", "setVolume", kIo, "OrvMediaClient_setVolume failed."},
};

class PlaybackFailureTest : public JniFixture, public testing::WithParamInterface<Failure> {
protected:
    // The command's expected outcome but for what it throws.
    Expected failing(const std::string& mapping) {
        const Command command = playbackCommand(GetParam().function);
        return Returns(command.good)
            .logs(command.whole(
                {bridgeError("process_media_player_call(): " + mapping + ", throw exception\n")}))
            .engine(command.engine);
    }
    Outcome run(int status) {
        setUpPlayer().answer(GetParam().operation, {status});
        return playbackCommand(GetParam().function).call(*this);
    }
};

TEST_P(PlaybackFailureTest, InvalidOperationIsAnIllegalState) {
    EXPECT_THAT(run(-38), failing("INVALID_OPERATION").throws(kIllegalState));
}

TEST_P(PlaybackFailureTest, PermissionDeniedIsASecurityException) {
    EXPECT_THAT(run(-1), failing("PERMISSION_DENIED").throws(kSecurity));
}

TEST_P(PlaybackFailureTest, OtherStatusIsTheCommandsOwnException) {
    const Failure& failure = GetParam();
    if (failure.message == nullptr) {
        EXPECT_THAT(run(-1004), failing("else 3").throws(failure.exception));
    } else {
        EXPECT_THAT(run(-1004),
                    failing("else 2").throws(failure.exception,
                                             std::string(failure.message) + ": status=0xFFFFFC14"));
    }
}

INSTANTIATE_TEST_SUITE_P(Commands, PlaybackFailureTest, testing::ValuesIn(kFailures),
                         [](const testing::TestParamInfo<Failure>& info) {
                             return std::string(info.param.function);
                         });

class PlaybackCommandsTest : public JniFixture {
protected:
    Outcome run(const std::string& function) { return playbackCommand(function).call(*this); }

    // A player whose service has no engine player.
    void setUpWithoutEngine() {
        // Setup goes on behind the exception, and writes the Java field.
        vm.tolerate("LongField: called with a pending java/lang/RuntimeException");
        AllocationFailure failure = AllocationFailure::of<android::TarnPlayer>();
        jobject weak = vm.local(vm.newObject("java/lang/ref/WeakReference"));
        call<void>("native_setup", "(Ljava/lang/Object;)V", weak);
    }
};

TEST_F(PlaybackCommandsTest, MissingServiceLinesDifferBetweenCommands) {
    std::set<int> numbers;
    for (const Command& command : playbackCommands()) {
        for (int number : lineNumbers(command.call(*this).log)) numbers.insert(number);
    }
    EXPECT_EQ(numbers.size(), playbackCommands().size());
}

TEST_F(PlaybackCommandsTest, PrepareGoesOnWhenTheSurfaceIsRefused) {
    setUpPlayer().answer("setVideoSurfaceTexture", {-22});
    EXPECT_THAT(run("prepare"), ReturnsNothing()
                                    .logs(playbackCommand("prepare").whole())
                                    .engine({"setVideoSurfaceTexture(null)", "prepare()"}));
}

TEST_F(PlaybackCommandsTest, EveryFailureOfSeekIsAnIllegalState) {
    for (int status : {-1, -38, -1004, 1}) {
        setUpPlayer().answer("seekTo", {status});
        EXPECT_THAT(
            run("seekTo"),
            ReturnsNothing()
                .logs({enter("OrvMediaClient_seekTo"), service("seekTo(1500)"),
                       bridgeInfo("OrvMediaClient_seekTo(): " + std::to_string(status) + "\n"),
                       bridgeError("OrvMediaClient_seekTo(): throw exception\n"),
                       leave("OrvMediaClient_seekTo")})
                .engine({"seekTo(1500, 0)"})
                .throws(kIllegalState));
        call<void>("native_release", "()V");
    }
}

TEST_F(PlaybackCommandsTest, VideoSizeIsTheEnginesWhateverItsStatus) {
    for (int status : {0, -38}) {
        setUpPlayer();
        engine->put("getVideoWidth", 1920);
        engine->put("getVideoHeight", 1080);
        engine->answer("getVideoWidth", {status});
        engine->answer("getVideoHeight", {status});
        EXPECT_EQ(run("getVideoWidth").returned, "1920");
        EXPECT_EQ(run("getVideoHeight").returned, "1080");
        EXPECT_FALSE(run("getVideoHeight").thrown);
        call<void>("native_release", "()V");
    }
}

TEST_F(PlaybackCommandsTest, PositionIsReturnedAlsoWithAnException) {
    setUpPlayer().put("getCurrentPosition", 4200);
    EXPECT_EQ(run("getCurrentPosition").returned, "4200");
    engine->answer("getCurrentPosition", {-1004});
    const Outcome failed = run("getCurrentPosition");
    EXPECT_EQ(failed.returned, "4200");
    EXPECT_THAT(failed.thrown, testing::Optional(fakejni::Thrown{
                                   kIo, "getCurrentPosition failed.: status=0xFFFFFC14"}));
}

TEST_F(PlaybackCommandsTest, DurationIsTheEnginesWhateverItsStatus) {
    for (int status : {0, -38}) {
        setUpPlayer().put("getDuration", 90000);
        engine->answer("getDuration", {status});
        EXPECT_THAT(run("getDuration"),
                    Returns("90000")
                        .logs({enter("OrvMediaClient_getDuration"), service("getDuration()"),
                               serviceError("OrvMediaService::getDuration(): 90000"),
                               bridgeInfo("OrvMediaClient_getDuration(): 90000 (msec)"),
                               leave("OrvMediaClient_getDuration")})
                        .engine({"getDuration()"}));
        call<void>("native_release", "()V");
    }
}

TEST_F(PlaybackCommandsTest, DurationWithoutEngineIsZero) {
    setUpWithoutEngine();
    EXPECT_THAT(run("getDuration"),
                Returns("0").logs({enter("OrvMediaClient_getDuration"), service("getDuration()"),
                                   serviceError("OrvMediaService::getDuration(): NO_INIT"),
                                   bridgeInfo("OrvMediaClient_getDuration(): 0 (msec)"),
                                   leave("OrvMediaClient_getDuration")}));
}

TEST_F(PlaybackCommandsTest, IsPlayingIsTheEnginesAnswer) {
    setUpPlayer().answer("isPlaying", {0});
    EXPECT_EQ(run("isPlaying").returned, "false");
}

TEST_F(PlaybackCommandsTest, LoopingIsRemembered) {
    setUpPlayer();
    run("setLooping");
    EXPECT_EQ(run("isLooping").returned, "true");
    EXPECT_THAT(call<void>("native_setLooping", "(Z)V", jboolean(0)).engine,
                testing::ElementsAre("setLooping(0)"));
    EXPECT_EQ(run("isLooping").returned, "false");
}

TEST_F(PlaybackCommandsTest, AudioSessionIsRemembered) {
    setUpPlayer();
    run("set_audio_session_id");
    EXPECT_EQ(run("get_audio_session_id").returned, "7");
}

TEST_F(PlaybackCommandsTest, NegativeAudioSessionIsAnIoException) {
    setUpPlayer();
    EXPECT_THAT(call<void>("native_setAudioSessionId", "(I)V", -1),
                ReturnsNothing()
                    .logs({enter("OrvMediaClient_set_audio_session_id"),
                           service("setAudioSessionId(-1), not implement"),
                           bridgeError("process_media_player_call(): else 2, throw exception\n"),
                           leave("OrvMediaClient_set_audio_session_id")})
                    .throws(kIo,
                            "OrvMediaClient_set_audio_session_id failed.: "
                            "status=0xFFFFFFEA"));
}

TEST_F(PlaybackCommandsTest, FailedEffectsAreIoExceptions) {
    setUpPlayer();
    const ServiceFailure failure(-19);
    const auto failed = [](const std::string& name) {
        return ReturnsNothing().logs(playbackCommand(name).whole(
            {bridgeError("process_media_player_call(): else 2, throw exception\n")}));
    };
    EXPECT_THAT(
        run("setAuxEffectSendLevel"),
        failed("setAuxEffectSendLevel")
            .throws(kIo, "OrvMediaClient_setAuxEffectSendLevel failed.: status=0xFFFFFFED"));
    // The message of another command, as it is.
    EXPECT_THAT(
        run("attachAuxEffect"),
        failed("attachAuxEffect").throws(kIo, "getCurrentBytePosition failed.: status=0xFFFFFFED"));
}

TEST_F(PlaybackCommandsTest, AudioStreamTypeWithoutEngineIsAnIoException) {
    setUpWithoutEngine();
    EXPECT_THAT(
        run("setAudioStreamType"),
        ReturnsNothing()
            .logs({enter("OrvMediaClient_setAudioStreamType"), service("setAudioStreamType()"),
                   serviceError("OrvMediaService::setAudioStreamType(): NO_INIT"),
                   bridgeError("process_media_player_call(): else 2, throw exception\n"),
                   leave("OrvMediaClient_setAudioStreamType")})
            .throws(kIo, "OrvMediaClient_setAudioStreamType failed.: status=0xFFFFFFED"));
}

TEST_F(PlaybackCommandsTest, FrameIsNullWithAndWithoutService) {
    const auto getFrame = [&] {
        return call<jobject>("native_getFrameAt", "(I)Landroid/graphics/Bitmap;", 5);
    };
    const Expected null = Returns("null").logs({occur("OrvMediaClient_getFrameAt")});
    EXPECT_THAT(getFrame(), null);
    setUpPlayer();
    EXPECT_THAT(getFrame(), null);
    EXPECT_THAT(vm.callsOf("GetLongField"), testing::IsEmpty()) << "the service was looked up";
}

// Its destructor runs behind the command, on the command's thread.
TEST_F(PlaybackCommandsTest, ServiceOutlivesAReleaseDuringTheCall) {
    setUpPlayer();
    engine->whenCalled("start", [&] {
        vm.onJavaThread([&] {
            fakejni::callNative<void>(vm, playerClass, vm.local(player), "native_release", "()V");
        });
        EXPECT_EQ(ScriptedEngine::live(), 1);
    });
    std::vector<ExpectedLine> lines = playbackCommand("start").whole();
    lines.push_back(service("~OrvMediaService()"));
    lines.push_back(serviceInfo("setNotifyCallback"));
    // The release gives the two references of the events' poster up.
    EXPECT_THAT(run("start"),
                ReturnsNothing().logs(lines).engine({"start()", "release()"}).makesGlobals(-2));
    EXPECT_EQ(ScriptedEngine::live(), 0);
}

class AudioTrackTest : public PlaybackCommandsTest {
protected:
    Outcome select() { return call<jboolean>("native_setAudioTrack", "(I)Z", 2); }
    const std::vector<ExpectedLine> begin = {
        enter("OrvMediaClient_setAudioTrack"),
        bridgeInfo("OrvMediaClient_setAudioTrack(): track num = 2\n")};
    std::vector<ExpectedLine> lines(std::vector<ExpectedLine> rest) {
        rest.insert(rest.begin(), begin.begin(), begin.end());
        return rest;
    }
};

TEST_F(AudioTrackTest, IsSelected) {
    setUpPlayer();
    EXPECT_THAT(
        select(),
        Returns("true")
            .logs(lines({service("setAudioTrack(2)"), leave("OrvMediaClient_setAudioTrack")}))
            .engine({"selectAudioTrack(2)"}));
}

TEST_F(AudioTrackTest, RefusalLogsTheMissingServiceAndNeverThrows) {
    setUpPlayer().answer("selectAudioTrack", {0});
    EXPECT_THAT(select(), Returns("false")
                              .logs(lines({service("setAudioTrack(2)"), bridgeError(kMissingLine)}))
                              .engine({"selectAudioTrack(2)"}));
}

TEST_F(AudioTrackTest, MissingServiceNeverThrows) {
    const Outcome missing = select();
    EXPECT_THAT(missing, Returns("false").logs(lines({bridgeError(kMissingLine)})));
    setUpPlayer().answer("selectAudioTrack", {0});
    EXPECT_NE(lineNumbers(select().log), lineNumbers(missing.log));
}

}  // namespace
}  // namespace orvtest
