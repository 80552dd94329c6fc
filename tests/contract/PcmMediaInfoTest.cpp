// SPDX-License-Identifier: Apache-2.0
// The description of a raw PCM stream, from Java to the engine.
#include "JniFixture.h"

namespace orvtest {
namespace {

using fakejni::ObjectPtr;
using fakejni::Value;
using testing::IsEmpty;

const std::string kOuter = "com/quintora/mmp/util/PcmMediaInfo";
const std::string kNested = kOuter + "$AudioPcmInfo";
const std::string kLine = "nativeSetPcmMediaInfo(): ";
const std::string kMember = kLine + "mediaInfo.";
const std::string kPcmMember =
    kMember + "uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info.";

class PcmMediaInfoTest : public JniFixture {
protected:
    PcmMediaInfoTest() {
        fakejni::Class& outerClass = vm.define(kOuter);
        for (const char* field : {"mediaType", "totalDuration", "fgSynchronized", "audioCodec"}) {
            outerClass.field(field, "I");
        }
        outerClass.field("size", "J");
        outerClass.field("audioPcmInfo", "L" + kNested + ";");
        fakejni::Class& nestedClass = vm.define(kNested);
        for (const char* field :
             {"pcm_type", "channelNumber", "sampleRate", "bitsPerSample", "bigEndian"}) {
            nestedClass.field(field, "I");
        }
        nestedClass.field("blockAlign", "S");

        outer = vm.newObject(kOuter);
        nested = vm.newObject(kNested);
        setInts(
            outer,
            {{"mediaType", 1}, {"totalDuration", -2}, {"fgSynchronized", 2}, {"audioCodec", 4}});
        outer->set("size", Value::ofLong(5));
        outer->set("audioPcmInfo", Value::of(nested));
        setInts(nested, {{"pcm_type", 6},
                         {"channelNumber", 7},
                         {"sampleRate", 48000},
                         {"bitsPerSample", 24},
                         {"bigEndian", -1}});
        nested->set("blockAlign", Value::ofShort(8));
    }

    static void setInts(const ObjectPtr& object, const std::map<std::string, int>& fields) {
        for (const auto& [field, value] : fields) object->set(field, Value::ofInt(value));
    }

    Outcome set() {
        return call<void>("native_setPcmMediaInfo", "(Lcom/quintora/mmp/util/PcmMediaInfo;)V",
                          vm.local(outer));
    }
    const IORV_PB_CTRL_SET_MEDIA_INFO_T& received() { return engine->receivedPcmInfos.back(); }

    // The lines of the values that the constructor set, with that size.
    std::vector<ExpectedLine> valueLines(const std::string& size) const {
        return {bridgeInfo(kMember + "eMediaType = 1\n"),
                bridgeInfo(kMember + "u4TotalDuration = -2\n"),
                bridgeInfo(kMember + "u8Size = " + size + "\n"),
                bridgeInfo(kMember + "fgSynchronized = 1\n"),
                bridgeInfo(kMember + "uFormatInfo.tAudioEsInfo.tAudInfo.eAudEnc = 4\n"),
                bridgeInfo(kPcmMember + "e_pcm_type = 6\n"),
                bridgeInfo(kPcmMember + "eNumCh = 7\n"),
                bridgeInfo(kPcmMember + "eSampleRate = 48000\n"),
                bridgeInfo(kPcmMember + "u2BlockAlign = 8\n"),
                bridgeInfo(kPcmMember + "eBitsPerSample = 24\n"),
                bridgeInfo(kPcmMember + "fgBigEndian = 1\n")};
    }

    ObjectPtr outer;
    ObjectPtr nested;
    const ExpectedLine entered = bridgeInfo(kLine + "Enter\n");
    const ExpectedLine left = bridgeInfo(kLine + "Leave\n");
    const ExpectedLine service = serviceInfo("OrvMediaService::setPCMMediaInfo()");
};

std::vector<ExpectedLine> around(const ExpectedLine& first, std::vector<ExpectedLine> lines,
                                 const std::vector<ExpectedLine>& last) {
    lines.insert(lines.begin(), first);
    lines.insert(lines.end(), last.begin(), last.end());
    return lines;
}

TEST_F(PcmMediaInfoTest, EveryMemberReachesTheEngine) {
    setUpPlayer();
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs(around(entered, valueLines("5"), {service, left}))
                           .engine({"setPCMMediaInfo()"}));
    EXPECT_EQ(received().eMediaType, 1);
    EXPECT_EQ(received().u4TotalDuration, 0xFFFFFFFEu);
    EXPECT_EQ(received().u8Size, 5);
    EXPECT_EQ(received().fgSynchronized, 1);
    const ORV_AUD_INFO_T& audio = received().uFormatInfo.tAudioEsInfo.tAudInfo;
    EXPECT_EQ(audio.eAudEnc, 4);
    EXPECT_EQ(audio.uAudCodecInfo.t_pcm_info.e_pcm_type, 6);
    EXPECT_EQ(audio.uAudCodecInfo.t_pcm_info.eNumCh, 7);
    EXPECT_EQ(audio.uAudCodecInfo.t_pcm_info.eSampleRate, 48000);
    EXPECT_EQ(audio.uAudCodecInfo.t_pcm_info.u2BlockAlign, 8);
    EXPECT_EQ(audio.uAudCodecInfo.t_pcm_info.eBitsPerSample, 24);
    EXPECT_EQ(audio.uAudCodecInfo.t_pcm_info.fgBigEndian, 1);
}

TEST_F(PcmMediaInfoTest, FieldsAreReadInTheirOrder) {
    setUpPlayer();
    set();
    EXPECT_THAT(vm.callsOf("FindClass"), testing::ElementsAre(kOuter, kNested));
    const std::vector<std::string> fields = vm.callsOf("GetFieldID");
    EXPECT_THAT(fields,
                testing::ElementsAre("mediaType I", "totalDuration I", "size J", "fgSynchronized I",
                                     "audioCodec I", "audioPcmInfo L" + kNested + ";", "pcm_type I",
                                     "channelNumber I", "sampleRate I", "blockAlign S",
                                     "bitsPerSample I", "bigEndian I"));
}

// The nested object is not examined: the reads themselves then meet the null.
TEST_F(PcmMediaInfoTest, NullPcmInfoIsTakenToTheFieldReads) {
    vm.tolerate("Field: null argument");
    setUpPlayer();
    outer->set("audioPcmInfo", Value::of(nullptr));
    ASSERT_EQ(set().engine, std::vector<std::string>{"setPCMMediaInfo()"});
    EXPECT_THAT(vm.callsOf("GetIntField"),
                testing::ElementsAre("mediaType", "totalDuration", "fgSynchronized", "audioCodec",
                                     "pcm_type", "channelNumber", "sampleRate", "bitsPerSample",
                                     "bigEndian"));
    EXPECT_THAT(vm.callsOf("GetShortField"), testing::ElementsAre("blockAlign"));
    EXPECT_EQ(received().eMediaType, 1);
}

TEST_F(PcmMediaInfoTest, FlagsAreOneOrZero) {
    setUpPlayer();
    setInts(outer, {{"fgSynchronized", 0}});
    setInts(nested, {{"bigEndian", 0}});
    set();
    EXPECT_EQ(received().fgSynchronized, 0);
    EXPECT_EQ(received().uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info.fgBigEndian, 0);
    setInts(outer, {{"fgSynchronized", 256}});
    setInts(nested, {{"bigEndian", 256}});
    set();
    EXPECT_EQ(received().fgSynchronized, 1);
    EXPECT_EQ(received().uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info.fgBigEndian, 1);
}

TEST_F(PcmMediaInfoTest, BlockAlignIsA16BitPattern) {
    setUpPlayer();
    nested->set("blockAlign", Value::ofShort(-1));
    set();
    EXPECT_EQ(received().uFormatInfo.tAudioEsInfo.tAudInfo.uAudCodecInfo.t_pcm_info.u2BlockAlign,
              0xFFFF);
}

struct SizeCase {
    jlong java;
    int64_t engine;
};
void PrintTo(const SizeCase& one, std::ostream* out) { *out << one.java; }

class PcmSizeTest : public PcmMediaInfoTest, public testing::WithParamInterface<SizeCase> {};

TEST_P(PcmSizeTest, IsTheLow32BitsExtendedBySign) {
    setUpPlayer();
    outer->set("size", Value::ofLong(GetParam().java));
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs(around(entered, valueLines(std::to_string(GetParam().engine)),
                                        {service, left}))
                           .engine({"setPCMMediaInfo()"}));
    EXPECT_EQ(received().u8Size, GetParam().engine);
}

INSTANTIATE_TEST_SUITE_P(Sizes, PcmSizeTest,
                         testing::Values(SizeCase{0, 0}, SizeCase{0x7FFFFFFF, 2147483647},
                                         SizeCase{0x80000000, -2147483648LL},
                                         SizeCase{0x100000010, 16}, SizeCase{-1, -1},
                                         SizeCase{0xFFFFFFFF, -1}));

TEST_F(PcmMediaInfoTest, EnginesRefusalIsLogged) {
    setUpPlayer().answer("setPCMMediaInfo", {-22});
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs(around(entered, valueLines("5"),
                                        {service, bridgeError(kLine + "failed\n"), left}))
                           .engine({"setPCMMediaInfo()"}));
}

TEST_F(PcmMediaInfoTest, MissingService) {
    EXPECT_THAT(set(), ReturnsNothing().logs(
                           {entered, bridgeError("OrvMediaClient_setPcmMediaInfo(): service not "
                                                 "exist, error\n")}));
}

TEST_F(PcmMediaInfoTest, MissingOuterClass) {
    setUpPlayer();
    vm.hide(kOuter);
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs({entered, bridgeError("OrvMediaClient_setPcmMediaInfo(): find "
                                                       "class(" +
                                                       kOuter + ") failed, please check\n")})
                           .throws("java/lang/NoClassDefFoundError", kOuter));
}

ExpectedLine missingField(const std::string& path, const std::string& field) {
    return bridgeError("OrvMediaClient_setPcmMediaInfo(): find variable(" + path + ", " + field +
                       ") failed, please check\n");
}

// Only the outer class is looked at: the nested one shows in its first field.
TEST_F(PcmMediaInfoTest, MissingNestedClassShowsInItsFirstField) {
    setUpPlayer();
    vm.hide(kNested);
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs({entered, missingField(kNested, "pcm_type")})
                           .throws("java/lang/NoClassDefFoundError", kNested));
}

struct MissingPcmField {
    std::string path;
    std::string field;
};
void PrintTo(const MissingPcmField& missing, std::ostream* out) { *out << missing.field; }

class MissingPcmFieldTest : public PcmMediaInfoTest,
                            public testing::WithParamInterface<MissingPcmField> {};

TEST_P(MissingPcmFieldTest, EndsTheCallWithItsException) {
    setUpPlayer();
    vm.find(GetParam().path)->remove(GetParam().field);
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs({entered, missingField(GetParam().path, GetParam().field)})
                           .throws("java/lang/NoSuchFieldError", GetParam().field));
    EXPECT_THAT(engine->receivedPcmInfos, IsEmpty());
}

std::vector<MissingPcmField> everyField() {
    std::vector<MissingPcmField> fields;
    for (const char* field :
         {"mediaType", "totalDuration", "size", "fgSynchronized", "audioCodec", "audioPcmInfo"}) {
        fields.push_back({kOuter, field});
    }
    for (const char* field :
         {"pcm_type", "channelNumber", "sampleRate", "blockAlign", "bitsPerSample", "bigEndian"}) {
        fields.push_back({kNested, field});
    }
    return fields;
}

INSTANTIATE_TEST_SUITE_P(Fields, MissingPcmFieldTest, testing::ValuesIn(everyField()),
                         [](const auto& info) { return info.param.field; });

class PcmFlagTest : public JniFixture {
protected:
    Outcome set() { return call<void>("native_setPcmFlag", "()V"); }
};

TEST_F(PcmFlagTest, ReachesTheEngine) {
    setUpPlayer();
    EXPECT_THAT(set(), ReturnsNothing()
                           .logs({bridgeInfo("_setPcmFlag(): Enter\n"),
                                  serviceInfo("OrvMediaService::ifMP3Media()")})
                           .engine({"setPcmFlag()"}));
}

TEST_F(PcmFlagTest, MissingServiceThrowsNothing) {
    EXPECT_THAT(set(), ReturnsNothing().logs(
                           {bridgeInfo("_setPcmFlag(): Enter\n"),
                            bridgeError("service not exist,throw exception. Line:%d\n")}));
}

}  // namespace
}  // namespace orvtest
