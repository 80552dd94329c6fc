// SPDX-License-Identifier: Apache-2.0
#include <stddef.h>
#include <string.h>

#include "JniFixture.h"
#include "jni/ClientFields.h"

namespace orvtest {
namespace {

using android::ClientFields;
using android::gClientFields;
using testing::ElementsAre;

constexpr char kField[] = "GetFieldID";
constexpr char kMethod[] = "GetMethodID";
constexpr char kStaticMethod[] = "GetStaticMethodID";

// One lookup of native_init: what is asked for, where its ID goes, and what is
// said when there is none.
struct Lookup {
    const char* function;
    const char* name;
    const char* signature;
    size_t member;
    std::vector<const char*> errors;
};
void PrintTo(const Lookup& lookup, std::ostream* out) { *out << lookup.name; }

#define VARIABLE_ERROR(name) \
    "OrvMediaClient_init(): find variable(OrvMediaPlayer, " name ") failed, please check\n"
#define METHOD_ERROR(name) \
    "OrvMediaClient_init(): find method(OrvMediaPlayer, " name ") failed, please check\n"
#define MEMBER(name) offsetof(ClientFields, name)

// In the order of the lookups.
const std::vector<Lookup> kLookups = {
    {kField, "mNativeContext", "J", MEMBER(context), {VARIABLE_ERROR("mNativeContext")}},
    {kStaticMethod,
     "postEventFromNative",
     "(Ljava/lang/Object;IIILjava/lang/Object;)V",
     MEMBER(postEvent),
     {METHOD_ERROR("postEventFromNative")}},
    {kField,
     "mNativeSurfaceTexture",
     "J",
     MEMBER(surfaceTexture),
     {VARIABLE_ERROR("mNativeSurfaceTexture")}},
    {kMethod, "readStream", "(I)I", MEMBER(readStream), {METHOD_ERROR("readStream")}},
    {kField,
     "mStreamReadBuffer",
     "[B",
     MEMBER(streamReadBuffer),
     {"OrvMediaClient_init(): find variable(BrixMediaPlayer, mStreamReadBuffer) failed, please "
      "check\n",
      VARIABLE_ERROR("mNativeSurfaceTexture")}},
    {kField, "mStreamSize", "J", MEMBER(streamSize), {VARIABLE_ERROR("mStreamSize")}},
    {kField, "mStreamDuration", "J", MEMBER(streamDuration), {VARIABLE_ERROR("mStreamDuration")}},
    {kField, "mStreamCurPos", "J", MEMBER(streamCurPos), {VARIABLE_ERROR("mStreamCurPos")}},
    {kMethod, "seekStream", "(IJ)J", MEMBER(seekStream), {METHOD_ERROR("seekStream")}},
    {kMethod, "seekStreamEx", "(IJ)J", MEMBER(seekStreamEx), {METHOD_ERROR("seekStreamEx")}},
    {kMethod, "timeSeekStream", "(JJ)J", MEMBER(timeSeekStream), {METHOD_ERROR("timeSeekStream")}},
    {kMethod, "cancelRead", "()V", MEMBER(cancelRead), {METHOD_ERROR("cancelRead")}},
    {kMethod, "closeStream", "()V", MEMBER(closeStream), {METHOD_ERROR("closeStream")}},
    {kField, "mStreamSeekable", "Z", MEMBER(streamSeekable), {VARIABLE_ERROR("mStreamSeekable")}},
    {kField,
     "mStallingSupport",
     "Z",
     MEMBER(stallingSupport),
     {VARIABLE_ERROR("mStallingSupport")}},
    {kMethod, "getSeekType", "()I", MEMBER(getSeekType), {VARIABLE_ERROR("getSeekType")}},
    {kField, "mDataSourceType", "I", MEMBER(dataSourceType), {VARIABLE_ERROR("mDataSourceType")}},
};

// The ID that a member holds now; field and method IDs are both one pointer.
const void* valueOf(size_t member) {
    const void* value;
    memcpy(&value, reinterpret_cast<const char*>(&gClientFields) + member, sizeof value);
    return value;
}

class ClientFieldsTest : public VmFixture {
protected:
    void SetUp() override { loadLibrary(); }

    Outcome init() { return callStatic<void>("native_init", "()V"); }

    // The lookups that were tried, as "function name signature".
    std::vector<std::string> lookups() {
        std::vector<std::string> tried;
        for (const fakejni::JniCall& call : vm.calls()) {
            if (call.function.find("ID") != std::string::npos)
                tried.push_back(call.function + " " + call.detail);
        }
        return tried;
    }
};

TEST_F(ClientFieldsTest, AllFoundLogsEnterAndLeaveOnly) {
    EXPECT_THAT(init(), ReturnsNothing().logs(
                            {enter("OrvMediaClient_init"), leave("OrvMediaClient_init")}));
    for (const Lookup& lookup : kLookups) EXPECT_NE(valueOf(lookup.member), nullptr) << lookup.name;
}

TEST_F(ClientFieldsTest, LooksUpInTheFixedOrder) {
    init();
    std::vector<std::string> expected;
    for (const Lookup& lookup : kLookups) {
        expected.push_back(std::string(lookup.function) + " " + lookup.name + " " +
                           lookup.signature);
    }
    EXPECT_EQ(lookups(), expected);
    EXPECT_THAT(vm.callsOf("FindClass"), ElementsAre(kPlayerClass));
}

TEST_F(ClientFieldsTest, EachMemberHoldsTheIdOfItsOwnName) {
    init();
    for (const Lookup& lookup : kLookups) {
        const void* expected =
            lookup.function == kField
                ? static_cast<void*>(playerClass.findField(lookup.name, lookup.signature, false))
                : static_cast<void*>(playerClass.findMethod(lookup.name, lookup.signature,
                                                            lookup.function == kStaticMethod));
        EXPECT_EQ(valueOf(lookup.member), expected) << lookup.name;
    }
}

TEST_F(ClientFieldsTest, MembersKeepTheirOrder) {
    const size_t order[] = {
        MEMBER(context),        MEMBER(surfaceTexture),   MEMBER(postEvent),
        MEMBER(readStream),     MEMBER(streamReadBuffer), MEMBER(streamSize),
        MEMBER(streamCurPos),   MEMBER(seekStream),       MEMBER(seekStreamEx),
        MEMBER(streamSeekable), MEMBER(dataSourceType),   MEMBER(timeSeekStream),
        MEMBER(getSeekType),    MEMBER(stallingSupport),  MEMBER(streamDuration),
        MEMBER(cancelRead),     MEMBER(closeStream)};
    for (size_t i = 0; i < 17; ++i) EXPECT_EQ(order[i], i * sizeof(void*)) << i;
    EXPECT_EQ(sizeof(ClientFields), 17 * sizeof(void*));
}

TEST_F(ClientFieldsTest, MissingClassStopsAtOnce) {
    vm.hide(kPlayerClass);
    EXPECT_THAT(init(),
                ReturnsNothing()
                    .logs({enter("OrvMediaClient_init"),
                           bridgeError("OrvMediaClient_init(): find "
                                       "class(com/quintora/mmp/OrvMediaPlayer) failed, please "
                                       "check\n")})
                    .throws("java/lang/NoClassDefFoundError", kPlayerClass));
    EXPECT_TRUE(lookups().empty());
    for (const Lookup& lookup : kLookups) EXPECT_EQ(valueOf(lookup.member), nullptr);
}

TEST_F(ClientFieldsTest, SecondCallWritesTheSameAgain) {
    init();
    const ClientFields first = gClientFields;
    EXPECT_THAT(init(), ReturnsNothing().logs(
                            {enter("OrvMediaClient_init"), leave("OrvMediaClient_init")}));
    EXPECT_EQ(memcmp(&first, &gClientFields, sizeof first), 0);
    EXPECT_EQ(lookups().size(), 17u);
}

TEST_F(ClientFieldsTest, InstancePostEventFailsTheStaticLookup) {
    playerClass.remove("postEventFromNative");
    playerClass.method("postEventFromNative", "(Ljava/lang/Object;IIILjava/lang/Object;)V");
    EXPECT_THAT(init(), ReturnsNothing()
                            .logs({enter("OrvMediaClient_init"),
                                   bridgeError(METHOD_ERROR("postEventFromNative"))})
                            .throws("java/lang/NoSuchMethodError", "postEventFromNative"));
    EXPECT_NE(gClientFields.context, nullptr);
    EXPECT_EQ(gClientFields.postEvent, nullptr);
}

class ClientFieldsLookupTest : public ClientFieldsTest,
                               public testing::WithParamInterface<Lookup> {};

TEST_P(ClientFieldsLookupTest, FirstMissingMemberStopsTheRest) {
    const Lookup& missing = GetParam();
    playerClass.remove(missing.name);

    std::vector<ExpectedLine> lines = {enter("OrvMediaClient_init")};
    for (const char* error : missing.errors) lines.push_back(bridgeError(error));
    const char* exception =
        missing.function == kField ? "java/lang/NoSuchFieldError" : "java/lang/NoSuchMethodError";
    EXPECT_THAT(init(), ReturnsNothing().logs(lines).throws(exception, missing.name));

    bool found = true;
    for (const Lookup& lookup : kLookups) {
        if (lookup.member == missing.member) found = false;
        EXPECT_EQ(valueOf(lookup.member) != nullptr, found) << lookup.name;
    }
    EXPECT_EQ(lookups().back(),
              std::string(missing.function) + " " + missing.name + " " + missing.signature);
}

INSTANTIATE_TEST_SUITE_P(Members, ClientFieldsLookupTest, testing::ValuesIn(kLookups),
                         [](const testing::TestParamInfo<Lookup>& info) {
                             return std::string(info.param.name);
                         });

}  // namespace
}  // namespace orvtest
