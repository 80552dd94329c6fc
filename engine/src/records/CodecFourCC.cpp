// SPDX-License-Identifier: Apache-2.0
#include "records/CodecFourCC.h"

namespace orvtarn {
namespace {

struct Code {
    std::string_view codec;
    char code[5];
};

const Code kCodes[] = {
    {"aac", "mp4a"},
    {"aac_latm", "mp4a"},
    {"ac3", "ac-3"},
    {"adpcm_ima_wav", "ima4"},
    {"adpcm_ms", "msad"},
    {"amr_nb", "samr"},
    {"amr_wb", "sawb"},
    {"arib_caption", "arib"},
    {"av1", "av01"},
    {"dts", "dtsc"},
    {"dvb_subtitle", "dvbs"},
    {"dvb_teletext", "telx"},
    {"dvd_subtitle", "vobs"},
    {"dvvideo", "dvsd"},
    {"eac3", "ec-3"},
    {"eia_608", "c608"},
    {"flac", "fLaC"},
    {"hdmv_pgs_subtitle", "pgs "},
    {"hdmv_text_subtitle", "hdmt"},
    {"mjpeg", "mjpg"},
    {"mov_text", "tx3g"},
    {"mp3", ".mp3"},
    {"mpeg1video", "mp1v"},
    {"mpeg2video", "mp2v"},
    {"mpeg4", "mp4v"},
    {"msmpeg4v1", "MPG4"},
    {"msmpeg4v2", "MP42"},
    {"msmpeg4v3", "MP43"},
    {"opus", "Opus"},
    {"pcm_alaw", "alaw"},
    {"pcm_mulaw", "ulaw"},
    {"prores", "apcn"},
    {"rawvideo", "raw "},
    {"subrip", "srt "},
    {"truehd", "mlpa"},
    {"vc1", "vc-1"},
    {"vp8", "vp08"},
    {"vp9", "vp09"},
    {"webvtt", "wvtt"},
    {"wmav1", "wma1"},
    {"wmav2", "wma2"},
    {"wmv1", "WMV1"},
    {"wmv2", "WMV2"},
    {"wmv3", "WMV3"},
};

// "pcm_s16le" differs from others in what follows the prefix.
std::string_view withoutPcm(std::string_view name) {
    const std::string_view prefix = "pcm_";
    return name.substr(0, prefix.size()) == prefix ? name.substr(prefix.size()) : name;
}

int32_t pack(std::string_view text) {
    uint32_t code = 0;
    for (size_t i = 0; i < 4; i++) {
        const char character = i < text.size() ? text[i] : ' ';
        code |= static_cast<uint32_t>(static_cast<unsigned char>(character)) << (8 * i);
    }
    return static_cast<int32_t>(code);
}

}  // namespace

int32_t codecFourCC(std::string_view codecName) {
    for (const Code& code : kCodes) {
        if (code.codec == codecName) return pack(code.code);
    }
    return codecName.empty() ? 0 : pack(withoutPcm(codecName));
}

}  // namespace orvtarn
