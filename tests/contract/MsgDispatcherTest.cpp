// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>

#include "JniFixture.h"
#include "dispatch/MsgDispatcher.h"
#include "dispatch/SyncToAsync.h"
#include "jni/JavaVm.h"
#include "jni/PlayerContext.h"

namespace orvtest {
namespace {

using android::Parcel;
using android::sp;
using ORV::MsgDispatcher;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

const char* const kConstructor =
    "MsgDispatcher::MsgDispatcher(JNIEnv, jobject thiz, jobject weak_thiz)";

ExpectedLine constructorLine(const std::string& word) {
    return bridgeInfo(std::string(kConstructor) + ": " + word + "\n");
}

ExpectedLine notifyLine(const std::string& text) {
    return bridgeInfo("MsgDispatcher::notify(): " + text + "\n");
}

class MsgDispatcherTest : public JniFixture {
protected:
    void SetUp() override {
        JniFixture::SetUp();
        weak = vm.newObject("java/lang/ref/WeakReference");
    }
    void TearDown() override {
        dispatcher.clear();
        JniFixture::TearDown();
    }

    Outcome make() {
        jobject thiz = vm.local(player);
        jobject weakThiz = vm.local(weak);
        return observeAction([=] { dispatcher = new MsgDispatcher(vm.env(), thiz, weakThiz); });
    }
    Outcome destroy() {
        return observeAction([&] { dispatcher.clear(); });
    }
    // As the dispatcher's worker does: on a thread of its own.
    Outcome notify(const Parcel* obj) {
        Outcome outcome;
        vm.onNativeThread(
            [&] { outcome = observeAction([&] { dispatcher->notify(200, 701, -3, obj); }); });
        return outcome;
    }
    std::vector<ExpectedLine> begin(int attachResult = 0) {
        return {notifyLine("Enter"), notifyLine("g__JavaVM[X] = " + pointerText(vm.javaVm())),
                notifyLine("i4AttachRet = " + std::to_string(attachResult))};
    }
    std::vector<ExpectedLine> whole(const std::vector<ExpectedLine>& middle) {
        std::vector<ExpectedLine> lines = begin();
        lines.insert(lines.end(), middle.begin(), middle.end());
        for (const char* end : {"DetachCurrentThread, begin", "DetachCurrentThread, end", "Leave"})
            lines.push_back(notifyLine(end));
        return lines;
    }

    static Parcel threeWords() {
        Parcel parcel;
        for (int word : {1, 0x01020304, -1}) parcel.writeInt32(word);
        return parcel;
    }

    fakejni::ObjectPtr weak;
    sp<MsgDispatcher> dispatcher;
};

constexpr char kPostedNull[] =
    "postEventFromNative(java/lang/ref/WeakReference, 200, 701, -3, null)";
constexpr char kPostedBytes[] =
    "postEventFromNative(java/lang/ref/WeakReference, 200, 701, -3, byte[12])";

TEST_F(MsgDispatcherTest, HoldsTheClassAndTheWeakReference) {
    EXPECT_THAT(make(), ReturnsNothing()
                            .logs({constructorLine("Enter"), constructorLine("Leave")})
                            .makesGlobals(2));
    EXPECT_THAT(vm.callsOf("NewGlobalRef"),
                ElementsAre("java/lang/Class", "java/lang/ref/WeakReference"));
}

TEST_F(MsgDispatcherTest, GivesTheWeakReferenceBackBeforeTheClass) {
    make();
    EXPECT_THAT(destroy(), ReturnsNothing()
                               .logs({enter("MsgDispatcher::~MsgDispatcher"),
                                      leave("MsgDispatcher::~MsgDispatcher")})
                               .makesGlobals(-2));
    EXPECT_THAT(vm.callsOf("DeleteGlobalRef"),
                ElementsAre("java/lang/ref/WeakReference", "java/lang/Class"));
    EXPECT_THAT(vm.callsOf("AttachCurrentThread"), IsEmpty());
}

// As the dispatcher's worker, when a player is released inside its own event.
TEST_F(MsgDispatcherTest, LastReferenceOnANativeThreadAttachesItMeanwhile) {
    make();
    bool attached = true;
    Outcome outcome;
    vm.onNativeThread([&] {
        outcome = destroy();
        attached = vm.isAttached();
    });
    EXPECT_THAT(outcome, ReturnsNothing()
                             .logs({enter("MsgDispatcher::~MsgDispatcher"),
                                    leave("MsgDispatcher::~MsgDispatcher")})
                             .makesGlobals(-2));
    EXPECT_FALSE(attached);
    EXPECT_THAT(vm.callsOf("AttachCurrentThread"), SizeIs(1));
}

TEST_F(MsgDispatcherTest, FailedAttachLeavesTheReferencesAndSkipsTheDetach) {
    make();
    vm.fail("AttachCurrentThread");
    vm.onNativeThread([&] { EXPECT_EQ(destroy().globals, 0); });
    EXPECT_THAT(vm.callsOf("DetachCurrentThread"), IsEmpty());
    leftGlobals = 2;
}

TEST_F(MsgDispatcherTest, WithoutVmTheReferencesAreLeft) {
    make();
    g__JavaVM = nullptr;
    vm.onNativeThread([&] { EXPECT_EQ(destroy().globals, 0); });
    g__JavaVM = vm.javaVm();
    EXPECT_THAT(vm.callsOf("AttachCurrentThread"), IsEmpty());
    leftGlobals = 2;
}

TEST_F(MsgDispatcherTest, MissingClassThrowsAndCarriesOn) {
    vm.tolerate("NewGlobalRef: called with a pending java/lang/Exception");
    vm.fail("GetObjectClass");
    EXPECT_THAT(make(),
                ReturnsNothing()
                    .logs({constructorLine("Enter"),
                           bridgeError(std::string(kConstructor) + ": Can't find " + kPlayerClass),
                           constructorLine("Leave")})
                    .throws("java/lang/Exception")
                    .makesGlobals(1));
    EXPECT_THAT(destroy(), ReturnsNothing()
                               .logs({enter("MsgDispatcher::~MsgDispatcher"),
                                      leave("MsgDispatcher::~MsgDispatcher")})
                               .makesGlobals(-1));
}

TEST_F(MsgDispatcherTest, WithoutVmNothingIsPosted) {
    make();
    g__JavaVM = nullptr;
    EXPECT_THAT(notify(nullptr),
                ReturnsNothing().logs({notifyLine("Enter"), notifyLine("g__JavaVM==NULL")}));
    g__JavaVM = vm.javaVm();
}

TEST_F(MsgDispatcherTest, EventWithoutParcelHasANullPayload) {
    make();
    EXPECT_THAT(notify(nullptr),
                ReturnsNothing().logs(whole({notifyLine("3")})).java({kPostedNull}));
    EXPECT_EQ(vm.javaCalls()[0].args[0].object, weak);
    EXPECT_EQ(vm.javaCalls()[0].form, "CallStaticVoidMethod");
}

TEST_F(MsgDispatcherTest, EmptyParcelIsANullPayload) {
    make();
    const Parcel empty;
    EXPECT_THAT(notify(&empty),
                ReturnsNothing().logs(whole({notifyLine("3")})).java({kPostedNull}));
}

TEST_F(MsgDispatcherTest, ParcelReachesJavaAsItsRawBytes) {
    make();
    const Parcel parcel = threeWords();
    parcel.setDataPosition(8);
    EXPECT_THAT(
        notify(&parcel),
        ReturnsNothing().logs(whole({notifyLine("1"), notifyLine("2")})).java({kPostedBytes}));
    const std::vector<uint8_t> expected(parcel.data(), parcel.data() + 12);
    EXPECT_EQ(vm.javaCalls()[0].args[4].object->bytes, expected);
    EXPECT_THAT(vm.callsOf("DeleteLocalRef"), ElementsAre("byte[12]"));
    EXPECT_THAT(vm.callsOf("ReleaseByteArrayElements"), ElementsAre("0"));
    // The bytes are Java's before the event is posted.
    EXPECT_THAT(vmCalls(),
                ElementsAre("GetEnv", "AttachCurrentThread", "NewByteArray", "GetByteArrayElements",
                            "ReleaseByteArrayElements", "CallStaticVoidMethod", "DeleteLocalRef",
                            "DetachCurrentThread"));
}

TEST_F(MsgDispatcherTest, AttachesAndDetachesItsThread) {
    make();
    bool during = false;
    playerClass.remove("postEventFromNative");
    playerClass.staticMethod("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V",
                             [&](const fakejni::Invocation& call) {
                                 during = call.vm.isAttached();
                                 return fakejni::Value();
                             });
    initClass();
    notify(nullptr);
    EXPECT_TRUE(during);
    EXPECT_EQ(vm.attachedThreads(), 0);
}

TEST_F(MsgDispatcherTest, ArrayThatCannotBeMadePostsNothing) {
    make();
    vm.fail("NewByteArray");
    const Parcel parcel = threeWords();
    EXPECT_THAT(notify(&parcel), ReturnsNothing().logs(whole({notifyLine("1")})));
}

// Java is not handed an array of zeros for an event that had bytes.
TEST_F(MsgDispatcherTest, ArrayWithoutElementsPostsNothing) {
    make();
    vm.fail("GetByteArrayElements");
    const Parcel parcel = threeWords();
    EXPECT_THAT(notify(&parcel).java, IsEmpty());
    EXPECT_EQ(vm.attachedThreads(), 0);
}

// A thread that has its environment already posts although it cannot attach.
TEST_F(MsgDispatcherTest, FailedAttachSkipsTheDetach) {
    make();
    vm.fail("AttachCurrentThread");
    std::vector<ExpectedLine> lines = begin(-1);
    lines.push_back(notifyLine("3"));
    lines.push_back(notifyLine("Leave"));
    EXPECT_THAT(observeAction([&] { dispatcher->notify(200, 701, -3, nullptr); }),
                ReturnsNothing().logs(lines).java({kPostedNull}));
    EXPECT_THAT(vm.callsOf("DetachCurrentThread"), IsEmpty());
}

TEST_F(MsgDispatcherTest, ExceptionOfTheJavaSideIsLeftAlone) {
    playerClass.remove("postEventFromNative");
    playerClass.staticMethod("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V",
                             [](const fakejni::Invocation& call) {
                                 call.vm.raise(kIllegalState);
                                 return fakejni::Value();
                             });
    initClass();
    make();
    const Parcel parcel = threeWords();
    EXPECT_THAT(
        notify(&parcel),
        ReturnsNothing().logs(whole({notifyLine("1"), notifyLine("2")})).java({kPostedBytes}));
    EXPECT_THAT(vm.callsOf("ExceptionClear"), IsEmpty());
}

TEST_F(MsgDispatcherTest, ManyEventsLeaveNothingBehind) {
    make();
    const Parcel parcel = threeWords();
    vm.onNativeThread([&] {
        for (int i = 0; i < 2000; ++i) dispatcher->notify(i, 0, 0, &parcel);
    });
    EXPECT_THAT(vm.javaCalls(), SizeIs(2000));
    EXPECT_EQ(vm.attachedThreads(), 0);
}

// The whole way of an action that carries its service: over the dispatcher's
// worker to the player's own weak reference.
TEST_F(MsgDispatcherTest, ActionWithAServiceReachesJavaOnTheWorkerThread) {
    setUpPlayer();
    auto* action = new ORV::SyncToAsyncAction;
    action->service = android::getMediaService(vm.env(), vm.local(player));
    action->payload = new NotifyMessage{1, 2, 3, nullptr};
    action->valid = true;
    ORV::SyncToAsync::getInstance()->addAction(action);
    ASSERT_TRUE(log.waitFor(notifyLine("Leave")));
    ASSERT_THAT(vm.javaCallTexts(),
                ElementsAre("postEventFromNative(java/lang/ref/WeakReference, 1, 2, 3, null)"));
    EXPECT_NE(vm.javaCalls()[0].thread, std::this_thread::get_id());
}

// The engine's own events end before they reach the dispatcher.
TEST_F(MsgDispatcherTest, EngineEventsDoNotReachJava) {
    setUpPlayer();
    log.clear();
    engine->sendEvent(1, 0, 0, nullptr);
    EXPECT_THAT(log.lines(), IsEmpty());
    EXPECT_THAT(vm.javaCallTexts(), IsEmpty());
}

}  // namespace
}  // namespace orvtest
