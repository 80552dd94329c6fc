// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <stdio.h>

#include <stdexcept>
#include <string>

namespace orvtrace {

// What ends the program: one sentence for its user.
struct Failure : std::runtime_error {
    using std::runtime_error::runtime_error;
};

// A file that is there whole or not at all: it is written under another name and renamed.
// What is no regular file (a pipe, a device, "-" for standard output) is written at once.
class OutputFile {
public:
    // Throws a Failure if it cannot be written.
    explicit OutputFile(const std::string& path);
    // Without a finish before it, leaves nothing behind.
    ~OutputFile();
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;

    FILE* file() const { return mFile; }
    // Throws a Failure if not all could be written.
    void finish();

private:
    void create();
    [[noreturn]] void fail(int error) const;

    std::string mPath;
    std::string mDraft;  // empty if it is written at once
    FILE* mFile = nullptr;
};

}  // namespace orvtrace
