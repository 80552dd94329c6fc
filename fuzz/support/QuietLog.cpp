// SPDX-License-Identifier: Apache-2.0
#include "QuietLog.h"

#include "LogSink.h"

namespace orvfuzz {
namespace {

bool drop(const orvtest::SinkLine&) { return true; }

}  // namespace

void quietLog() {
    orvtest::installLogSink<drop>();
    __android_log_set_minimum_priority(ANDROID_LOG_VERBOSE);
}

}  // namespace orvfuzz
