// SPDX-License-Identifier: Apache-2.0
#include "Table.h"

#include <utf8.h>

#include <vector>

#include "Text.h"

namespace orvtrace {

namespace {

using Row = std::vector<std::string>;

size_t widthOf(const std::string& text) { return utf8::distance(text.begin(), text.end()); }

std::string padded(const std::string& text, size_t width, bool left) {
    const std::string blanks(width - widthOf(text), ' ');
    return left ? text + blanks : blanks + text;
}

// A time below what the log's lines can tell apart.
std::string shown(int64_t time, int digits) {
    if (time == 0 && digits == 0) return "< 1 s";
    return time == 0 && digits <= 3 ? "< 1 ms" : readableTime(time);
}

Row rowOf(const MethodCalls& calls, int digits) {
    Row row = {calls.method->name, readableCount(calls.calls),
               calls.failed == 0 ? "-" : readableCount(calls.failed)};
    if (calls.times.count() == 0) {
        row.insert(row.end(), {"-", "-", "-", "-", ""});
        return row;
    }
    // A bucket's middle may lie beyond all of its times.
    const auto quantile = [&](double share) {
        const int64_t time = static_cast<int64_t>(calls.times.quantile(share));
        return shown(std::clamp(time, calls.shortest, calls.longest), digits);
    };
    row.insert(row.end(), {shown(calls.total, digits), quantile(0.5), quantile(0.99),
                           shown(calls.longest, digits), std::string(calls.longestAt.asWritten())});
    return row;
}

std::string laidOut(const std::vector<Row>& rows) {
    std::vector<size_t> widths(rows.front().size());
    for (const Row& row : rows) {
        for (size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], widthOf(row[i]));
    }
    std::string text;
    for (const Row& row : rows) {
        for (size_t i = 0; i < row.size(); ++i) {
            const bool last = i + 1 == row.size();
            if (i > 0) text += "  ";
            text += last ? row[i] : padded(row[i], widths[i], i == 0);
        }
        while (!text.empty() && text.back() == ' ') text.pop_back();
        text += '\n';
    }
    return text;
}

// "3 lines", and nothing for none.
void say(std::string& text, uint64_t count, const char* one, const char* several) {
    if (count == 0) return;
    text += text.empty() ? "" : ", ";
    text += readableCount(count) + " " + (count == 1 ? one : several);
}

uint64_t missing(const Statistics& statistics) {
    uint64_t count = 0;
    for (const MethodCalls* calls : statistics.methods()) count += calls->leaveMissing;
    return count;
}

}  // namespace

std::string summaryOf(const Statistics& statistics, const LineCounts& lines, uint64_t players) {
    std::string kinds;
    say(kinds, lines.ours, "of the player", "of the player");
    say(kinds, lines.otherTags, "of another tag", "of other tags");
    say(kinds, lines.foreign, "in no known format", "in no known format");
    std::string text = readableCount(lines.lines) + (lines.lines == 1 ? " line" : " lines") +
                       (kinds.empty() ? "" : ": " + kinds) + ".\n";
    std::string found;
    say(found, statistics.calls(), "call", "calls");
    say(found, players, "player", "players");
    say(found, statistics.marks(Mark::kEvent), "event", "events");
    say(found, statistics.marks(Mark::kException), "exception", "exceptions");
    say(found, statistics.marks(Mark::kError), "error", "errors");
    say(found, statistics.marks(Mark::kWarning), "warning", "warnings");
    if (!found.empty()) text += found + ".\n";
    std::string odd;
    say(odd, missing(statistics), "call without a line that leaves it",
        "calls without a line that leaves them");
    say(odd, lines.strayLeaves, "line that leaves what none has entered",
        "lines that leave what none has entered");
    say(odd, lines.longLines, "line cut, as it was too long", "lines cut, as they were too long");
    say(odd, lines.setBack, "time the clock was set back", "times the clock was set back");
    if (!odd.empty()) text += odd + ".\n";
    if (lines.withoutTime > 0) {
        text +=
            "Lines without times: record them with logcat -v threadtime to see how long calls "
            "took.\n";
    } else if (lines.digits <= 3) {
        text += lines.digits == 0 ? "Times are in whole seconds.\n"
                                  : "Times are in milliseconds; logcat -v threadtime,usec gives "
                                    "microseconds.\n";
    }
    if (lines.digits > 3 && lines.shortestStep != INT64_MAX && lines.withoutTime == 0) {
        text += "Writing a line of the log takes " + readableTime(lines.shortestStep) +
                " or more; each is part of its call but the last.\n";
    }
    if (!lines.threads) {
        text += "Lines without threads: calls of several threads at a time may be mixed up.\n";
    }
    return text;
}

std::vector<std::vector<std::string>> rowsOf(const Statistics& statistics,
                                             const LineCounts& lines) {
    std::vector<Row> rows = {
        {"METHOD", "CALLS", "FAILED", "TOTAL", "MEDIAN", "99 %", "LONGEST", "AT"}};
    for (const MethodCalls* calls : statistics.methods()) {
        rows.push_back(rowOf(*calls, lines.digits));
    }
    return rows;
}

std::string tableOf(const Statistics& statistics, const LineCounts& lines, uint64_t players) {
    return laidOut(rowsOf(statistics, lines)) + "\n" + summaryOf(statistics, lines, players);
}

}  // namespace orvtrace
