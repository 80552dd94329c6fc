// SPDX-License-Identifier: Apache-2.0
#include "MediaSource.h"

#include <errno.h>
#include <limits.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utils/Errors.h>

namespace orvtarn {
namespace {

// A reader that its source counts.
class CountedFdSource : public FdByteSource {
public:
    CountedFdSource(int fd, int64_t offset, int64_t length, ReaderCount& readers)
        : FdByteSource(fd, offset, length), mReaders(readers) {}
    ~CountedFdSource() override { mReaders.leave(); }

private:
    ReaderCount& mReaders;
};

// The path of a file name or "file:" URL; null for URLs of other kinds.
const char* pathOf(const char* url) {
    if (strncasecmp(url, "file://", 7) == 0) return url + 7;
    return *url == '/' || strstr(url, "://") == nullptr ? url : nullptr;
}

int statusOfErrno(int error) {
    if (error == EACCES) return android::PERMISSION_DENIED;
    if (error == ENOENT || error == ENOTDIR || error == ENAMETOOLONG || error == ELOOP) {
        return android::NAME_NOT_FOUND;
    }
    return -error;
}

}  // namespace

bool ReaderCount::enter() {
    std::lock_guard<std::mutex> lock(mMutex);
    if (mClosed) return false;
    mCount++;
    return true;
}

void ReaderCount::leave() {
    std::lock_guard<std::mutex> lock(mMutex);
    if (--mCount == 0) mLeft.notify_all();
}

void ReaderCount::close() {
    std::lock_guard<std::mutex> lock(mMutex);
    mClosed = true;
}

void ReaderCount::awaitNone() {
    std::unique_lock<std::mutex> lock(mMutex);
    mLeft.wait(lock, [this] { return mCount == 0; });
}

int ReaderCount::count() const {
    std::lock_guard<std::mutex> lock(mMutex);
    return mCount;
}

FdMediaSource::~FdMediaSource() { ::close(mFd); }

std::unique_ptr<ByteSource> FdMediaSource::openReader() {
    if (!mReaders.enter()) return nullptr;
    return std::make_unique<CountedFdSource>(mFd, mOffset, mLength, mReaders);
}

void FdMediaSource::close() {
    mReaders.close();
    mReaders.awaitNone();
}

int resolveName(const char* url, std::string& name) {
    if (url == nullptr || *url == '\0') return android::BAD_VALUE;
    const char* path = pathOf(url);
    if (path == nullptr) {
        name = url;
        return android::NO_ERROR;
    }
    char resolved[PATH_MAX];
    struct stat status;
    if (realpath(path, resolved) == nullptr || stat(resolved, &status) != 0) {
        return statusOfErrno(errno);
    }
    if (S_ISDIR(status.st_mode)) return android::BAD_VALUE;
    if (access(resolved, R_OK) != 0) return statusOfErrno(errno);
    name = resolved;
    return android::NO_ERROR;
}

}  // namespace orvtarn
