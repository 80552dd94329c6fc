// SPDX-License-Identifier: Apache-2.0
#include <ctype.h>

#include <algorithm>
#include <ostream>

#include "ServiceOperation.h"

namespace orvtest {
namespace {

const char kServiceTag[] = "OrvMediaService";
const int kUntouched = -77;
const int kFromEngine = 4711;

std::vector<ExpectedLine> joined(std::vector<ExpectedLine> first,
                                 const std::vector<ExpectedLine>& second) {
    first.insert(first.end(), second.begin(), second.end());
    for (ExpectedLine& line : first) line.tag = kServiceTag;
    return first;
}

}  // namespace

void PrintTo(const ServiceOperation& operation, std::ostream* out) { *out << operation.name; }

std::string operationTestName(const testing::TestParamInfo<ServiceOperation>& info) {
    std::string name = info.param.name;
    std::replace_if(name.begin(), name.end(), [](unsigned char c) { return !isalnum(c); }, '_');
    return name;
}

TEST_P(ServiceOperationTest, WithoutPlayer) {
    const ServiceOperation& operation = GetParam();
    int out = kUntouched;
    const int64_t result = operation.call(*service, out);
    if (operation.noPlayerResultDefined) {
        EXPECT_EQ(result, operation.noPlayerResult);
    }
    EXPECT_EQ(out, kUntouched);
    EXPECT_THAT(log.take(), LinesAre(joined(operation.entryLines, operation.noPlayerLines)));
}

TEST_P(ServiceOperationTest, WithPlayer) {
    const ServiceOperation& operation = GetParam();
    attachPlayer();
    for (const ServiceOperation::Outcome& outcome : operation.outcomes) {
        SCOPED_TRACE("engine answers " + std::to_string(outcome.engine));
        engine->answer(operation.engineOperation, {outcome.engine});
        engine->put(operation.engineOperation, kFromEngine);
        int out = kUntouched;
        EXPECT_EQ(operation.call(*service, out), outcome.service);
        EXPECT_EQ(out, operation.hasOutValue ? kFromEngine : kUntouched);
        EXPECT_THAT(log.take(), LinesAre(joined(operation.entryLines, operation.playerLines)));
        EXPECT_EQ(engine->takeCalls(), operation.engineCalls);
    }
}

}  // namespace orvtest
