// SPDX-License-Identifier: Apache-2.0
#include "dispatch/SyncToAsync.h"

#include <log/log.h>

#include <algorithm>

#include "os/ScopedMutex.h"
#include "os/StaticOrder.h"

#undef LOG_TAG
#define LOG_TAG "ORV::SyncToAsync"

using android::OrvMediaService;
using android::sp;

namespace ORV {

namespace {

// Between two deliveries, so that Java is not flooded.
const int kPauseMs = 50;

}  // namespace

os::Mutex SyncToAsync::s_mutexGlobal ORV_INIT_ORDER(ORV_INIT_DISPATCHER_MUTEX);

SyncToAsync* SyncToAsync::getInstance() {
    os::ScopedMutex lock(s_mutexGlobal);
    static SyncToAsync instance;
    return &instance;
}

SyncToAsync::SyncToAsync() : os::Thread("thread") {
    ALOGI("SyncToAsync::SyncToAsync(): Enter");
    Start();
    ALOGI("SyncToAsync::SyncToAsync(): Leave");
}

SyncToAsync::~SyncToAsync() {
    ALOGI("SyncToAsync::~SyncToAsync(): Enter");
    m_queue.send(nullptr);  // ends Run
    Wait();
    ALOGI("SyncToAsync::~SyncToAsync(): Leave");
}

void SyncToAsync::addAction(SyncToAsyncAction* action) {
    if (action == nullptr) {
        ALOGI("SyncToAsync::addAction(): invalid argument");
        return;
    }
    os::ScopedMutex lock(m_mutex);
    m_actions.push_back(action);
    m_queue.send(action);
}

void SyncToAsync::abortAction(SyncToAsyncAction* action) {
    if (action == nullptr) {
        ALOGI("SyncToAsync::abortAction(): invalid argument");
        return;
    }
    os::ScopedMutex lock(m_mutex);
    // An action that is not listed any more was deleted: it must not be touched.
    const auto pending = std::find(m_actions.begin(), m_actions.end(), action);
    if (pending != m_actions.end()) (*pending)->cancelled = 1;
}

void SyncToAsync::abortAllActions(sp<OrvMediaService> service, bool keepValid) {
    ALOGI("SyncToAsync::abortAllActions(): Enter");
    if (service == nullptr) {
        ALOGI("SyncToAsync::abortAllActions(): invalid argument");
        return;
    }
    os::ScopedMutex lock(m_mutex);
    for (SyncToAsyncAction* action : m_actions) {
        if (action->service != service) continue;
        action->cancelled = 1;
        action->valid = keepValid;
    }
    ALOGI("SyncToAsync::abortAllActions(): Leave");
}

void SyncToAsync::addMsgHandler(sp<OrvMediaService> service, sp<MsgDispatcher> dispatcher) {
    ALOGI("SyncToAsync::addMsgHandler(): Enter");
    if (service == nullptr || dispatcher == nullptr) {
        ALOGI("SyncToAsync::addMsgHandler(): invalid argument");
        return;
    }
    os::ScopedMutex lock(m_mutex);
    m_handlers.push_back(new MsgHandler{service, dispatcher});
    ALOGI("SyncToAsync::addMsgHandler(): Leave");
}

void SyncToAsync::delMsgHandler(sp<OrvMediaService> service) {
    ALOGI("SyncToAsync::delMsgHandler(): Enter");
    if (service == nullptr) {
        ALOGI("SyncToAsync::delMsgHandler(): invalid argument");
        return;
    }
    os::ScopedMutex lock(m_mutex);
    const auto first =
        std::find_if(m_handlers.begin(), m_handlers.end(),
                     [&](const MsgHandler* handler) { return handler->service == service; });
    if (first != m_handlers.end()) m_deleteMsgHandler(*first);
    ALOGI("SyncToAsync::delMsgHandler(): leave");
}

void SyncToAsync::Run() {
    while (SyncToAsyncAction* action = m_queue.recv()) {
        os::ScopedMutex lock(m_mutex);
        m_handleAction(action);
    }
}

void SyncToAsync::m_handleAction(SyncToAsyncAction* action) {
    if (!action->valid) {
        ALOGI("SyncToAsync::Run(): action is not valid");
        m_deleteAction(action);
        return;
    }
    const sp<MsgDispatcher> dispatcher = m_getMsgDispather(action->service);
    if (dispatcher == nullptr) {
        ALOGE("SyncToAsync::Run(): prMsgDispatcher==NULL");
        m_deleteAction(action);
        return;
    }
    m_deliver(action, dispatcher);
    m_deleteAction(action);
    sleep(kPauseMs);
}

void SyncToAsync::m_deliver(SyncToAsyncAction* action, const sp<MsgDispatcher>& dispatcher) {
    if (action->cancelled != 0) {
        ALOGI("SyncToAsync::Run(): this event has been canceled");
        return;
    }
    if (action->kind != 0) return;
    const NotifyMessage* message = action->payload;
    if (message == nullptr) {
        ALOGE("SyncToAsync::Run(): prMsgWrapper==NULL");
        return;
    }
    dispatcher->notify(message->msg, message->ext1, message->ext2, message->obj);
}

sp<MsgDispatcher> SyncToAsync::m_getMsgDispather(sp<OrvMediaService> service) {
    if (service == nullptr) {
        ALOGI("SyncToAsync::m_getMsgDispather(): invalid argument");
        return nullptr;
    }
    for (const MsgHandler* handler : m_handlers) {
        if (handler->service == service) return handler->dispatcher;
    }
    return nullptr;
}

void SyncToAsync::m_deleteMsgHandler(MsgHandler* handler) {
    ALOGI("SyncToAsync::m_deleteMsgHandler(): Enter");
    if (handler != nullptr) {
        m_handlers.remove(handler);
        delete handler;
    }
    ALOGI("SyncToAsync::m_deleteMsgHandler(): Leave");
}

void SyncToAsync::m_deleteAction(SyncToAsyncAction* action) {
    if (action == nullptr) return;
    // Actions go in the order in which they came: it is the first, usually.
    const auto pending = std::find(m_actions.begin(), m_actions.end(), action);
    if (pending != m_actions.end()) m_actions.erase(pending);
    delete action->payload;
    delete action;
}

}  // namespace ORV
