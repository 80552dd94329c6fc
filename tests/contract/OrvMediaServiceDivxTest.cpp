// SPDX-License-Identifier: Apache-2.0
// DivX navigation, which the service answers by itself.
#include <string.h>

#include "ServiceOperation.h"

namespace orvtest {
namespace {

using Service = android::OrvMediaService;
using Operation = ServiceOperation;

// Fails with a player and without, and leaves the record as it was.
template <class Record, class Get>
Operation recordGetter(const std::string& name, Get get) {
    return Operation::flag(name, false,
                           [get](Service& s) {
                               Record record;
                               memset(static_cast<void*>(&record), 0x5a, sizeof(record));
                               const Record before = record;
                               const bool result = get(s, record);
                               EXPECT_EQ(memcmp(&record, &before, sizeof(record)), 0);
                               return result;
                           })
        .entry({"OrvMediaService::" + name + "\n"})
        .answersItself(false);
}

template <class Call>
Operation navigation(const std::string& name, Call call) {
    return Operation::flag(name, true, std::move(call)).answersItself(false);
}

std::vector<Operation> recordGetters() {
    return {
        recordGetter<DivxTitleInfo>(
            "getDivxTitleInfo",
            [](Service& s, DivxTitleInfo& r) { return s.getDivxTitleInfo(1, r); }),
        recordGetter<DivxChapInfo>(
            "getDivxChapInfo",
            [](Service& s, DivxChapInfo& r) { return s.getDivxChapInfo(1, 2, 3, r); }),
        recordGetter<DivxPlayListInfo>(
            "getDivxPlayListInfo",
            [](Service& s, DivxPlayListInfo& r) { return s.getDivxPlayListInfo(1, 2, r); })
            .entry({"OrvMediaService::getDivxChapInfo\n"}),
        recordGetter<DivxPositionInfo>(
            "getDivxPositionInfo",
            [](Service& s, DivxPositionInfo& r) { return s.getDivxPositionInfo(r); }),
        recordGetter<DivxDisplayInfo>(
            "getDivxDisplayInfo",
            [](Service& s, DivxDisplayInfo& r) { return s.getDivxDisplayInfo(1, 2, 3, 4, 5, r); }),
        recordGetter<DivxLastMemoryFilePosition>("getDivxLastMemoryFilePosition",
                                                 [](Service& s, DivxLastMemoryFilePosition& r) {
                                                     return s.getDivxLastMemoryFilePosition(r);
                                                 }),
    };
}

std::vector<Operation> numbersAndSetters() {
    return {
        navigation("getDivxTitleNum",
                   [](Service& s) {
                       int number = 12;
                       const bool result = s.getDivxTitleNum(number);
                       EXPECT_EQ(number, 12);
                       return result;
                   }),
        navigation("getDivxLastMemoryFileID",
                   [](Service& s) {
                       int id = 12;
                       const bool result = s.getDivxLastMemoryFileID(id);
                       EXPECT_EQ(id, 12);
                       return result;
                   }),
        navigation("setDivxTitleInfo", [](Service& s) { return s.setDivxTitleInfo(1, 2, 3); }),
        navigation("setDivxChapInfo", [](Service& s) { return s.setDivxChapInfo(1, 2, 3, 4); }),
        navigation("setDivxPlayListInfo",
                   [](Service& s) { return s.setDivxPlayListInfo(1, 2, 3, 4); }),
        navigation("setDivxBtnInfo", [](Service& s) { return s.setDivxBtnInfo(1, 2); }),
        navigation("setDivxFilePosition", [](Service& s) { return s.setDivxFilePosition(1, 2); }),
        navigation("setDivxLastMemoryFilePosition",
                   [](Service& s) {
                       return s.setDivxLastMemoryFilePosition(DivxLastMemoryFilePosition());
                   }),
    };
}

INSTANTIATE_TEST_SUITE_P(DivxRecords, ServiceOperationTest, testing::ValuesIn(recordGetters()),
                         operationTestName);
INSTANTIATE_TEST_SUITE_P(DivxNumbers, ServiceOperationTest, testing::ValuesIn(numbersAndSetters()),
                         operationTestName);

}  // namespace
}  // namespace orvtest
