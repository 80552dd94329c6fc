// SPDX-License-Identifier: Apache-2.0
//
// Runs a fuzz target over files, and those of folders, once each: the tests do
// it with the seeds. Needs no fuzzer, so any compiler will do.
#include <stdint.h>
#include <stdio.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

extern "C" {
int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);
__attribute__((weak)) int LLVMFuzzerInitialize(int* argc, char*** argv);
}

namespace {

using Paths = std::vector<std::filesystem::path>;

void addFiles(const std::filesystem::path& path, Paths& files) {
    if (!std::filesystem::is_directory(path)) {
        files.push_back(path);
        return;
    }
    for (const auto& entry : std::filesystem::recursive_directory_iterator(path)) {
        if (entry.is_regular_file()) files.push_back(entry.path());
    }
}

bool replay(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    // Kept within its bytes exactly, so that a sanitizer sees a read behind them.
    const std::vector<uint8_t> bytes{std::istreambuf_iterator<char>(file), {}};
    if (!file.is_open() || file.bad()) {
        fprintf(stderr, "%s cannot be read.\n", path.c_str());
        return false;
    }
    fprintf(stderr, "%s\n", path.c_str());  // before it runs: it may not come back
    LLVMFuzzerTestOneInput(bytes.data(), bytes.size());
    return true;
}

}  // namespace

int main(int argc, char** argv) {
    if (LLVMFuzzerInitialize != nullptr) LLVMFuzzerInitialize(&argc, &argv);
    Paths files;
    for (int i = 1; i < argc; i++) addFiles(argv[i], files);
    std::sort(files.begin(), files.end());
    if (files.empty()) {
        fprintf(stderr, "there is nothing to replay.\n");
        return 2;
    }
    bool good = true;
    for (const auto& file : files) good = replay(file) && good;
    return good ? 0 : 1;
}
