// SPDX-License-Identifier: Apache-2.0
//
// The description of a raw PCM stream from Java to the engine, and what the
// desktop engine makes of it. Input: the fields of PcmMediaInfo in their order,
// any number of times.
#include "records/PcmFormat.h"
#include "support/JavaObjects.h"
#include "support/PlayerMachine.h"
#include "support/Require.h"
#include "support/Words.h"

namespace {

using fakejni::ObjectPtr;
using orvfuzz::require;

constexpr char kClass[] = "com/quintora/mmp/util/PcmMediaInfo";

int64_t field(const ObjectPtr& object, const char* name) { return object->get(name).integer; }

void requireRecord(const ObjectPtr& java, const IORV_PB_CTRL_SET_MEDIA_INFO_T& info) {
    const ObjectPtr nested = java->get("audioPcmInfo").object;
    const ORV_AUD_INFO_T& audio = info.uFormatInfo.tAudioEsInfo.tAudInfo;
    const ORV_AUD_PCM_INFO_T& pcm = audio.uAudCodecInfo.t_pcm_info;
    require(info.eMediaType == field(java, "mediaType") &&
                info.u4TotalDuration == static_cast<uint32_t>(field(java, "totalDuration")) &&
                info.u8Size == static_cast<int32_t>(field(java, "size")) &&
                info.fgSynchronized == (field(java, "fgSynchronized") != 0) &&
                audio.eAudEnc == field(java, "audioCodec"),
            "the media's fields arrive");
    require(pcm.e_pcm_type == field(nested, "pcm_type") &&
                pcm.eNumCh == field(nested, "channelNumber") &&
                pcm.eSampleRate == field(nested, "sampleRate") &&
                pcm.u2BlockAlign == static_cast<uint16_t>(field(nested, "blockAlign")) &&
                pcm.eBitsPerSample == field(nested, "bitsPerSample") &&
                pcm.fgBigEndian == (field(nested, "bigEndian") != 0),
            "the samples' fields arrive");
}

void requireFormat(const IORV_PB_CTRL_SET_MEDIA_INFO_T& info) {
    orvtarn::PcmFormat format;
    std::string reason;
    if (!orvtarn::pcmFormat(info, format, reason)) {
        require(!reason.empty(), "a refusal has its reason");
        return;
    }
    const ORV_AUD_PCM_INFO_T& pcm = info.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info;
    require(pcm.u2BlockAlign * 8 == pcm.eNumCh * pcm.eBitsPerSample, "samples fill their block");
    require(format.bytesPerSecond == pcm.eSampleRate * pcm.u2BlockAlign && format.durationMs >= 0,
            "rates and durations are not negative");
    require(!format.options.empty(), "there is a demuxer for what is accepted");
}

void send(orvfuzz::PlayerMachine& machine, orvtest::ScriptedEngine& engine, const ObjectPtr& java) {
    engine.receivedPcmInfos.clear();
    machine.call<void>("native_setPcmMediaInfo", "(Lcom/quintora/mmp/util/PcmMediaInfo;)V",
                       machine.vm.local(java));
    require(engine.receivedPcmInfos.size() == 1, "the engine gets the description");
    requireRecord(java, engine.receivedPcmInfos[0]);
    requireFormat(engine.receivedPcmInfos[0]);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvfuzz::Words words(data, size);
    orvfuzz::PlayerMachine machine;
    orvtest::ScriptedEngine& engine = machine.setUp();
    while (!words.atEnd()) {
        send(machine, engine, orvfuzz::newFilledObject(machine.vm, kClass, words));
    }
    machine.finish();
    return 0;
}
