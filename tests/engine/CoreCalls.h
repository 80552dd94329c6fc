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
bool newestPause();

// While it lives, every core refuses to have that property set, or to carry out commands
// of that name, with MPV_ERROR_PROPERTY_ERROR or MPV_ERROR_COMMAND. One of each at a time;
// the name must outlive it.
class RefusedProperty {
public:
    explicit RefusedProperty(const char* name);
    ~RefusedProperty();
    RefusedProperty(const RefusedProperty&) = delete;
    RefusedProperty& operator=(const RefusedProperty&) = delete;
};
class RefusedCommand {
public:
    explicit RefusedCommand(const char* name);
    ~RefusedCommand();
    RefusedCommand(const RefusedCommand&) = delete;
    RefusedCommand& operator=(const RefusedCommand&) = delete;
};

}  // namespace orvtest
