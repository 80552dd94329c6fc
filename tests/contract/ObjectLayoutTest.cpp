// SPDX-License-Identifier: Apache-2.0
// The fields of the objects that other libraries of the process hold, in the
// order of the contract. Every field stands at the next place that suits its
// alignment, so a swap or an insertion shows on every target; the numbers of
// the 32-bit ARM target stand beside them.

#include <gtest/gtest.h>
#include <string.h>

#include <list>
#include <queue>
#include <string>
#include <vector>

#include "PrivateMember.h"
#include "dispatch/SyncToAsync.h"
#include "os/MemoryPool.h"
#include "os/ScopedMutex.h"
#include "stream/JavaInputStream.h"

namespace orvtest {

// Opens Class::member to this file under the name tag.
#define OPEN(tag, Class, member) ORV_OPEN_MEMBER(Layout##tag, Class, member)

using android::OrvMediaService;
using ActionQueue = os::MessageQueue<ORV::SyncToAsyncAction*>;

OPEN(EngineListener, OrvMediaService, mEngineListener);
OPEN(StreamType, OrvMediaService, mStreamType);
OPEN(AudioSessionId, OrvMediaService, mAudioSessionId);
OPEN(Player, OrvMediaService, mPlayer);
OPEN(ServiceMutex, OrvMediaService, mLock);
OPEN(ServiceListener, OrvMediaService, mListener);
OPEN(Loop, OrvMediaService, mLoop);
OPEN(MetadataMutex, OrvMediaService, mMetadataLock);
OPEN(MetadataAllow, OrvMediaService, mMetadataAllow);
OPEN(MetadataDrop, OrvMediaService, mMetadataDrop);
OPEN(MetadataUpdated, OrvMediaService, mMetadataUpdated);
OPEN(Speed, OrvMediaService, mSpeed);
OPEN(PosterClass, ORV::MsgDispatcher, mClass);
OPEN(PosterObject, ORV::MsgDispatcher, mObject);
OPEN(NativeMutex, os::Mutex, mMutex);
OPEN(MutexAttributes, os::Mutex, mAttributes);
OPEN(NativeSemaphore, os::Semaphore, mSemaphore);
OPEN(ThreadName, os::Thread, mName);
OPEN(ThreadHandle, os::Thread, mHandle);
OPEN(ThreadAttributes, os::Thread, mAttributes);
OPEN(ThreadImplmentation, os::Thread, mImplmentation);
OPEN(QueueItems, ActionQueue, mQueue);
OPEN(QueueMutex, ActionQueue, mMutex);
OPEN(QueueWakeUp, ActionQueue, mWakeUp);
OPEN(DispatcherQueue, ORV::SyncToAsync, m_queue);
OPEN(DispatcherMutex, ORV::SyncToAsync, m_mutex);
OPEN(DispatcherActions, ORV::SyncToAsync, m_actions);
OPEN(DispatcherHandlers, ORV::SyncToAsync, m_handlers);
OPEN(StreamValid, JavaInputStream, mValid);
OPEN(StreamClass, JavaInputStream, mClass);
OPEN(StreamObject, JavaInputStream, mObject);
OPEN(StreamCallMutex, JavaInputStream, mCallMutex);
OPEN(StreamStreamMutex, JavaInputStream, mStreamMutex);
OPEN(StreamDataSourceType, JavaInputStream, mDataSourceType);
OPEN(StreamThreadSelf, JavaInputStream, mThreadSelf);

namespace {

using android::Mutex;
using android::OrvMediaServiceListener;
using android::SortedVector;
using android::sp;
using android::TarnPlayer;

struct Field {
    const char* name;
    size_t offset, size, alignment;
    size_t armOffset;
};

// A member pointer is the member's offset in the Itanium C++ ABI. Expected is
// the field's type by contract, or one of its width.
template <typename Expected, typename Object, typename Member>
Field field(const char* name, Member Object::* member, size_t armOffset) {
    static_assert(sizeof(Member) == sizeof(Expected) && alignof(Member) == alignof(Expected));
    ptrdiff_t offset = 0;
    static_assert(sizeof(offset) == sizeof(member));
    memcpy(&offset, &member, sizeof(offset));
    return {name, static_cast<size_t>(offset), sizeof(Member), alignof(Member), armOffset};
}

// begin: what stands before the first field, such as the table of slots.
void expectFields(const std::vector<Field>& fields, size_t begin) {
    size_t end = begin;
    for (const Field& field : fields) {
        const size_t place = (end + field.alignment - 1) / field.alignment * field.alignment;
        EXPECT_EQ(field.offset, place) << field.name;
#ifdef __arm__
        EXPECT_EQ(field.offset, field.armOffset) << field.name;
#endif
        end = place + field.size;
    }
}

constexpr size_t kSlots = sizeof(void*);  // the pointer to an object's virtual slots

#define OPENED(Type, tag, armOffset) field<Type>(#tag, memberOf(Layout##tag{}), armOffset)
#define PUBLIC(Type, Class, member, armOffset) field<Type>(#member, &Class::member, armOffset)

TEST(ObjectLayout, MediaService) {
    expectFields(
        {
            OPENED(sp<OrvMediaService::Listener>, EngineListener, 4),
            OPENED(int32_t, StreamType, 8),
            OPENED(int32_t, AudioSessionId, 12),
            OPENED(sp<TarnPlayer>, Player, 16),
            OPENED(Mutex, ServiceMutex, 20),
            OPENED(sp<OrvMediaServiceListener>, ServiceListener, 44),
            OPENED(bool, Loop, 48),
            OPENED(Mutex, MetadataMutex, 52),
            OPENED(SortedVector<int32_t>, MetadataAllow, 76),
            OPENED(SortedVector<int32_t>, MetadataDrop, 96),
            OPENED(SortedVector<int32_t>, MetadataUpdated, 116),
            OPENED(int32_t, Speed, 136),
        },
        kSlots);
}

TEST(ObjectLayout, EventRecords) {
    expectFields(
        {
            PUBLIC(int32_t, NotifyMessage, msg, 0),
            PUBLIC(int32_t, NotifyMessage, ext1, 4),
            PUBLIC(int32_t, NotifyMessage, ext2, 8),
            PUBLIC(const android::Parcel*, NotifyMessage, obj, 12),
        },
        0);
    using ORV::MsgHandler;
    using ORV::SyncToAsyncAction;
    expectFields(
        {
            PUBLIC(int32_t, SyncToAsyncAction, kind, 0),
            PUBLIC(NotifyMessage*, SyncToAsyncAction, payload, 4),
            PUBLIC(int32_t, SyncToAsyncAction, cancelled, 8),
            PUBLIC(sp<OrvMediaService>, SyncToAsyncAction, service, 12),
            PUBLIC(bool, SyncToAsyncAction, valid, 16),
        },
        0);
    expectFields(
        {
            PUBLIC(sp<OrvMediaService>, MsgHandler, service, 0),
            PUBLIC(sp<ORV::MsgDispatcher>, MsgHandler, dispatcher, 4),
        },
        0);
#ifdef __arm__
    EXPECT_EQ(sizeof(NotifyMessage), 16u);
    EXPECT_EQ(sizeof(SyncToAsyncAction), 20u);
    EXPECT_EQ(sizeof(MsgHandler), 8u);
#endif
}

TEST(ObjectLayout, EventPoster) {
    expectFields({OPENED(jclass, PosterClass, 4), OPENED(jobject, PosterObject, 8)}, kSlots);
}

TEST(ObjectLayout, OsLayer) {
    EXPECT_EQ(sizeof(os::Lock), kSlots);
    expectFields(
        {OPENED(pthread_mutex_t, NativeMutex, 4), OPENED(pthread_mutexattr_t, MutexAttributes, 28)},
        kSlots);
    expectFields({OPENED(sem_t, NativeSemaphore, 0)}, 0);
    EXPECT_EQ(sizeof(os::Semaphore), sizeof(sem_t));
    EXPECT_EQ(sizeof(os::ScopedMutex), sizeof(os::Lock*));
    expectFields(
        {
            OPENED(std::string, ThreadName, 4),
            OPENED(pthread_t, ThreadHandle, 28),
            OPENED(pthread_attr_t*, ThreadAttributes, 32),
            OPENED(void*, ThreadImplmentation, 36),
        },
        kSlots);
}

TEST(ObjectLayout, DispatcherAndItsQueue) {
    expectFields(
        {
            OPENED(std::queue<ORV::SyncToAsyncAction*>, QueueItems, 0),
            OPENED(os::Mutex, QueueMutex, 40),
            OPENED(os::Semaphore, QueueWakeUp, 72),
        },
        0);
    struct ThreeFields {
        std::queue<ORV::SyncToAsyncAction*> items;
        os::Mutex mutex;
        os::Semaphore wakeUp;
    };
    EXPECT_EQ(sizeof(ActionQueue), sizeof(ThreeFields));
    expectFields(
        {
            OPENED(ActionQueue, DispatcherQueue, 40),
            OPENED(os::Mutex, DispatcherMutex, 128),
            OPENED(std::list<ORV::SyncToAsyncAction*>, DispatcherActions, 160),
            OPENED(std::list<ORV::MsgHandler*>, DispatcherHandlers, 172),
        },
        sizeof(os::Thread));
}

TEST(ObjectLayout, JavaStream) {
    EXPECT_EQ(sizeof(IOrvStreamSource), kSlots);
    expectFields(
        {
            OPENED(bool, StreamValid, 4),
            OPENED(jclass, StreamClass, 8),
            OPENED(jobject, StreamObject, 12),
            OPENED(os::Mutex, StreamCallMutex, 16),
            OPENED(os::Mutex, StreamStreamMutex, 48),
            OPENED(int32_t, StreamDataSourceType, 80),
            OPENED(bool, StreamThreadSelf, 84),
        },
        kSlots);
}

TEST(ObjectLayout, MemoryPool) {
    expectFields(
        {
            PUBLIC(int32_t, MemoryBlock, size, 0),
            PUBLIC(int32_t, MemoryBlock, reserved, 4),
            PUBLIC(MemoryBlock*, MemoryBlock, next, 8),
            PUBLIC(MemoryBlock*, MemoryBlock, prev, 12),
        },
        0);
    expectFields(
        {PUBLIC(MemoryBlock, MemoryList, head, 0), PUBLIC(int32_t, MemoryList, reserved, 16)}, 0);
#ifdef __arm__
    EXPECT_EQ(sizeof(MemoryList), 20u);
    EXPECT_EQ(size_t{MEMORY_HEADER_SIZE}, 16u);
#endif
}

}  // namespace
}  // namespace orvtest
