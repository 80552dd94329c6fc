// SPDX-License-Identifier: Apache-2.0
#include "PlaybackCommandTable.h"

#include <algorithm>

namespace orvtest {

jobject newParcel(JniFixture& test) {
    return test.vm.local(test.vm.newObject("android/os/Parcel"));
}

ExpectedLine service(const std::string& operation) {
    return serviceInfo("OrvMediaService::" + operation);
}

namespace {

template <typename R, typename... A>
Call calling(const char* name, const char* signature, A... args) {
    return [=](JniFixture& test) { return test.call<R>(name, signature, args...); };
}

// A command without arguments and result that forwards to one operation.
Command transport(const char* operation) {
    Command command;
    command.function = std::string("OrvMediaClient_") + operation;
    const std::string name = std::string("native_") + operation;
    command.call = [name](JniFixture& test) { return test.call<void>(name, "()V"); };
    command.body = {service(std::string(operation) + "()")};
    command.engine = {std::string(operation) + "()"};
    return command;
}

Command prepare() {
    Command command = transport("prepare");
    command.body = {service("setVideoSurfaceTexture()"), service("prepare()")};
    command.engine = {"setVideoSurfaceTexture(null)", "prepare()"};
    return command;
}

Command command(const char* function, Call call, std::vector<ExpectedLine> body,
                std::vector<std::string> engine) {
    Command made;
    made.function = std::string("OrvMediaClient_") + function;
    made.call = std::move(call);
    made.body = std::move(body);
    made.engine = std::move(engine);
    return made;
}

Command returning(Command command, const char* good, const char* zero) {
    command.good = good;
    command.zero = zero;
    return command;
}

Command silent(Command command) {
    command.hasLines = false;
    return command;
}

Command occurring(Command command) {
    command.occurs = true;
    return command;
}

Command setDataSourceWithHeaders() {
    return command(
        "setDataSourceAndHeaders",
        [](JniFixture& test) {
            return test.call<void>("native_setDataSource",
                                   "(Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V",
                                   test.string("/a.mp4"), jobjectArray(), jobjectArray());
        },
        {service("setDataSource(/a.mp4)")}, {"configPlayer(false)", "setDataSource(/a.mp4, null)"});
}

Command setDataSourceFd() {
    return command("setDataSourceFD",
                   [](JniFixture& test) {
                       return test.call<void>("native_setDataSource",
                                              "(Ljava/io/FileDescriptor;JJ)V",
                                              test.vm.local(newFileDescriptor(test.vm, 5)),
                                              jlong(0x100000002), jlong(0x7ffffffffffffff));
                   },
                   {}, {"setDataSource(5, 4294967298, 576460752303423487)"});
}

Command inert(const char* function, Call call, const char* good, const char* zero) {
    return occurring(returning(command(function, std::move(call), {}, {}), good, zero));
}

Command setAudioStreamType() {
    return command("setAudioStreamType", calling<void>("native_setAudioStreamType", "(I)V", 3),
                   {service("setAudioStreamType()")}, {});
}

Command setLooping() {
    return command("setLooping", calling<void>("native_setLooping", "(Z)V", jboolean(1)),
                   {service("setLooping(1)")}, {"setLooping(1)"});
}

Command setVolume() {
    return command("setVolume", calling<void>("native_setVolume", "(FF)V", 0.5f, 0.25f),
                   {service("setVolume(0.500000, 0.250000)")}, {"setVolume(0.5, 0.25)"});
}

Command setAudioSessionId() {
    return command("set_audio_session_id", calling<void>("native_setAudioSessionId", "(I)V", 7),
                   {service("setAudioSessionId(7), not implement")}, {});
}

Command getCurrentPosition() {
    return silent(
        returning(command("getCurrentPosition", calling<jint>("native_getCurrentPosition", "()I"),
                          {}, {"getCurrentPosition()"}),
                  "0", "0"));
}

Command seekTo() {
    return command("seekTo", calling<void>("native_seekTo", "(I)V", 1500),
                   {service("seekTo(1500)"), bridgeInfo("OrvMediaClient_seekTo(): 0\n")},
                   {"seekTo(1500, 0)"});
}

Command getDuration() {
    return returning(
        command("getDuration", calling<jint>("native_getDuration", "()I"),
                {service("getDuration()"), serviceError("OrvMediaService::getDuration(): 0"),
                 bridgeInfo("OrvMediaClient_getDuration(): 0 (msec)")},
                {"getDuration()"}),
        "0", "0");
}

Command setParameter() {
    Command made =
        command("setParameter",
                [](JniFixture& test) {
                    return test.call<jboolean>("native_setParameter", "(ILandroid/os/Parcel;)Z", 1,
                                               newParcel(test));
                },
                {}, {});
    made.leaves = false;
    return returning(made, "false", "false");
}

const std::vector<Command> kCommands = {
    setDataSourceWithHeaders(),
    setDataSourceFd(),
    prepare(),
    transport("prepareAsync"),
    transport("start"),
    transport("stop"),
    transport("pause"),
    seekTo(),
    returning(command("getVideoWidth", calling<jint>("native_getVideoWidth", "()I"),
                      {service("getVideoWidth(): occur")}, {"getVideoWidth()"}),
              "0", "0"),
    returning(command("getVideoHeight", calling<jint>("native_getVideoHeight", "()I"),
                      {service("getVideoHeight(): occur")}, {"getVideoHeight()"}),
              "0", "0"),
    returning(command("isPlaying", calling<jboolean>("native_isPlaying", "()Z"),
                      {service("isPlaying()")}, {"isPlaying()"}),
              "true", "false"),
    getCurrentPosition(),
    getDuration(),
    setAudioStreamType(),
    setLooping(),
    occurring(returning(command("isLooping", calling<jboolean>("native_isLooping", "()Z"),
                                {service("isLooping()")}, {}),
                        "false", "false")),
    setVolume(),
    inert(
        "invoke",
        [](JniFixture& test) {
            return test.call<jint>("native_invoke", "(Landroid/os/Parcel;Landroid/os/Parcel;)I",
                                   newParcel(test), newParcel(test));
        },
        "0", "-2147483648"),
    inert(
        "setMetadataFilter",
        [](JniFixture& test) {
            return test.call<jint>("native_setMetadataFilter", "(Landroid/os/Parcel;)I",
                                   newParcel(test));
        },
        "0", "-2147483648"),
    inert(
        "getMetadata",
        [](JniFixture& test) {
            return test.call<jboolean>("native_getMetadata", "(ZZLandroid/os/Parcel;)Z",
                                       jboolean(1), jboolean(1), newParcel(test));
        },
        "false", "false"),
    silent(
        returning(command("get_audio_session_id", calling<jint>("native_getAudioSessionId", "()I"),
                          {service("getAudioSessionId(), not implement")}, {}),
                  "0", "0")),
    setAudioSessionId(),
    command("setAuxEffectSendLevel", calling<void>("native_setAuxEffectSendLevel", "(F)V", 0.5f),
            {service("setAuxEffectSendLevel(0.500000), not implement")}, {}),
    command("attachAuxEffect", calling<void>("native_attachAuxEffect", "(I)V", 9),
            {service("attachAuxEffect(9), not implement")}, {}),
    setParameter(),
    command("getParameter",
            [](JniFixture& test) {
                return test.call<void>("native_getParameter", "(ILandroid/os/Parcel;)V", 1,
                                       newParcel(test));
            },
            {}, {}),
};

}  // namespace

const std::vector<Command>& playbackCommands() { return kCommands; }

const Command& playbackCommand(const std::string& name) {
    return *std::find_if(kCommands.begin(), kCommands.end(), [&](const Command& command) {
        return command.function == "OrvMediaClient_" + name;
    });
}

}  // namespace orvtest
