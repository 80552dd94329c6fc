// SPDX-License-Identifier: Apache-2.0
// Fails whatever a native method, a callback or a stream operation needs, one thing
// at a time: each call into the virtual machine, each allocation that may yield null,
// each operation of the engine with each kind of status. What becomes of each stands
// in traces/InjectedFailuresTest.txt. Whatever it is, nothing crashes, all that was
// taken is given back, and the next call without a failure goes as it should.
#include <binder/Parcel.h>
#include <dispatch/MsgDispatcher.h>
#include <gui/Surface.h>
#include <jni/DivxNavigation.h>
#include <jni/OrvMediaClient.h>

#include <set>
#include <tuple>

#include "AllocationFailure.h"
#include "DivxService.h"
#include "JavaInputStreamFixture.h"
#include "JavaMembers.h"
#include "NativeMethodRows.h"
#include "PlatformCalls.h"
#include "PosixCalls.h"
#include "RecordTexts.h"
#include "Trace.h"
#include "TraceBook.h"
#include "jni/JavaVm.h"

namespace orvtest {
namespace {

using android::sp;
using fakejni::ObjectPtr;
using fakejni::Value;

class InjectedFailuresTest;

// What is done while things fail.
struct Operation {
    std::string name;
    std::function<Outcome(InjectedFailuresTest&)> run;
    // What it needs, before anything fails.
    std::function<void(InjectedFailuresTest&)> prepare = {};
    // The strings that it never gives back, as programs have come to expect.
    std::vector<std::string> kept = {};
    // The engine owns the stream that it was given; the scripted one never deletes it.
    bool engineKeepsStream = false;
    // A second run is another case: the first has changed what it works on.
    bool changesItself = false;
};
void PrintTo(const Operation& operation, std::ostream* out) { *out << operation.name; }

// The statuses that some method tells apart, then one that none does; 0 is what an
// operation that answers yes or no says for no.
constexpr int kStatuses[] = {-38, -1, -1004, 1, -32, 0};

class InjectedFailuresTest : public JavaInputStreamFixture,
                             public testing::WithParamInterface<Operation> {
public:
    using JavaInputStreamFixture::make;
    using JavaInputStreamFixture::onEngine;
    using JavaInputStreamFixture::stream;

    void begin() {
        player = newPlayer();
        setUpPlayer();
        fillEngine();
        player->set("mStreamReadBuffer", Value::of(vm.newBytes({1, 2, 3})));
        poster = new ORV::MsgDispatcher(vm.env(), vm.local(player),
                                        vm.local(vm.newObject("java/lang/ref/WeakReference")));
    }

    template <typename T>
    T argument(const std::string& type) {
        if constexpr (std::is_same_v<T, jstring>) {
            return string("text");
        } else if constexpr (std::is_same_v<T, jobjectArray>) {
            return strings({"a", "b"});
        } else if constexpr (std::is_pointer_v<T>) {
            return static_cast<T>(object(type));
        } else {
            return static_cast<T>(1);
        }
    }

    sp<android::Surface> surface;
    sp<ORV::MsgDispatcher> poster;
    std::vector<std::unique_ptr<JavaInputStream>> engineStreams;

protected:
    void SetUp() override {
        // A native thread that the machine does not attach has no environment: what
        // becomes of it is left open.
        vm.spare("AttachCurrentThread");
        // A thread that runs Java always has one.
        vm.spare("GetEnv");
        setText(mDivx.display.mText1, u"one");
        setText(mDivx.display.mText2, u"two");
        defineJavaMembers(vm, ORV_JAVA_MEMBERS);
        answerAll();
        JavaInputStreamFixture::SetUp();
        surface = new android::Surface(new TestProducer);
    }
    void TearDown() override {
        const Untraced ending(*this);
        surface.clear();
        JavaInputStreamFixture::TearDown();
    }
    static void TearDownTestSuite() { std::cout << "injected failures: " << sInjected << "\n"; }

    using HasFailed = std::function<bool()>;
    using Arm = std::function<HasFailed()>;

    // Runs the operation on a new player while the failure is armed, then again
    // without it. False when the failure did not come. A failed call is named.
    bool attempt(const std::string& failure, const Arm& arm);
    void failEachCall();
    void failEachAllocation();
    void failEachMalloc();
    void failEachEngineOperation();
    void runWithoutMachine();
    void checkNextPlayer();

    std::string good;  // what it does when nothing fails
    std::vector<std::string> engineOperations;

    static int sInjected;

private:
    void answerAll() {
        playerClass.remove("readStream");
        playerClass.method("readStream", "(I)I",
                           [](const fakejni::Invocation&) { return Value::ofInt(3); });
    }

    void fillEngine() {
        // A scripted engine frees none, so that the test does.
        engine->takeStream = [this](IOrvStreamSource* source) {
            engineStreams.emplace_back(static_cast<JavaInputStream*>(source));
        };
        for (const char* tracks :
             {"getVideoTrackCount", "getAudioTrackCount", "getSubtitleTrackCount"}) {
            engine->put(tracks, 2);
        }
        engine->currentVideoCodec.emplace();
        for (int i = 0; i < 2; i++) {
            engine->videoCodecs[i];
            engine->subtitleTracks[i];
            engine->audioTracks[i];
        }
        engine->metaDataInfo.emplace();
        engine->albumArt = {{1, 2, 3}};
        engine->drawThumbnail = [](_Media_Thumbnail_Info_T* thumbnail) {
            std::fill_n(thumbnail->pBuffer, thumbnail->u4BufferSize, uint8_t{7});
        };
    }

    jobject object(const std::string& type) {
        if (type == "android/view/Surface") return vm.local(newJavaSurface(vm, surface));
        if (type == "java/io/FileDescriptor") return vm.local(newFileDescriptor(vm, 5));
        if (type == "java/lang/Object") {
            return vm.local(vm.newObject("java/lang/ref/WeakReference"));
        }
        const ObjectPtr filled = newFilledObject(vm, type);
        if (type == "com/quintora/mmp/util/ThumbnailInfo") {
            filled->set("mCanvasColormode", Value::ofInt(ORV_COLOR_MODE_ARGB8888));
        }
        return vm.local(filled);
    }

    DivxService mDivx;
};

int InjectedFailuresTest::sInjected = 0;

// The class paths of a signature's references, in order.
std::vector<std::string> typesOf(const std::string& signature) {
    std::vector<std::string> types;
    for (size_t i = 1; signature[i] != ')'; i++) {
        const bool isArray = signature[i] == '[';
        if (isArray) i++;
        if (signature[i] != 'L') {
            types.emplace_back(1, signature[i]);
            continue;
        }
        const size_t end = signature.find(';', i);
        types.push_back(signature.substr(i + 1, end - i - 1));
        i = end;
    }
    return types;
}

template <auto Function>
struct Native;

template <typename R, typename Self, typename... A, R (*Function)(JNIEnv*, Self, A...)>
struct Native<Function> {
    static Outcome run(InjectedFailuresTest& test, const std::string& name,
                       const std::string& signature) {
        std::vector<std::string> types = typesOf(signature);
        std::reverse(types.begin(), types.end());
        const auto takeType = [&types] {
            std::string type = types.back();
            types.pop_back();
            return type;
        };
        (void)takeType;
        const std::tuple<A...> arguments{test.argument<A>(takeType())...};
        return std::apply(
            [&](A... values) {
                if constexpr (std::is_same_v<Self, jclass>) {
                    return test.callStatic<R>(name, signature, values...);
                } else {
                    return test.call<R>(name, signature, values...);
                }
            },
            arguments);
    }
};

// The names of overloads differ by the native function's.
std::string titleOf(const std::string& function) {
    return function.substr(std::string("OrvMediaClient_").size());
}

std::vector<Operation> nativeMethods() {
    std::vector<Operation> operations;
#define ROW(name, signature, function)                                                       \
    operations.push_back({titleOf(#function), [](InjectedFailuresTest& test) {               \
                              return Native<&android::function>::run(test, name, signature); \
                          }});
    ORV_NATIVE_METHODS(ROW)
#undef ROW
    const std::set<std::string> keep = {"addTimedTextSource", "QTVDEC_SendCliCommand"};
    const std::set<std::string> change = {"release", "finalize", "setup", "setVideoSurface"};
    for (Operation& operation : operations) {
        if (keep.count(operation.name) != 0) operation.kept = {"GetStringUTFChars"};
        operation.changesItself = change.count(operation.name) != 0;
        operation.engineKeepsStream = operation.name == "setDataSourceByInputStream";
        // A second set-up would leave the first service and its player.
        if (operation.name == "setup") {
            operation.prepare = [](InjectedFailuresTest& test) {
                test.call<void>("native_release", "()V");
            };
        }
    }
    return operations;
}

// Says what came back.
using StreamCall = std::function<std::string(JavaInputStream&)>;

Operation stream(const std::string& name, const StreamCall& call) {
    return {"stream_" + name,
            [call](InjectedFailuresTest& test) {
                std::string returned;
                Outcome outcome = test.onEngine([&] { returned = call(*test.stream); });
                outcome.returned = returned;
                return outcome;
            },
            [](InjectedFailuresTest& test) { test.make(); }};
}

std::vector<Operation> streamOperations() {
    return {
        {"stream_new", [](InjectedFailuresTest& test) { return test.make(); }},
        stream("read",
               [](JavaInputStream& source) {
                   char buffer[3] = {};
                   int count = 0;
                   source.read(buffer, 3, count);
                   return std::to_string(count) + " bytes, the first " + std::to_string(buffer[0]);
               }),
        stream("byteSeek",
               [](JavaInputStream& source) {
                   return std::to_string(source.byteSeek(E_ORV_STREAM_SEEK_SET, 1));
               }),
        stream("timeSeek",
               [](JavaInputStream& source) { return std::to_string(source.timeSeek(0, 1)); }),
        stream("cancelRead",
               [](JavaInputStream& source) {
                   source.cancelRead();
                   return "void";
               }),
        stream("closeStream",
               [](JavaInputStream& source) {
                   source.closeStream();
                   return "void";
               }),
        stream("getFileLength",
               [](JavaInputStream& source) { return std::to_string(source.getFileLength()); }),
        stream("getCurrentPosition",
               [](JavaInputStream& source) { return std::to_string(source.getCurrentPosition()); }),
        stream("getDuration",
               [](JavaInputStream& source) { return std::to_string(source.getDuration()); }),
    };
}

// An event on its way to Java, with that many words.
Operation event(const std::string& name, int words) {
    return {"event_" + name, [words](InjectedFailuresTest& test) {
                android::Parcel parcel;
                for (int i = 0; i < words; i++) parcel.writeInt32(i);
                return test.onEngine([&] { test.poster->notify(200, 701, -3, &parcel); });
            }};
}

std::vector<Operation> operations() {
    std::vector<Operation> all = nativeMethods();
    for (const Operation& operation : streamOperations()) all.push_back(operation);
    all.push_back(event("bare", 0));
    all.push_back(event("withBytes", 3));
    return all;
}

std::string describe(const Outcome& outcome) {
    const Trace trace;
    Trace::add("returns", outcome.returned);
    if (outcome.thrown) {
        Trace::add("throws", outcome.thrown->type + " " + outcome.thrown->message.value_or(""));
    }
    for (const std::string& call : outcome.engine) Trace::add("engine", call);
    for (const std::string& call : outcome.java) Trace::add("java", call);
    for (const std::string& buffer : outcome.unreleased) Trace::add("keeps", buffer);
    std::string text;
    for (const std::string& step : trace.steps()) text += (text.empty() ? "" : "; ") + step;
    return text;
}

bool InjectedFailuresTest::attempt(const std::string& failure, const Arm& arm) {
    SCOPED_TRACE(failure);
    const Untraced repeated(*this);
    const Operation& operation = GetParam();
    begin();
    if (operation.prepare) operation.prepare(*this);
    const int before = vm.failures();
    const HasFailed hasFailed = arm();
    const Outcome outcome = operation.run(*this);
    const bool failed = hasFailed();
    const bool calls = vm.failures() != before;
    vm.forgetFailures();
    std::string result = describe(outcome);
    // The contract has native code go on after some exceptions.
    std::set<std::string> afterException;
    for (const std::string& violation : vm.takeViolations()) {
        EXPECT_THAT(violation, testing::HasSubstr("called with a pending"));
        afterException.insert(violation.substr(0, violation.find(':')));
    }
    for (const std::string& call : afterException) result += "; goes on to " + call;
    for (const std::string& buffer : outcome.unreleased) {
        EXPECT_THAT(operation.kept, testing::Contains(buffer));
    }
    if (!operation.changesItself) {
        EXPECT_EQ(good, describe(operation.run(*this))) << "the next run";
        vm.takeViolations();
    }
    checkNextPlayer();
    if (!failed) return false;
    sInjected++;
    // What changes nothing needs no paragraph.
    if (result != good) addToTracePage(failure + (calls ? ", " + vm.lastFailed() : ""), {result});
    return true;
}

// Whatever a failure left, a player can be released, set up and used.
void InjectedFailuresTest::checkNextPlayer() {
    stream.reset();
    engineStreams.clear();
    poster.clear();
    call<void>("native_release", "()V");
    EXPECT_EQ(ScriptedEngine::live(), 0);
    if (!GetParam().engineKeepsStream) {
        EXPECT_EQ(vm.globalReferences(), 0u);
    }
    EXPECT_EQ(vm.attachedThreads(), 0);
    ScriptedEngine::forgetAll();
    initClass();
    player = newPlayer();
    setUpPlayer();
    const Outcome next = call<jint>("native_getCurrentPosition", "()I");
    EXPECT_THAT(next, Returns("0").engine({"getCurrentPosition()"}));
    call<void>("native_release", "()V");
    EXPECT_THAT(vm.takeViolations(), testing::IsEmpty());
    ScriptedEngine::forgetAll();
}

void InjectedFailuresTest::failEachCall() {
    for (int n = 1;; n++) {
        const bool came = attempt("call " + std::to_string(n) + " fails", [&] {
            const int before = vm.failures();
            vm.failNth(n);
            return [this, before] { return vm.failures() != before; };
        });
        if (!came) return;
    }
}

void InjectedFailuresTest::failEachAllocation() {
    for (int n = 1;; n++) {
        std::unique_ptr<AllocationFailure> failure;
        const bool came = attempt("allocation " + std::to_string(n) + " is null", [&] {
            // NOLINTNEXTLINE(modernize-make-unique): it can be neither copied nor moved
            failure.reset(new AllocationFailure(AllocationFailure::nth(n)));
            return [&failure] {
                const bool failed = failure->failed() != 0;
                failure.reset();
                return failed;
            };
        });
        if (!came) return;
    }
}

// One method takes memory by malloc; of the others the machine would lack its own.
void InjectedFailuresTest::failEachMalloc() {
    if (GetParam().name != "getThumbnailInfo") return;
    for (int n = 1;; n++) {
        int left = n;
        std::optional<decltype(mallocCall.replace({}))> replacement;
        const bool came = attempt("malloc " + std::to_string(n) + " is null", [&] {
            replacement.emplace(mallocCall, [&left](size_t bytes) -> void* {
                return --left == 0 ? nullptr : mallocCall.real(bytes);
            });
            return [&] {
                replacement.reset();
                return left <= 0;
            };
        });
        if (!came) return;
    }
}

void InjectedFailuresTest::failEachEngineOperation() {
    for (const std::string& operation : engineOperations) {
        for (const int status : kStatuses) {
            const std::string failure =
                "engine's " + operation + " answers " + std::to_string(status);
            attempt(failure, [&] {
                engine->answer(operation, {status});
                // The operation is one of those that the run without a failure got to.
                return [&] {
                    engine->answer(operation, {});
                    return true;
                };
            });
        }
    }
}

void InjectedFailuresTest::runWithoutMachine() {
    attempt("no virtual machine", [&] {
        JavaVM* const machine = std::exchange(g__JavaVM, nullptr);
        return [machine] {
            g__JavaVM = machine;
            return true;
        };
    });
}

TEST_P(InjectedFailuresTest, EachIsAsStated) {
    if (GetParam().name == "setDataSourceFD" && platformHelpersAreInline()) {
        GTEST_SKIP() << "it would count the calls of the platform's helper";
    }
    {
        const Untraced first(*this);
        begin();
        if (GetParam().prepare) GetParam().prepare(*this);
        const Outcome outcome = GetParam().run(*this);
        good = describe(outcome);
        for (const std::string& call : outcome.engine) {
            engineOperations.push_back(call.substr(0, call.find('(')));
        }
        vm.takeViolations();
        checkNextPlayer();
    }
    addToTracePage("nothing fails", {good});
    failEachCall();
    failEachAllocation();
    failEachMalloc();
    failEachEngineOperation();
    runWithoutMachine();
    if (GetParam().engineKeepsStream) leftGlobals = vm.globalReferences();
    if (!GetParam().kept.empty()) leftUnreleased = vm.unreleased();
}

INSTANTIATE_TEST_SUITE_P(Operations, InjectedFailuresTest, testing::ValuesIn(operations()),
                         [](const auto& info) { return info.param.name; });

}  // namespace
}  // namespace orvtest
