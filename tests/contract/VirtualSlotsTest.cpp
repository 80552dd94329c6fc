// SPDX-License-Identifier: Apache-2.0
// Every virtual operation that another library calls, or that this one calls
// in another library, through the number of its slot.

#include <binder/Parcel.h>
#include <errno.h>
#include <stream/IOrvStreamSource.h>

#include <string>
#include <vector>

#include "JniFixture.h"
#include "MutexProbe.h"
#include "PrivateMember.h"
#include "VtableSlots.h"
#include "dispatch/SyncToAsync.h"
#include "jni/media-service/MediaClientListener.h"
#include "jni/media-service/OrvMediaService.h"
#include "os/Mutex.h"
#include "os/Thread.h"
#include "stream/JavaInputStream.h"

namespace orvtest {

ORV_OPEN_MEMBER(SlotsQueue, ORV::SyncToAsync, m_queue);
ORV_OPEN_MEMBER(SlotsAttributes, os::Thread, mAttributes);

namespace {

using android::MediaPlayerBase;
using android::OrvMediaService;
using android::OrvMediaServiceListener;
using android::Parcel;
using android::RefBase;
using android::sp;
using android::status_t;
using android::TarnPlayer;
using testing::ElementsAre;

// --- the engine player

// Writes the hooks of reference counting down.
class HookedPlayer : public TarnPlayer {
public:
    HookedPlayer() : TarnPlayer(-1) {}
    void onFirstRef() override { hooks.push_back("onFirstRef"); }
    void onLastStrongRef(const void*) override { hooks.push_back("onLastStrongRef"); }
    bool onIncStrongAttempted(uint32_t flags, const void*) override {
        hooks.push_back("onIncStrongAttempted(" + std::to_string(flags) + ")");
        return true;
    }
    void onLastWeakRef(const void*) override { hooks.push_back("onLastWeakRef"); }
    std::vector<std::string> hooks;
};

class EnginePlayerSlots : public testing::Test {
protected:
    EnginePlayerSlots() { player->incStrong(this); }
    ~EnginePlayerSlots() override {
        player->decStrong(this);
        ScriptedEngine::forgetAll();
    }

    template <typename Result = status_t, typename... Arguments>
    Result call(int slot, Arguments... arguments) {
        return callSlot<Result>(player, slot, arguments...);
    }

    HookedPlayer* const player = new HookedPlayer;
    ScriptedEngine& engine = *ScriptedEngine::last();
};

TEST_F(EnginePlayerSlots, BeginWithDestructorsAndReferenceHooks) {
    EXPECT_TRUE(hasDestructorsAt<TarnPlayer>(0, -1));
    player->hooks.clear();
    call<void>(2);
    call<void, const void*>(3, nullptr);
    EXPECT_TRUE((call<bool, uint32_t, const void*>(4, 1, nullptr)));
    call<void, const void*>(5, nullptr);
    EXPECT_THAT(player->hooks, ElementsAre("onFirstRef", "onLastStrongRef",
                                           "onIncStrongAttempted(1)", "onLastWeakRef"));
}

TEST_F(EnginePlayerSlots, CarryThePlayersNineteenOperations) {
    engine.put("getCurrentPosition", 11);
    engine.put("getDuration", 12);
    const android::SortedVector<int> ids;
    const sp<android::IGraphicBufferProducer> producer;
    Parcel parcel;
    int position = 0;
    int duration = 0;

    call<status_t, int, int64_t, int64_t>(6, 3, 0x100000004, -5);
    call<status_t, const sp<android::IGraphicBufferProducer>*>(7, &producer);
    call(8);
    call(9);
    call(10);
    call(11);
    call(12);
    EXPECT_TRUE(call<bool>(13));
    call(14, 1500, 2);
    call(15, &position);
    call(16, &duration);
    call(17);
    call(18, 1);
    call(19, 7, &parcel);
    call(20, 8, &parcel);
    call(21, &parcel, &parcel);
    call(22, &ids, &parcel);
    call(23, 0.25f, 0.5f);
    call(24);

    EXPECT_EQ(position, 11);
    EXPECT_EQ(duration, 12);
    EXPECT_THAT(
        engine.calls(),
        ElementsAre("setDataSource(3, 4294967300, -5)", "setVideoSurfaceTexture(null)", "prepare()",
                    "prepareAsync()", "start()", "stop()", "pause()", "isPlaying()",
                    "seekTo(1500, 2)", "getCurrentPosition()", "getDuration()", "reset()",
                    "setLooping(1)", "setParameter(7, [])", "getParameter(8)", "invoke([])",
                    "getMetadata({})", "setVolume(0.25, 0.5)", "release()"));
}

// --- the stream source

class RecordingSource : public IOrvStreamSource {
public:
    int read(char*, int len, int& readLen) override { return saw("read", readLen = len); }
    long long byteSeek(E_Orv_Stream_Seek_Type, long long offset) override {
        saw("byteSeek", 0);
        return offset;
    }
    uint32_t getFileLength() override { return saw("getFileLength", 3); }
    long long getCurrentPosition() override { return saw("getCurrentPosition", 4); }
    bool isValid() override { return saw("isValid", 1); }
    void setInvalid() override { saw("setInvalid", 0); }
    void lock() override { saw("lock", 0); }
    void unlock() override { saw("unlock", 0); }
    int getDataSourceType() override { return saw("getDataSourceType", 9); }
    bool isSeekable() override { return saw("isSeekable", 1); }
    void setThreadSelf() override { saw("setThreadSelf", 0); }
    bool isThreadSelf() override { return saw("isThreadSelf", 1); }
    void cancelRead() override { saw("cancelRead", 0); }
    void closeStream() override { saw("closeStream", 0); }
    long long timeSeek(long long first, long long second) override {
        saw("timeSeek", 0);
        return first - second;
    }
    int getSeekType() override { return saw("getSeekType", 16); }
    bool isStallingSupport() override { return saw("isStallingSupport", 1); }
    uint32_t getDuration() override { return saw("getDuration", 18); }

    std::vector<std::string> seen;

private:
    int saw(const char* operation, int result) {
        seen.push_back(operation);
        return result;
    }
};

TEST(StreamSourceSlots, CarryItsEighteenOperations) {
    RecordingSource source;
    char byte = 0;
    int readLen = 0;
    EXPECT_EQ(callSlot<int>(&source, 2, &byte, 1, &readLen), 1);
    EXPECT_EQ(readLen, 1);
    EXPECT_EQ((callSlot<long long, int, long long>(&source, 3, 1, 1LL << 40)), 1LL << 40);
    EXPECT_EQ(callSlot<uint32_t>(&source, 4), 3u);
    EXPECT_EQ(callSlot<long long>(&source, 5), 4);
    EXPECT_TRUE(callSlot<bool>(&source, 6));
    callSlot(&source, 7);
    callSlot(&source, 8);
    callSlot(&source, 9);
    EXPECT_EQ(callSlot<int>(&source, 10), 9);
    EXPECT_TRUE(callSlot<bool>(&source, 11));
    callSlot(&source, 12);
    EXPECT_TRUE(callSlot<bool>(&source, 13));
    callSlot(&source, 14);
    callSlot(&source, 15);
    EXPECT_EQ((callSlot<long long, long long, long long>(&source, 16, 1LL << 33, 1)),
              (1LL << 33) - 1);
    EXPECT_EQ(callSlot<int>(&source, 17), 16);
    EXPECT_TRUE(callSlot<bool>(&source, 18));
    EXPECT_EQ(callSlot<uint32_t>(&source, 19), 18u);
    EXPECT_THAT(source.seen,
                ElementsAre("read", "byteSeek", "getFileLength", "getCurrentPosition", "isValid",
                            "setInvalid", "lock", "unlock", "getDataSourceType", "isSeekable",
                            "setThreadSelf", "isThreadSelf", "cancelRead", "closeStream",
                            "timeSeek", "getSeekType", "isStallingSupport", "getDuration"));
    EXPECT_TRUE(hasDestructorsAt<RecordingSource>(0));
}

// --- listeners and the service

struct Event {
    int msg, ext1, ext2;
    const Parcel* obj;
    bool operator==(const Event& other) const {
        return msg == other.msg && ext1 == other.ext1 && ext2 == other.ext2 && obj == other.obj;
    }
};

template <typename Base>
class RecordingListener : public Base {
public:
    void notify(int msg, int ext1, int ext2, const Parcel* obj) override {
        events.push_back({msg, ext1, ext2, obj});
    }
    std::vector<Event> events;
};

// The listeners are made on the heap, as reference counting expects.
template <typename Base>
void expectNotifyAt(int slot) {
    const sp<RecordingListener<Base>> listener = new RecordingListener<Base>;
    const Parcel parcel;
    callSlot(static_cast<Base*>(listener.get()), slot, 1, -2, 3, &parcel);
    EXPECT_THAT(listener->events, ElementsAre(Event{1, -2, 3, &parcel}));
}

TEST(ListenerSlots, ServiceListenerIsNotifiedBeforeItsDestructors) {
    expectNotifyAt<OrvMediaServiceListener>(0);
    EXPECT_TRUE(hasDestructorsAt<RecordingListener<OrvMediaServiceListener>>(1));
    EXPECT_TRUE(hasDestructorsAt<MediaClientListener>(1));
}

TEST(ListenerSlots, EngineListenerIsNotifiedBehindTheReferenceHooks) {
    expectNotifyAt<MediaPlayerBase::Listener>(6);
    EXPECT_TRUE(hasDestructorsAt<RecordingListener<MediaPlayerBase::Listener>>(0));
    EXPECT_TRUE(hasDestructorsAt<OrvMediaService::Listener>(0));
    const sp<MediaPlayerBase::Listener> listener = new OrvMediaService::Listener;
    const Parcel parcel;
    callSlot(listener.get(), 6, 1, -2, 3, &parcel);  // ends there
}

TEST(ServiceSlots, AreItsDestructorsAlone) { EXPECT_TRUE(hasDestructorsAt<OrvMediaService>(0)); }

// --- the OS layer

class RecordingLock : public os::Lock {
public:
    int lock() override { return 5; }
    int unlock() override { return 6; }
};

TEST(OsSlots, LockAndUnlockFollowTheDestructors) {
    RecordingLock lock;
    EXPECT_EQ(callSlot<int>(&lock, 2), 5);
    EXPECT_EQ(callSlot<int>(&lock, 3), 6);
    EXPECT_TRUE(hasDestructorsAt<RecordingLock>(0));
    EXPECT_TRUE(hasDestructorsAt<os::Mutex>(0));
}

TEST(OsSlots, MutexKnowsLockFromUnlock) {
    os::Mutex mutex;
    EXPECT_EQ(callSlot<int>(&mutex, 2), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), EBUSY);
    EXPECT_EQ(callSlot<int>(&mutex, 3), 0);
    EXPECT_EQ(tryFromAnotherThread(mutex), 0);
}

class RecordingThread : public os::Thread {
public:
    RecordingThread() : os::Thread("slots") {}
    void Run() override { ran = true; }
    bool ran = false;
};

TEST(OsSlots, ThreadBodyFollowsTheDestructors) {
    RecordingThread thread;
    callSlot(&thread, 2);
    EXPECT_TRUE(thread.ran);
    EXPECT_TRUE(hasDestructorsAt<RecordingThread>(0));
}

// --- the dispatcher

// Its worker is stopped first, so that this thread is the queue's one receiver.
TEST(DispatcherSlots, BodyFollowsTheDestructors) {
    ORV::SyncToAsync* dispatcher = ORV::SyncToAsync::getInstance();
    auto& queue = dispatcher->*memberOf(SlotsQueue{});
    queue.send(nullptr);
    ASSERT_EQ(dispatcher->Wait(), 0);

    LogCapture log;
    dispatcher->addAction(new ORV::SyncToAsyncAction);  // not valid: dropped with a line
    queue.send(nullptr);
    callSlot(dispatcher, 2);
    EXPECT_THAT(log.take(), LinesAre({info("SyncToAsync::Run(): action is not valid")}));

    pthread_attr_t*& attributes = dispatcher->*memberOf(SlotsAttributes{});
    pthread_attr_destroy(attributes);
    delete attributes;
    dispatcher->Start();  // for the process's end, which waits for a worker
}

// --- objects over Java

class JavaObjectSlots : public JniFixture {};

TEST_F(JavaObjectSlots, PosterHasItsDestructorsAndInheritsTheHooks) {
    JNIEnv* env = vm.env();
    jobject thiz = vm.local(player);
    EXPECT_TRUE(hasDestructorsAt<ORV::MsgDispatcher>(0, env, thiz, thiz));

    const sp<ORV::MsgDispatcher> poster = new ORV::MsgDispatcher(env, thiz, thiz);
    class Plain : public RefBase {};
    const sp<RefBase> plain = new Plain;
    const RefBase* hooks = poster.get();
    for (int slot = 2; slot <= 5; ++slot) {
        EXPECT_EQ(slotsOf(hooks)[slot], slotsOf(plain.get())[slot]) << slot;
    }
}

TEST_F(JavaObjectSlots, StreamAnswersThroughTheInterfacesSlots) {
    player->set("mDataSourceType", fakejni::Value::ofInt(3));
    player->set("mStreamSize", fakejni::Value::ofLong(1000));
    player->set("mStreamCurPos", fakejni::Value::ofLong(1LL << 33));
    player->set("mStreamDuration", fakejni::Value::ofLong(60000));
    JNIEnv* env = vm.env();
    jobject thiz = vm.local(player);
    EXPECT_TRUE(hasDestructorsAt<JavaInputStream>(0, env, thiz));

    JavaInputStream stream(env, thiz);
    EXPECT_EQ(callSlot<int>(&stream, 10), 3);
    EXPECT_TRUE(callSlot<bool>(&stream, 6));
    callSlot(&stream, 7);
    EXPECT_FALSE(callSlot<bool>(&stream, 6));
    EXPECT_FALSE(callSlot<bool>(&stream, 13));
    callSlot(&stream, 12);
    EXPECT_TRUE(callSlot<bool>(&stream, 13));
}

}  // namespace
}  // namespace orvtest
