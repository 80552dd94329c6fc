// SPDX-License-Identifier: Apache-2.0
#include <dispatch/SyncToAsync.h>
#include <malloc.h>
#include <os/ScopedMutex.h>
#include <stdio.h>
#include <unistd.h>

#include <chrono>

#include "LogCounts.h"
#include "Options.h"
#include "Perturbation.h"
#include "PrivateMember.h"
#include "Progress.h"
#include "Stacks.h"

namespace orvtest {

ORV_OPEN_MEMBER(HeldMutex, ORV::SyncToAsync, m_mutex);

}  // namespace orvtest

namespace {

using std::chrono::steady_clock;

bool isOver(const stress::Options& options, uint32_t round, steady_clock::time_point start) {
    if (options.seconds == 0) return round >= options.rounds;
    return steady_clock::now() - start >= std::chrono::seconds(options.seconds);
}

[[noreturn]] void report(const stress::Options& options, uint32_t seed,
                         const std::vector<std::string>& faults) {
    for (const std::string& fault : faults) fprintf(stderr, "%s\n", fault.c_str());
    fprintf(stderr,
            "The round of seed %u failed; again: --rounds 1 --seed %u --perturb %u --threads %u "
            "--players %u --calls %u\n",
            seed, seed, options.perturb, options.size.threads, options.size.players,
            options.size.calls);
    fflush(stderr);
    _exit(1);  // what went wrong may not end in peace
}

[[noreturn]] void holdForEver(const stress::Options& options) {
    auto& mutex = ORV::SyncToAsync::getInstance()->*memberOf(orvtest::HeldMutex{});
    const os::ScopedMutex lock(mutex);
    stress::runRound(options.seed, options.size);
    _exit(0);
}

}  // namespace

int main(int argc, char** argv) {
    const stress::Options options = stress::parseOptions(argc, argv);
    mallopt(M_PERTURB, 0xA5);  // memory that was freed does not look as before
    stress::countLog();
    stress::prepareStacks();
    stress::setPerturbation(options.perturb);
    stress::startWatchdog(options.stall);
    if (options.deadlock) holdForEver(options);
    const auto start = steady_clock::now();
    uint32_t round = 0;
    for (; !isOver(options, round, start); ++round) {
        const uint32_t seed = options.seed + round;
        const std::vector<std::string> faults = stress::runRound(seed, options.size);
        if (!faults.empty()) report(options, seed, faults);
    }
    printf("%u rounds from seed %u on %u threads: %llu steps, %llu pauses of seed %u, no fault.\n",
           round, options.seed, options.size.threads,
           static_cast<unsigned long long>(stress::steps()),
           static_cast<unsigned long long>(stress::perturbations()), options.perturb);
    return 0;
}
