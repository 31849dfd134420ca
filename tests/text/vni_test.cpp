#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "text/message_helper.h"
#include "text/utf.h"
#include "text/vni.h"

namespace kickvane::text {
namespace {

std::string Convert(std::string_view text) {
    return VniToUnicodeUtf8(text);
}

TEST(Vni, ConvertsMessagesOfTheTool) {
    EXPECT_EQ(Convert("Tho6ng ba1o"), "Thông báo");
    EXPECT_EQ(Convert("U71ng du5ng d9ang cha5y ro62i ma2"), "Ứng dụng đang chạy rồi mà");
    EXPECT_EQ(Convert("D9a4 co1 phie6n ba3n mo71i! "), "Đã có phiên bản mới! ");
}

TEST(Vni, AppliesToneInSecondPass_AfterShapeMark) {
    EXPECT_EQ(Convert("a61"), "ấ");
    EXPECT_EQ(Convert("u7o71"), "ướ");
    EXPECT_EQ(Convert("d9u7o7ng"), "đương");
    EXPECT_EQ(Convert("A81"), "Ắ");
}

TEST(Vni, DigitAfterConvertedLetter_IsNotAMarkForIt) {
    EXPECT_EQ(Convert("a16"), "á6");
    EXPECT_EQ(Convert("a11"), "á1");
    EXPECT_EQ(Convert("a66"), "â6");
    EXPECT_EQ(Convert("a611"), "ấ1");
    // The character after a mark still serves as the letter of the next one.
    EXPECT_EQ(Convert("a1a1"), "áá");
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
    ASSERT_GT(text.size(), 32767u);
    EXPECT_EQ(VniToUnicode(text), expected);
}

TEST(Vni, Utf8_ReplacesInvalidBytes_AndKeepsOtherCharacters) {
    EXPECT_EQ(Convert("a\xFF"
                      "1"),
              "a\xEF\xBF\xBD"
              "1");
    EXPECT_EQ(Convert("\xE1\xBA"
                      "a1"),
              "\xEF\xBF\xBD"
              "á");                                              // truncated sequence
    EXPECT_EQ(Convert("\xC0\xAF"), "\xEF\xBF\xBD\xEF\xBF\xBD");  // overlong form
    EXPECT_EQ(Convert("\xED\xA0\x80").size(), 9u);               // encoded surrogate
    EXPECT_EQ(Convert("\xF0\x9F\x98\x80"
                      "e61"),
              "\xF0\x9F\x98\x80"
              "ế");
    EXPECT_EQ(Utf16ToUtf8(u"\xD800x"),
              "\xEF\xBF\xBD"
              "x");
}

TEST(MessageHelper, ConsoleWritesEachConvertedTextOnItsOwnLine) {
    std::ostringstream out;
    ConsoleMessageHelper helper(out);
    helper.ShowText(helper.ConvertText("Chu7a co1 phie6n ba3n mo71i"));
    helper.ShowText("x");
    EXPECT_EQ(out.str(), "Chưa có phiên bản mới\nx\n");
    EXPECT_EQ(helper.ReadWindowText(42), "");
}

}  // namespace
}  // namespace kickvane::text
