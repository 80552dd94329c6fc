// SPDX-License-Identifier: Apache-2.0
#include "Reading.h"

#include <errno.h>
#include <fcntl.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <thread>

#include "OutputFile.h"

namespace orvtrace {

namespace {

using std::chrono::steady_clock;

constexpr std::chrono::seconds kRefreshEvery{1};
// How long a file that has no more is left alone, and a pipe waited for.
constexpr std::chrono::milliseconds kPatience{200};
// So many lines pass between two looks at the clock.
constexpr uint64_t kLinesPerLook = 4096;

std::string reasonOf(int error) { return std::string(strerror(error)); }

}  // namespace

// An open log.
class Reading::File {
public:
    explicit File(const std::string& path) : mPath(path) {
        mFd = path == "-" ? dup(STDIN_FILENO) : open(path.c_str(), O_RDONLY | O_CLOEXEC);
        if (mFd < 0) fail(errno);
        struct stat status{};
        if (fstat(mFd, &status) != 0) fail(errno);
        if (S_ISDIR(status.st_mode)) fail(EISDIR);
        mRegular = S_ISREG(status.st_mode);
    }
    ~File() { close(mFd); }
    File(const File&) = delete;
    File& operator=(const File&) = delete;

    int fd() const { return mFd; }
    bool isRegular() const { return mRegular; }

    // Whether another file has its name by now, or it has become shorter than what was read.
    bool isReplaced(uint64_t read) const {
        struct stat mine{}, named{};
        if (mPath == "-" || fstat(mFd, &mine) != 0 || stat(mPath.c_str(), &named) != 0)
            return false;
        return mine.st_ino != named.st_ino || mine.st_dev != named.st_dev ||
               static_cast<uint64_t>(mine.st_size) < read;
    }

    [[noreturn]] void fail(int error) const {
        const std::string name = mPath == "-" ? "Standard input" : "'" + mPath + "'";
        throw Failure(name + " cannot be read: " + reasonOf(error) +
                      ". Name a file that logcat has written, or - for standard input.");
    }

private:
    std::string mPath;
    int mFd = -1;
    bool mRegular = false;
};

Reading::Reading(Session& session, const volatile sig_atomic_t& stop)
    : mSession(session), mStop(stop) {}

void Reading::follow(std::function<void()> refresh) {
    mRefresh = std::move(refresh);
    mRefreshed = steady_clock::now();
}

bool Reading::read(const std::vector<std::string>& logs) {
    for (size_t i = 0; i < logs.size(); ++i) {
        const bool follows = mRefresh != nullptr && i + 1 == logs.size();
        while (readLog(logs[i], follows)) {
            // It was replaced.
        }
        if (mStop != 0) return false;
    }
    return true;
}

// Whether the file was replaced by another of its name.
bool Reading::readLog(const std::string& path, bool follows) {
    const File file(path);
    LineReader reader(file.fd(), follows ? static_cast<int>(kPatience.count()) : -1);
    mSession.nextLog();
    bool replaced = false;
    std::string_view line;
    while (mStop == 0 && !replaced) {
        const LineReader::Result result = reader.next(line);
        if (result == LineReader::Result::kLine) {
            mSession.line(line);
        } else if (result == LineReader::Result::kError) {
            file.fail(errno);
        } else if (result == LineReader::Result::kEnd) {
            if (!follows || !file.isRegular()) break;
            replaced = file.isReplaced(reader.bytesRead());
            if (!replaced) std::this_thread::sleep_for(kPatience);
        }
        const bool waited = result != LineReader::Result::kLine;
        if (follows && (waited || mSession.lines() % kLinesPerLook == 0)) refreshIfDue();
    }
    const std::string_view rest = reader.rest();
    if (!rest.empty()) mSession.line(rest);
    mSession.addLongLines(reader.longLines());
    return replaced;
}

void Reading::refreshIfDue() {
    const steady_clock::time_point now = steady_clock::now();
    if (now < mRefreshed + kRefreshEvery) return;
    mRefreshed = now;
    mRefresh();
}

}  // namespace orvtrace
