// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string_view>

#include "LogLine.h"

namespace orvtrace {

enum class Format { kNone, kThreadtime, kTime, kBrief, kLong, kStderr };

// Recognises the formats of the platform's log, line by line; a log may change from one
// to another. Times may have a year, a zone and up to nine digits behind the point, or be
// seconds since some start (epoch, monotonic); threadtime lines may have a user id.
//
//   threadtime  11-22 23:43:08.123  1234  5678 I Tag: text
//   time        11-22 23:43:08.123 I/Tag( 1234): text
//   brief       I/Tag( 1234): text
//   long        [ 11-22 23:43:08.123  1234: 5678 I/Tag ], lines of text, an empty line
//   stderr      Tag I 11-22 23:43:08 1234 5678 text
class FormatReader {
public:
    enum class Result {
        kEntry,      // line was a log line, or one of the texts below a long format's header
        kSeparator,  // nothing of its own: empty, a header, "--------- beginning of main"
        kForeign,    // no line of any of the formats
    };

    Result read(std::string_view line, LogLine& out);
    // That of the last entry.
    Format format() const { return mFormat; }
    // Forgets a long format's header: another file begins.
    void restart() { mInLong = false; }

private:
    Result readLong(std::string_view line, LogLine& out);
    bool readHeader(std::string_view line);

    Format mFormat = Format::kNone;
    bool mInLong = false;
    LogLine mHeader;  // of the long entry; its texts stand in mHeaderText
    char mHeaderText[256];
};

}  // namespace orvtrace
