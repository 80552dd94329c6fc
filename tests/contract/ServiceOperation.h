// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <functional>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "ServiceFixture.h"

namespace orvtest {

// One operation of the service and everything that is promised about it. It
// starts as the regular form (entry line "OrvMediaService::name()", error line
// "OrvMediaService::name(): NO_INIT", one engine call of the same name); the
// setters state what differs.
struct ServiceOperation {
    using Service = android::OrvMediaService;
    struct Outcome {
        int engine;
        int64_t service;
    };

    std::string name;
    std::function<int64_t(Service&, int& out)> call;
    std::vector<ExpectedLine> entryLines;
    std::vector<ExpectedLine> noPlayerLines;
    std::vector<ExpectedLine> playerLines;  // behind the entry lines
    int64_t noPlayerResult = 0;
    bool noPlayerResultDefined = true;
    std::string engineOperation;
    std::vector<std::string> engineCalls;
    std::vector<Outcome> outcomes;
    bool hasOutValue = false;

    // A status passes unchanged; without a player it is NO_INIT. Calls take
    // the service, or the service and an out-value that the engine writes.
    template <class Call>
    static ServiceOperation status(const std::string& name, Call call) {
        return regular(name, std::move(call), android::NO_INIT, {{0, 0}, {-1004, -1004}});
    }
    // A bool passes unchanged.
    template <class Call>
    static ServiceOperation flag(const std::string& name, bool withoutPlayer, Call call) {
        return regular(name, std::move(call), withoutPlayer, {{1, 1}, {0, 0}});
    }

    ServiceOperation& entry(std::vector<std::string> texts) { return set(entryLines, texts, info); }
    ServiceOperation& noPlayer(std::vector<std::string> texts) {
        return set(noPlayerLines, texts, error);
    }
    ServiceOperation& noPlayerGives(int64_t result) {
        noPlayerResult = result;
        return *this;
    }
    ServiceOperation& reaches(std::vector<std::string> calls) {
        engineCalls = std::move(calls);
        engineOperation = engineCalls.back().substr(0, engineCalls.back().find('('));
        return *this;
    }
    ServiceOperation& gives(std::vector<Outcome> newOutcomes) {
        outcomes = std::move(newOutcomes);
        return *this;
    }
    // The service answers by itself.
    ServiceOperation& answersItself(int64_t result) {
        engineCalls.clear();
        return gives({{0, result}});
    }

private:
    template <class Call>
    static ServiceOperation regular(const std::string& name, Call call, int64_t withoutPlayer,
                                    std::vector<Outcome> outcomes) {
        ServiceOperation operation;
        operation.name = name;
        operation.hasOutValue = std::is_invocable_v<Call, Service&, int&>;
        if constexpr (std::is_invocable_v<Call, Service&, int&>) {
            operation.call = std::move(call);
        } else {
            operation.call = [call](Service& service, int&) { return int64_t{call(service)}; };
        }
        operation.entry({"OrvMediaService::" + name + "()"});
        operation.noPlayer({"OrvMediaService::" + name + "(): NO_INIT"});
        operation.noPlayerResult = withoutPlayer;
        operation.reaches({name + "()"});
        return operation.gives(std::move(outcomes));
    }

    ServiceOperation& set(std::vector<ExpectedLine>& lines, const std::vector<std::string>& texts,
                          ExpectedLine (*priority)(const std::string&)) {
        lines.clear();
        for (const std::string& text : texts) lines.push_back(priority(text));
        return *this;
    }
};
void PrintTo(const ServiceOperation& operation, std::ostream* out);

// Runs the tests of ServiceOperationTest.cpp for a list of operations.
class ServiceOperationTest : public ServiceFixture,
                             public testing::WithParamInterface<ServiceOperation> {};

std::string operationTestName(const testing::TestParamInfo<ServiceOperation>& info);

}  // namespace orvtest
