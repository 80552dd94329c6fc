// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

namespace orvtest {

struct MediaPacket {
    double time;         // seconds from the media's start
    long long position;  // bytes
};

// The packets of a file of tests/media with a time and a place, as ffprobe has them, in
// the file's order; of a stream that ffprobe names, the first video stream's as a rule.
std::vector<MediaPacket> packetsOf(const std::string& name, const std::string& stream = "v:0");

}  // namespace orvtest
