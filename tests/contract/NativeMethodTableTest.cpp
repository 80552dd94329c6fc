// SPDX-License-Identifier: Apache-2.0
#include "JniFixture.h"
#include "NativeMethodRows.h"
#include "jni/OrvMediaClient.h"

namespace orvtest {
namespace {

struct TableRow {
    const char* name;
    const char* signature;
    void* function;
};

using namespace android;

#define ROW(name, signature, function) TableRow{name, signature, reinterpret_cast<void*>(function)},
const TableRow kTable[] = {ORV_NATIVE_METHODS(ROW)};
#undef ROW

class NativeMethodTableTest : public JniFixture {};

TEST_F(NativeMethodTableTest, RegistersEveryRowInOrderWithItsFunction) {
    const std::vector<JNINativeMethod> registered = vm.registrations();
    ASSERT_EQ(registered.size(), 83u);
    for (size_t i = 0; i < registered.size(); ++i) {
        SCOPED_TRACE(i + 1);
        EXPECT_STREQ(registered[i].name, kTable[i].name);
        EXPECT_STREQ(registered[i].signature, kTable[i].signature);
        EXPECT_EQ(registered[i].fnPtr, kTable[i].function);
    }
}

TEST_F(NativeMethodTableTest, NoTwoRowsShareAFunction) {
    std::set<void*> functions;
    for (const JNINativeMethod& row : vm.registrations()) functions.insert(row.fnPtr);
    EXPECT_EQ(functions.size(), 83u);
}

// The signature alone leads each overload to its own function, as the first
// line shows.
TEST_F(NativeMethodTableTest, DataSourceOverloadsReachTheirOwnFunctions) {
    const auto first = [](const Outcome& outcome) { return outcome.log.front(); };
    EXPECT_THAT(first(call<void>("native_setDataSource", "(Ljava/lang/String;)V", string("/a"))),
                LineIs(enter("OrvMediaClient_setDataSource")));
    EXPECT_THAT(first(call<void>("native_setDataSource",
                                 "(Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V",
                                 string("/a"), jobjectArray(), jobjectArray())),
                LineIs(enter("OrvMediaClient_setDataSourceAndHeaders")));
    EXPECT_THAT(first(call<void>("native_setDataSource", "(Ljava/io/FileDescriptor;JJ)V", jobject(),
                                 jlong(0), jlong(0))),
                LineIs(enter("OrvMediaClient_setDataSourceFD")));
}

}  // namespace
}  // namespace orvtest
