// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

#include <memory>
#include <string>
#include <vector>

#include "inspect/MediaFile.h"

namespace orvtest {

// The path of a file that make-media.sh has made.
std::string mediaPath(const std::string& name);

// The same, opened; a failed expectation and null when it cannot be.
std::unique_ptr<orvtarn::MediaFile> openMedia(const std::string& name);

// A name as the last part of a test's: only letters, digits and underscores.
std::string testName(const std::string& name);

std::vector<uint8_t> bytesOf(const std::string& path);

// What a shell command writes to its output; a failed expectation when it fails.
std::vector<uint8_t> outputOf(const std::string& command);

// Bytes in memory, as a source that may lack any ability.
class MemorySource : public orvtarn::ByteSource {
public:
    explicit MemorySource(std::vector<uint8_t> bytes) : mBytes(std::move(bytes)) {}

    int read(uint8_t* buffer, int length) override;
    bool seek(int64_t position) override;
    int64_t size() override { return mHasSize ? static_cast<int64_t>(mBytes.size()) : -1; }
    bool isSeekable() override { return mIsSeekable; }

    bool mIsSeekable = true;
    bool mHasSize = true;
    int mLongestRead = 1 << 20;
    int64_t mFailsAt = -1;   // reads from this position on fail
    int64_t mBytesRead = 0;  // in all

private:
    std::vector<uint8_t> mBytes;
    int64_t mPosition = 0;
};

}  // namespace orvtest
