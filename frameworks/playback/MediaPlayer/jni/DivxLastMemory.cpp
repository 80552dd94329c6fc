// SPDX-License-Identifier: Apache-2.0
// The position at which a viewer left DivX media, from Java to the service.

#include <orvtarn/DivxRecords.h>

#include "jni/BridgeLog.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

const char kPositionClass[] = "com/quintora/mmp/util/DivxLastMemoryFilePosition";

struct Word {
    const char* name;
    char type;  // of the Java field: J or I
    uint32_t DivxLastMemoryFilePosition::* member;
};

#define WORD(type, name) {#name, type, &DivxLastMemoryFilePosition::name}
const Word kWords[] = {
    WORD('J', ui8_clip_id),
    WORD('I', ui4_title_idx),
    WORD('I', ui4_playlist_idx),
    WORD('I', ui4_chap_idx),
    WORD('I', ui2_aud_idx),
    WORD('I', ui2_sub_idx),
    WORD('J', ui8_aud_pts_info),
    WORD('J', ui8_aud_frame_position),
    WORD('J', ui8_i_pts_info),
    WORD('J', ui8_pts_info),
    WORD('J', ui8_i_frame_position),
    WORD('J', ui8_frame_position),
    WORD('I', i4_temporal_reference),
    WORD('I', ui2_decoding_order),
    WORD('J', ui8_stc),
    WORD('J', ui8_frame_position_disp),
    WORD('I', ui4_timestap),
};
#undef WORD

bool readWord(JNIEnv* env, jclass clazz, jobject object, const Word& word,
              DivxLastMemoryFilePosition& out) {
    const char signature[] = {word.type, '\0'};
    jfieldID field = env->GetFieldID(clazz, word.name, signature);
    if (field == nullptr) {
        ALOGE(
            "OrvMediaClient_setDivxLastMemoryFilePosition(): find variable(%s, %s) failed, please "
            "check\n",
            kPositionClass, word.name);
        return false;
    }
    // Java longs lose their high halves.
    out.*word.member = word.type == 'J' ? static_cast<uint32_t>(env->GetLongField(object, field))
                                        : static_cast<uint32_t>(env->GetIntField(object, field));
    return true;
}

}  // namespace

jint OrvMediaClient_setDivxLastMemoryFilePosition(JNIEnv* env, jobject thiz, jobject position) {
    logEnter(__func__);
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("service not exist. Line:%d\n", __LINE__);
        return -1;
    }
    DivxLastMemoryFilePosition record;
    jclass clazz = env->FindClass(kPositionClass);
    if (clazz == nullptr) {
        ALOGE(
            "OrvMediaClient_setDivxLastMemoryFilePosition(): find class(%s) failed, please "
            "check\n",
            kPositionClass);
        return -1;
    }
    for (const Word& word : kWords) {
        if (!readWord(env, clazz, position, word, record)) return -1;
    }
    const bool done = service->setDivxLastMemoryFilePosition(record);
    if (!done) {
        ALOGI("OrvMediaClient_setDivxLastMemoryFilePosition(): service get failed\n");
    }
    logLeave(__func__);
    return done ? 1 : -1;
}

}  // namespace android
