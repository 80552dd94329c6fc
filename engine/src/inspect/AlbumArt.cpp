// SPDX-License-Identifier: Apache-2.0
#include "inspect/AlbumArt.h"

#include <stdlib.h>
#include <string.h>

#include <new>

#include "base/LibavValues.h"

extern "C" {
#include <libavformat/avformat.h>
}

namespace orvtarn {
namespace {

// The demuxers name an embedded picture's purpose in this tag.
bool isFrontCover(const AVStream& stream) {
    return strcmp(tagOf(stream.metadata, "comment"), "Cover (front)") == 0;
}

const AVPacket* coverOf(const AVFormatContext& media) {
    const AVPacket* cover = nullptr;
    for (unsigned i = 0; i < media.nb_streams; i++) {
        const AVStream& stream = *media.streams[i];
        if (stream.attached_pic.size <= 0) continue;
        if (isFrontCover(stream)) return &stream.attached_pic;
        if (cover == nullptr) cover = &stream.attached_pic;
    }
    return cover;
}

}  // namespace

MediaAlbumArt* extractAlbumArt(const MediaFile& file) {
    const AVPacket* cover = coverOf(*file.context());
    if (cover == nullptr) return nullptr;
    const size_t size = static_cast<size_t>(cover->size);
    void* block = malloc(sizeof(MediaAlbumArt) + size);
    if (block == nullptr) return nullptr;
    MediaAlbumArt* art = new (block) MediaAlbumArt{static_cast<uint32_t>(size)};
    memcpy(art->data(), cover->data, size);
    return art;
}

}  // namespace orvtarn
