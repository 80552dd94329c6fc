// SPDX-License-Identifier: Apache-2.0
// DivX navigation between Java and the service, which answers it by itself.
#include <string.h>

#include "DivxService.h"
#include "JniFixture.h"
#include "jni/PlayerContext.h"

namespace orvtest {
namespace {

const ExpectedLine kMissingService = bridgeError("service not exist. Line:%d\n");
const std::string kPosition = "com/quintora/mmp/util/DivxLastMemoryFilePosition";

std::string functionOf(const std::string& name) { return "OrvMediaClient_" + name; }

class DivxTest : public JniFixture {
protected:
    // Gives the player a service without an engine player.
    void setUpServiceAlone() {
        android::setMediaService(vm.env(), vm.local(player), new android::OrvMediaService);
        log.clear();
    }
};

// One native method of a family, with arguments 1, 2, 3, …
struct DivxMethod {
    std::string name;
    int arguments;
    std::string logName;  // in the entry lines, the bridge's and the service's
};
void PrintTo(const DivxMethod& method, std::ostream* out) { *out << method.name; }

class DivxMethodTest : public DivxTest, public testing::WithParamInterface<DivxMethod> {
protected:
    template <typename R>
    Outcome callIt(const std::string& result) {
        const std::string native = "native_" + GetParam().name;
        const std::string signature = "(" + std::string(GetParam().arguments, 'I') + ")" + result;
        switch (GetParam().arguments) {
            case 0:
                return call<R>(native, signature);
            case 1:
                return call<R>(native, signature, jint{1});
            case 2:
                return call<R>(native, signature, jint{1}, jint{2});
            case 3:
                return call<R>(native, signature, jint{1}, jint{2}, jint{3});
            case 4:
                return call<R>(native, signature, jint{1}, jint{2}, jint{3}, jint{4});
            default:
                return call<R>(native, signature, jint{1}, jint{2}, jint{3}, jint{4}, jint{5});
        }
    }
    std::string function() const { return functionOf(GetParam().name); }
    ExpectedLine entered() const { return enter(functionOf(GetParam().logName)); }
    ExpectedLine noPlayer() const {
        return serviceError("OrvMediaService::" + GetParam().name + "(): NO_INIT");
    }
};

class DivxRecordGetterTest : public DivxMethodTest {
protected:
    Outcome get() { return callIt<jboolean>("Z"); }
    ExpectedLine service() const {
        return serviceInfo("OrvMediaService::" + GetParam().logName + "\n");
    }
    ExpectedLine refused() const { return bridgeError(function() + "(): service get failed\n"); }
};

TEST_P(DivxRecordGetterTest, EndsAtTheServicesRefusal) {
    setUpPlayer();
    EXPECT_THAT(get(), Returns("false").logs({entered(), service(), refused()}));
}

TEST_P(DivxRecordGetterTest, EndsAtTheServicesRefusalWithoutPlayerToo) {
    setUpServiceAlone();
    EXPECT_THAT(get(), Returns("false").logs({entered(), service(), noPlayer(), refused()}));
}

TEST_P(DivxRecordGetterTest, MissingService) {
    EXPECT_THAT(get(), Returns("false").logs({entered(), kMissingService}));
}

INSTANTIATE_TEST_SUITE_P(Getters, DivxRecordGetterTest,
                         testing::Values(DivxMethod{"getDivxTitleInfo", 1, "getDivxTitleInfo"},
                                         DivxMethod{"getDivxChapInfo", 3, "getDivxChapInfo"},
                                         DivxMethod{"getDivxPlayListInfo", 2, "getDivxChapInfo"},
                                         DivxMethod{"getDivxPositionInfo", 0,
                                                    "getDivxPositionInfo"},
                                         DivxMethod{"getDivxDisplayInfo", 5, "getDivxDisplayInfo"},
                                         DivxMethod{"getDivxLastMemoryFilePosition", 0,
                                                    "getDivxLastMemoryFilePosition"}),
                         [](const auto& info) { return info.param.name; });

class DivxNumberTest : public DivxMethodTest {
protected:
    Outcome get() { return callIt<jint>("I"); }
    ExpectedLine service() const {
        return serviceInfo("OrvMediaService::" + GetParam().name + "()");
    }
};

TEST_P(DivxNumberTest, IsTheStartValueThatTheServiceLeaves) {
    setUpPlayer();
    EXPECT_THAT(get(), Returns("0").logs({entered(), service(), leave(function())}));
}

TEST_P(DivxNumberTest, IsTheStartValueWithoutPlayer) {
    setUpServiceAlone();
    EXPECT_THAT(get(), Returns("0").logs({entered(), service(), noPlayer(), leave(function())}));
}

TEST_P(DivxNumberTest, IsZeroWithoutService) {
    EXPECT_THAT(get(), Returns("0").logs({entered(), kMissingService}));
}

INSTANTIATE_TEST_SUITE_P(Numbers, DivxNumberTest,
                         testing::Values(DivxMethod{"getDivxTitleNum", 0, "getDivxTitleNum"},
                                         DivxMethod{"getDivxLastMemoryFileID", 0,
                                                    "getDivxLastMemoryFileID"}),
                         [](const auto& info) { return info.param.name; });

class DivxSetterTest : public DivxMethodTest {
protected:
    Outcome set() { return callIt<jint>("I"); }
    ExpectedLine service() const {
        return serviceInfo("OrvMediaService::" + GetParam().name + "()");
    }
};

TEST_P(DivxSetterTest, FailsWithAPlayer) {
    setUpPlayer();
    EXPECT_THAT(set(), Returns("-1").logs({entered(), service(),
                                           bridgeInfo(function() + "(): service get failed\n"),
                                           leave(function())}));
}

TEST_P(DivxSetterTest, SucceedsWithoutPlayer) {
    setUpServiceAlone();
    EXPECT_THAT(set(), Returns("1").logs({entered(), service(), noPlayer(), leave(function())}));
}

TEST_P(DivxSetterTest, FailsWithoutService) {
    EXPECT_THAT(set(), Returns("-1").logs({entered(), kMissingService}));
}

INSTANTIATE_TEST_SUITE_P(
    Setters, DivxSetterTest,
    testing::Values(DivxMethod{"setDivxTitleInfo", 3, "setDivxTitleInfo"},
                    DivxMethod{"setDivxChapInfo", 4, "setDivxChapInfo"},
                    DivxMethod{"setDivxPlayListInfo", 4, "setDivxPlayListInfo"},
                    DivxMethod{"setDivxBtnInfo", 2, "setDivxBtnInfo"},
                    DivxMethod{"setDivxFilePosition", 2, "setDivxFilePosition"}),
    [](const auto& info) { return info.param.name; });

// The fields of the last memory position, in the order of their lookups.
struct PositionField {
    const char* name;
    const char* signature;
};
void PrintTo(const PositionField& field, std::ostream* out) { *out << field.name; }
const PositionField kPositionFields[] = {{"ui8_clip_id", "J"},
                                         {"ui4_title_idx", "I"},
                                         {"ui4_playlist_idx", "I"},
                                         {"ui4_chap_idx", "I"},
                                         {"ui2_aud_idx", "I"},
                                         {"ui2_sub_idx", "I"},
                                         {"ui8_aud_pts_info", "J"},
                                         {"ui8_aud_frame_position", "J"},
                                         {"ui8_i_pts_info", "J"},
                                         {"ui8_pts_info", "J"},
                                         {"ui8_i_frame_position", "J"},
                                         {"ui8_frame_position", "J"},
                                         {"i4_temporal_reference", "I"},
                                         {"ui2_decoding_order", "I"},
                                         {"ui8_stc", "J"},
                                         {"ui8_frame_position_disp", "J"},
                                         {"ui4_timestap", "I"}};

class DivxLastMemoryTest : public DivxTest {
protected:
    DivxLastMemoryTest() {
        fakejni::Class& type = vm.define(kPosition);
        for (const PositionField& field : kPositionFields) type.field(field.name, field.signature);
        position = vm.newObject(kPosition);
    }
    Outcome set() {
        return call<jint>("native_setDivxLastMemoryFilePosition",
                          "(Lcom/quintora/mmp/util/DivxLastMemoryFilePosition;)I",
                          vm.local(position));
    }

    fakejni::ObjectPtr position;
    const std::string name = "OrvMediaClient_setDivxLastMemoryFilePosition";
    const ExpectedLine service = serviceInfo("OrvMediaService::setDivxLastMemoryFilePosition()");
};

TEST_F(DivxLastMemoryTest, EveryFieldIsReadInOrderInItsOwnWidth) {
    setUpServiceAlone();
    EXPECT_THAT(set(),
                Returns("1").logs({enter(name), service,
                                   serviceError("OrvMediaService::setDivxLastMemoryFilePosition(): "
                                                "NO_INIT"),
                                   leave(name)}));
    std::vector<std::string> lookups;
    std::vector<std::string> longs = {"mNativeContext"};
    std::vector<std::string> ints;
    for (const PositionField& field : kPositionFields) {
        lookups.push_back(std::string(field.name) + " " + field.signature);
        (field.signature[0] == 'J' ? longs : ints).emplace_back(field.name);
    }
    EXPECT_EQ(vm.callsOf("GetFieldID"), lookups);
    EXPECT_EQ(vm.callsOf("GetLongField"), longs);
    EXPECT_EQ(vm.callsOf("GetIntField"), ints);
}

TEST_F(DivxLastMemoryTest, EveryWordIsTheLow32BitsOfItsField) {
    setUpPlayer();
    DivxService answering;
    uint32_t expected[17];
    for (uint32_t i = 0; i < 17; ++i) {
        const PositionField& field = kPositionFields[i];
        expected[i] = 0xA0000001 + i;  // negative as an int
        position->set(field.name, field.signature[0] == 'J'
                                      ? fakejni::Value::ofLong(0x700000000 + expected[i])
                                      : fakejni::Value::ofInt(static_cast<jint>(expected[i])));
    }
    EXPECT_THAT(set(), Returns("1").logs({enter(name), leave(name)}));
    uint32_t words[17];
    static_assert(sizeof(words) == sizeof(answering.receivedPosition));
    memcpy(words, &answering.receivedPosition, sizeof(words));
    EXPECT_THAT(words, testing::ElementsAreArray(expected));

    position->set("ui8_stc", fakejni::Value::ofLong(0x100000005));
    set();
    EXPECT_EQ(answering.receivedPosition.ui8_stc, 5u);
}

TEST_F(DivxLastMemoryTest, FailsWithAPlayer) {
    setUpPlayer();
    EXPECT_THAT(set(),
                Returns("-1").logs({enter(name), service,
                                    bridgeInfo(name + "(): service get failed\n"), leave(name)}));
}

TEST_F(DivxLastMemoryTest, MissingService) {
    EXPECT_THAT(set(), Returns("-1").logs({enter(name), kMissingService}));
}

TEST_F(DivxLastMemoryTest, MissingClass) {
    setUpPlayer();
    vm.hide(kPosition);
    EXPECT_THAT(set(), Returns("-1")
                           .logs({enter(name), bridgeError(name + "(): find class(" + kPosition +
                                                           ") failed, please check\n")})
                           .throws("java/lang/NoClassDefFoundError", kPosition));
}

class MissingPositionFieldTest : public DivxLastMemoryTest,
                                 public testing::WithParamInterface<PositionField> {};

TEST_P(MissingPositionFieldTest, EndsTheCall) {
    setUpPlayer();
    const std::string field = GetParam().name;
    position->type->remove(field);
    EXPECT_THAT(set(),
                Returns("-1")
                    .logs({enter(name), bridgeError(name + "(): find variable(" + kPosition + ", " +
                                                    field + ") failed, please check\n")})
                    .throws("java/lang/NoSuchFieldError", field));
}

INSTANTIATE_TEST_SUITE_P(Fields, MissingPositionFieldTest, testing::ValuesIn(kPositionFields),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace orvtest
