// SPDX-License-Identifier: Apache-2.0
// Thumbnails and the picture embedded in the media.

#include <nativehelper/JNIHelp.h>
#include <orvtarn/PictureRecords.h>
#include <stdlib.h>
#include <string.h>

#include "jni/BridgeLog.h"
#include "jni/JavaFieldReaders.h"
#include "jni/OrvMediaClient.h"
#include "jni/PlayerContext.h"
#include "jni/StatusExceptions.h"

namespace android {

namespace {

const char kThumbnailInfoClass[] = "com/quintora/mmp/util/ThumbnailInfo";

// Bytes that each row of the engine's buffer is padded to a multiple of.
const uint32_t kRowAlignment = 64;

uint32_t bytesPerPixel(int32_t colorMode) {
    switch (colorMode) {
        case 3:
        case 4:
        case 9:
        case 10:
        case 11:
        case 15:
        case 16:
            return 2;
        case 5:
        case 12:
        case 17:
        case 18:
            return 4;
        default:
            return 0;
    }
}

bool readField(JNIEnv* env, jobject info, const char* field, int32_t& out) {
    if (getIntValueFromJava(env, kThumbnailInfoClass, info, field, out)) return true;
    ALOGE("OrvMediaCliengetThumbnailInfo(): get %s, %s, error happen\n", field,
          kThumbnailInfoClass);
    return false;
}

// Moves the padded rows together, front to back.
void packRows(uint8_t* buffer, int32_t height, uint32_t rowBytes, uint32_t paddedRowBytes) {
    // An 8-bit counter, on purpose: callers ask for at most 255 rows.
    // NOLINTNEXTLINE(bugprone-too-small-loop-variable)
    for (uint8_t row = 1; row < height; ++row) {
        memmove(buffer + row * rowBytes, buffer + row * paddedRowBytes, rowBytes);
    }
}

jbyteArray newByteArray(JNIEnv* env, const uint8_t* bytes, uint32_t size) {
    const jsize length = static_cast<jsize>(size);
    jbyteArray array = env->NewByteArray(length);
    if (array != nullptr) {
        env->SetByteArrayRegion(array, 0, length, reinterpret_cast<const jbyte*>(bytes));
    }
    return array;
}

void fillByteArray(JNIEnv* env, jbyteArray array, const MediaAlbumArt& art) {
    jbyte* elements = env->GetByteArrayElements(array, nullptr);
    if (elements == nullptr) return;
    memcpy(elements, art.data(), art.size());
    env->ReleaseByteArrayElements(array, elements, 0);
}

}  // namespace

jbyteArray OrvMediaClient_getThumbnailInfo(JNIEnv* env, jobject thiz, jobject thumbnailInfo) {
    logEnter(__func__);
    sp<OrvMediaService> service = serviceOrThrow(env, thiz);
    if (service == nullptr) return nullptr;

    _Media_Thumbnail_Info_T request = {};
    if (!readField(env, thumbnailInfo, "mCanvasColormode", request.i4CanvasColormode) ||
        !readField(env, thumbnailInfo, "mThumbnailWidth", request.i4Width) ||
        !readField(env, thumbnailInfo, "mThumbnailHeight", request.i4Height)) {
        return nullptr;
    }
    const uint32_t pixelBytes = bytesPerPixel(request.i4CanvasColormode);
    const uint32_t rowBytes = pixelBytes * static_cast<uint32_t>(request.i4Width);
    uint32_t widthNew = 0;
    if (pixelBytes != 0) {
        widthNew = ((rowBytes + kRowAlignment - 1) & ~(kRowAlignment - 1)) / pixelBytes;
        ALOGE("width_new :%d\n", widthNew);
    }
    const uint32_t paddedRowBytes = pixelBytes * widthNew;
    const uint32_t height = static_cast<uint32_t>(request.i4Height);
    const uint64_t paddedSize = uint64_t{height} * paddedRowBytes;
    const uint32_t packedSize = height * rowBytes;
    if (paddedSize == 0) {
        ALOGE("####  OrvMediaCliengetThumbnailInfo(): thumbnail_Colormode not used now!\n");
        return nullptr;
    }
    // No buffer has more bytes than the request can say.
    uint8_t* buffer =
        paddedSize <= UINT32_MAX ? static_cast<uint8_t*>(malloc(paddedSize)) : nullptr;
    if (buffer == nullptr) {
        ALOGE("####  OrvMediaCliengetThumbnailInfo(): Out of memory !!!\n");
        return nullptr;
    }
    memset(buffer, 0, paddedSize);
    request.pBuffer = buffer;
    request.u4BufferSize = static_cast<uint32_t>(paddedSize);
    if (!service->getThumbnailInfo(&request)) {
        ALOGI("OrvMediaCliengetThumbnailInfo(): GetThumbNail() failed");
        free(buffer);
        return nullptr;
    }
    packRows(buffer, request.i4Height, rowBytes, paddedRowBytes);
    jbyteArray array = newByteArray(env, buffer, packedSize);
    free(buffer);
    ALOGI("nativeGetThumbNailInfo(): Leave");
    return array;
}

jbyteArray OrvMediaClient_getEmbeddedPicture(JNIEnv* env, jobject thiz, jint) {
    ALOGI("getEmbeddedPicture(): Enter\n");
    sp<OrvMediaService> service = getMediaService(env, thiz);
    if (service == nullptr) {
        ALOGE("OrvMediaClient_prepare(): service not exist, throw exception\n");  // another name
        jniThrowException(env, "java/lang/IllegalStateException", nullptr);
        return nullptr;
    }
    MediaAlbumArt* art = service->extractAlbumArt();
    if (art == nullptr) {
        ALOGI("getEmbeddedPicture(): return NULL, leave\n");
        return nullptr;
    }
    jbyteArray array = env->NewByteArray(static_cast<jsize>(art->size()));
    if (array != nullptr) {
        fillByteArray(env, array, *art);
    } else {
        ALOGE("getEmbeddedPicture: OutOfMemoryError is thrown.");
    }
    free(art);
    ALOGI("getEmbeddedPicture(): Leave\n");
    return array;
}

}  // namespace android
