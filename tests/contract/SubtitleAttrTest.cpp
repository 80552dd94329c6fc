// SPDX-License-Identifier: Apache-2.0
// The walk of a Java SubtitleAttr, group by group.
#include "JniFixture.h"

namespace orvtest {
namespace {

using fakejni::ObjectPtr;
using fakejni::Value;
using testing::ElementsAre;
using testing::IsEmpty;

const std::string kAttr = "com/quintora/mmp/util/SubtitleAttr";
const std::string kTimeOffset = kAttr + "$Subtitle_TimeOffset";
const std::string kFontInfo = kAttr + "$Subtitle_FontInfo";
const std::string kColor = kAttr + "$Subtitle_Color";
const std::string kDisplayOffset = kAttr + "$Subtitle_DisplayOffset";
const int kEveryGroup = 0xBD;

std::string type(const std::string& path) { return "L" + path + ";"; }

void defineAttrClasses(fakejni::Vm& vm) {
    fakejni::Class& offset = vm.define(kTimeOffset);
    offset.field("mTimeOffsetType", "I");
    offset.field("mOffsetValue", "I");
    fakejni::Class& font = vm.define(kFontInfo);
    font.field("mFontSizeType", "I");
    font.field("mCustomSize", "B");
    fakejni::Class& color = vm.define(kColor);
    for (const char* channel : {"mA", "mR", "mG", "mB"}) color.field(channel, "B");
    fakejni::Class& display = vm.define(kDisplayOffset);
    display.field("mX", "I");
    display.field("mY", "I");
    fakejni::Class& attr = vm.define(kAttr);
    attr.field("mMask", "I");
    attr.field("mTimeOffset", type(kTimeOffset));
    attr.field("mFontInfo", type(kFontInfo));
    for (const char* field : {"mBgColor", "mTextColor", "mEdgColor"}) {
        attr.field(field, type(kColor));
    }
    attr.field("mDisplayOffset", type(kDisplayOffset));
}

class SubtitleAttrTest : public JniFixture {
protected:
    SubtitleAttrTest() {
        defineAttrClasses(vm);
        attr = vm.newObject(kAttr);
        attr->set("mTimeOffset",
                  Value::of(ints(kTimeOffset, {{"mTimeOffsetType", 1}, {"mOffsetValue", -250}})));
        const ObjectPtr font = ints(kFontInfo, {{"mFontSizeType", 3}});
        font->set("mCustomSize", Value::ofByte(36));
        attr->set("mFontInfo", Value::of(font));
        attr->set("mBgColor", Value::of(color(1, 2, 3, 4)));
        attr->set("mTextColor", Value::of(color(5, 6, 7, 8)));
        attr->set("mEdgColor", Value::of(color(9, 10, 11, 12)));
        attr->set("mDisplayOffset", Value::of(ints(kDisplayOffset, {{"mX", -100}, {"mY", 200}})));
    }

    ObjectPtr ints(const std::string& path, const std::map<std::string, int>& fields) {
        ObjectPtr object = vm.newObject(path);
        for (const auto& [field, value] : fields) object->set(field, Value::ofInt(value));
        return object;
    }
    ObjectPtr color(int a, int r, int g, int b) {
        ObjectPtr object = vm.newObject(kColor);
        object->set("mA", Value::ofByte(static_cast<jbyte>(a)));
        object->set("mR", Value::ofByte(static_cast<jbyte>(r)));
        object->set("mG", Value::ofByte(static_cast<jbyte>(g)));
        object->set("mB", Value::ofByte(static_cast<jbyte>(b)));
        return object;
    }

    Outcome set(int mask) {
        attr->set("mMask", Value::ofInt(mask));
        return call<void>("native_setSubtitleAttr", "(Lcom/quintora/SubtitleAttr;)V",
                          vm.local(attr));
    }

    // The bridge's own lines, without the readers' and the service's.
    static std::vector<LogLine> bridgeLines(const Outcome& outcome) {
        std::vector<LogLine> lines;
        for (const LogLine& line : outcome.log) {
            if (line.tag == "OrvMediaClient-JNI") lines.push_back(line);
        }
        return lines;
    }

    ObjectPtr attr;
};

ExpectedLine step(const std::string& text) { return bridgeInfo("setSubtitleAttr(): " + text); }
ExpectedLine occurs(const std::string& flag) { return step("config " + flag + ", occur"); }
ExpectedLine failed(const std::string& path, const std::string& what) {
    return bridgeError("setSubtitleAttr(): deal with " + path + ": " + what + ", error happen\n");
}

ExpectedLine reader(const std::string& text) { return info(text).tagged("Customer_media_Utils"); }
ExpectedLine readerEntry(const std::string& name, const std::string& path,
                         const std::string& field) {
    return reader(name + "(): pszClassPath=" + path + ", pszVar_AliasName=" + field);
}

TEST_F(SubtitleAttrTest, EveryGroupIsSentInOrderAndThenFlushed) {
    setUpPlayer();
    const Outcome outcome = set(kEveryGroup);
    EXPECT_THAT(outcome.engine,
                ElementsAre("setSubtitleAttr(0, 1, -250)", "setSubtitleAttr(2, 3, 36)",
                            "setSubtitleAttr(3, 1, 2, 3, 4)", "setSubtitleAttr(4, 5, 6, 7, 8)",
                            "setSubtitleAttr(5, 9, 10, 11, 12)", "setSubtitleAttr(8, -100, 200)",
                            "flushSubtitleAttr()"));
    EXPECT_THAT(
        bridgeLines(outcome),
        LinesAre(
            {step("Enter\n"), occurs("FLAG_SUBTITLE_TIME_OFFSET"),
             step("config FLAG_SUBTITLE_TIME_OFFSET, i4TimeOffsetType=1, i4TimeOffsetValue=-250"),
             occurs("FLAG_SUBTITLE_FONT_INFO"),
             step("config FLAG_SUBTITLE_FONT_INFO, i4FontSizeType=3, chCustomSize=36"),
             occurs("FLAG_SUBTITLE_BG_COLOR"),
             step("config FLAG_SUBTITLE_BG_COLOR, chA=1, chR=2, chG=3, chB=4"),
             occurs("FLAG_SUBTITLE_TEXT_COLOR"),
             step("config FLAG_SUBTITLE_TEXT_COLOR, chA=5, chR=6, chG=7, chB=8"),
             occurs("FLAG_SUBTITLE_EDGE_COLOR"),
             step("config FLAG_SUBTITLE_EDGE_COLOR, chA=9, chR=10, chG=11, chB=12"),
             occurs("FLAG_SUBTITLE_DISPLAY_OFFSET"),
             step("config FLAG_SUBTITLE_DISPLAY_OFFSET, i4X=-100, i4Y=200"), step("Leave\n")}));
    EXPECT_EQ(outcome.thrown, std::nullopt);
}

TEST_F(SubtitleAttrTest, FieldsAreReadInOrder) {
    setUpPlayer();
    set(kEveryGroup);
    EXPECT_THAT(vm.callsOf("GetObjectField"),
                ElementsAre("mTimeOffset", "mFontInfo", "mBgColor", "mTextColor", "mEdgColor",
                            "mDisplayOffset"));
    EXPECT_THAT(vm.callsOf("GetIntField"), ElementsAre("mMask", "mTimeOffsetType", "mOffsetValue",
                                                       "mFontSizeType", "mX", "mY"));
    EXPECT_THAT(vm.callsOf("GetByteField"), ElementsAre("mCustomSize", "mA", "mR", "mG", "mB", "mA",
                                                        "mR", "mG", "mB", "mA", "mR", "mG", "mB"));
}

// Each field through its reader, the values logged before they are sent, and
// the flush before the end.
TEST_F(SubtitleAttrTest, GroupsLinesComeInTheOrderOfItsSteps) {
    setUpPlayer();
    EXPECT_THAT(
        set(0x04),
        ReturnsNothing()
            .logs({step("Enter\n"), readerEntry("getIntValueFromJava", kAttr, "mMask"),
                   reader("getIntValueFromJava(): i4Ret=4"), occurs("FLAG_SUBTITLE_FONT_INFO"),
                   reader("getObjValueFromJava(): pszClassPath_Parent=" + kAttr +
                          ", pszClassPathType_Son=" + type(kFontInfo) +
                          ", pszVar_AliasName=mFontInfo"),
                   readerEntry("getIntValueFromJava", kFontInfo, "mFontSizeType"),
                   reader("getIntValueFromJava(): i4Ret=3"),
                   readerEntry("getByteValueFromJava", kFontInfo, "mCustomSize"),
                   reader("getByteValueFromJava(): chRet=36"),
                   step("config FLAG_SUBTITLE_FONT_INFO, i4FontSizeType=3, chCustomSize=36"),
                   serviceInfo("OrvMediaService::setSubtitleAttr()"),
                   serviceInfo("OrvMediaService::flushSubtltAttr()"), step("Leave\n")})
            .engine({"setSubtitleAttr(2, 3, 36)", "flushSubtitleAttr()"}));
}

// A mask, and what of it reaches the engine.
struct MaskCase {
    int mask;
    std::vector<std::string> engine;
};
void PrintTo(const MaskCase& one, std::ostream* out) { *out << one.mask; }

class SubtitleMaskTest : public SubtitleAttrTest, public testing::WithParamInterface<MaskCase> {};

TEST_P(SubtitleMaskTest, OnlyItsSixBitsCount) {
    setUpPlayer();
    std::vector<std::string> expected = GetParam().engine;
    expected.emplace_back("flushSubtitleAttr()");
    EXPECT_EQ(set(GetParam().mask).engine, expected);
}

INSTANTIATE_TEST_SUITE_P(
    Masks, SubtitleMaskTest,
    testing::Values(MaskCase{0, {}}, MaskCase{0x02, {}}, MaskCase{0x40, {}},
                    MaskCase{~0xFF | 0x42, {}}, MaskCase{0x01, {"setSubtitleAttr(0, 1, -250)"}},
                    MaskCase{0x04, {"setSubtitleAttr(2, 3, 36)"}},
                    MaskCase{0x08, {"setSubtitleAttr(3, 1, 2, 3, 4)"}},
                    MaskCase{0x10, {"setSubtitleAttr(4, 5, 6, 7, 8)"}},
                    MaskCase{0x20, {"setSubtitleAttr(5, 9, 10, 11, 12)"}},
                    MaskCase{0x80, {"setSubtitleAttr(8, -100, 200)"}},
                    MaskCase{0x81,
                             {"setSubtitleAttr(0, 1, -250)", "setSubtitleAttr(8, -100, 200)"}}));

TEST_F(SubtitleAttrTest, ChannelsKeepTheirOrderAndAll8Bits) {
    setUpPlayer();
    attr->set("mBgColor", Value::of(color(0x80, 1, 2, 255)));
    EXPECT_THAT(set(0x08).engine,
                ElementsAre("setSubtitleAttr(3, 128, 1, 2, 255)", "flushSubtitleAttr()"));
}

TEST_F(SubtitleAttrTest, EnginesRefusalIsIgnored) {
    setUpPlayer();
    engine->answer("setSubtitleAttr", {0});
    engine->answer("flushSubtitleAttr", {0});
    const Outcome outcome = set(0x05);
    EXPECT_EQ(outcome.engine.size(), 3u);
    EXPECT_EQ(bridgeLines(outcome).back().text, "setSubtitleAttr(): Leave\n");
}

TEST_F(SubtitleAttrTest, MissingService) {
    EXPECT_THAT(set(kEveryGroup),
                ReturnsNothing().logs(
                    {step("Enter\n"), bridgeError("setSubtitleAttr(): service not exist\n")}));
}

TEST_F(SubtitleAttrTest, MissingMaskEndsTheWalk) {
    setUpPlayer();
    attr->type->remove("mMask");
    const Outcome outcome =
        call<void>("native_setSubtitleAttr", "(Lcom/quintora/SubtitleAttr;)V", vm.local(attr));
    EXPECT_THAT(bridgeLines(outcome), LinesAre({step("Enter\n"), failed(kAttr, "mMask")}));
    EXPECT_THAT(outcome.engine, IsEmpty());
}

TEST_F(SubtitleAttrTest, NullGroupEndsTheWalkUnflushed) {
    setUpPlayer();
    attr->set("mBgColor", Value::of(nullptr));
    const Outcome outcome = set(0x09);
    EXPECT_THAT(outcome.engine, ElementsAre("setSubtitleAttr(0, 1, -250)"));
    EXPECT_THAT(bridgeLines(outcome),
                LinesAre({step("Enter\n"), occurs("FLAG_SUBTITLE_TIME_OFFSET"),
                          step("config FLAG_SUBTITLE_TIME_OFFSET, i4TimeOffsetType=1, "
                               "i4TimeOffsetValue=-250"),
                          occurs("FLAG_SUBTITLE_BG_COLOR"),
                          failed(kAttr, "FLAG_SUBTITLE_BG_COLOR, mBgColor")}));
    EXPECT_EQ(outcome.thrown, std::nullopt);
}

// One field that a class does not have, and what was sent before it.
struct MissingField {
    std::string path;
    std::string field;
    std::string flag;
    int mask;
    size_t sentBefore;
};
void PrintTo(const MissingField& missing, std::ostream* out) {
    *out << missing.flag << " " << missing.field;
}

class MissingAttrFieldTest : public SubtitleAttrTest,
                             public testing::WithParamInterface<MissingField> {};

TEST_P(MissingAttrFieldTest, EndsTheWalkUnflushed) {
    const MissingField& missing = GetParam();
    setUpPlayer();
    vm.find(missing.path)->remove(missing.field);
    const Outcome outcome = set(missing.mask);
    EXPECT_EQ(outcome.engine.size(), missing.sentBefore);
    for (const std::string& call : outcome.engine) EXPECT_NE(call, "flushSubtitleAttr()");
    const LogLine last = bridgeLines(outcome).back();
    EXPECT_THAT(last, LineIs(failed(missing.path, missing.flag + ", " + missing.field)));
    ASSERT_TRUE(outcome.thrown.has_value());
    EXPECT_EQ(outcome.thrown->type, "java/lang/NoSuchFieldError");
}

std::vector<MissingField> everyField() {
    std::vector<MissingField> fields = {
        {kAttr, "mTimeOffset", "FLAG_SUBTITLE_TIME_OFFSET", kEveryGroup, 0},
        {kTimeOffset, "mTimeOffsetType", "FLAG_SUBTITLE_TIME_OFFSET", kEveryGroup, 0},
        {kTimeOffset, "mOffsetValue", "FLAG_SUBTITLE_TIME_OFFSET", kEveryGroup, 0},
        {kAttr, "mFontInfo", "FLAG_SUBTITLE_FONT_INFO", kEveryGroup, 1},
        {kFontInfo, "mFontSizeType", "FLAG_SUBTITLE_FONT_INFO", kEveryGroup, 1},
        {kFontInfo, "mCustomSize", "FLAG_SUBTITLE_FONT_INFO", kEveryGroup, 1},
        {kAttr, "mBgColor", "FLAG_SUBTITLE_BG_COLOR", kEveryGroup, 2},
        {kAttr, "mTextColor", "FLAG_SUBTITLE_TEXT_COLOR", kEveryGroup, 3},
        {kAttr, "mEdgColor", "FLAG_SUBTITLE_EDGE_COLOR", kEveryGroup, 4},
        {kAttr, "mDisplayOffset", "FLAG_SUBTITLE_DISPLAY_OFFSET", kEveryGroup, 5},
        {kDisplayOffset, "mX", "FLAG_SUBTITLE_DISPLAY_OFFSET", kEveryGroup, 5},
        {kDisplayOffset, "mY", "FLAG_SUBTITLE_DISPLAY_OFFSET", kEveryGroup, 5},
    };
    for (const char* channel : {"mA", "mR", "mG", "mB"}) {
        fields.push_back({kColor, channel, "FLAG_SUBTITLE_BG_COLOR", 0x09, 1});
        fields.push_back({kColor, channel, "FLAG_SUBTITLE_TEXT_COLOR", 0x11, 1});
        fields.push_back({kColor, channel, "FLAG_SUBTITLE_EDGE_COLOR", 0x21, 1});
    }
    return fields;
}

INSTANTIATE_TEST_SUITE_P(Fields, MissingAttrFieldTest, testing::ValuesIn(everyField()));

TEST_F(SubtitleAttrTest, MissingNestedClassIsTheFailureOfItsFirstField) {
    setUpPlayer();
    vm.hide(kFontInfo);
    const Outcome outcome = set(0x04);
    EXPECT_THAT(bridgeLines(outcome).back(),
                LineIs(failed(kFontInfo, "FLAG_SUBTITLE_FONT_INFO, mFontSizeType")));
    EXPECT_THAT(outcome.engine, IsEmpty());
}

}  // namespace
}  // namespace orvtest
