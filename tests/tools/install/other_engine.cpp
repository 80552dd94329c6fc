// SPDX-License-Identifier: Apache-2.0
#include <orvtarn/TarnPlayer.h>
#include <stream/IOrvStreamSource.h>

namespace android {

bool TarnPlayer::canDoSeek(int speed) { return speed == 0; }

}  // namespace android
