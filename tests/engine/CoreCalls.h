// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtest {

// While it lives, no playback core can be created.
class NoNewCore {
public:
    NoNewCore();
    ~NoNewCore();
    NoNewCore(const NoNewCore&) = delete;
    NoNewCore& operator=(const NoNewCore&) = delete;
};

// While it lives, cores that are created know no such option. The name must
// outlive it.
class UnknownOption {
public:
    explicit UnknownOption(const char* name);
    ~UnknownOption();
    UnknownOption(const UnknownOption&) = delete;
    UnknownOption& operator=(const UnknownOption&) = delete;
};

// How often a rendering thread of any player has asked the core for a value so
// far, which may stop the core for as long as it waits for that thread.
int questionsWhileRendering();

// What any core was given last: percent, and whether it is silent.
double newestVolume();
bool newestMute();

}  // namespace orvtest
