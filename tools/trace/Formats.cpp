// SPDX-License-Identifier: Apache-2.0
#include "Formats.h"

#include <string.h>

namespace orvtrace {

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }
bool isPriority(char c) { return c != '\0' && strchr("VDIWEFAS", c) != nullptr; }

// Takes a line apart from its beginning. What does not match leaves it where it was.
class Cursor {
public:
    explicit Cursor(std::string_view line) : mAt(line.data()), mEnd(line.data() + line.size()) {}

    const char* at() const { return mAt; }
    bool atEnd() const { return mAt == mEnd; }
    std::string_view rest() const { return {mAt, static_cast<size_t>(mEnd - mAt)}; }
    void backTo(const char* place) { mAt = place; }

    bool take(char c) {
        if (mAt == mEnd || *mAt != c) return false;
        ++mAt;
        return true;
    }
    bool takeBlanks() {
        const char* begin = mAt;
        while (mAt != mEnd && *mAt == ' ') ++mAt;
        return mAt != begin;
    }
    // A number of at least one and at most so many digits.
    bool takeNumber(int64_t& value, int most) {
        const char* begin = mAt;
        value = 0;
        while (mAt != mEnd && mAt - begin < most && isDigit(*mAt))
            value = value * 10 + *mAt++ - '0';
        return mAt != begin;
    }
    bool takeInt(int& value, int most) {
        int64_t number;
        if (!takeNumber(number, most)) return false;
        value = static_cast<int>(number);
        return true;
    }
    bool takePriority(char& priority) {
        if (mAt == mEnd || !isPriority(*mAt)) return false;
        priority = *mAt++;
        return true;
    }
    bool takeWord(std::string_view& word) {
        const char* begin = mAt;
        while (mAt != mEnd && *mAt != ' ') ++mAt;
        word = {begin, static_cast<size_t>(mAt - begin)};
        return mAt != begin;
    }

private:
    const char* mAt;
    const char* mEnd;
};

// ".123", as nanoseconds. Nothing is nothing.
bool takeFraction(Cursor& cursor, int64_t& nanoseconds, int& digits) {
    nanoseconds = 0;
    digits = 0;
    if (!cursor.take('.')) return true;
    const char* begin = cursor.at();
    if (!cursor.takeNumber(nanoseconds, 9)) return false;
    digits = static_cast<int>(cursor.at() - begin);
    for (int i = digits; i < 9; ++i) nanoseconds *= 10;
    return true;
}

// " +0200"
void takeZone(Cursor& cursor) {
    const char* begin = cursor.at();
    int64_t zone;
    if (cursor.take(' ') && (cursor.take('+') || cursor.take('-')) && cursor.takeNumber(zone, 4)) {
        return;
    }
    cursor.backTo(begin);
}

bool takeDate(Cursor& cursor, LogTime& time) {
    const char* begin = cursor.at();
    int first;
    if (!cursor.takeInt(first, 4)) return false;
    const bool hasYear = cursor.at() - begin == 4;
    if (hasYear) {
        time.year = first;
        if (time.year < kFirstYear || time.year > kLastYear) return false;
        if (!cursor.take('-') || !cursor.takeInt(first, 2)) return false;
    }
    time.month = first;
    return cursor.take('-') && cursor.takeInt(time.day, 2) && time.month >= 1 && time.month <= 12 &&
           time.day >= 1 && time.day <= 31;
}

bool takeTimeOfDay(Cursor& cursor, LogTime& time) {
    int hours, minutes, seconds;
    int64_t fraction;
    if (!cursor.takeInt(hours, 2) || !cursor.take(':') || !cursor.takeInt(minutes, 2) ||
        !cursor.take(':') || !cursor.takeInt(seconds, 2) ||
        !takeFraction(cursor, fraction, time.digits)) {
        return false;
    }
    if (hours > 23 || minutes > 59 || seconds > 60) return false;
    time.nanoseconds = ((hours * 60 + minutes) * 60LL + seconds) * kNanosecondsPerSecond + fraction;
    return true;
}

// Date and time, or seconds since a start.
bool takeTime(Cursor& cursor, LogTime& time) {
    const char* begin = cursor.at();
    time = {};
    if (takeDate(cursor, time)) {
        if (!cursor.take(' ') || !takeTimeOfDay(cursor, time)) return false;
    } else {
        cursor.backTo(begin);
        time = {};
        int64_t seconds, fraction;
        cursor.takeBlanks();
        if (!cursor.takeNumber(seconds, 10) || seconds > kMostSeconds ||
            !takeFraction(cursor, fraction, time.digits) || time.digits == 0) {
            return false;
        }
        time.counted = true;
        time.nanoseconds = seconds * kNanosecondsPerSecond + fraction;
    }
    time.known = true;
    time.text = {begin, static_cast<size_t>(cursor.at() - begin)};
    if (!time.counted) takeZone(cursor);
    return true;
}

std::string_view withoutBlanksAtEnd(std::string_view text) {
    const size_t last = text.find_last_not_of(" \t\r\n");
    return text.substr(0, last == std::string_view::npos ? 0 : last + 1);
}

// "Tag     : text"
bool takeTagAndText(std::string_view rest, LogLine& out) {
    size_t colon = rest.find(": ");
    if (colon == std::string_view::npos) {
        if (rest.empty() || rest.back() != ':') return false;
        colon = rest.size() - 1;
    }
    out.tag = withoutBlanksAtEnd(rest.substr(0, colon));
    out.text = withoutBlanksAtEnd(rest.substr(colon + 1));
    if (!out.text.empty()) out.text.remove_prefix(1);
    return true;
}

// What stands behind a time in threadtime: "[uid] pid tid P ". A blank at the beginning of
// the text is the text's.
bool takeThreadtime(Cursor& cursor, LogLine& out) {
    const char* begin = cursor.at();
    for (const bool hasUser : {false, true}) {
        cursor.backTo(begin);
        std::string_view user;
        if (!cursor.takeBlanks()) return false;
        if (hasUser && !(cursor.takeWord(user) && cursor.takeBlanks())) return false;
        if (cursor.takeInt(out.pid, 9) && cursor.takeBlanks() && cursor.takeInt(out.tid, 9) &&
            cursor.takeBlanks() && cursor.takePriority(out.priority) && cursor.take(' ')) {
            return takeTagAndText(cursor.rest(), out);
        }
    }
    return false;
}

// "I/Tag( 1234): text"
bool takeBrief(Cursor& cursor, LogLine& out) {
    if (!cursor.takePriority(out.priority) || !cursor.take('/')) return false;
    const std::string_view rest = cursor.rest();
    size_t open = rest.find('(');
    for (; open != std::string_view::npos; open = rest.find('(', open + 1)) {
        Cursor inner(rest.substr(open + 1));
        inner.takeBlanks();
        if (!inner.takeInt(out.pid, 9) || !inner.take(')') || !inner.take(':')) continue;
        inner.take(' ');
        out.tid = out.pid;
        out.tag = withoutBlanksAtEnd(rest.substr(0, open));
        out.text = withoutBlanksAtEnd(inner.rest());
        return true;
    }
    return false;
}

Format takeTimed(std::string_view line, LogLine& out) {
    Cursor cursor(line);
    if (!takeTime(cursor, out.time)) return Format::kNone;
    const char* behindTime = cursor.at();
    if (takeThreadtime(cursor, out)) return Format::kThreadtime;
    cursor.backTo(behindTime);
    if (cursor.takeBlanks() && takeBrief(cursor, out)) return Format::kTime;
    return Format::kNone;
}

// "Tag I 11-22 23:43:08 1234 5678 text": the platform's library writes so to standard error.
bool takeStderr(std::string_view line, LogLine& out) {
    for (size_t blank = line.find(' '); blank != std::string_view::npos;
         blank = line.find(' ', blank + 1)) {
        Cursor cursor(line.substr(blank + 1));
        if (!cursor.takePriority(out.priority) || !cursor.take(' ') ||
            !takeTime(cursor, out.time) || out.time.counted) {
            continue;
        }
        if (!cursor.takeBlanks() || !cursor.takeInt(out.pid, 9) || !cursor.takeBlanks() ||
            !cursor.takeInt(out.tid, 9)) {
            continue;
        }
        cursor.take(' ');
        out.tag = line.substr(0, blank);
        out.text = withoutBlanksAtEnd(cursor.rest());
        return true;
    }
    return false;
}

// "\033[38;5;40m": logcat's colours.
std::string_view withoutColour(std::string_view line) {
    if (line.size() < 2 || line[0] != '\033' || line[1] != '[') return line;
    const size_t end = line.find('m');
    if (end == std::string_view::npos) return line;
    line.remove_prefix(end + 1);
    const std::string_view reset = "\033[0m";
    if (line.size() >= reset.size() && line.substr(line.size() - reset.size()) == reset) {
        line.remove_suffix(reset.size());
    }
    return line;
}

Format readLine(std::string_view line, LogLine& out) {
    if (line.size() < 2) return Format::kNone;
    if (isDigit(line[0]) || line[0] == ' ') {
        const Format format = takeTimed(line, out);
        if (format != Format::kNone) return format;
    }
    if (line[1] == '/') {
        Cursor cursor(line);
        out.time = {};
        if (takeBrief(cursor, out)) return Format::kBrief;
    }
    return takeStderr(line, out) ? Format::kStderr : Format::kNone;
}

}  // namespace

FormatReader::Result FormatReader::read(std::string_view line, LogLine& out) {
    line = withoutColour(line);
    if (line.size() > 2 && line[0] == '[' && line[1] == ' ' && readHeader(line)) {
        mInLong = true;
        return Result::kSeparator;
    }
    if (mInLong) return readLong(line, out);
    if (line.empty() || line.substr(0, 10) == "--------- ") return Result::kSeparator;
    const Format format = readLine(line, out);
    if (format == Format::kNone) return Result::kForeign;
    mFormat = format;
    return Result::kEntry;
}

FormatReader::Result FormatReader::readLong(std::string_view line, LogLine& out) {
    if (line.empty()) {
        mInLong = false;
        return Result::kSeparator;
    }
    out = mHeader;
    out.text = withoutBlanksAtEnd(line);
    mFormat = Format::kLong;
    return Result::kEntry;
}

bool FormatReader::readHeader(std::string_view line) {
    if (line.size() > sizeof(mHeaderText)) return false;
    LogLine header;
    Cursor cursor(line);
    cursor.take('[');
    cursor.take(' ');
    if (!takeTime(cursor, header.time)) return false;
    cursor.takeBlanks();
    const char* behindTime = cursor.at();
    std::string_view user;
    bool numbers = false;
    for (const bool hasUser : {false, true}) {
        cursor.backTo(behindTime);
        if (hasUser) {
            cursor.takeWord(user);
            if (!user.empty() && user.back() == ':') cursor.take(' ');
            cursor.takeBlanks();
        }
        if (!cursor.takeInt(header.pid, 9) || !cursor.take(':')) continue;
        cursor.takeBlanks();
        numbers = cursor.takeInt(header.tid, 9) && cursor.takeBlanks();
        if (numbers) break;
    }
    if (!numbers || !cursor.takePriority(header.priority) || !cursor.take('/')) return false;
    std::string_view tag = cursor.rest();
    if (tag.size() < 2 || tag.substr(tag.size() - 2) != " ]") return false;
    header.tag = withoutBlanksAtEnd(tag.substr(0, tag.size() - 2));

    // The line does not last until its texts come.
    memcpy(mHeaderText, line.data(), line.size());
    const char* old = line.data();
    header.tag = {mHeaderText + (header.tag.data() - old), header.tag.size()};
    header.time.text = {mHeaderText + (header.time.text.data() - old), header.time.text.size()};
    mHeader = header;
    return true;
}

}  // namespace orvtrace
