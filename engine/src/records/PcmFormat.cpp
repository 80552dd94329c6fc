// SPDX-License-Identifier: Apache-2.0
#include "records/PcmFormat.h"

namespace orvtarn {
namespace {

bool isWithin(int64_t value, int64_t min, int64_t max, const char* name, std::string& reason) {
    if (value >= min && value <= max) return true;
    reason = std::string(name) + " is " + std::to_string(value) + ", must be " +
             std::to_string(min) + (min == max ? "" : " to " + std::to_string(max));
    return false;
}

// Which widths a sample type has, as "8, 16", and whether bits is one of them.
struct Widths {
    const char* text;
    bool fits;
};

Widths widthsOf(E_Orv_Pcm_Type type, int bits) {
    const bool whole = bits == 8 || bits == 16 || bits == 24 || bits == 32;
    switch (type) {
        case E_ORV_PCM_TYPE_SIGNED:
            return {"8, 16, 24 or 32", whole};
        case E_ORV_PCM_TYPE_FLOAT:
            return {"32 for floating point", bits == 32};
        default:
            return {"8 for this sample type", bits == 8};
    }
}

bool checkWidth(const ORV_AUD_PCM_INFO_T& pcm, std::string& reason) {
    const Widths widths = widthsOf(pcm.e_pcm_type, pcm.eBitsPerSample);
    if (widths.fits) return true;
    reason = "bitsPerSample is " + std::to_string(pcm.eBitsPerSample) + ", must be " + widths.text;
    return false;
}

bool checkPcm(const ORV_AUD_PCM_INFO_T& pcm, std::string& reason) {
    return isWithin(pcm.e_pcm_type, E_ORV_PCM_TYPE_SIGNED, E_ORV_PCM_TYPE_ULAW, "pcm_type",
                    reason) &&
           isWithin(pcm.eNumCh, 1, 8, "channelNumber", reason) &&
           isWithin(pcm.eSampleRate, 1000, 384000, "sampleRate", reason) &&
           isWithin(pcm.fgBigEndian, 0, 1, "bigEndian", reason) && checkWidth(pcm, reason) &&
           isWithin(pcm.u2BlockAlign, pcm.eNumCh * pcm.eBitsPerSample / 8,
                    pcm.eNumCh * pcm.eBitsPerSample / 8, "blockAlign", reason);
}

// mpv's name, such as "s16le" and "floatbe".
std::string sampleFormat(const ORV_AUD_PCM_INFO_T& pcm) {
    if (pcm.e_pcm_type == E_ORV_PCM_TYPE_UNSIGNED) return "u8";
    if (pcm.eBitsPerSample == 8) return "s8";
    const std::string order = pcm.fgBigEndian ? "be" : "le";
    if (pcm.e_pcm_type == E_ORV_PCM_TYPE_FLOAT) return "float" + order;
    return "s" + std::to_string(pcm.eBitsPerSample) + order;
}

// mpv's own reader of raw audio has no companded samples; libavformat has.
void setCompanded(const ORV_AUD_PCM_INFO_T& pcm, PcmFormat& format) {
    const bool isALaw = pcm.e_pcm_type == E_ORV_PCM_TYPE_ALAW;
    format.options = {{"demuxer", "lavf"},
                      {"demuxer-lavf-format", isALaw ? "alaw" : "mulaw"},
                      {"demuxer-lavf-o", "sample_rate=" + std::to_string(pcm.eSampleRate) +
                                             ",ch_layout=" + std::to_string(pcm.eNumCh) + "c"}};
}

void setLinear(const ORV_AUD_PCM_INFO_T& pcm, PcmFormat& format) {
    format.options = {{"demuxer", "rawaudio"},
                      {"demuxer-rawaudio-format", sampleFormat(pcm)},
                      {"demuxer-rawaudio-rate", std::to_string(pcm.eSampleRate)}};
}

// Milliseconds, 0 when unknown.
int64_t durationOf(const IORV_PB_CTRL_SET_MEDIA_INFO_T& info, int bytesPerSecond) {
    if (info.u4TotalDuration > 0 || info.u8Size <= 0) return info.u4TotalDuration;
    return info.u8Size / bytesPerSecond * 1000 +
           info.u8Size % bytesPerSecond * 1000 / bytesPerSecond;
}

}  // namespace

bool pcmFormat(const IORV_PB_CTRL_SET_MEDIA_INFO_T& info, PcmFormat& format, std::string& reason) {
    const ORV_AUD_INFO_T& audio = info.uFormatInfo.tAudioEsInfo.tAudInfo;
    const ORV_AUD_PCM_INFO_T& pcm = audio.uAudCodecInfo.t_pcm_info;
    if (!isWithin(info.eMediaType, E_ORV_MEDIA_TYPE_AUDIO_ES, E_ORV_MEDIA_TYPE_AUDIO_ES,
                  "mediaType", reason) ||
        !isWithin(audio.eAudEnc, E_ORV_AUD_ENC_PCM, E_ORV_AUD_ENC_PCM, "audioCodec", reason) ||
        !isWithin(info.fgSynchronized, 0, 1, "synchronized", reason) || !checkPcm(pcm, reason)) {
        return false;
    }
    format = PcmFormat();
    format.channels = pcm.eNumCh;
    format.bytesPerSecond = pcm.eSampleRate * pcm.u2BlockAlign;
    format.durationMs = durationOf(info, format.bytesPerSecond);
    const bool isCompanded =
        pcm.e_pcm_type == E_ORV_PCM_TYPE_ALAW || pcm.e_pcm_type == E_ORV_PCM_TYPE_ULAW;
    if (isCompanded) {
        setCompanded(pcm, format);
    } else {
        setLinear(pcm, format);
    }
    return true;
}

}  // namespace orvtarn
