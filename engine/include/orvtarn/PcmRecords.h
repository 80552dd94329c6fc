// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

// The engine's description of a stream that does not describe itself. The
// enumerations are the engine's numbering; their desktop meanings follow.

enum E_Orv_Media_Type : int32_t {
    E_ORV_MEDIA_TYPE_UNKNOWN = 0,
    E_ORV_MEDIA_TYPE_AUDIO_ES = 1,  // an elementary audio stream
};

enum E_Orv_Aud_Enc : int32_t {
    E_ORV_AUD_ENC_UNKNOWN = 0,
    E_ORV_AUD_ENC_PCM = 1,
};

enum E_Orv_Pcm_Type : int32_t {
    E_ORV_PCM_TYPE_SIGNED = 0,    // 8, 16, 24 or 32 bits per sample
    E_ORV_PCM_TYPE_UNSIGNED = 1,  // 8 bits per sample only
    E_ORV_PCM_TYPE_FLOAT = 2,     // 32 bits per sample only
    E_ORV_PCM_TYPE_ALAW = 3,      // 8 bits per sample
    E_ORV_PCM_TYPE_ULAW = 4,      // 8 bits per sample
};

// Plain numbers: channels, samples per second, bits.
enum E_Orv_Aud_Ch_Num : int32_t {};
enum E_Orv_Aud_Sample_Rate : int32_t {};
enum E_Orv_Aud_Bits_Per_Sample : int32_t {};

struct ORV_AUD_PCM_INFO_T {
    E_Orv_Pcm_Type e_pcm_type;
    E_Orv_Aud_Ch_Num eNumCh;                   // 1 to 8
    E_Orv_Aud_Sample_Rate eSampleRate;         // Hz, 1000 to 384000
    uint16_t u2BlockAlign;                     // bytes of one sample of all channels
    E_Orv_Aud_Bits_Per_Sample eBitsPerSample;  // 8, 16, 24 or 32
    uint8_t fgBigEndian;                       // 0 or 1, of no effect on 8 bits
};

struct ORV_AUD_INFO_T {
    E_Orv_Aud_Enc eAudEnc;  // E_ORV_AUD_ENC_PCM
    union {
        ORV_AUD_PCM_INFO_T t_pcm_info;
    } uAudCodecInfo;
};

struct IORV_PB_CTRL_SET_MEDIA_INFO_T {
    E_Orv_Media_Type eMediaType;  // E_ORV_MEDIA_TYPE_AUDIO_ES
    // Of media whose source does not know its length; a source's own counts first.
    uint32_t u4TotalDuration;  // milliseconds, 0 when unknown
    int64_t u8Size;            // bytes, 0 or negative when unknown; where the above is 0
    uint8_t fgSynchronized;    // 0 or 1, of no effect
    union alignas(8) {
        struct {
            ORV_AUD_INFO_T tAudInfo;
        } tAudioEsInfo;
    } uFormatInfo;
};
