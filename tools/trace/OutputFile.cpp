// SPDX-License-Identifier: Apache-2.0
#include "OutputFile.h"

#include <errno.h>
#include <limits.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

namespace orvtrace {

namespace {

// The file behind a link is replaced, not the link.
std::string realPath(const std::string& path) {
    char real[PATH_MAX];
    return realpath(path.c_str(), real) != nullptr ? real : path;
}

mode_t usualMode() {
    const mode_t mask = umask(0);
    umask(mask);
    return 0666 & ~mask;
}

}  // namespace

OutputFile::OutputFile(const std::string& path) : mPath(path) {
    struct stat status{};
    if (path == "-") {
        mFile = fdopen(dup(STDOUT_FILENO), "w");
        if (mFile == nullptr) fail(errno);
        return;
    }
    const bool exists = stat(path.c_str(), &status) == 0;
    if (exists && S_ISDIR(status.st_mode)) fail(EISDIR);
    if (exists && !S_ISREG(status.st_mode)) {
        mFile = fopen(path.c_str(), "w");
        if (mFile == nullptr) fail(errno);
        return;
    }
    // A file that may not be written is not replaced, either.
    if (exists && access(path.c_str(), W_OK) != 0) fail(errno);
    create();
    fchmod(fileno(mFile), exists ? status.st_mode & 07777 : usualMode());
}

void OutputFile::create() {
    mDraft = realPath(mPath) + ".XXXXXX";
    const int fd = mkstemp(mDraft.data());
    if (fd < 0) {
        const int error = errno;
        mDraft.clear();
        fail(error);
    }
    mFile = fdopen(fd, "w");
}

OutputFile::~OutputFile() {
    if (mFile != nullptr) fclose(mFile);
    if (!mDraft.empty()) unlink(mDraft.c_str());
}

void OutputFile::finish() {
    const bool failed = ferror(mFile) != 0 || fflush(mFile) != 0;
    int error = errno;
    FILE* file = mFile;
    mFile = nullptr;
    if (fclose(file) != 0 && !failed) fail(errno);
    if (failed) fail(error != 0 ? error : EIO);
    if (mDraft.empty()) return;
    if (rename(mDraft.c_str(), realPath(mPath).c_str()) != 0) fail(errno);
    mDraft.clear();
}

void OutputFile::fail(int error) const {
    throw Failure("'" + mPath + "' cannot be written: " + strerror(error) +
                  ". Name another place for it.");
}

}  // namespace orvtrace
