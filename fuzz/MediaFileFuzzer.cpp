// SPDX-License-Identifier: Apache-2.0
//
// Reads everything from bytes that may be a media file: tags, chapters,
// pictures and a thumbnail. Seeds: the files of tests/media.
#include <stdlib.h>
#include <string.h>

#include <algorithm>

#include "inspect/AlbumArt.h"
#include "inspect/ContainerInfo.h"
#include "inspect/MediaFile.h"
#include "inspect/Thumbnailer.h"

extern "C" {
#include <libavutil/log.h>
}

namespace {

class Bytes : public orvtarn::ByteSource {
public:
    Bytes(const uint8_t* data, size_t size) : mData(data), mSize(static_cast<int64_t>(size)) {}

    int read(uint8_t* buffer, int length) override {
        const int64_t count = std::min<int64_t>(length, mSize - mPosition);
        if (count > 0) memcpy(buffer, mData + mPosition, static_cast<size_t>(count));
        mPosition += count;
        return static_cast<int>(count);
    }
    bool seek(int64_t position) override {
        if (position < 0 || position > mSize) return false;
        mPosition = position;
        return true;
    }
    int64_t size() override { return mSize; }
    bool isSeekable() override { return true; }

private:
    const uint8_t* mData;
    int64_t mSize;
    int64_t mPosition = 0;
};

void draw(std::unique_ptr<orvtarn::MediaFile> file) {
    std::unique_ptr<orvtarn::Thumbnailer> thumbnailer;
    if (orvtarn::Thumbnailer::create(std::move(file), -1, thumbnailer) != 0) return;
    uint8_t pixels[64 * 9];
    thumbnailer->draw(1000, {pixels, sizeof(pixels), ORV_COLOR_MODE_RGB565, 16, 9});
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    av_log_set_level(AV_LOG_QUIET);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    orvtarn::MediaOpenOptions options;
    options.timeLimit = std::chrono::seconds(1);
    std::unique_ptr<orvtarn::MediaFile> file;
    if (orvtarn::MediaFile::open(std::make_unique<Bytes>(data, size), options, file) != 0) return 0;
    free(orvtarn::extractAlbumArt(*file));
    orvtarn::metaDataInfo(*file);
    SubtitleTrackInfo chapter;
    for (int i = 0; orvtarn::chapterRecord(*file, i, chapter); i++) continue;
    draw(std::move(file));
    return 0;
}
