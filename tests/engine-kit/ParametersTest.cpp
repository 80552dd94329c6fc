// SPDX-License-Identifier: Apache-2.0
// Values that are set and read by keys.
#include <binder/Parcel.h>
#include <orvtarn/Parameters.h>
#include <utils/String16.h>

#include "KitTest.h"

using android::BAD_VALUE;
using android::INVALID_OPERATION;
using android::NO_ERROR;
using android::Parcel;

namespace orvkit {
namespace {

constexpr int kNoKey = 0x7FFF;

class ParametersTest : public KitTest {
protected:
    static void writeValue(Parcel& parcel, int32_t value) {
        parcel.writeInt32(value);
        parcel.setDataPosition(0);
    }
    // An engine without a key answers as for an unknown one.
    android::status_t set(int key, int32_t value) {
        Parcel request;
        writeValue(request, value);
        return player->setParameter(key, request);
    }
    android::status_t get(int key, int32_t& value) {
        Parcel reply;
        const android::status_t status = player->getParameter(key, &reply);
        reply.setDataPosition(0);
        value = reply.readInt32();
        return status;
    }
};

TEST_F(ParametersTest, UnknownKeysAreRefused) {
    checks("setParameter", "For the keys and methods of orvtarn/Parameters.h");
    EXPECT_EQ(BAD_VALUE, set(kNoKey, 1));
}

TEST_F(ParametersTest, AParameterIsKept) {
    checks("setParameter", "Any time, for all media to come");
    ORV_NOT_OFFERED_IF(set(ORV_PARAMETER_KEEP_ASPECT, 0) == BAD_VALUE, "it has no such parameter");
    int32_t value = -1;
    ASSERT_EQ(NO_ERROR, get(ORV_PARAMETER_KEEP_ASPECT, value));
    EXPECT_EQ(0, value);
    EXPECT_EQ(BAD_VALUE, set(ORV_PARAMETER_KEEP_ASPECT, 2));
}

TEST_F(ParametersTest, UnknownKeysHaveNoValue) {
    checks("getParameter", "Unknown keys and methods are BAD_VALUE");
    Parcel reply;
    EXPECT_EQ(BAD_VALUE, player->getParameter(kNoKey, &reply));
}

TEST_F(ParametersTest, TheEngineHasAName) {
    checks("getParameter",
           "ORV_PARAMETER_ENGINE_NAME: String16: the playback library and its version");
    Parcel reply;
    const android::status_t status = player->getParameter(ORV_PARAMETER_ENGINE_NAME, &reply);
    ORV_NOT_OFFERED_IF(status == BAD_VALUE, "it has no such parameter");
    ASSERT_EQ(NO_ERROR, status);
    reply.setDataPosition(0);
    EXPECT_GT(reply.readInt32(), 0) << "the length of the name";
}

TEST_F(ParametersTest, UnknownMethodsAreRefused) {
    checks("invoke", "Unknown keys and methods are BAD_VALUE");
    Parcel request;
    Parcel reply;
    writeValue(request, kNoKey);
    EXPECT_EQ(BAD_VALUE, player->invoke(request, &reply));
}

TEST_F(ParametersTest, TheTracksCanBeListed) {
    checks("invoke", "INVALID_OPERATION without media to operate on");
    Parcel request;
    Parcel reply;
    writeValue(request, ORV_INVOKE_GET_TRACKS);
    const android::status_t status = player->invoke(request, &reply);
    ORV_NOT_OFFERED_IF(status == BAD_VALUE, "it has no such method");
    EXPECT_EQ(INVALID_OPERATION, status);
    ORV_OPEN();
    request.setDataPosition(0);
    ASSERT_EQ(NO_ERROR, player->invoke(request, &reply));
    reply.setDataPosition(0);
    EXPECT_GT(reply.readInt32(), 0) << "how many there are";
    EXPECT_EQ(ORV_TRACK_KIND_VIDEO, reply.readInt32());
}

}  // namespace
}  // namespace orvkit
