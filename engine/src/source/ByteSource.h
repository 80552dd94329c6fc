// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdint.h>

namespace orvtarn {

// Media bytes that a MediaFile reads, in whatever way the source has them. Only
// one thread uses a source at a time. Calls may block as long as the source.
class ByteSource {
public:
    virtual ~ByteSource() = default;

    // Reads up to length bytes from the current position. The count (more than
    // 0), 0 at the end, negative for an error.
    virtual int read(uint8_t* buffer, int length) = 0;
    // Moves to a position counted from the start. False when it cannot.
    virtual bool seek(int64_t position) = 0;
    // Bytes in all; negative when unknown.
    virtual int64_t size() = 0;
    virtual bool isSeekable() = 0;
};

// A range of a file by descriptor, with a position of its own: the descriptor's
// is neither used nor moved. The descriptor is borrowed.
class FdByteSource : public ByteSource {
public:
    // length bytes from offset; a range that passes the file's end ends there.
    FdByteSource(int fd, int64_t offset, int64_t length);

    int read(uint8_t* buffer, int length) override;
    bool seek(int64_t position) override;
    int64_t size() override;
    bool isSeekable() override { return true; }

private:
    int mFd;
    int64_t mOffset;
    int64_t mLength;
    int64_t mPosition = 0;
};

}  // namespace orvtarn
