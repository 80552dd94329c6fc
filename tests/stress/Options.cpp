// SPDX-License-Identifier: Apache-2.0
#include "Options.h"

#include <getopt.h>
#include <stdio.h>
#include <stdlib.h>

#include <map>

namespace stress {

namespace {

const char kHelp[] =
    "Random native calls on many threads. A round runs its calls, releases every player and\n"
    "counts what is left.\n"
    "  --rounds N     rounds to run (4)\n"
    "  --seconds N    instead: rounds until that many seconds have passed\n"
    "  --calls N      calls of each thread in a round (200)\n"
    "  --threads N    threads, 2 or more; a quarter of them reads streams (8)\n"
    "  --players N    players at a time, 2 or more (4)\n"
    "  --seed N       of the first round's calls; each further round has the next (1)\n"
    "  --perturb N    seed of the pauses where threads meet, 0 for none; ORV_PERTURB does\n"
    "                 the same (0)\n"
    "  --stall N      seconds without a step after which every thread's stack is printed\n"
    "                 and the program ends with status 3 (60)\n"
    "  --deadlock     hold the dispatcher's lock for ever, to see that\n";

// A whole number from the least on; ends the program for anything else.
uint32_t numberOf(const char* name, const char* text, uint32_t least) {
    char* end = nullptr;
    const unsigned long value = strtoul(text, &end, 10);
    if (text[0] >= '0' && text[0] <= '9' && *end == '\0' && value >= least && value <= 0xFFFFFFFF)
        return static_cast<uint32_t>(value);
    fprintf(stderr, "%s takes a whole number from %u on, not '%s'.\n", name, least, text);
    exit(2);
}

}  // namespace

Options parseOptions(int argc, char** argv) {
    Options options;
    if (const char* seed = getenv("ORV_PERTURB"))
        options.perturb = numberOf("ORV_PERTURB", seed, 0);
    static const option kNames[] = {{"rounds", required_argument, nullptr, 0},
                                    {"seconds", required_argument, nullptr, 1},
                                    {"calls", required_argument, nullptr, 2},
                                    {"threads", required_argument, nullptr, 3},
                                    {"players", required_argument, nullptr, 4},
                                    {"seed", required_argument, nullptr, 5},
                                    {"perturb", required_argument, nullptr, 6},
                                    {"stall", required_argument, nullptr, 7},
                                    {"deadlock", no_argument, nullptr, 'd'},
                                    {"help", no_argument, nullptr, 'h'},
                                    {nullptr, 0, nullptr, 0}};
    uint32_t* const numbers[] = {&options.rounds,       &options.seconds,      &options.size.calls,
                                 &options.size.threads, &options.size.players, &options.seed,
                                 &options.perturb,      &options.stall};
    const uint32_t least[] = {1, 1, 1, 2, 2, 0, 0, 1};
    for (int found; (found = getopt_long(argc, argv, "", kNames, nullptr)) != -1;) {
        if (found == 'h') {
            fputs(kHelp, stdout);
            exit(0);
        }
        if (found == '?') exit(2);
        if (found == 'd') {
            options.deadlock = true;
        } else {
            *numbers[found] = numberOf(kNames[found].name, optarg, least[found]);
        }
    }
    if (optind == argc) return options;
    fprintf(stderr, "'%s' is not an option.\n", argv[optind]);
    exit(2);
}

}  // namespace stress
