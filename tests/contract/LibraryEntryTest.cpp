// SPDX-License-Identifier: Apache-2.0
#include <stdio.h>

#include "JniFixture.h"
#include "NativeMethodRows.h"
#include "jni/JavaVm.h"

namespace orvtest {
namespace {

using fakejni::NativeResult;
using fakejni::Value;
using testing::ElementsAre;
using testing::IsEmpty;

constexpr char kRegistrationError[] = "ERROR: BrixMediaPlayer native registration failed\n";

class LibraryEntryTest : public VmFixture {
protected:
    // What loading did; of the log, the library's own lines. How the platform
    // finds out which method is missing is its own affair.
    Outcome load() {
        Outcome outcome = observe("JNI_OnLoad", [&] {
            return NativeResult{Value::ofInt(JNI_OnLoad(vm.javaVm(), nullptr)), 0};
        });
        const auto foreign = [](const LogLine& line) { return line.tag != "OrvMediaClient-JNI"; };
        outcome.log.erase(std::remove_if(outcome.log.begin(), outcome.log.end(), foreign),
                          outcome.log.end());
        outcome.java.clear();
        return outcome;
    }

    ExpectedLine vmLine() {
        char text[80];
        snprintf(text, sizeof text, "JNI_OnLoad():  g__JavaVM[X] = %p\n",
                 static_cast<void*>(vm.javaVm()));
        return bridgeInfo(text);
    }
};

TEST_F(LibraryEntryTest, LoadingKeepsTheVmAndRegistersTheTable) {
    EXPECT_THAT(load(), Returns("65540").logs({vmLine()}));
    EXPECT_EQ(g__JavaVM, vm.javaVm());
    EXPECT_THAT(vm.callsOf("RegisterNatives"), ElementsAre("83"));
    EXPECT_EQ(vm.callsOf("FindClass").back(), kPlayerClass);
}

TEST_F(LibraryEntryTest, EnvironmentIsAskedForVersion14) {
    load();
    EXPECT_EQ(vm.callsOf("GetEnv").front(), "0x00010004");
}

TEST_F(LibraryEntryTest, RefusedEnvironmentEndsLoadingWithoutRegistering) {
    vm.fail("GetEnv");
    EXPECT_THAT(load(), Returns("-1").logs({vmLine(), bridgeError("ERROR: GetEnv failed\n")}));
    EXPECT_EQ(g__JavaVM, vm.javaVm());
    EXPECT_THAT(vm.callsOf("RegisterNatives"), IsEmpty());
}

TEST_F(LibraryEntryTest, ThreadWithoutEnvironmentCannotLoad) {
    jint result = 0;
    vm.onNativeThread([&] { result = JNI_OnLoad(vm.javaVm(), nullptr); });
    EXPECT_EQ(result, -1);
    EXPECT_EQ(g__JavaVM, vm.javaVm());
    EXPECT_THAT(vm.callsOf("RegisterNatives"), IsEmpty());
}

TEST_F(LibraryEntryTest, MissingClassEndsLoadingAndLeavesTheMachinesException) {
    vm.hide(kPlayerClass);
    EXPECT_THAT(load(), Returns("-1")
                            .logs({vmLine(), bridgeError(kRegistrationError)})
                            .throws("java/lang/NoClassDefFoundError", kPlayerClass));
    EXPECT_EQ(g__JavaVM, vm.javaVm());
}

TEST_F(LibraryEntryTest, MethodThatIsNotNativeIsRefused) {
    playerClass.remove("native_start");
    playerClass.method("native_start", "()V");
    EXPECT_THAT(load(), Returns("-1")
                            .logs({vmLine(), bridgeError(kRegistrationError)})
                            .throws("java/lang/NoSuchMethodError", "native_start"));
}

struct Row {
    const char* name;
    const char* signature;
};
void PrintTo(const Row& row, std::ostream* out) { *out << row.name << row.signature; }

#define ROW(name, signature, function) Row{name, signature},
const Row kRows[] = {ORV_NATIVE_METHODS(ROW)};
#undef ROW

class LibraryEntryRowTest : public LibraryEntryTest, public testing::WithParamInterface<Row> {
protected:
    // Takes the row's declaration away; the other rows of its name stay.
    void undeclare() {
        playerClass.remove(GetParam().name);
        for (const Row& row : kRows) {
            const bool sameName = std::string(row.name) == GetParam().name;
            if (sameName && row.signature != GetParam().signature)
                playerClass.nativeMethod(row.name, row.signature);
        }
    }
    void expectRefusal() {
        EXPECT_THAT(load(), Returns("-1")
                                .logs({vmLine(), bridgeError(kRegistrationError)})
                                .throws("java/lang/NoSuchMethodError", GetParam().name));
        EXPECT_EQ(g__JavaVM, vm.javaVm());
    }
};

TEST_P(LibraryEntryRowTest, ClassWithoutTheMethodIsRefused) {
    undeclare();
    expectRefusal();
}

TEST_P(LibraryEntryRowTest, ClassWithAnotherSignatureIsRefused) {
    undeclare();
    playerClass.nativeMethod(GetParam().name, "(D)V");
    expectRefusal();
}

INSTANTIATE_TEST_SUITE_P(Rows, LibraryEntryRowTest, testing::ValuesIn(kRows));

}  // namespace
}  // namespace orvtest
