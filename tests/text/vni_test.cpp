#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "text/utf.h"
#include "text/vni.h"

namespace kickvane::text {
namespace {

std::string Convert(std::string_view text) {
    return VniToUnicodeUtf8(text);
}

// The shape marks (6, 7, 8, 9) are applied first, the tones after them; the letter a mark
// produces is never the letter of a later digit in the same pass.
TEST(Vni, AppliesShapesThenTones_AndADigitAfterAConvertedLetterStays) {
    const std::pair<const char*, const char*> cases[] = {
        {"a61", "ấ"},  {"A81", "Ắ"},  {"u7o71", "ướ"}, {"d9u7o7ng", "đương"}, {"a16", "á6"},
        {"a11", "á1"}, {"a66", "â6"}, {"a611", "ấ1"},  {"a1a1", "áá"},
    };
    for (const auto& [vni, unicode] : cases) {
        EXPECT_EQ(Convert(vni), unicode) << vni;
    }
}

TEST(Vni, ConvertsAnyListedLetterBeforeItsDigit_AndNothingElse) {
    EXPECT_EQ(Convert("data2"), "datà");
    EXPECT_EQ(Convert("dd9"), "dđ");
    EXPECT_EQ(Convert("A1 a1 D9"), "Á á Đ");
    for (const char* unchanged : {"", "a", "1", "1a", "a0", "F7", "b1", "e8", "i6", "D7"}) {
        EXPECT_EQ(Convert(unchanged), unchanged);
    }
}

TEST(Vni, ConvertsTextsLongerThan32767Units) {
    std::u16string text;
    std::u16string expected;
    for (int i = 0; i < 30000; ++i) {
        text += u"o71 ";
        expected += u"ớ ";
    }
    EXPECT_EQ(VniToUnicode(text), expected);
}

// Octal escapes end after three digits: "\377" is the byte FF, "\341\272" the bytes E1 BA.
TEST(Vni, Utf8InputWithInvalidBytesGetsReplacementCharacters) {
    EXPECT_EQ(Convert("a\3771"), "a\uFFFD1");
    EXPECT_EQ(Convert("\341\272a1"), "\uFFFDá");               // truncated sequence
    EXPECT_EQ(Convert("\xC0\xAF"), "\uFFFD\uFFFD");            // overlong form
    EXPECT_EQ(Convert("\xED\xA0\x80"), "\uFFFD\uFFFD\uFFFD");  // an encoded surrogate
    EXPECT_EQ(Convert("😀e61"), "😀ế");                          // a valid four-byte form
    EXPECT_EQ(Utf16ToUtf8(u"\xD800x"), "\uFFFDx");             // a lone surrogate
}

}  // namespace
}  // namespace kickvane::text
