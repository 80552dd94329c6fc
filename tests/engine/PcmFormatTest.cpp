// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <cstdio>
#include <vector>

#include "RealPlayer.h"
#include "records/PcmFormat.h"

namespace orvtarn {
namespace {

IORV_PB_CTRL_SET_MEDIA_INFO_T description(int type, int bits, int channels, int rate,
                                          bool bigEndian) {
    IORV_PB_CTRL_SET_MEDIA_INFO_T info = {};
    info.eMediaType = E_ORV_MEDIA_TYPE_AUDIO_ES;
    ORV_AUD_INFO_T& audio = info.uFormatInfo.tAudioEsInfo.tAudInfo;
    audio.eAudEnc = E_ORV_AUD_ENC_PCM;
    ORV_AUD_PCM_INFO_T& pcm = audio.uAudCodecInfo.t_pcm_info;
    pcm.e_pcm_type = static_cast<E_Orv_Pcm_Type>(type);
    pcm.eNumCh = static_cast<E_Orv_Aud_Ch_Num>(channels);
    pcm.eSampleRate = static_cast<E_Orv_Aud_Sample_Rate>(rate);
    pcm.u2BlockAlign = static_cast<uint16_t>(int64_t{channels} * bits / 8);
    pcm.eBitsPerSample = static_cast<E_Orv_Aud_Bits_Per_Sample>(bits);
    pcm.fgBigEndian = bigEndian;
    return info;
}

ORV_AUD_PCM_INFO_T& pcmOf(IORV_PB_CTRL_SET_MEDIA_INFO_T& info) {
    return info.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info;
}

// Empty when the description is taken.
std::string refusal(const IORV_PB_CTRL_SET_MEDIA_INFO_T& info) {
    PcmFormat format;
    std::string reason;
    if (pcmFormat(info, format, reason)) return "";
    EXPECT_TRUE(format.options.empty());
    EXPECT_FALSE(reason.empty());
    return reason;
}

struct Combination {
    int type;
    int bits;
    bool bigEndian;
    const char* codec;  // libavcodec's name for what must play
};

const Combination kCombinations[] = {
    {E_ORV_PCM_TYPE_SIGNED, 8, false, "pcm_s8"},     {E_ORV_PCM_TYPE_SIGNED, 8, true, "pcm_s8"},
    {E_ORV_PCM_TYPE_SIGNED, 16, false, "pcm_s16le"}, {E_ORV_PCM_TYPE_SIGNED, 16, true, "pcm_s16be"},
    {E_ORV_PCM_TYPE_SIGNED, 24, false, "pcm_s24le"}, {E_ORV_PCM_TYPE_SIGNED, 24, true, "pcm_s24be"},
    {E_ORV_PCM_TYPE_SIGNED, 32, false, "pcm_s32le"}, {E_ORV_PCM_TYPE_SIGNED, 32, true, "pcm_s32be"},
    {E_ORV_PCM_TYPE_UNSIGNED, 8, false, "pcm_u8"},   {E_ORV_PCM_TYPE_FLOAT, 32, false, "pcm_f32le"},
    {E_ORV_PCM_TYPE_FLOAT, 32, true, "pcm_f32be"},   {E_ORV_PCM_TYPE_ALAW, 8, false, "pcm_alaw"},
    {E_ORV_PCM_TYPE_ULAW, 8, false, "pcm_mulaw"},
};

TEST(PcmFormat, DescribesSixteenBitSound) {
    PcmFormat format;
    std::string reason;
    ASSERT_TRUE(pcmFormat(description(E_ORV_PCM_TYPE_SIGNED, 16, 2, 44100, true), format, reason));
    const MpvOptions expected = {{"demuxer", "rawaudio"},
                                 {"demuxer-rawaudio-format", "s16be"},
                                 {"demuxer-rawaudio-rate", "44100"}};
    EXPECT_EQ(format.options, expected);
    EXPECT_EQ(format.channels, 2);
    EXPECT_EQ(format.bytesPerSecond, 176400);
}

// What the player makes of half a second of each format.
TEST(PcmFormat, IsPlayedAsDescribed) {
    const std::string path = testing::TempDir() + "/samples.raw";
    orvtest::RealPlayer player;
    for (const Combination& one : kCombinations) {
        for (int channels : {1, 2, 6, 8}) {
            SCOPED_TRACE(std::string(one.codec) + " x" + std::to_string(channels));
            PcmFormat format;
            std::string reason;
            ASSERT_TRUE(pcmFormat(description(one.type, one.bits, channels, 32000, one.bigEndian),
                                  format, reason))
                << reason;
            const std::vector<char> samples(format.bytesPerSecond / 2);
            FILE* file = fopen(path.c_str(), "wb");
            ASSERT_NE(file, nullptr);
            ASSERT_EQ(fwrite(samples.data(), 1, samples.size(), file), samples.size());
            fclose(file);
            const std::string count = std::to_string(format.channels);
            ASSERT_TRUE(player.command("set", "demuxer-rawaudio-channels", count.c_str()));
            ASSERT_TRUE(player.load(path, format.options));
            EXPECT_EQ(player.text("track-list/0/codec"), one.codec);
            EXPECT_EQ(player.text("track-list/0/demux-samplerate"), "32000");
            EXPECT_EQ(player.text("track-list/0/demux-channel-count"), std::to_string(channels));
            EXPECT_EQ(player.text("duration").substr(0, 3), "0.5");
        }
    }
    remove(path.c_str());
}

TEST(PcmFormat, RefusesEveryOtherTypeAndWidth) {
    for (int type = -1; type <= 6; type++) {
        for (int bits : {-8, 0, 1, 7, 8, 12, 16, 20, 24, 32, 48, 64}) {
            bool isKnown = false;
            for (const Combination& one : kCombinations) {
                isKnown = isKnown || (one.type == type && one.bits == bits);
            }
            EXPECT_EQ(refusal(description(type, bits, 2, 48000, false)).empty(), isKnown)
                << type << ", " << bits;
        }
    }
}

TEST(PcmFormat, RefusesNumbersOutOfRange) {
    for (int channels : {INT32_MIN, -1, 0, 9, INT32_MAX / 64}) {
        EXPECT_EQ(refusal(description(E_ORV_PCM_TYPE_SIGNED, 16, channels, 48000, false)),
                  "channelNumber is " + std::to_string(channels) + ", must be 1 to 8");
    }
    for (int rate : {INT32_MIN, -1, 0, 999, 384001, INT32_MAX}) {
        EXPECT_EQ(refusal(description(E_ORV_PCM_TYPE_SIGNED, 16, 2, rate, false)),
                  "sampleRate is " + std::to_string(rate) + ", must be 1000 to 384000");
    }
    for (int rate : {1000, 384000}) {
        EXPECT_EQ(refusal(description(E_ORV_PCM_TYPE_SIGNED, 16, 8, rate, false)), "");
    }
}

TEST(PcmFormat, RefusesABlockAlignThatDoesNotFit) {
    for (int align : {0, 2, 3, 5, 8, 0xFFFF}) {
        auto info = description(E_ORV_PCM_TYPE_SIGNED, 16, 2, 48000, false);
        pcmOf(info).u2BlockAlign = static_cast<uint16_t>(align);
        EXPECT_EQ(refusal(info), "blockAlign is " + std::to_string(align) + ", must be 4");
    }
}

TEST(PcmFormat, RefusesOtherMediaAndCodecs) {
    for (int other : {-1, 0, 2}) {
        auto info = description(E_ORV_PCM_TYPE_SIGNED, 16, 2, 48000, false);
        info.eMediaType = static_cast<E_Orv_Media_Type>(other);
        EXPECT_EQ(refusal(info), "mediaType is " + std::to_string(other) + ", must be 1");
        info.eMediaType = E_ORV_MEDIA_TYPE_AUDIO_ES;
        info.uFormatInfo.tAudioEsInfo.tAudInfo.eAudEnc = static_cast<E_Orv_Aud_Enc>(other);
        EXPECT_EQ(refusal(info), "audioCodec is " + std::to_string(other) + ", must be 1");
    }
    auto info = description(E_ORV_PCM_TYPE_SIGNED, 16, 2, 48000, false);
    pcmOf(info).fgBigEndian = 2;
    EXPECT_EQ(refusal(info), "bigEndian is 2, must be 0 to 1");
    pcmOf(info).fgBigEndian = 0;
    info.fgSynchronized = 2;
    EXPECT_EQ(refusal(info), "synchronized is 2, must be 0 to 1");
    info.fgSynchronized = 1;
    EXPECT_EQ(refusal(info), "");
}

TEST(PcmFormat, TellsTheDurationByTheTimeOrElseTheSize) {
    auto info = description(E_ORV_PCM_TYPE_SIGNED, 16, 2, 48000, false);
    const auto duration = [&info] {
        PcmFormat format;
        std::string reason;
        EXPECT_TRUE(pcmFormat(info, format, reason));
        return format.durationMs;
    };
    EXPECT_EQ(duration(), 0);
    info.u8Size = 192000 + 96000;
    EXPECT_EQ(duration(), 1500);
    info.u4TotalDuration = UINT32_MAX;
    EXPECT_EQ(duration(), int64_t{UINT32_MAX});
}

// A size of 2 GiB and more arrives negative.
TEST(PcmFormat, TakesAnySize) {
    auto info = description(E_ORV_PCM_TYPE_SIGNED, 16, 2, 48000, false);
    for (int64_t size : {INT64_MIN, int64_t{-1}, int64_t{0}, INT64_MAX}) {
        info.u8Size = size;
        EXPECT_EQ(refusal(info), "");
    }
}

}  // namespace
}  // namespace orvtarn
