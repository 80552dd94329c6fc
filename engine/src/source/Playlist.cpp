// SPDX-License-Identifier: Apache-2.0
#include "source/Playlist.h"

#include <strings.h>
#include <sys/stat.h>

#include <algorithm>
#include <fstream>
#include <iterator>

namespace orvtarn {
namespace {

const char* const kEndings[] = {".m3u", ".m3u8", ".pls", ".asx", ".mpd"};
const char* const kStarts[] = {"#EXTM3U", "[playlist]", "<MPD", "<ASX"};
constexpr size_t kPlaylistSample = 1024;

bool endsWith(const std::string& path, const std::string& ending) {
    return path.size() > ending.size() &&
           strcasecmp(path.c_str() + path.size() - ending.size(), ending.c_str()) == 0;
}

std::string sampleOf(const std::string& path) {
    struct stat status;
    if (stat(path.c_str(), &status) != 0 || !S_ISREG(status.st_mode)) return "";
    std::string sample(kPlaylistSample, '\0');
    std::ifstream file(path, std::ios::binary);
    file.read(sample.data(), kPlaylistSample);
    sample.resize(static_cast<size_t>(file.gcount()));
    return sample;
}

}  // namespace

bool isPlaylist(const std::string& path) {
    if (std::any_of(std::begin(kEndings), std::end(kEndings),
                    [&](const char* ending) { return endsWith(path, ending); })) {
        return true;
    }
    const std::string sample = sampleOf(path);
    return std::any_of(std::begin(kStarts), std::end(kStarts),
                       [&](const char* start) { return sample.find(start) != std::string::npos; });
}

}  // namespace orvtarn
