// SPDX-License-Identifier: Apache-2.0
#include "playback/HardwareDecoding.h"

#include "core/HardwareDecoder.h"

namespace orvtarn {

void HardwareDecoding::setOnWindow(bool onWindow) {
    std::lock_guard<std::mutex> lock(mMutex);
    mOnWindow = onWindow;
    apply();
}

void HardwareDecoding::setFiltered(bool filtered) {
    std::lock_guard<std::mutex> lock(mMutex);
    mFiltered = filtered;
    apply();
}

// mpv begins its decoder anew for each setting.
void HardwareDecoding::apply() {
    const bool direct = mOnWindow && !mFiltered;
    if (direct == mDirect) return;
    mDirect = direct;
    mMpv.set("hwdec", direct ? directDecoder(mDecoder) : mDecoder);
}

}  // namespace orvtarn
