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

}  // namespace

AVStream* coverOf(const MediaFile& file) {
    const AVFormatContext& media = *file.context();
    AVStream* cover = nullptr;
    for (unsigned i = 0; i < media.nb_streams; i++) {
        AVStream* stream = media.streams[i];
        if (stream->attached_pic.size <= 0) continue;
        if (isFrontCover(*stream)) return stream;
        if (cover == nullptr) cover = stream;
    }
    return cover;
}

MediaAlbumArt* extractAlbumArt(const MediaFile& file) {
    const AVStream* cover = coverOf(file);
    if (cover == nullptr) return nullptr;
    const size_t size = static_cast<size_t>(cover->attached_pic.size);
    void* block = malloc(sizeof(MediaAlbumArt) + size);
    if (block == nullptr) return nullptr;
    MediaAlbumArt* art = new (block) MediaAlbumArt{static_cast<uint32_t>(size)};
    memcpy(art->data(), cover->attached_pic.data, size);
    return art;
}

}  // namespace orvtarn
