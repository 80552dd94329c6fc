// SPDX-License-Identifier: Apache-2.0
#include "core/PlayerState.h"

#include <algorithm>

#include "base/EngineLog.h"
#include "base/Milliseconds.h"

namespace orvtarn {

const char* phaseName(Phase phase) {
    static const char* const kNames[] = {"idle",    "initialized", "preparing", "prepared",
                                         "started", "paused",      "stopped",   "completed",
                                         "error",   "released"};
    return kNames[static_cast<int>(phase)];
}

bool PlayerState::Values::isOneOf(std::initializer_list<Phase> phases) const {
    return std::find(phases.begin(), phases.end(), phase) != phases.end();
}

bool PlayerState::Values::isOpen() const {
    return isOneOf({Phase::Prepared, Phase::Started, Phase::Paused, Phase::Completed});
}

PlayerState::Position PlayerState::Values::currentPosition() const {
    if (phase == Phase::Error) return {error, 0};
    if (!isOpen()) return {};
    const double reached = duration > 0 ? std::min(position, duration) : position;
    return {android::NO_ERROR, toMilliseconds(phase == Phase::Completed ? duration : reached)};
}

bool PlayerState::Values::awaitsData() const {
    return fileOpen && (phase == Phase::Preparing || (isOpen() && (left || buffering)));
}

void PlayerState::Values::beginSeek() {
    seeksOf = seeks;
    restartsOf = restarts;
}

void PlayerState::Values::onSeek() {
    if (seeks == seeksOf) restartsOf = restarts;
    seeks++;
    left = true;
}

bool PlayerState::Values::isArriving() const {
    return seeking && (seeks == seeksOf || restarts == restartsOf);
}

void PlayerState::Values::forgetMedia() {
    const Values fresh;
    fileStarted = left = restarted = framed = hasVideo = seekable = buffering = false;
    if (!attended) seeking = false;  // who attends it ends it
    startUs.reset();
    position = fresh.position;
    duration = fresh.duration;
    width = height = 0;
    bufferPercent = 0;
}

bool PlayerState::Values::fail(android::status_t status) {
    if (phase != Phase::Preparing && !isOpen()) return false;
    phase = Phase::Error;
    error = status;
    return true;
}

android::status_t PlayerState::requireOpen(const char* operation) const {
    const Phase now = phase();
    const bool open = read([](const Values& v) { return v.isOpen(); });
    return open ? android::NO_ERROR : wrongPhase(operation, now);
}

android::status_t PlayerState::wrongPhase(const char* operation, Phase phase) {
    ALOGE("%s: not possible while %s", operation, phaseName(phase));
    return android::INVALID_OPERATION;
}

}  // namespace orvtarn
