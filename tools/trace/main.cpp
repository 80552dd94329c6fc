// SPDX-License-Identifier: Apache-2.0
// ./orv trace: how long the native methods took, from a log.

#include <signal.h>
#include <stdio.h>
#include <unistd.h>

#include <memory>

#include "Arguments.h"
#include "OutputFile.h"
#include "PageWriter.h"
#include "Reading.h"
#include "Session.h"
#include "Table.h"
#include "TraceWriter.h"

namespace orvtrace {
namespace {

constexpr int kFailed = 1;
constexpr int kMisused = 2;
constexpr int kInterrupted = 130;

const char kRecord[] =
    "Record one with: adb logcat -v threadtime > log, or: orv play --log FILE 2> log";

volatile sig_atomic_t sStop = 0;

void stop(int) { sStop = 1; }

// Without SA_RESTART: a signal ends a read that waits.
void catchSignals() {
    struct sigaction action{};
    action.sa_handler = stop;
    for (const int number : {SIGINT, SIGTERM, SIGHUP}) sigaction(number, &action, nullptr);
    signal(SIGPIPE, SIG_IGN);
}

std::string namesOf(const std::vector<std::string>& logs) {
    if (logs.size() > 1) return "Each of the " + std::to_string(logs.size()) + " logs";
    return logs[0] == "-" ? "Standard input" : "'" + logs[0] + "'";
}

// Throws a Failure if there is nothing to show.
void requireCalls(const Session& session, const std::string& names) {
    const LineCounts counts = session.counts();
    const std::string lines = std::to_string(counts.lines) + " lines";
    if (counts.lines == 0) throw Failure(names + " is empty. " + kRecord);
    if (counts.entries() == 0) {
        throw Failure(names + " is no log: none of " + lines + " is of a format of logcat. " +
                      kRecord);
    }
    if (counts.ours == 0) {
        throw Failure(names + " has nothing of the player: none of " + lines +
                      " has its tag, such as OrvMediaClient-JNI. Record the log while a player "
                      "is used, without a filter that leaves that tag out.");
    }
    if (session.statistics().calls() == 0) {
        throw Failure(names + " has no call of a native method: of " + lines +
                      " none says that one is entered. Record priority I and lower, from before "
                      "the player is used.");
    }
}

void print(FILE* file, const std::string& text) {
    if (fwrite(text.data(), 1, text.size(), file) != text.size() || fflush(file) != 0) {
        throw Failure("The table cannot be written to standard output.");
    }
}

std::string tableOf(const Session& session) {
    return orvtrace::tableOf(session.statistics(), session.counts(), session.players());
}

// Clears the terminal, or sets apart.
void printAnew(FILE* file, const Session& session) {
    if (session.statistics().calls() == 0) return;
    const bool terminal = isatty(fileno(file)) == 1;
    print(file, (terminal ? "\033[H\033[J" : "") + tableOf(session) + (terminal ? "" : "\n"));
}

int run(const Arguments& arguments) {
    std::unique_ptr<TraceWriter> trace;
    std::unique_ptr<PageWriter> page;
    std::vector<Sink*> writers;
    if (!arguments.trace.empty()) {
        trace = std::make_unique<TraceWriter>(arguments.trace);
        writers.push_back(trace.get());
    }
    if (!arguments.page.empty()) {
        page = std::make_unique<PageWriter>(arguments.page);
        writers.push_back(page.get());
    }
    // A trace that goes to standard output has it for itself.
    FILE* shown = arguments.trace == "-" || arguments.page == "-" ? stderr : stdout;

    const auto session = std::make_unique<Session>(writers);
    const auto refresh = [&] { printAnew(shown, *session); };
    Reading reading(*session, sStop);
    if (arguments.live) reading.follow(refresh);
    const bool complete = reading.read(arguments.logs);
    if (!complete && !arguments.live) return kInterrupted;
    session->finish();

    const std::string names = namesOf(arguments.logs);
    requireCalls(*session, names);
    if (arguments.live) {
        refresh();
    } else {
        print(shown, tableOf(*session));
    }
    const LineCounts counts = session->counts();
    if (!writers.empty() && counts.withoutTime == counts.ours) {
        throw Failure(names +
                      " has no times, of which a trace is made. "
                      "Record one with: adb logcat -v threadtime > log");
    }
    if (trace != nullptr) trace->finish();
    if (page != nullptr) page->finish(session->statistics(), counts, session->players());
    return 0;
}

}  // namespace
}  // namespace orvtrace

int main(int count, char** values) {
    using namespace orvtrace;
    try {
        const Arguments arguments = parseArguments(count, values);
        if (arguments.help) {
            fputs(kHelp, stdout);
            return 0;
        }
        catchSignals();
        return run(arguments);
    } catch (const Misuse& misuse) {
        fprintf(stderr, "orv: %s See ./orv trace --help.\n", misuse.sentence.c_str());
        return kMisused;
    } catch (const std::exception& failure) {
        fprintf(stderr, "orv: %s\n", failure.what());
        return kFailed;
    }
}
