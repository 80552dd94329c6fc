// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvfuzz {

// Lines of every priority are put together, so that a fault in doing so is
// found, and dropped.
void quietLog();

}  // namespace orvfuzz
