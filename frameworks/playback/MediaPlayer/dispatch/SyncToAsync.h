// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/RefBase.h>

#include <list>

#include "dispatch/MsgDispatcher.h"
#include "dispatch/SyncToAsyncAction.h"
#include "jni/media-service/OrvMediaService.h"
#include "os/Export.h"
#include "os/MessageQueue.h"
#include "os/Mutex.h"
#include "os/Thread.h"

namespace ORV {

// A service and the poster of its events.
struct MsgHandler {
    // Members go in reverse: the poster first, then the service.
    android::sp<android::OrvMediaService> service;
    android::sp<MsgDispatcher> dispatcher;
};

// The process's one dispatcher: a worker thread that hands events to the
// posters of their services, in the order of addAction, at least 50 ms apart.
// The pause is taken under the dispatcher's mutex, so every operation here may
// wait for a delivery and its pause. Any thread may call them.
class ORV_EXPORT SyncToAsync : public os::Thread {
public:
    // Created on first use, destroyed at process exit.
    static SyncToAsync* getInstance();

    ~SyncToAsync() override;

    // Takes the action over and returns before it is delivered.
    void addAction(SyncToAsyncAction* action);
    // Delivery of a pending action becomes a line in the log.
    void abortAction(SyncToAsyncAction* action);
    // The same for all pending actions of a service; unless keepValid they are
    // dropped at once when their turn comes.
    void abortAllActions(android::sp<android::OrvMediaService> service, bool keepValid);

    // Pairs are kept in the order of their registration, and a service may
    // have several: the first gets its events and is the first to be removed.
    void addMsgHandler(android::sp<android::OrvMediaService> service,
                       android::sp<MsgDispatcher> dispatcher);
    void delMsgHandler(android::sp<android::OrvMediaService> service);

    void Run() override;

private:
    SyncToAsync();

    // These are called with m_mutex held.
    void m_handleAction(SyncToAsyncAction* action);
    void m_deliver(SyncToAsyncAction* action, const android::sp<MsgDispatcher>& dispatcher);
    android::sp<MsgDispatcher> m_getMsgDispather(android::sp<android::OrvMediaService> service);
    void m_deleteMsgHandler(MsgHandler* handler);
    void m_deleteAction(SyncToAsyncAction* action);

    static os::Mutex s_mutexGlobal;  // guards the creation of the instance

    os::MessageQueue<SyncToAsyncAction*> m_queue;
    os::Mutex m_mutex;  // guards both lists and every delivery
    std::list<SyncToAsyncAction*> m_actions;
    std::list<MsgHandler*> m_handlers;
};

}  // namespace ORV
