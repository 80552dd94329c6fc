// SPDX-License-Identifier: Apache-2.0
// DivX navigation. The service answers all of it itself: with an engine player
// every operation fails, without one the numbers and setters succeed.

#include "jni/media-service/OrvMediaService.h"
#include "jni/media-service/ServiceLog.h"

namespace android {

bool OrvMediaService::getDivxTitleInfo(int, DivxTitleInfo&) {
    ALOGI("OrvMediaService::getDivxTitleInfo\n");
    hasPlayer(__func__);
    return false;
}

bool OrvMediaService::getDivxChapInfo(int, int, int, DivxChapInfo&) {
    ALOGI("OrvMediaService::getDivxChapInfo\n");
    hasPlayer(__func__);
    return false;
}

bool OrvMediaService::getDivxPlayListInfo(int, int, DivxPlayListInfo&) {
    ALOGI("OrvMediaService::getDivxChapInfo\n");  // the chapter getter's line
    hasPlayer(__func__);
    return false;
}

bool OrvMediaService::getDivxPositionInfo(DivxPositionInfo&) {
    ALOGI("OrvMediaService::getDivxPositionInfo\n");
    hasPlayer(__func__);
    return false;
}

bool OrvMediaService::getDivxDisplayInfo(int, int, int, int, int, DivxDisplayInfo&) {
    ALOGI("OrvMediaService::getDivxDisplayInfo\n");
    hasPlayer(__func__);
    return false;
}

bool OrvMediaService::getDivxLastMemoryFilePosition(DivxLastMemoryFilePosition&) {
    ALOGI("OrvMediaService::getDivxLastMemoryFilePosition\n");
    hasPlayer(__func__);
    return false;
}

bool OrvMediaService::getDivxTitleNum(int&) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::getDivxLastMemoryFileID(int&) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::setDivxTitleInfo(int, int, int) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::setDivxChapInfo(int, int, int, int) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::setDivxPlayListInfo(int, int, int, int) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::setDivxBtnInfo(int, int) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::setDivxFilePosition(int, int) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

bool OrvMediaService::setDivxLastMemoryFilePosition(DivxLastMemoryFilePosition) {
    logEntry(__func__);
    return !hasPlayer(__func__);
}

}  // namespace android
