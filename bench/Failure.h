// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <benchmark/benchmark.h>

#include <string>

namespace orvbench {

// Ends a benchmark, and has the program fail, too.
void fail(benchmark::State& state, const std::string& why);

// Whether any has failed.
bool anyFailed();

}  // namespace orvbench
