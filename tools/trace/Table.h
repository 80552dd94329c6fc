// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

#include "Statistics.h"

namespace orvtrace {

// The table: its heading and a row for each native method that was called.
std::vector<std::vector<std::string>> rowsOf(const Statistics& statistics, const LineCounts& lines);
// The native methods that were called, a line each, and what became of the log's lines.
std::string tableOf(const Statistics& statistics, const LineCounts& lines, uint64_t players);
// The last part of it: sentences.
std::string summaryOf(const Statistics& statistics, const LineCounts& lines, uint64_t players);

}  // namespace orvtrace
