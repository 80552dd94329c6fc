// SPDX-License-Identifier: Apache-2.0
#include "core/AudioOutputs.h"

#include <glob.h>
#include <stdlib.h>
#include <unistd.h>

namespace orvtarn {
namespace {

bool hasSoundCards() {
    glob_t cards;
    const bool found = glob("/dev/snd/pcm*p", GLOB_NOSORT, nullptr, &cards) == 0;
    globfree(&cards);
    return found;
}

// Where clients of PipeWire look for their server's socket: pipewire(1).
bool hasPipewire() {
    const char* remote = getenv("PIPEWIRE_REMOTE");
    const std::string name = remote != nullptr && *remote != '\0' ? remote : "pipewire-0";
    if (name[0] == '/') return access(name.c_str(), W_OK) == 0;
    for (const char* variable : {"PIPEWIRE_RUNTIME_DIR", "XDG_RUNTIME_DIR"}) {
        const char* folder = getenv(variable);
        if (folder != nullptr && access((folder + ("/" + name)).c_str(), W_OK) == 0) return true;
    }
    return access(("/run/pipewire/" + name).c_str(), W_OK) == 0;
}

}  // namespace

std::string audioOutputs() {
    return std::string(hasPipewire() ? "pipewire," : "") + "pulse," +
           (hasSoundCards() ? "alsa," : "") + kSilentOutput;
}

}  // namespace orvtarn
