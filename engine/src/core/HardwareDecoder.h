// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtarn {

// The hardware decoder that mpv shall try, as its option "hwdec" has it: one that
// copies its pictures back, so that they can be drawn by software, and that this
// machine has the device of. A search for others would complain on machines
// without them. "no" where there is none; mpv decodes by software where the
// decoder cannot do the media.
const char* hardwareDecoder();

}  // namespace orvtarn
