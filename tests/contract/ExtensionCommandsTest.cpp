// SPDX-License-Identifier: Apache-2.0
// The native methods of the television's extras, each a row of one table: what
// it says and gives without a service, and for every answer of the engine.
#include <string.h>

#include <functional>

#include "JniFixture.h"

namespace orvtest {
namespace {

using Call = std::function<Outcome(JniFixture&)>;
using Lines = std::vector<ExpectedLine>;

template <typename R, typename... A>
Call calling(const char* name, const char* signature, A... args) {
    return [=](JniFixture& test) { return test.call<R>(name, signature, args...); };
}

Lines joined(Lines first, const Lines& second) {
    first.insert(first.end(), second.begin(), second.end());
    return first;
}

// What a command does for one answer of the engine.
struct Answer {
    int engine;
    std::string returned;
    Lines rest;  // behind the service's line
    bool throws = false;
};

struct Command {
    std::string name;  // of the native function, without its prefix
    Call call;
    Lines entry;
    Lines missing;  // without a service, behind the entry lines
    bool missingThrows;
    std::string missingReturns;
    std::string serviceEntry;  // empty for none
    std::string operation;     // the engine's
    std::string arguments;
    std::vector<Answer> answers;
    int put = 0;  // what the engine writes

    std::string full() const { return "OrvMediaClient_" + name; }
};
void PrintTo(const Command& command, std::ostream* out) { *out << command.name; }

Lines numbered(const std::string& text, int line) {
    return {bridgeError(text + std::to_string(line) + "\n")};
}
Lines unnamedMissing(int line) {
    return numbered("service not exist,throw exception. Line:", line);
}

std::string failedLine(const std::string& name) {
    return "OrvMediaClient_" + name + "(): service get failed\n";
}
Lines notExist(const std::string& name) {
    return {bridgeError("OrvMediaClient_" + name + "(): service not exist, error\n")};
}
Lines left(const std::string& name) { return {leave("OrvMediaClient_" + name)}; }

// A track or subtitle command: never throws, returns nothing.
Command trackCommand(const char* name, Call call, const char* serviceEntry, const char* arguments,
                     const char* failedName) {
    return {name,
            std::move(call),
            {enter(std::string("OrvMediaClient_") + name)},
            notExist(name),
            false,
            "void",
            serviceEntry,
            name,
            arguments,
            {{1, "void", left(name)},
             {0, "void", joined({bridgeError(failedLine(failedName))}, left(name))}}};
}

Command canDo(const char* name, int line) {
    const std::string entry = std::string("OrvMediaService::") + name + "(8000)";
    return {name,
            [=](JniFixture& test) {
                return test.call<jboolean>("native_" + std::string(name), "(I)Z", 8000);
            },
            {bridgeInfo("OrvMediaClient_" + std::string(name) + ": occur\n")},
            unnamedMissing(line),
            true,
            "false",
            entry.substr(strlen("OrvMediaService::")),
            name,
            "8000",
            {{1, "true", {}}, {0, "false", {}}}};
}

Command index(const char* name, int line) {
    const std::string function = std::string("OrvMediaClient_") + name;
    Command command = {
        name,
        [=](JniFixture& test) { return test.call<jint>("native_" + std::string(name), "()I"); },
        {enter(function)},
        {bridgeError("service not exist, throw exception. Line:" + std::to_string(line) + "\n")},
        true,
        "0",
        std::string(name) + "(): occur",
        name,
        "",
        {{1, "4", left(name)},
         {-38, "4", left(name)},
         {0, "0",
          joined({bridgeError(function + "(): getCurrentAudioIndex failed")}, left(name))}}};
    command.put = 4;
    return command;
}

Command setPlayMode() {
    const Lines leaves = {bridgeInfo("OrvMediaClient_setPlayModeEx(): Leave\n")};
    return {"setPlayMode",
            calling<jint>("native_setPlayMode", "(I)I", 2000),
            {enter("OrvMediaClient_setPlayMode")},
            unnamedMissing(3521),
            true,
            "-1",
            "setSpeed(2000)",
            "setSpeed",
            "2000",
            {{0, "0", leaves}, {-38, "-38", leaves}, {7, "7", leaves}}};
}

Command getPlayMode() {
    const Lines speed = {bridgeInfo("OrvMediaClient_getPlayMode(): i4Speed=2000\n"),
                         leave("OrvMediaClient_getPlayMode")};
    Command command = {
        "getPlayMode",
        calling<jint>("native_getPlayMode", "()I"),
        {enter("OrvMediaClient_getPlayMode")},
        notExist("getPlayMode"),
        false,
        "0",
        "getSpeed()",
        "getSpeed",
        "",
        {{1, "2000", speed}, {0, "2000", joined({bridgeError(failedLine("getPlayMode"))}, speed)}}};
    command.put = 2000;
    return command;
}

Command getBufferPercent() {
    return {"getBufferingTime",
            calling<jint>("native_getBufferPercent", "()I"),
            {},
            notExist("getBufferingTime"),
            false,
            "0",
            "getBufferPercent()",
            "getBufferPercent",
            "",
            {{0, "0", {}}, {42, "42", {}}, {-1, "-1", {}}}};
}

Command step() {
    return {"step",
            calling<void>("native_step", "(I)V", -2),
            {enter("OrvMediaClient_step")},
            notExist("step"),
            true,
            "void",
            "step in",
            "step",
            "-2",
            {{1, "void", left("step")},
             {0, "void", joined({bridgeError(failedLine("step"))}, left("step")), true}}};
}

Command seekToPosition() {
    return {"seekToPosition",
            calling<void>("native_seekToPosition", "(J)V", jlong(0x100000010)),
            {bridgeInfo("OrvMediaClient_seekToPosition(): occur\n"),
             bridgeInfo("OrvMediaClient_seekToPosition(): seek position(byte) = 4294967312")},
            unnamedMissing(3500),
            true,
            "void",
            "seekToPosition()",
            "seekToPosition",
            "16",
            {{1, "void", {}}, {0, "void", {bridgeError(failedLine("seekToPosition"))}, true}}};
}

Command setTs() {
    return {"setTS",
            calling<jboolean>("native_setTS", "(I)Z", 65541),
            {bridgeInfo("OrvMediaClient_setTS: occur\n")},
            unnamedMissing(3570),
            true,
            "boolean(255)",
            "setTS(5)",
            "setTS",
            "5",
            {{1, "true", {bridgeInfo("OrvMediaClient_setTS()end")}},
             {0, "false", {bridgeError(failedLine("setTS"))}}}};
}

Command getCurrentBytePosition() {
    Command command = {"getCurrentBytePosition",
                       calling<jint>("native_getCurrentBytePosition", "()I"),
                       {},
                       unnamedMissing(3591),
                       true,
                       "0",
                       "",
                       "getCurrentBytePosition",
                       "",
                       {{0, "77", {}}}};
    command.put = 77;
    return command;
}

Command setPlayerRole() {
    return {"setPlayerRole",
            calling<void>("native_setPlayerRole", "(I)V", 2),
            {bridgeInfo("OrvMediaClient_setPlayerRole(): occur\n"),
             bridgeInfo("OrvMediaClient_setPlayerRole(): player's role is = 2")},
            unnamedMissing(3617),
            true,
            "void",
            "setPlayerRole()",
            "setPlayerRole",
            "2",
            {{0, "void", {}}, {-38, "void", {}}}};
}

Command setAbRepeat() {
    return {"setABRepeat",
            calling<jint>("native_setABRepeat", "(I)I", 1),
            {enter("OrvMediaClient_setABRepeat")},
            {bridgeInfo("OrvMediaClient_setABRepeat(): service not exist, error\n")},
            false,
            "-1",
            "setABRepeat type (1)",
            "setABRepeat",
            "1",
            {{1, "1", left("setABRepeat")},
             {-22, "1", left("setABRepeat")},
             {0, "0", joined({bridgeInfo(failedLine("setABRepeat"))}, left("setABRepeat"))}}};
}

Command setUnLockPin() {
    return {"setUnLockPin",
            calling<jint>("native_setUnLockPin", "(I)I", 1234),
            {enter("OrvMediaClient_setUnLockPin")},
            numbered("OrvMediaClient_setUnLockPin(): service not exist, error. Line:", 3634),
            false,
            "-1",
            "setUnLockPin(): occur",
            "setUnLockPin",
            "1234",
            {{0, "0", left("setUnLockPin")},
             {-22, "-1",
              joined({bridgeError("OrvMediaClient_setUnLockPin(): service get failed. "
                                  "Line:3640 \n")},
                     left("setUnLockPin"))}}};
}

const std::vector<Command> kCommands = {
    setPlayMode(),
    getPlayMode(),
    getBufferPercent(),
    trackCommand("onSubtitleTrack", calling<void>("native_onSubtitleTrack", "(I)V", 3),
                 "onSubtitleTrack()", "3", "onSubtitleTrack"),
    trackCommand("offSubtitleTrack", calling<void>("native_offSubtitleTrack", "()V"),
                 "offSubtitleTrack()", "", "offSubtitleTrack"),
    trackCommand("deselectTrack", calling<void>("native_deselectTrack", "(I)V", 3),
                 "deselectTrack()", "3", "deselectTrack"),
    trackCommand("selectTrack", calling<void>("native_selectTrack", "(I)V", 3),
                 "setSubtitleTrack(3)", "3", "offSubtitleTrack"),
    step(),
    seekToPosition(),
    canDo("canDoSeek", 3540),
    canDo("canDoTrick", 3555),
    setTs(),
    getCurrentBytePosition(),
    setPlayerRole(),
    setAbRepeat(),
    index("getCurrentAudioIndex", 1408),
    index("getCurrentSubtitleIndex", 1435),
    setUnLockPin(),
};

class ExtensionCommandTest : public JniFixture, public testing::WithParamInterface<Command> {};

TEST_P(ExtensionCommandTest, EveryAnswerOfTheEngine) {
    const Command& command = GetParam();
    for (const Answer& answer : command.answers) {
        SCOPED_TRACE(answer.engine);
        setUpPlayer().answer(command.operation, {answer.engine});
        engine->put(command.operation, command.put);
        Lines lines = command.entry;
        if (!command.serviceEntry.empty())
            lines.push_back(serviceInfo("OrvMediaService::" + command.serviceEntry));
        Expected expected = Returns(answer.returned)
                                .logs(joined(lines, answer.rest))
                                .engine({command.operation + "(" + command.arguments + ")"});
        if (answer.throws) expected.throws(kIllegalState);
        EXPECT_THAT(command.call(*this), expected);
        call<void>("native_release", "()V");
    }
}

TEST_P(ExtensionCommandTest, MissingService) {
    const Command& command = GetParam();
    Expected expected =
        Returns(command.missingReturns).logs(joined(command.entry, command.missing));
    if (command.missingThrows) expected.throws(kIllegalState);
    EXPECT_THAT(command.call(*this), expected);
}

INSTANTIATE_TEST_SUITE_P(Commands, ExtensionCommandTest, testing::ValuesIn(kCommands),
                         [](const testing::TestParamInfo<Command>& info) {
                             return info.param.name;
                         });

}  // namespace
}  // namespace orvtest
