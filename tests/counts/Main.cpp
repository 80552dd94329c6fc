// SPDX-License-Identifier: Apache-2.0
// orv_counts PATH TIMES takes a path of the library that often, for
// tools/counts/callgrind.py to count; without arguments it lists the paths.
#include <android/log.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <vector>

#include "Counting.h"
#include "Paths.h"

namespace {

using orvcounts::Path;

std::vector<Path> allPaths() {
    std::vector<Path> paths;
    for (const Path& path : orvcounts::kCallPaths) paths.push_back(path);
    for (const Path& path : orvcounts::kMemoryPaths) paths.push_back(path);
    for (const Path& path : orvcounts::kEventPaths) paths.push_back(path);
    return paths;
}

}  // namespace

int main(int argc, char** argv) {
    const std::vector<Path> paths = allPaths();
    if (argc == 1) {
        for (const Path& path : paths) puts(path.name);
        return 0;
    }
    const int times = argc == 3 ? atoi(argv[2]) : 0;
    orvcounts::require(times > 0, "a path and how many times");
    __android_log_set_minimum_priority(ANDROID_LOG_SILENT);
    for (const Path& path : paths) {
        if (strcmp(path.name, argv[1]) != 0) continue;
        path.run(times);
        // Not exit: the dispatcher would wait for the thread that was ended.
        _exit(0);
    }
    orvcounts::require(false, "there is no such path");
}
