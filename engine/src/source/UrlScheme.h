// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <utils/Errors.h>

#include <string>

#include "source/MediaSource.h"

namespace orvtarn {

// The scheme of a URL in lower case, "http"; empty for what is not a URL.
std::string schemeOf(const std::string& name);

// Whether media are opened from addresses of that scheme. Of mpv's own schemes
// none is: they reach descriptors, devices and other media.
bool isOpenedScheme(const std::string& scheme);

// Whether opening that media may lead to opening that name, as a playlist
// names it. 0, ORV_ERROR_SCHEME, or ORV_ERROR_LOCAL_REFERENCE for a file where
// the media are not one themselves.
android::status_t checkReference(const MediaSource& media, const std::string& name);

// The protocols that libavformat may use for media from the network or from a
// local file, in the form of its option protocol_whitelist.
const char* protocolWhitelist(bool isLocal);

}  // namespace orvtarn
