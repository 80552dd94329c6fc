// SPDX-License-Identifier: Apache-2.0
//
// A file that may hold subtitles, beside a second of silence, in the desktop
// engine: loaded, its tracks described, turned on and off. Input: the file.
#include <orvtarn/TarnPlayer.h>
#include <string.h>
#include <sys/mman.h>
#include <unistd.h>

#include <string>

#include "support/QuietLog.h"
#include "support/Require.h"

namespace {

using orvfuzz::require;

// What mpv and libav make of a longer one takes them long, and is theirs.
constexpr size_t kMostBytes = 1 << 16;

// A file without a name, that has a path for as long as it lives.
class MemoryFile {
public:
    MemoryFile(const void* bytes, size_t size) : mFd(memfd_create("fuzz", MFD_CLOEXEC)) {
        require(mFd >= 0 && write(mFd, bytes, size) == static_cast<ssize_t>(size),
                "a file in memory can be written");
    }
    ~MemoryFile() { close(mFd); }
    std::string path() const { return "/proc/self/fd/" + std::to_string(mFd); }

private:
    const int mFd;
};

// WAVE: one channel of 8 bits, 8000 samples a second.
std::string silence() {
    const auto word = [](uint32_t value) {
        return std::string(reinterpret_cast<const char*>(&value), 4);
    };
    constexpr uint32_t rate = 8000;
    return "RIFF" + word(36 + rate) + "WAVEfmt " + word(16) + word(1 << 16 | 1) + word(rate) +
           word(rate) + word(8 << 16 | 1) + "data" + word(rate) + std::string(rate, '\x80');
}

// Every byte of a text that ends within its array.
void requireText(const OrvText& text) {
    require(memchr(text, 0, sizeof(text)) != nullptr, "a text ends within its record");
}

void lookAt(android::TarnPlayer& player) {
    int count = 0;
    require(player.getSubtitleTrackCount(count) && count >= 0, "subtitle tracks can be counted");
    for (int i = 0; i < count; i++) {
        SubtitleTrackInfo info;
        require(player.getSubtitleTrackInfo(i, info), "every track has its record");
        requireText(info.mText);
        requireText(info.mLanguage);
        require(player.onSubtitleTrack(i), "every track can be turned on");
    }
    SubtitleTrackInfo info;
    require(!player.getSubtitleTrackInfo(count, info), "behind the last track there is none");
    player.offSubtitleTrack();
}

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
    orvfuzz::quietLog();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    if (size > kMostBytes) return 0;
    static const std::string wave = silence();
    const MemoryFile media(wave.data(), wave.size());
    const MemoryFile subtitles(data, size);
    android::sp<android::TarnPlayer> player = new android::TarnPlayer(-1);
    require(player->setDataSource(media.path().c_str(), nullptr) == android::NO_ERROR,
            "silence can be set");
    require(player->prepare() == android::NO_ERROR, "silence can be prepared");
    player->setSubtitleDataSource(subtitles.path().c_str());
    lookAt(*player);
    require(player->release() == android::NO_ERROR, "a player can be released");
    return 0;
}
