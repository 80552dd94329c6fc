// SPDX-License-Identifier: Apache-2.0
// The log on standard error, as logcat prints it: -v threadtime,nsec. With nanoseconds,
// which the platform's own library does not write there, the times between lines say how
// long a native method took.

#include <android/log.h>
#include <errno.h>
#include <stdio.h>
#include <string.h>
#include <sys/syscall.h>
#include <time.h>
#include <unistd.h>

#include <string>
#include <string_view>

#include "LogReader.h"

namespace {

struct Line {
    int priority;
    const char* tag;
    const char* text;
};

// From Android 11 on the text is in the record.
template <typename Record>
Line lineOf(const Record* record, const char* text) {
    return {record->priority, record->tag, text};
}
template <typename Record>
Line lineOf(const Record* record) {
    return {record->priority, record->tag, record->message};
}

char letterOf(int priority) {
    constexpr char kLetters[] = "??VDIWEFS";
    return priority >= 0 && priority < static_cast<int>(sizeof(kLetters)) - 1 ? kLetters[priority]
                                                                              : '?';
}

// "11-22 23:43:08": a second's lines have it once. Any second that is not the last one's,
// also an earlier one, is looked up anew.
struct Second {
    time_t second = -1;
    char text[24] = {};
};

const char* dateOf(time_t second) {
    thread_local Second last;
    if (last.second == second) return last.text;
    tm local{};
    localtime_r(&second, &local);
    strftime(last.text, sizeof(last.text), "%m-%d %H:%M:%S", &local);
    last.second = second;
    return last.text;
}

// "11-22 23:43:08.123456789  1234  5678 I Tag     : "
void appendPrefix(const Line& line, const timespec& now, std::string& out) {
    char text[64];
    snprintf(text, sizeof(text), ".%09ld %5d %5ld %c ", now.tv_nsec, getpid(), syscall(SYS_gettid),
             letterOf(line.priority));
    const std::string_view tag = line.tag != nullptr ? line.tag : "";
    out.append(dateOf(now.tv_sec)).append(text).append(tag);
    if (tag.size() < 8) out.append(8 - tag.size(), ' ');
    out.append(": ");
}

// At once, so that lines of several threads are not mixed.
void writeAll(std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = write(STDERR_FILENO, bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) return;
        bytes.remove_prefix(count);
    }
}

// Each line of the text is one of the log; line ends at its end are left out.
void writeLine(const Line& line) {
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    std::string_view text = line.text != nullptr ? line.text : "";
    while (!text.empty() && text.back() == '\n') text.remove_suffix(1);
    std::string out;
    out.reserve(128 + text.size());
    for (size_t end = 0; end != std::string_view::npos;) {
        end = text.find('\n');
        appendPrefix(line, now, out);
        out.append(text.substr(0, end)).append(1, '\n');
        if (end != std::string_view::npos) text.remove_prefix(end + 1);
    }
    const int error = errno;
    writeAll(out);
    errno = error;
}

__attribute__((constructor)) void setLogger() {
    __android_log_set_logger([](auto... arguments) {
        const Line line = lineOf(arguments...);
        if (android::giveToLogReaders(line.priority, line.tag, line.text)) writeLine(line);
    });
}

}  // namespace
