// SPDX-License-Identifier: Apache-2.0
#include "JavaObjects.h"

namespace orvfuzz {
namespace {

using fakejni::ObjectPtr;
using fakejni::Value;

struct FieldRow {
    const char* type;  // its path below com/quintora/mmp/util/
    const char* name;
    const char* signature;
};

#define ATTR "SubtitleAttr$Subtitle_"
#define ATTR_TYPE(name) "Lcom/quintora/mmp/util/" ATTR name ";"
const FieldRow kFields[] = {
    {"ThumbnailInfo", "mCanvasColormode", "I"},
    {"ThumbnailInfo", "mThumbnailWidth", "I"},
    {"ThumbnailInfo", "mThumbnailHeight", "I"},
    {"PcmMediaInfo$AudioPcmInfo", "pcm_type", "I"},
    {"PcmMediaInfo$AudioPcmInfo", "channelNumber", "I"},
    {"PcmMediaInfo$AudioPcmInfo", "sampleRate", "I"},
    {"PcmMediaInfo$AudioPcmInfo", "blockAlign", "S"},
    {"PcmMediaInfo$AudioPcmInfo", "bitsPerSample", "I"},
    {"PcmMediaInfo$AudioPcmInfo", "bigEndian", "I"},
    {"PcmMediaInfo", "mediaType", "I"},
    {"PcmMediaInfo", "totalDuration", "I"},
    {"PcmMediaInfo", "size", "J"},
    {"PcmMediaInfo", "fgSynchronized", "I"},
    {"PcmMediaInfo", "audioCodec", "I"},
    {"PcmMediaInfo", "audioPcmInfo", "Lcom/quintora/mmp/util/PcmMediaInfo$AudioPcmInfo;"},
    {ATTR "TimeOffset", "mTimeOffsetType", "I"},
    {ATTR "TimeOffset", "mOffsetValue", "I"},
    {ATTR "FontInfo", "mFontSizeType", "I"},
    {ATTR "FontInfo", "mCustomSize", "B"},
    {ATTR "Color", "mA", "B"},
    {ATTR "Color", "mR", "B"},
    {ATTR "Color", "mG", "B"},
    {ATTR "Color", "mB", "B"},
    {ATTR "DisplayOffset", "mX", "I"},
    {ATTR "DisplayOffset", "mY", "I"},
    {"SubtitleAttr", "mMask", "I"},
    {"SubtitleAttr", "mTimeOffset", ATTR_TYPE("TimeOffset")},
    {"SubtitleAttr", "mFontInfo", ATTR_TYPE("FontInfo")},
    {"SubtitleAttr", "mBgColor", ATTR_TYPE("Color")},
    {"SubtitleAttr", "mTextColor", ATTR_TYPE("Color")},
    {"SubtitleAttr", "mEdgColor", ATTR_TYPE("Color")},
    {"SubtitleAttr", "mDisplayOffset", ATTR_TYPE("DisplayOffset")},
    {"DivxLastMemoryFilePosition", "ui8_clip_id", "J"},
    {"DivxLastMemoryFilePosition", "ui4_title_idx", "I"},
    {"DivxLastMemoryFilePosition", "ui4_playlist_idx", "I"},
    {"DivxLastMemoryFilePosition", "ui4_chap_idx", "I"},
    {"DivxLastMemoryFilePosition", "ui2_aud_idx", "I"},
    {"DivxLastMemoryFilePosition", "ui2_sub_idx", "I"},
    {"DivxLastMemoryFilePosition", "ui8_aud_pts_info", "J"},
    {"DivxLastMemoryFilePosition", "ui8_aud_frame_position", "J"},
    {"DivxLastMemoryFilePosition", "ui8_i_pts_info", "J"},
    {"DivxLastMemoryFilePosition", "ui8_pts_info", "J"},
    {"DivxLastMemoryFilePosition", "ui8_i_frame_position", "J"},
    {"DivxLastMemoryFilePosition", "ui8_frame_position", "J"},
    {"DivxLastMemoryFilePosition", "i4_temporal_reference", "I"},
    {"DivxLastMemoryFilePosition", "ui2_decoding_order", "I"},
    {"DivxLastMemoryFilePosition", "ui8_stc", "J"},
    {"DivxLastMemoryFilePosition", "ui8_frame_position_disp", "J"},
    {"DivxLastMemoryFilePosition", "ui4_timestap", "I"},
};
#undef ATTR_TYPE
#undef ATTR

#define TEXT "Ljava/lang/String;"
const char* const kCallbacks[][2] = {
    {"setVideoCodecInfo", "(IIIIII)V"},
    {"setAllVideoCodecInfo", "(IIIIIIII)V"},
    {"setSubtitleTrackInfo", "(II" TEXT "I)V"},
    {"setAllSubtitleTrackInfo", "(IIII" TEXT "I)V"},
    {"setAllAudioTrackInfo", "(IIIIIIII" TEXT TEXT TEXT TEXT "I" TEXT TEXT TEXT TEXT ")V"},
    {"setMetaDataInfo", "(IIII" TEXT TEXT TEXT TEXT "I" TEXT TEXT TEXT ")V"},
};
#undef TEXT

Value wordOf(fakejni::Vm& vm, const std::string& signature, Words& words) {
    if (signature[0] == 'L') {
        return Value::of(newFilledObject(vm, signature.substr(1, signature.size() - 2), words));
    }
    const int64_t number = words.number();
    switch (signature[0]) {
        case 'B':
            return Value::ofByte(static_cast<jbyte>(number));
        case 'S':
            return Value::ofShort(static_cast<jshort>(number));
        case 'I':
            return Value::ofInt(static_cast<jint>(number));
        default:
            return Value::ofLong(number);
    }
}

}  // namespace

void defineValueClasses(fakejni::Vm& vm) {
    for (const FieldRow& row : kFields) {
        const std::string path = std::string("com/quintora/mmp/util/") + row.type;
        fakejni::Class* type = vm.find(path);
        (type != nullptr ? *type : vm.define(path)).field(row.name, row.signature);
    }
}

void defineCallbacks(fakejni::Class& player) {
    for (const auto& [name, signature] : kCallbacks) player.method(name, signature);
}

ObjectPtr newFilledObject(fakejni::Vm& vm, const std::string& path, Words& words) {
    ObjectPtr object = vm.newObject(path);
    for (const auto& field : object->type->fields) {
        object->set(field->name, wordOf(vm, field->signature, words));
    }
    return object;
}

}  // namespace orvfuzz
