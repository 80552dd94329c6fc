// SPDX-License-Identifier: Apache-2.0
#include "source/ByteSource.h"

#include <errno.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>

namespace orvtarn {

FdByteSource::FdByteSource(int fd, int64_t offset, int64_t length)
    : mFd(fd), mOffset(offset), mLength(length) {
    struct stat status;
    if (fstat(fd, &status) == 0 && S_ISREG(status.st_mode)) {
        mLength = std::clamp<int64_t>(status.st_size - offset, 0, length);
    }
}

int FdByteSource::read(uint8_t* buffer, int length) {
    const int64_t left = std::min<int64_t>(mLength - mPosition, length);
    if (left <= 0) return 0;
    ssize_t count;
    do {
        count = pread64(mFd, buffer, static_cast<size_t>(left), mOffset + mPosition);
    } while (count < 0 && errno == EINTR);
    if (count > 0) mPosition += count;
    return static_cast<int>(count);
}

bool FdByteSource::seek(int64_t position) {
    if (position < 0 || position > mLength) return false;
    mPosition = position;
    return true;
}

int64_t FdByteSource::size() { return mLength; }

}  // namespace orvtarn
