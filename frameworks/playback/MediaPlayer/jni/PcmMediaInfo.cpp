// SPDX-License-Identifier: Apache-2.0
// The description of a raw PCM stream, which the engine cannot learn from the
// data.

#include <orvtarn/PcmRecords.h>

#include "jni/BridgeLog.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

const char kMediaInfoClass[] = "com/quintora/mmp/util/PcmMediaInfo";
const char kPcmInfoClass[] = "com/quintora/mmp/util/PcmMediaInfo$AudioPcmInfo";
const char kPcmInfoType[] = "Lcom/quintora/mmp/util/PcmMediaInfo$AudioPcmInfo;";

// The fields of one Java object. A field that does not exist is logged and
// leaves the virtual machine's exception pending.
struct JavaFields {
    JNIEnv* env;
    jclass clazz;
    const char* classPath;
    jobject object;

    jfieldID find(const char* name, const char* signature) const {
        // Not every virtual machine takes a null class: its lookups just fail.
        jfieldID field = clazz != nullptr ? env->GetFieldID(clazz, name, signature) : nullptr;
        if (field == nullptr) {
            ALOGE("OrvMediaClient_setPcmMediaInfo(): find variable(%s, %s) failed, please check\n",
                  classPath, name);
        }
        return field;
    }

    template <typename Int>
    bool readInt(const char* name, Int& out) const {
        jfieldID field = find(name, "I");
        if (field == nullptr) return false;
        out = static_cast<Int>(env->GetIntField(object, field));
        return true;
    }

    bool readFlag(const char* name, uint8_t& out) const {
        jfieldID field = find(name, "I");
        if (field == nullptr) return false;
        out = env->GetIntField(object, field) != 0;
        return true;
    }

    // Only the low 32 bits, widened again by sign.
    bool readSize(const char* name, int64_t& out) const {
        jfieldID field = find(name, "J");
        if (field == nullptr) return false;
        out = static_cast<int32_t>(env->GetLongField(object, field));
        return true;
    }

    bool readShort(const char* name, uint16_t& out) const {
        jfieldID field = find(name, "S");
        if (field == nullptr) return false;
        out = static_cast<uint16_t>(env->GetShortField(object, field));
        return true;
    }

    bool readObject(const char* name, const char* type, jobject& out) const {
        jfieldID field = find(name, type);
        if (field == nullptr) return false;
        out = env->GetObjectField(object, field);
        return true;
    }
};

bool readMediaInfo(const JavaFields& fields, IORV_PB_CTRL_SET_MEDIA_INFO_T& info,
                   jobject& pcmInfo) {
    return fields.readInt("mediaType", info.eMediaType) &&
           fields.readInt("totalDuration", info.u4TotalDuration) &&
           fields.readSize("size", info.u8Size) &&
           fields.readFlag("fgSynchronized", info.fgSynchronized) &&
           fields.readInt("audioCodec", info.uFormatInfo.tAudioEsInfo.tAudInfo.eAudEnc) &&
           fields.readObject("audioPcmInfo", kPcmInfoType, pcmInfo);
}

bool readPcmInfo(const JavaFields& fields, ORV_AUD_PCM_INFO_T& info) {
    return fields.readInt("pcm_type", info.e_pcm_type) &&
           fields.readInt("channelNumber", info.eNumCh) &&
           fields.readInt("sampleRate", info.eSampleRate) &&
           fields.readShort("blockAlign", info.u2BlockAlign) &&
           fields.readInt("bitsPerSample", info.eBitsPerSample) &&
           fields.readFlag("bigEndian", info.fgBigEndian);
}

void logInfo(const IORV_PB_CTRL_SET_MEDIA_INFO_T& info) {
    const ORV_AUD_INFO_T& audio = info.uFormatInfo.tAudioEsInfo.tAudInfo;
    const ORV_AUD_PCM_INFO_T& pcm = audio.uAudCodecInfo.t_pcm_info;
    ALOGI("nativeSetPcmMediaInfo(): mediaInfo.eMediaType = %d\n", info.eMediaType);
    ALOGI("nativeSetPcmMediaInfo(): mediaInfo.u4TotalDuration = %d\n", info.u4TotalDuration);
    ALOGI("nativeSetPcmMediaInfo(): mediaInfo.u8Size = %lld\n",
          static_cast<long long>(info.u8Size));
    ALOGI("nativeSetPcmMediaInfo(): mediaInfo.fgSynchronized = %d\n", info.fgSynchronized);
    ALOGI("nativeSetPcmMediaInfo(): mediaInfo.uFormatInfo.tAudioEsInfo.tAudInfo.eAudEnc = %d\n",
          audio.eAudEnc);
#define PCM_MEMBER              \
    "nativeSetPcmMediaInfo(): " \
    "mediaInfo.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info."
    ALOGI(PCM_MEMBER "e_pcm_type = %d\n", pcm.e_pcm_type);
    ALOGI(PCM_MEMBER "eNumCh = %d\n", pcm.eNumCh);
    ALOGI(PCM_MEMBER "eSampleRate = %d\n", pcm.eSampleRate);
    ALOGI(PCM_MEMBER "u2BlockAlign = %d\n", pcm.u2BlockAlign);
    ALOGI(PCM_MEMBER "eBitsPerSample = %d\n", pcm.eBitsPerSample);
    ALOGI(PCM_MEMBER "fgBigEndian = %d\n", pcm.fgBigEndian);
#undef PCM_MEMBER
}

}  // namespace

void OrvMediaClient_setPcmMediaInfo(JNIEnv* env, jobject thiz, jobject pcmMediaInfo) {
    ALOGI("nativeSetPcmMediaInfo(): Enter\n");
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_setPcmMediaInfo(): service not exist, error\n");
        return;
    }
    jclass outer = env->FindClass(kMediaInfoClass);
    if (outer == nullptr) {
        ALOGE("OrvMediaClient_setPcmMediaInfo(): find class(%s) failed, please check\n",
              kMediaInfoClass);
        return;
    }
    // Not cleared: what is not filled here is the engine's to ignore.
    IORV_PB_CTRL_SET_MEDIA_INFO_T mediaInfo;
    jobject pcmInfo = nullptr;
    if (!readMediaInfo({env, outer, kMediaInfoClass, pcmMediaInfo}, mediaInfo, pcmInfo)) return;

    jclass nested = env->FindClass(kPcmInfoClass);
    if (outer == nullptr) {  // the outer class again: a missing nested one shows in its fields
        ALOGE("OrvMediaClient_setPcmMediaInfo(): find class(%s) failed, please check\n",
              kPcmInfoClass);
        return;
    }
    ORV_AUD_PCM_INFO_T& pcm = mediaInfo.uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info;
    if (!readPcmInfo({env, nested, kPcmInfoClass, pcmInfo}, pcm)) return;

    logInfo(mediaInfo);
    if (!service->setPCMMediaInfo(&mediaInfo)) ALOGE("nativeSetPcmMediaInfo(): failed\n");
    ALOGI("nativeSetPcmMediaInfo(): Leave\n");
}

void OrvMediaClient_setPcmFlag(JNIEnv* env, jobject thiz) {
    ALOGI("_setPcmFlag(): Enter\n");
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("service not exist,throw exception. Line:%d\n", __LINE__);  // nothing is thrown
        return;
    }
    service->setPcmFlag();
}

}  // namespace android
