// SPDX-License-Identifier: Apache-2.0
#include "source/MediaSource.h"

#include <errno.h>
#include <limits.h>
#include <orvtarn/PlayerTypes.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utils/Errors.h>

#include <filesystem>
#include <system_error>

#include "source/FileName.h"
#include "source/Playlist.h"
#include "source/UrlScheme.h"

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

int statusOfErrno(int error) {
    if (error == EACCES) return android::PERMISSION_DENIED;
    if (error == ENOENT || error == ENOTDIR || error == ENAMETOOLONG || error == ELOOP) {
        return android::NAME_NOT_FOUND;
    }
    return -error;
}

// Links of /proc to pipes and deleted files can be opened, but lead to no path.
std::string absolutePath(const std::string& path) {
    char resolved[PATH_MAX];
    if (realpath(path.c_str(), resolved) != nullptr) return resolved;
    std::error_code error;
    const std::string absolute = std::filesystem::absolute(path, error).string();
    return error ? path : absolute;
}

}  // namespace

int64_t MediaSource::knownDuration() {
    const int64_t own = ownDuration();
    return own > 0 ? own : mToldDuration.load();
}

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

bool UrlMediaSource::canOpenTwice() const {
    struct stat status;
    if (!isLocal()) return true;
    return stat(mName.c_str(), &status) == 0 &&
           (S_ISREG(status.st_mode) || S_ISBLK(status.st_mode));
}

bool UrlMediaSource::mayReference() const { return !isLocal() || isPlaylist(mName); }

int resolveName(const char* url, std::string& name) {
    if (url == nullptr || *url == '\0') return android::BAD_VALUE;
    std::string path;
    if (!filePath(url, path)) {
        name = url;
        if (!isOpenedScheme(schemeOf(name))) return ORV_ERROR_SCHEME;
        return android::NO_ERROR;
    }
    struct stat status;
    if (stat(path.c_str(), &status) != 0) return statusOfErrno(errno);
    if (S_ISDIR(status.st_mode)) return android::BAD_VALUE;
    if (access(path.c_str(), R_OK) != 0) return statusOfErrno(errno);
    name = absolutePath(path);
    return android::NO_ERROR;
}

}  // namespace orvtarn
