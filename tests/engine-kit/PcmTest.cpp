// SPDX-License-Identifier: Apache-2.0
// Media that are raw samples.
#include "KitTest.h"

using android::BAD_VALUE;
using android::INVALID_OPERATION;
using android::NO_ERROR;

namespace orvkit {
namespace {

constexpr int kToneMs = 2000;  // of tone-s16le.pcm as it was made

// What tone-s16le.pcm has.
IORV_PB_CTRL_SET_MEDIA_INFO_T toneInfo(int rate) {
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = {};
    info.eMediaType = E_ORV_MEDIA_TYPE_AUDIO_ES;
    auto& audio = info.uFormatInfo.tAudioEsInfo.tAudInfo;
    audio.eAudEnc = E_ORV_AUD_ENC_PCM;
    auto& pcm = audio.uAudCodecInfo.t_pcm_info;
    pcm.e_pcm_type = E_ORV_PCM_TYPE_SIGNED;
    pcm.eNumCh = E_Orv_Aud_Ch_Num(2);
    pcm.eSampleRate = E_Orv_Aud_Sample_Rate(rate);
    pcm.u2BlockAlign = 4;
    pcm.eBitsPerSample = E_Orv_Aud_Bits_Per_Sample(16);
    return info;
}

class PcmTest : public KitTest {
protected:
    void openTone() { openFile("tone-s16le.pcm"); }
};

TEST_F(PcmTest, SamplesArePlayedWithoutADescription) {
    checks("setPcmFlag", "without a description two channels of signed");
    player->setPcmFlag();
    openTone();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_NEAR(kToneMs, duration(), kNearMs);
}

TEST_F(PcmTest, ADescriptionIsFollowed) {
    checks("setPCMMediaInfo", "the media are raw samples of that description");
    constexpr int kHalfTheRate = 22050;
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = toneInfo(kHalfTheRate);
    const android::status_t status = player->setPCMMediaInfo(&info);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it plays no raw samples");
    ASSERT_EQ(NO_ERROR, status);
    openTone();
    if (IsSkipped() || HasFailure()) return;
    EXPECT_NEAR(2 * kToneMs, duration(), kNearMs);
}

TEST_F(PcmTest, OtherDescriptionsAreRefused) {
    checks("setPCMMediaInfo", "BAD_VALUE for values that orvtarn/PcmRecords.h does not have");
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = toneInfo(1);
    const android::status_t status = player->setPCMMediaInfo(&info);
    ORV_NOT_OFFERED_IF(status == INVALID_OPERATION, "it plays no raw samples");
    EXPECT_EQ(BAD_VALUE, status);
}

}  // namespace
}  // namespace orvkit
