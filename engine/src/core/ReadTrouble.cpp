// SPDX-License-Identifier: Apache-2.0
#include "core/ReadTrouble.h"

#include <orvtarn/PlayerTypes.h>
#include <stdlib.h>
#include <string.h>

#include <iterator>

namespace orvtarn {
namespace {

struct Sign {
    const char* text;
    android::status_t status;
};

// The weightier first: a connection that is taken up again leads to several.
// The same in mpv 0.35 to 0.40 and FFmpeg 5.1 to 7.1.
const Sign kSigns[] = {
    {"not on whitelist", ORV_ERROR_LOCAL_REFERENCE},
    {"Refusing to load potentially unsafe URL", ORV_ERROR_LOCAL_REFERENCE},
    {"Unsafe file name", ORV_ERROR_LOCAL_REFERENCE},
    {"HTTP error ", ORV_ERROR_HTTP},
    {"Failed to resolve hostname", ORV_ERROR_CONNECTION_LOST},
    {"Connection to ", ORV_ERROR_CONNECTION_LOST},
    {"Failed to open segment", ORV_ERROR_CONNECTION_LOST},
    {"Cannot seek backward in linear streams", ORV_ERROR_NEEDS_RANGES},
    {"Stream ends prematurely", ORV_ERROR_CUT_SHORT},
    {"Will reconnect at ", ORV_ERROR_CONNECTION_LOST},
};

}  // namespace

void ReadTrouble::note(const std::string& line) {
    for (size_t i = 0; i <= mWeight && i < std::size(kSigns); i++) {
        const size_t place = line.find(kSigns[i].text);
        if (place == std::string::npos) continue;
        const char* after = line.c_str() + place + strlen(kSigns[i].text);
        const int httpStatus = kSigns[i].status == ORV_ERROR_HTTP ? atoi(after) : 0;
        mStatus = kSigns[i].status - httpStatus;
        mWeight = i;
        return;
    }
}

void ReadTrouble::forget() { *this = {}; }

}  // namespace orvtarn
