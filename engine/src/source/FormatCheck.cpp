// SPDX-License-Identifier: Apache-2.0
#include "source/FormatCheck.h"

#include <fcntl.h>
#include <orvtarn/PlayerTypes.h>
#include <unistd.h>

#include <memory>
#include <utility>

extern "C" {
#include <libavformat/avformat.h>
#include <libavutil/avstring.h>
}

namespace orvtarn {
namespace {

using android::status_t;

constexpr int kFormatSample = 64 * 1024;

struct KnownFormat {
    const char* libavName;  // one of those that a format of libavformat has
    E_Orv_Format format;
};

const KnownFormat kFormats[] = {
    {"mp4", E_ORV_FORMAT_MP4},      {"matroska", E_ORV_FORMAT_MATROSKA},
    {"avi", E_ORV_FORMAT_AVI},      {"mpegts", E_ORV_FORMAT_MPEG_TS},
    {"mpeg", E_ORV_FORMAT_MPEG_PS}, {"flv", E_ORV_FORMAT_FLV},
    {"asf", E_ORV_FORMAT_ASF},      {"ogg", E_ORV_FORMAT_OGG},
    {"wav", E_ORV_FORMAT_WAV},      {"flac", E_ORV_FORMAT_FLAC},
    {"mp3", E_ORV_FORMAT_MP3},      {"aac", E_ORV_FORMAT_AAC},
    {"aiff", E_ORV_FORMAT_AIFF},
};

int formatOf(const AVInputFormat& format) {
    for (const KnownFormat& known : kFormats) {
        if (av_match_name(known.libavName, format.name)) return known.format;
    }
    return E_ORV_FORMAT_OTHER;
}

class OwnedFile : public FdByteSource {
public:
    explicit OwnedFile(int fd) : FdByteSource(fd, 0, INT64_MAX), mFd(fd) {}
    ~OwnedFile() override { close(mFd); }

private:
    const int mFd;
};

std::unique_ptr<ByteSource> openReader(MediaSource& source) {
    if (source.isOfBytes()) return source.openReader();
    if (!source.isLocal() || !source.canOpenTwice()) return nullptr;
    const int fd = open(source.name().c_str(), O_RDONLY | O_CLOEXEC);
    return fd < 0 ? nullptr : std::make_unique<OwnedFile>(fd);
}

}  // namespace

status_t checkFormat(std::vector<uint8_t> bytes) {
    if (bytes.empty()) return ORV_ERROR_EMPTY;
    AVProbeData data = {};
    data.filename = "";
    data.buf_size = static_cast<int>(bytes.size());
    bytes.resize(bytes.size() + AVPROBE_PADDING_SIZE);
    data.buf = bytes.data();
    int score = 0;
    const AVInputFormat* format = av_probe_input_format3(&data, 1, &score);
    // Formats without a mark of their own are guessed, below that score.
    if (format == nullptr || score <= AVPROBE_SCORE_RETRY) return ORV_ERROR_MALFORMED;
    return ORV_ERROR_NOTHING_INSIDE - formatOf(*format);
}

status_t checkFormat(MediaSource& source) {
    const std::unique_ptr<ByteSource> reader = openReader(source);
    if (reader == nullptr) return ORV_ERROR_MALFORMED;
    std::vector<uint8_t> bytes(kFormatSample);
    int length = 0;
    int count = 0;
    do {
        count = reader->read(bytes.data() + length, kFormatSample - length);
        if (count > 0) length += count;
    } while (count > 0 && length < kFormatSample);
    if (count < 0) return ORV_ERROR_IO;
    bytes.resize(static_cast<size_t>(length));
    return checkFormat(std::move(bytes));
}

}  // namespace orvtarn
