// SPDX-License-Identifier: Apache-2.0
#include "Arguments.h"

#include <getopt.h>

namespace orvtrace {

const char kHelp[] =
    R"(Usage: orv trace [-o TRACE] [--html PAGE] [--live] LOG...

Reads the log of a television, or that of orv play --log, and shows how often each native
method of the player was called, how often it failed and how long it took.

      LOG...          Files as logcat writes them (threadtime, time, brief, long; also with
                      usec, year, zone, epoch or uid) or as orv play --log does, in the
                      order of their times; - for standard input.
  -o, --output=TRACE  Write a trace for Perfetto's viewer or Chrome's about:tracing (JSON): a
                        track for each thread and each player.
      --html=PAGE     Write a page with the trace and the table, which needs no network.
      --live          Follow the last log while it grows, and refresh the table, until Ctrl-C.
  -h, --help          Show this and exit.

Examples:
  adb logcat -v threadtime,usec > log; orv trace log -o trace.json
  adb logcat -v threadtime | orv trace --live -
  orv play --log film.mkv 2> log; orv trace log --html page.html
)";

namespace {

enum Long { kHtml = 256, kLive };

const option kOptions[] = {
    {"output", required_argument, nullptr, 'o'},
    {"html", required_argument, nullptr, kHtml},
    {"live", no_argument, nullptr, kLive},
    {"help", no_argument, nullptr, 'h'},
    {nullptr, 0, nullptr, 0},
};

// What getopt has stopped at: a letter, or a whole word.
std::string culprit(char** values) {
    if (optopt > 0 && optopt < kHtml) return std::string("-") + static_cast<char>(optopt);
    return values[optind - 1];
}

void setOnce(std::string& where, const char* option) {
    if (*optarg == '\0') throw Misuse{std::string(option) + " needs the name of a file."};
    where = optarg;
}

}  // namespace

Arguments parseArguments(int count, char** values) {
    Arguments arguments;
    opterr = 0;
    int found;
    while ((found = getopt_long(count, values, ":o:h", kOptions, nullptr)) != -1) {
        switch (found) {
            case 'o':
                setOnce(arguments.trace, "-o");
                break;
            case kHtml:
                setOnce(arguments.page, "--html");
                break;
            case kLive:
                arguments.live = true;
                break;
            case 'h':
                arguments.help = true;
                return arguments;
            case ':':
                throw Misuse{"'" + culprit(values) + "' lacks the name of a file."};
            default:
                throw Misuse{"trace does not know '" + culprit(values) + "'."};
        }
    }
    arguments.logs.assign(values + optind, values + count);
    if (arguments.logs.empty()) {
        throw Misuse{"trace needs a log: a file, or - for standard input."};
    }
    return arguments;
}

}  // namespace orvtrace
