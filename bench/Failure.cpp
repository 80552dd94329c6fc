// SPDX-License-Identifier: Apache-2.0
#include "Failure.h"

namespace orvbench {
namespace {

bool gFailed = false;

}  // namespace

void fail(benchmark::State& state, const std::string& why) {
    state.SkipWithError(why.c_str());
    gFailed = true;
}

bool anyFailed() { return gFailed; }

}  // namespace orvbench
