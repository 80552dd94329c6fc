// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>
#include <vector>

namespace orvtrace {

struct Arguments {
    std::vector<std::string> logs;  // "-" for standard input
    std::string trace;              // empty for none
    std::string page;               // empty for none
    bool live = false;
    bool help = false;
};

// What is wrong with the arguments, in a sentence.
struct Misuse {
    std::string sentence;
};

// Throws a Misuse.
Arguments parseArguments(int count, char** values);
// What --help prints.
extern const char kHelp[];

}  // namespace orvtrace
