// SPDX-License-Identifier: Apache-2.0
#include "source/UrlScheme.h"

#include <ctype.h>
#include <orvtarn/PlayerTypes.h>
#include <string.h>

#include <algorithm>
#include <cstddef>
#include <iterator>

// What playlists, redirects and manifests may lead to, without and with files.
#define NETWORK_PROTOCOLS                                                     \
    "http,https,httpproxy,tls,tcp,udp,rtp,rtsp,rtsps,rtmp,rtmpe,rtmps,rtmpt," \
    "rtmpte,rtmpts,ftp,ftps,mmsh,mmst,smb,crypto,data"

namespace orvtarn {

std::string schemeOf(const std::string& name) {
    const size_t end = name.find("://");
    if (end == std::string::npos || end == 0) return "";
    std::string scheme = name.substr(0, end);
    for (char& c : scheme) {
        if (!isalnum(static_cast<unsigned char>(c)) && strchr("+-.", c) == nullptr) return "";
        c = static_cast<char>(tolower(static_cast<unsigned char>(c)));
    }
    return scheme;
}

bool isOpenedScheme(const std::string& scheme) {
    static const char* const kOpened[] = {
        "http", "https", "rtsp", "rtsps", "rtmp", "rtmpe", "rtmps", "rtmpt",   "rtmpte", "rtmpts",
        "rtp",  "udp",   "ftp",  "ftps",  "mms",  "mmsh",  "mmst",  "mmshttp", "smb"};
    return std::any_of(std::begin(kOpened), std::end(kOpened),
                       [&](const char* opened) { return scheme == opened; });
}

android::status_t checkReference(const MediaSource& media, const std::string& name) {
    if (name == media.name()) return android::NO_ERROR;
    const std::string scheme = schemeOf(name);
    if (isOpenedScheme(scheme)) return android::NO_ERROR;
    if (!scheme.empty() && scheme != "file") return ORV_ERROR_SCHEME;
    if (!media.isLocal() || media.isOfBytes()) return ORV_ERROR_LOCAL_REFERENCE;
    return android::NO_ERROR;
}

const char* protocolWhitelist(bool isLocal) {
    return isLocal ? "file," NETWORK_PROTOCOLS : NETWORK_PROTOCOLS;
}

}  // namespace orvtarn
