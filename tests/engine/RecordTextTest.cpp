// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <string>

#include "base/RecordText.h"

namespace orvtarn {
namespace {

const std::string kReplacement = "\xEF\xBF\xBD";
const std::string kClef = "\xF0\x9D\x84\x9E";                           // U+1D11E
const std::string kClefAsPair = "\xED\xA0\xB4\xED\xB4\x9E";             // D834 DD1E
const std::string kGreek = "\xCE\x91\xCE\xB8\xCE\xAE\xCE\xBD\xCE\xB1";  // Athena
const std::string kKanji = "\xE6\x9D\xB1\xE4\xBA\xAC";                  // Tokyo

std::string narrow(std::string_view utf8) {
    OrvText text;
    memset(text, 'x', sizeof(text));
    setText(text, utf8);
    const size_t length = strnlen(text, sizeof(text));
    EXPECT_LT(length, sizeof(text)) << "not terminated";
    for (size_t i = length; i < sizeof(text); i++) EXPECT_EQ(text[i], 0) << "rest not cleared";
    return std::string(text, length);
}

// The units before the first zero.
std::u16string wide(std::string_view utf8) {
    OrvWideText text;
    memset(text, 'x', sizeof(text));
    setWideText(text, utf8);
    std::u16string units(text, std::find(text, text + ORV_TEXT_UNITS, 0));
    for (size_t i = units.size(); i < ORV_TEXT_UNITS; i++) EXPECT_EQ(text[i], 0);
    return units;
}

std::string repeat(const std::string& part, int count) {
    std::string text;
    for (int i = 0; i < count; i++) text += part;
    return text;
}

TEST(RecordText, KeepsTextsOfSeveralScripts) {
    for (const std::string& text : {std::string("plain"), kGreek, kKanji, std::string()}) {
        EXPECT_EQ(narrow(text), text);
    }
    EXPECT_EQ(wide(kGreek), u"\u0391\u03B8\u03AE\u03BD\u03B1");
    EXPECT_EQ(wide(kKanji), u"\u6771\u4EAC");
    EXPECT_EQ(wide(""), u"");
}

TEST(RecordText, KeepsTheEdgesOfEachSequenceLength) {
    const std::string edges =
        "\x01\x7F\xC2\x80\xDF\xBF\xE0\xA0\x80\xE0\xBF\xBF\xED\x9F\xBF\xEE\x80\x80\xEF\xBF\xBF";
    EXPECT_EQ(narrow(edges), edges);
    EXPECT_EQ(wide(edges),
              (std::u16string{1, 0x7F, 0x80, 0x7FF, 0x800, 0xFFF, 0xD7FF, 0xE000, 0xFFFF}));
    EXPECT_EQ(wide("\xF0\x90\x80\x80"), (std::u16string{0xD800, 0xDC00}));
    EXPECT_EQ(wide("\xF4\x8F\xBF\xBF"), (std::u16string{0xDBFF, 0xDFFF}));
}

TEST(RecordText, WritesSupplementaryCharactersAsPairs) {
    EXPECT_EQ(narrow("a" + kClef + "b"), "a" + kClefAsPair + "b");
    EXPECT_EQ(wide("a" + kClef + "b"), (std::u16string{'a', 0xD834, 0xDD1E, 'b'}));
}

TEST(RecordText, KeepsTextBehindAZeroCharacter) {
    const std::string_view zero("a\0b", 3);
    EXPECT_EQ(narrow(zero),
              "a\xC0\x80"
              "b");
    EXPECT_EQ(wide(zero), (std::u16string{'a', 0xFFFD, 'b'}));
}

struct IllFormed {
    const char* bytes;
    int replacements;
};

// Each is followed by a letter that must survive.
TEST(RecordText, ReplacesIllFormedParts) {
    const IllFormed cases[] = {
        {"\x80", 1},              // a trailing byte alone
        {"\xC3", 1},              // cut after the lead
        {"\xE6\x9D", 1},          // cut after two of three
        {"\xF0\x9D\x84", 1},      // cut after three of four
        {"\xC0\xAF", 2},          // overlong
        {"\xE0\x80\xAF", 3},      // overlong
        {"\xF0\x8F\xBF\xBF", 4},  // overlong
        {"\xED\xA0\x80", 3},      // a surrogate
        {"\xF4\x90\x80\x80", 4},  // beyond U+10FFFF
        {"\xFF\xFE", 2},
    };
    for (const IllFormed& one : cases) {
        const std::string text = std::string(one.bytes) + "z";
        EXPECT_EQ(narrow(text), repeat(kReplacement, one.replacements) + "z") << text;
        EXPECT_EQ(wide(text), std::u16string(one.replacements, 0xFFFD) + u"z") << text;
    }
}

TEST(RecordText, ReplacesASequenceCutByTheEnd) {
    EXPECT_EQ(narrow("a\xE6\x9D"), "a" + kReplacement);
    EXPECT_EQ(wide("a\xF0"), (std::u16string{'a', 0xFFFD}));
}

TEST(RecordText, CutsNarrowTextsAtAWholeCharacter) {
    EXPECT_EQ(narrow(std::string(127, 'a')), std::string(127, 'a'));
    EXPECT_EQ(narrow(std::string(200, 'a')), std::string(127, 'a'));
    EXPECT_EQ(narrow(std::string(124, 'a') + kKanji), std::string(124, 'a') + kKanji.substr(0, 3));
    EXPECT_EQ(narrow(std::string(125, 'a') + kKanji), std::string(125, 'a'));
    EXPECT_EQ(narrow(std::string(121, 'a') + kClef), std::string(121, 'a') + kClefAsPair);
    EXPECT_EQ(narrow(std::string(122, 'a') + kClef), std::string(122, 'a'));
    EXPECT_EQ(narrow(std::string(126, 'a') + std::string(1, '\0')), std::string(126, 'a'));
}

// A short character behind one that did not fit must not slip in.
TEST(RecordText, EndsWhereTheFirstCharacterDoesNotFit) {
    EXPECT_EQ(narrow(std::string(125, 'a') + kKanji + "b"), std::string(125, 'a'));
    EXPECT_EQ(wide(std::string(127, 'a') + kClef + "b"), std::u16string(127, 'a'));
}

TEST(RecordText, FillsWideTextsWithoutATerminator) {
    EXPECT_EQ(wide(std::string(128, 'a')), std::u16string(128, 'a'));
    EXPECT_EQ(wide(repeat(kKanji, 100)).size(), 128u);
    EXPECT_EQ(wide(repeat(kClef, 64)).size(), 128u);
    EXPECT_EQ(wide(repeat(kClef, 65)).size(), 128u);
}

TEST(RecordText, NeverEndsAWideTextInHalfAPair) {
    EXPECT_EQ(wide("a" + repeat(kClef, 64)).size(), 127u);
    EXPECT_EQ(wide(std::string(127, 'a') + kClef), std::u16string(127, 'a'));
}

}  // namespace
}  // namespace orvtarn
