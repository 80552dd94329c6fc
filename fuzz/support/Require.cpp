// SPDX-License-Identifier: Apache-2.0
#include "Require.h"

#include <stdio.h>
#include <stdlib.h>

namespace orvfuzz {

void require(bool holds, const char* promise) {
    if (holds) return;
    fprintf(stderr, "broken: %s\n", promise);
    abort();
}

void require(bool holds, const std::string& promise) { require(holds, promise.c_str()); }

}  // namespace orvfuzz
