// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace orvtrace {

// Lines of a file descriptor, by a buffer of fixed size.
class LineReader {
public:
    enum class Result { kLine, kEnd, kNothingYet, kInterrupted, kError };

    // What a line may have; of a longer one the first so many bytes are given.
    static constexpr size_t kMaxLine = 256 * 1024;

    // patienceMs: how long it waits for bytes; -1 for as long as the descriptor blocks.
    explicit LineReader(int fd, int patienceMs = -1);

    // Gives the next line without its line end. It lasts until the next call. At the end
    // of what there is, kEnd: a file that grows can be asked again. When nothing came
    // in time, kNothingYet. kInterrupted is a
    // signal's, kError leaves the reason in errno.
    Result next(std::string_view& line);
    // After kEnd: what stands behind the last line end. Empty if nothing does.
    std::string_view rest();

    uint64_t bytesRead() const { return mBytesRead; }
    uint64_t longLines() const { return mLongLines; }

private:
    Result fill();
    std::string_view withoutReturn(size_t begin, size_t end) const;

    int mFd;
    int mPatienceMs;
    std::vector<char> mBuffer;
    size_t mBegin = 0;
    size_t mScanned = 0;  // no line end before it
    size_t mEnd = 0;
    bool mSkipping = false;  // the rest of a long line
    uint64_t mBytesRead = 0;
    uint64_t mLongLines = 0;
};

}  // namespace orvtrace
