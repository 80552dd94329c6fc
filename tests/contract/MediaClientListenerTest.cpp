// SPDX-License-Identifier: Apache-2.0
#include <binder/Parcel.h>
#include <dispatch/SyncToAsync.h>
#include <jni/media-service/MediaClientListener.h>

#include <algorithm>
#include <optional>

#include "MutexProbe.h"
#include "PrivateMember.h"
#include "ServiceFixture.h"

namespace orvtest {

ORV_OPEN_MEMBER(ListenedActions, ORV::SyncToAsync, m_actions);
ORV_OPEN_MEMBER(ListenedMutex, ORV::SyncToAsync, m_mutex);

namespace {

using android::sp;

const char kListenerTag[] = "OrvMediaClient-JNI";

class MediaClientListenerTest : public ServiceFixture {
protected:
    void SetUp() override {
        ORV::SyncToAsync::getInstance();  // its first use logs more than the later ones
        log.clear();
    }

    // The lines of this thread, or of all others.
    std::vector<LogLine> linesOf(bool thisThread) const {
        std::vector<LogLine> lines = log.lines();
        const auto other = [&](const LogLine& line) {
            return (line.thread == std::this_thread::get_id()) != thisThread;
        };
        lines.erase(std::remove_if(lines.begin(), lines.end(), other), lines.end());
        return lines;
    }

    // What the dispatcher says of an action that names no service.
    const std::vector<ExpectedLine> discarded = {
        info("SyncToAsync::m_getMsgDispather(): invalid argument").tagged("ORV::SyncToAsync"),
        error("SyncToAsync::Run(): prMsgDispatcher==NULL").tagged("ORV::SyncToAsync")};
};

TEST_F(MediaClientListenerTest, LogsItsConstructionAndDestruction) {
    {
        sp<MediaClientListener> listener = new MediaClientListener;
    }
    const std::string constructor =
        "MediaClientListener::MediaClientListener(JNIEnv, jobject thiz, jobject weak_thiz): ";
    EXPECT_THAT(
        log.take(),
        LinesAre(
            {info(constructor + "Enter\n").tagged(kListenerTag),
             info(constructor + "Leave\n").tagged(kListenerTag),
             info("MediaClientListener::~MediaClientListener(): Enter\n").tagged(kListenerTag),
             info("MediaClientListener::~MediaClientListener(): Leave\n").tagged(kListenerTag)}));
}

TEST_F(MediaClientListenerTest, EventsGoToTheDispatcherWhichFindsNoPoster) {
    sp<MediaClientListener> listener = new MediaClientListener;
    log.clear();
    listener->notify(1, 2, 3, nullptr);
    ASSERT_TRUE(log.waitFor(discarded[1]));
    EXPECT_THAT(linesOf(true),
                LinesAre({info("MediaClientListener::notify(): Enter\n").tagged(kListenerTag),
                          info("MediaClientListener::notify(): Leave\n").tagged(kListenerTag)}));
    EXPECT_THAT(linesOf(false), LinesAre(discarded));
}

// Seen while the worker is kept from it, which the listener does not wait for.
TEST_F(MediaClientListenerTest, ActionCarriesTheEventAndNoService) {
    ORV::SyncToAsync& dispatcher = *ORV::SyncToAsync::getInstance();
    sp<MediaClientListener> listener = new MediaClientListener;
    const android::Parcel parcel;
    {
        os::ScopedMutex hold(dispatcher.*memberOf(ListenedMutex{}));
        listener->notify(3, -42, 7, &parcel);
        const auto& pending = dispatcher.*memberOf(ListenedActions{});
        ASSERT_EQ(pending.size(), 1u);
        const ORV::SyncToAsyncAction& action = *pending.front();
        EXPECT_EQ(action.kind, 0);
        EXPECT_EQ(action.cancelled, 0);
        EXPECT_TRUE(action.valid);
        EXPECT_EQ(action.service.get(), nullptr);
        ASSERT_NE(action.payload, nullptr);
        EXPECT_EQ(action.payload->msg, 3);
        EXPECT_EQ(action.payload->ext1, -42);
        EXPECT_EQ(action.payload->ext2, 7);
        EXPECT_EQ(action.payload->obj, &parcel);
    }
    EXPECT_TRUE(log.waitFor(discarded[1]));
}

// The leave line says that the dispatcher has the event.
TEST_F(MediaClientListenerTest, LeavesWhenTheActionIsAdded) {
    ORV::SyncToAsync& dispatcher = *ORV::SyncToAsync::getInstance();
    const ExpectedLine leave = info("MediaClientListener::notify(): Leave\n").tagged(kListenerTag);
    sp<MediaClientListener> listener = new MediaClientListener;
    std::optional<OtherThread> notifying;
    {
        os::ScopedMutex hold(dispatcher.*memberOf(ListenedMutex{}));
        notifying.emplace([&] { listener->notify(1, 2, 3, nullptr); });
        EXPECT_TRUE(notifying->isStopped());
        EXPECT_THAT(log.lines(), testing::Not(testing::Contains(LineIs(leave))));
    }
    notifying->join();
    EXPECT_TRUE(log.waitFor(discarded[1]));
}

TEST_F(MediaClientListenerTest, EveryEventOfAServiceIsDiscarded) {
    service->setListener(new MediaClientListener);
    log.clear();
    for (int msg : {1, 200, 5}) service->notify(msg, 0, 0, nullptr);
    ASSERT_TRUE(log.waitFor(discarded[1], 3));
    EXPECT_THAT(linesOf(false), LinesAre({discarded[0], discarded[1], discarded[0], discarded[1],
                                          discarded[0], discarded[1]}));
    service->setListener(nullptr);
}

TEST_F(MediaClientListenerTest, ParcelIsNeitherReadNorCopied) {
    sp<MediaClientListener> listener = new MediaClientListener;
    listener->notify(1, 2, 3, reinterpret_cast<const android::Parcel*>(8));
    EXPECT_TRUE(log.waitFor(discarded[1]));
}

TEST_F(MediaClientListenerTest, KeepsNoReferenceToItsService) {
    service->setListener(new MediaClientListener);
    service->notify(1, 0, 0, nullptr);
    ASSERT_TRUE(log.waitFor(discarded[1]));
    EXPECT_EQ(service->getStrongCount(), 1);
    service->setListener(nullptr);
}

}  // namespace
}  // namespace orvtest
