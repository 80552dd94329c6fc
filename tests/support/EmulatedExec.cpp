// SPDX-License-Identifier: Apache-2.0

// A test program that starts itself again, as death tests do, cannot do so
// inside the emulator: the host refuses a program of another machine. Linked
// with --wrap=execv, this starts the emulator with the program instead.
// ORV_EMULATOR holds the emulator's words, each a string and a comma.

#include <errno.h>
#include <unistd.h>

extern "C" int __wrap_execv(const char* path, char* const argv[]) {
    // A child between fork and exec: no allocation.
    static const char* const kEmulator[] = {ORV_EMULATOR};
    const char* words[64];
    size_t count = 0;
    for (const char* word : kEmulator) words[count++] = word;
    words[count++] = path;
    for (char* const* argument = argv + 1; *argument != nullptr; ++argument) {
        if (count == sizeof(words) / sizeof(words[0]) - 1) {
            errno = E2BIG;
            return -1;
        }
        words[count++] = *argument;
    }
    words[count] = nullptr;
    return execvp(words[0], const_cast<char* const*>(words));
}
