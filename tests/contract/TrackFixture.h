// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

#include "JniFixture.h"
#include "RecordTexts.h"

namespace orvtest {

constexpr char kNoClass[] = "java/lang/NoClassDefFoundError";
constexpr char kNoMethod[] = "java/lang/NoSuchMethodError";

inline ExpectedLine missingServiceLine() {
    return bridgeError("service not exist, throw exception. Line:%d\n");
}
inline ExpectedLine classError(const std::string& function) {
    return bridgeError(function + "(): find class(" + kPlayerClass + ") failed, please check\n");
}
inline ExpectedLine methodError(const std::string& function, const std::string& method) {
    return bridgeError(function + "(): get method id, " + method + ", failed\n");
}

inline VideoCodecInfo codec(int first) {
    VideoCodecInfo info;
    info.mCodec = first;
    info.mWidth = first + 1;
    info.mHeight = first + 2;
    info.mFrameRate = first + 3;
    info.mBitRate = first + 4;
    info.mFlags = -first - 5;
    return info;
}

inline SubtitleTrackInfo subtitle(int first, const char* text) {
    SubtitleTrackInfo info;
    info.mTrackId = first;
    info.mCodec = first + 1;
    setText(info.mText, text);
    info.mFlags = -first;
    setText(info.mLanguage, "not passed");
    return info;
}

MATCHER(IsZero, "is a record as it is constructed") {
    (void)result_listener;
    const SubtitleTrackInfo& info = arg;
    return info.mTrackId == 0 && info.mCodec == 0 && isClear(info.mText) && info.mFlags == 0 &&
           isClear(info.mLanguage);
}

// What the three table methods have in common.
class TrackTableTest : public JniFixture {
protected:
    TrackTableTest(const std::string& function, const std::string& countOperation)
        : name(function), countCall(countOperation + "()") {}

    ExpectedLine line(const std::string& text) const { return bridgeInfo(name + "(): " + text); }
    ExpectedLine failure(const std::string& text) const {
        return bridgeError(name + "(): " + text);
    }

    const std::string name;
    const std::string countCall;
    const ExpectedLine counted = serviceInfo("OrvMediaService::" + countCall);
};

}  // namespace orvtest
