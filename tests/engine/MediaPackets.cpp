// SPDX-License-Identifier: Apache-2.0
#include "MediaPackets.h"

#include <stdio.h>
#include <stdlib.h>

#include <sstream>

#include "TestMedia.h"

namespace orvtest {
namespace {

std::string probe(const std::string& name, const std::string& what) {
    const std::vector<uint8_t> output = outputOf("ffprobe -v error -show_entries " + what +
                                                 " -of csv=p=0 '" + mediaPath(name) + "'");
    return std::string(output.begin(), output.end());
}

}  // namespace

std::vector<MediaPacket> packetsOf(const std::string& name, const std::string& stream) {
    const double start = atof(probe(name, "format=start_time").c_str());
    std::istringstream lines(probe(name, "packet=pts_time,pos -select_streams " + stream));
    std::vector<MediaPacket> packets;
    for (std::string line; std::getline(lines, line);) {
        MediaPacket packet = {};
        if (sscanf(line.c_str(), "%lf,%lld", &packet.time, &packet.position) != 2) continue;
        packet.time -= start;
        packets.push_back(packet);
    }
    return packets;
}

}  // namespace orvtest
