// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>
#include <mpv/client.h>
#include <orvtarn/PlayerTypes.h>

#include "core/MpvError.h"

namespace orvtarn {
namespace {

TEST(MpvErrorTest, EachHasItsStatus) {
    EXPECT_EQ(android::NO_ERROR, statusOfMpvError(MPV_ERROR_SUCCESS));
    EXPECT_EQ(ORV_ERROR_IO, statusOfMpvError(MPV_ERROR_LOADING_FAILED));
    EXPECT_EQ(ORV_ERROR_MALFORMED, statusOfMpvError(MPV_ERROR_UNKNOWN_FORMAT));
    EXPECT_EQ(ORV_ERROR_UNSUPPORTED, statusOfMpvError(MPV_ERROR_NOTHING_TO_PLAY));
    EXPECT_EQ(ORV_ERROR_UNSUPPORTED, statusOfMpvError(MPV_ERROR_GENERIC));
    EXPECT_EQ(android::NO_MEMORY, statusOfMpvError(MPV_ERROR_NOMEM));
}

TEST(MpvErrorTest, AnyOtherIsUnknown) {
    for (int error :
         std::initializer_list<int>{MPV_ERROR_EVENT_QUEUE_FULL, MPV_ERROR_AO_INIT_FAILED,
                                    MPV_ERROR_VO_INIT_FAILED, MPV_ERROR_COMMAND, 1, -1000}) {
        EXPECT_EQ(android::UNKNOWN_ERROR, statusOfMpvError(error)) << error;
    }
}

}  // namespace
}  // namespace orvtarn
