#include "text/windows1258.h"

#include <gtest/gtest.h>

namespace kickvane::text {
namespace {

TEST(VietnameseWindowsText, ToneMarksComposeWithTheirLetters) {
    // "Trò chơi": o and a combining grave accent; ơ is 0xF5.
    EXPECT_EQ(VietnameseWindowsTextToUtf8("C:\\Tro\xCC ch\xF5i"), "C:\\Tr\xC3\xB2 ch\xC6\xA1i");
    // "Việt": ê (0xEA) with a dot below (0xF2) is one letter.
    EXPECT_EQ(VietnameseWindowsTextToUtf8("Vi\xEA\xF2t Nam"), "Vi\xE1\xBB\x87t Nam");
    // Đ, ă and ư stand alone.
    EXPECT_EQ(VietnameseWindowsTextToUtf8("\xD0\xE3ng \xFD"), "\xC4\x90\xC4\x83ng \xC6\xB0");
}

// Only text that reads as Vietnamese: otherwise the caller's other code page decides.
TEST(VietnameseWindowsText, OtherTextIsLeftToTheCaller) {
    for (const char* bytes : {
             "plain ASCII",
             "Caf\xE9",   // nothing that Windows-1252 lacks
             "\xC3\xA9",  // Ă and ©: © is no Vietnamese letter
             "x\xCC",     // a tone mark on a consonant
             "\xCC"
             "abc",       // a tone mark on nothing
             "\xD0\x81",  // 0x81 is unassigned
             "\xE0\xCC",  // a second tone on a toned letter
         }) {
        EXPECT_EQ(VietnameseWindowsTextToUtf8(bytes), std::nullopt) << bytes;
    }
}

}  // namespace
}  // namespace kickvane::text
