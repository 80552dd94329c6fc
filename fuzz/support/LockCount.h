// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvfuzz {

// How many mutexes the calling thread holds, of those that the product and the
// fakes take. By the linker's --wrap.
int heldLocks();

}  // namespace orvfuzz
