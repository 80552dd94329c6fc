// SPDX-License-Identifier: Apache-2.0
#include "LogCounts.h"

#include <string.h>

#include <atomic>
#include <initializer_list>

#include "LogSink.h"

namespace stress {

namespace {

struct Counter {
    const char* text;
    std::atomic<uint64_t> count;
};

Counter sNotValid{"SyncToAsync::Run(): action is not valid", {0}};
Counter sNoPoster{"SyncToAsync::Run(): prMsgDispatcher==NULL", {0}};
Counter sCancelled{"SyncToAsync::Run(): this event has been canceled", {0}};
Counter sListenerActions{"MediaClientListener::notify(): Leave\n", {0}};
Counter sTimedTexts{"OrvMediaClient_addTimedTextSource(): Leave\n", {0}};
Counter sCommands{"OrvMediaClient_QTVDEC_SendCliCommand(): Leave\n", {0}};

bool take(const orvtest::SinkLine& line) {
    for (Counter* counter :
         {&sNotValid, &sNoPoster, &sCancelled, &sListenerActions, &sTimedTexts, &sCommands}) {
        if (strcmp(line.text, counter->text) == 0) {
            counter->count.fetch_add(1, std::memory_order_relaxed);
        }
    }
    return true;
}

uint64_t valueOf(const Counter& counter) { return counter.count.load(std::memory_order_relaxed); }

}  // namespace

void countLog() {
    orvtest::installLogSink<take>();
    __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
}

LogCounts logCounts() {
    return {valueOf(sNotValid), valueOf(sNoPoster), valueOf(sCancelled), valueOf(sListenerActions),
            valueOf(sTimedTexts) + valueOf(sCommands)};
}

}  // namespace stress
