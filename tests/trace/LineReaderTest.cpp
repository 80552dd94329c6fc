// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <string>
#include <thread>
#include <vector>

#include "LineReader.h"

using testing::ElementsAre;

namespace orvtrace {
namespace {

// A pipe that another thread fills, in parts of so many bytes.
class Pipe {
public:
    Pipe(std::string bytes, size_t part) {
        EXPECT_EQ(pipe(mEnds), 0);
        mWriter = std::thread([this, bytes = std::move(bytes), part] {
            for (size_t at = 0; at < bytes.size(); at += part) {
                const std::string some = bytes.substr(at, part);
                for (size_t done = 0; done < some.size();) {
                    const ssize_t count = write(mEnds[1], some.data() + done, some.size() - done);
                    if (count < 0) return;
                    done += count;
                }
            }
            close(mEnds[1]);
        });
    }
    ~Pipe() {
        mWriter.join();
        close(mEnds[0]);
    }
    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;

    int end() const { return mEnds[0]; }

private:
    int mEnds[2] = {-1, -1};
    std::thread mWriter;
};

std::vector<std::string> linesOf(LineReader& reader) {
    std::vector<std::string> lines;
    std::string_view line;
    while (reader.next(line) == LineReader::Result::kLine) lines.emplace_back(line);
    const std::string_view rest = reader.rest();
    if (!rest.empty()) lines.emplace_back(rest);
    return lines;
}

TEST(LineReaderTest, GivesLinesWhereverTheirBytesAreCut) {
    for (const size_t part : {size_t{1}, size_t{3}, size_t{100}}) {
        const Pipe pipe("one\r\n\ntwo\rthree\nfour", part);
        LineReader reader(pipe.end());
        EXPECT_THAT(linesOf(reader), ElementsAre("one", "", "two\rthree", "four"));
        EXPECT_EQ(reader.bytesRead(), 20u);
        EXPECT_EQ(reader.longLines(), 0u);
    }
}

TEST(LineReaderTest, CutsWhatIsLongerThanALineMayBe) {
    const std::string longest(LineReader::kMaxLine, 'a');
    const Pipe pipe(longest + "\n" + longest + "b\n" + std::string(5000000, 'c') + "\nend\n",
                    70000);
    LineReader reader(pipe.end());
    const std::vector<std::string> lines = linesOf(reader);
    ASSERT_EQ(lines.size(), 4u);
    EXPECT_EQ(lines[0], longest);
    EXPECT_EQ(lines[1], longest);
    EXPECT_EQ(lines[2], std::string(LineReader::kMaxLine, 'c'));
    EXPECT_EQ(lines[3], "end");
    EXPECT_EQ(reader.longLines(), 2u);
}

TEST(LineReaderTest, ManyLinesPassTheBufferWhole) {
    std::string bytes;
    for (int i = 0; i < 300000; ++i) bytes += std::to_string(i) + "\n";
    const Pipe pipe(bytes, 65536);
    LineReader reader(pipe.end());
    const std::vector<std::string> lines = linesOf(reader);
    ASSERT_EQ(lines.size(), 300000u);
    for (int i = 0; i < 300000; ++i) ASSERT_EQ(lines[i], std::to_string(i));
}

TEST(LineReaderTest, IsPatientForAWhileAlone) {
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    LineReader reader(ends[0], 0);
    std::string_view line;
    EXPECT_EQ(reader.next(line), LineReader::Result::kNothingYet);
    ASSERT_EQ(write(ends[1], "a\nb", 3), 3);
    EXPECT_EQ(reader.next(line), LineReader::Result::kLine);
    EXPECT_EQ(line, "a");
    EXPECT_EQ(reader.next(line), LineReader::Result::kNothingYet);
    close(ends[1]);
    EXPECT_EQ(reader.next(line), LineReader::Result::kEnd);
    EXPECT_EQ(reader.rest(), "b");
    close(ends[0]);
}

TEST(LineReaderTest, AFailureIsNoEnd) {
    LineReader reader(-1);
    std::string_view line;
    EXPECT_EQ(reader.next(line), LineReader::Result::kError);
}

}  // namespace
}  // namespace orvtrace
