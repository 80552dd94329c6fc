// SPDX-License-Identifier: Apache-2.0
#include "TestMedia.h"

#include <gtest/gtest.h>
#include <stdio.h>
#include <string.h>

#include <algorithm>

extern "C" {
#include <libavutil/log.h>
}

namespace orvtest {
namespace {

// Damaged media is no news here.
const bool isQuiet = (av_log_set_level(AV_LOG_FATAL), true);

}  // namespace

std::string mediaPath(const std::string& name) { return ORV_TEST_MEDIA "/" + name; }

std::unique_ptr<orvtarn::MediaFile> openMedia(const std::string& name) {
    std::unique_ptr<orvtarn::MediaFile> file;
    EXPECT_EQ(orvtarn::MediaFile::open(mediaPath(name), {}, file), 0) << name;
    return file;
}

std::string testName(const std::string& name) {
    std::string plain = name;
    for (char& letter : plain) letter = isalnum(letter) ? letter : '_';
    return plain;
}

std::vector<uint8_t> bytesOf(const std::string& path) { return outputOf("cat '" + path + "'"); }

std::vector<uint8_t> outputOf(const std::string& command) {
    std::vector<uint8_t> output;
    FILE* pipe = popen(command.c_str(), "r");
    if (pipe == nullptr) {
        ADD_FAILURE() << command;
        return output;
    }
    uint8_t buffer[64 * 1024];
    for (size_t count; (count = fread(buffer, 1, sizeof(buffer), pipe)) > 0;) {
        output.insert(output.end(), buffer, buffer + count);
    }
    EXPECT_EQ(pclose(pipe), 0) << command;
    return output;
}

int MemorySource::read(uint8_t* buffer, int length) {
    if (mFailsAt >= 0 && mPosition >= mFailsAt) return -1;
    const int64_t left = static_cast<int64_t>(mBytes.size()) - mPosition;
    const int64_t count = std::min<int64_t>({length, left, mLongestRead});
    if (count <= 0) return 0;
    memcpy(buffer, mBytes.data() + mPosition, static_cast<size_t>(count));
    mPosition += count;
    mBytesRead += count;
    return static_cast<int>(count);
}

bool MemorySource::seek(int64_t position) {
    if (position < 0 || position > static_cast<int64_t>(mBytes.size())) return false;
    mPosition = position;
    return true;
}

}  // namespace orvtest
