// SPDX-License-Identifier: Apache-2.0
// native_setSubtitleAttr: walks a Java SubtitleAttr and hands each attribute
// group of its mask to the service, then has them applied together.

#include <orvtarn/SubtitleRecords.h>

#include "jni/BridgeLog.h"
#include "jni/JavaFieldReaders.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"

namespace android {

namespace {

// The class whose fields are read. The method's parameter has another class,
// com/quintora/SubtitleAttr; the Java side makes the two agree.
const char kAttrClass[] = "com/quintora/mmp/util/SubtitleAttr";
const char kTimeOffsetClass[] = "com/quintora/mmp/util/SubtitleAttr$Subtitle_TimeOffset";
const char kFontInfoClass[] = "com/quintora/mmp/util/SubtitleAttr$Subtitle_FontInfo";
const char kColorClass[] = "com/quintora/mmp/util/SubtitleAttr$Subtitle_Color";
const char kDisplayOffsetClass[] = "com/quintora/mmp/util/SubtitleAttr$Subtitle_DisplayOffset";

const char kTimeOffsetType[] = "Lcom/quintora/mmp/util/SubtitleAttr$Subtitle_TimeOffset;";
const char kFontInfoType[] = "Lcom/quintora/mmp/util/SubtitleAttr$Subtitle_FontInfo;";
const char kColorType[] = "Lcom/quintora/mmp/util/SubtitleAttr$Subtitle_Color;";
const char kDisplayOffsetType[] = "Lcom/quintora/mmp/util/SubtitleAttr$Subtitle_DisplayOffset;";

// Bits of mMask; all others are ignored.
enum : int {
    FLAG_SUBTITLE_TIME_OFFSET = 0x01,
    FLAG_SUBTITLE_FONT_INFO = 0x04,
    FLAG_SUBTITLE_BG_COLOR = 0x08,
    FLAG_SUBTITLE_TEXT_COLOR = 0x10,
    FLAG_SUBTITLE_EDGE_COLOR = 0x20,
    FLAG_SUBTITLE_DISPLAY_OFFSET = 0x80,
};

// The walk of one attribute group. The first failed read logs the class that
// was being read, the group's flag and the field, and ends the whole walk.
class Group {
public:
    Group(JNIEnv* env, jobject attr, const char* flag) : mEnv(env), mAttr(attr), mFlag(flag) {
        ALOGI("setSubtitleAttr(): config %s, occur", mFlag);
    }

    bool open(const char* field, const char* type, const char* classPath) {
        mClass = classPath;
        // A null child is a failed read as well.
        return (getObjValueFromJava(mEnv, kAttrClass, mAttr, field, type, mObject) &&
                mObject != nullptr) ||
               fail(kAttrClass, field);
    }

    bool read(const char* field, int& out) {
        out = 0;
        return getIntValueFromJava(mEnv, mClass, mObject, field, out) || fail(mClass, field);
    }

    bool read(const char* field, char& out) {
        out = 0;
        return getByteValueFromJava(mEnv, mClass, mObject, field, out) || fail(mClass, field);
    }

private:
    bool fail(const char* classPath, const char* field) {
        ALOGE("setSubtitleAttr(): deal with %s: %s, %s, error happen\n", classPath, mFlag, field);
        return false;
    }

    JNIEnv* mEnv;
    jobject mAttr;
    const char* mFlag;
    const char* mClass = nullptr;
    jobject mObject = nullptr;
};

bool sendTimeOffset(JNIEnv* env, jobject attr, const sp<OrvMediaService>& service) {
    Group group(env, attr, "FLAG_SUBTITLE_TIME_OFFSET");
    int type;
    int value;
    if (!group.open("mTimeOffset", kTimeOffsetType, kTimeOffsetClass) ||
        !group.read("mTimeOffsetType", type) || !group.read("mOffsetValue", value)) {
        return false;
    }
    ALOGI(
        "setSubtitleAttr(): config FLAG_SUBTITLE_TIME_OFFSET, i4TimeOffsetType=%d, "
        "i4TimeOffsetValue=%d",
        type, value);
    Subtitle_TimeOffset record;
    record.mTimeOffsetType = type;
    record.mOffsetValue = value;
    service->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_TIME_OFFSET, &record);
    return true;
}

bool sendFontInfo(JNIEnv* env, jobject attr, const sp<OrvMediaService>& service) {
    Group group(env, attr, "FLAG_SUBTITLE_FONT_INFO");
    int sizeType;
    char customSize;
    if (!group.open("mFontInfo", kFontInfoType, kFontInfoClass) ||
        !group.read("mFontSizeType", sizeType) || !group.read("mCustomSize", customSize)) {
        return false;
    }
    ALOGI("setSubtitleAttr(): config FLAG_SUBTITLE_FONT_INFO, i4FontSizeType=%d, chCustomSize=%d",
          sizeType, customSize);
    Subtitle_FontInfo record;
    record.mFontSizeType = sizeType;
    record.mCustomSize = static_cast<uint8_t>(customSize);
    service->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_FONT_INFO, &record);
    return true;
}

bool sendColor(JNIEnv* env, jobject attr, const sp<OrvMediaService>& service, const char* flag,
               const char* field, E_Subtitle_Attr_Type type) {
    Group group(env, attr, flag);
    char a;
    char r;
    char g;
    char b;
    if (!group.open(field, kColorType, kColorClass) || !group.read("mA", a) ||
        !group.read("mR", r) || !group.read("mG", g) || !group.read("mB", b)) {
        return false;
    }
    ALOGI("setSubtitleAttr(): config %s, chA=%d, chR=%d, chG=%d, chB=%d", flag, a, r, g, b);
    Subtitle_Color record;
    record.mA = static_cast<uint8_t>(a);
    record.mR = static_cast<uint8_t>(r);
    record.mG = static_cast<uint8_t>(g);
    record.mB = static_cast<uint8_t>(b);
    service->setSubtitleAttr(type, &record);
    return true;
}

bool sendDisplayOffset(JNIEnv* env, jobject attr, const sp<OrvMediaService>& service) {
    Group group(env, attr, "FLAG_SUBTITLE_DISPLAY_OFFSET");
    int x;
    int y;
    if (!group.open("mDisplayOffset", kDisplayOffsetType, kDisplayOffsetClass) ||
        !group.read("mX", x) || !group.read("mY", y)) {
        return false;
    }
    ALOGI("setSubtitleAttr(): config FLAG_SUBTITLE_DISPLAY_OFFSET, i4X=%d, i4Y=%d", x, y);
    Subtitle_TimeOffset record;  // X and Y travel in the time offset's shape
    record.mTimeOffsetType = x;
    record.mOffsetValue = y;
    service->setSubtitleAttr(E_SUBTITLE_ATTR_TYPE_DISPLAY_OFFSET, &record);
    return true;
}

// Groups already sent stay sent when a later one fails.
bool sendGroups(JNIEnv* env, jobject attr, const sp<OrvMediaService>& service, int mask) {
    return ((mask & FLAG_SUBTITLE_TIME_OFFSET) == 0 || sendTimeOffset(env, attr, service)) &&
           ((mask & FLAG_SUBTITLE_FONT_INFO) == 0 || sendFontInfo(env, attr, service)) &&
           ((mask & FLAG_SUBTITLE_BG_COLOR) == 0 ||
            sendColor(env, attr, service, "FLAG_SUBTITLE_BG_COLOR", "mBgColor",
                      E_SUBTITLE_ATTR_TYPE_BG_COLOR)) &&
           ((mask & FLAG_SUBTITLE_TEXT_COLOR) == 0 ||
            sendColor(env, attr, service, "FLAG_SUBTITLE_TEXT_COLOR", "mTextColor",
                      E_SUBTITLE_ATTR_TYPE_TEXT_COLOR)) &&
           ((mask & FLAG_SUBTITLE_EDGE_COLOR) == 0 ||
            sendColor(env, attr, service, "FLAG_SUBTITLE_EDGE_COLOR", "mEdgColor",
                      E_SUBTITLE_ATTR_TYPE_EDGE_COLOR)) &&
           ((mask & FLAG_SUBTITLE_DISPLAY_OFFSET) == 0 || sendDisplayOffset(env, attr, service));
}

}  // namespace

void OrvMediaClient_setSubtitleAttr(JNIEnv* env, jobject thiz, jobject attr) {
    ALOGI("setSubtitleAttr(): Enter\n");
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("setSubtitleAttr(): service not exist\n");
        return;
    }
    int mask = 0;
    if (!getIntValueFromJava(env, kAttrClass, attr, "mMask", mask)) {
        ALOGE("setSubtitleAttr(): deal with %s: mMask, error happen\n", kAttrClass);
        return;
    }
    if (!sendGroups(env, attr, service, mask)) return;  // unflushed
    service->flushSubtitleAttr();
    ALOGI("setSubtitleAttr(): Leave\n");
}

}  // namespace android
