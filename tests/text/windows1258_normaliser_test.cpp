// Checks the composition of Windows-1258 tone marks against Qt's Unicode normaliser.
#include <gtest/gtest.h>

#include <QString>

#include "text/windows1258.h"

namespace kickvane::text {
namespace {

TEST(VietnameseWindowsTextNormaliser, EveryVowelWithEveryToneIsTheNfcLetter) {
    // The vowels as Windows-1258 writes them: a ă â e ê i o ô ơ u ư y, in both cases.
    const std::string vowels =
        "a\xE3\xE2"
        "e\xEAio\xF4\xF5u\xFDy"
        "A\xC3\xC2"
        "E\xCAIO\xD4\xD5U\xDDY";
    const char marks[] = {'\xCC', '\xEC', '\xD2', '\xDE', '\xF2'};
    int checked = 0;
    for (const char vowel : vowels) {
        for (const char mark : marks) {
            const std::string bytes = std::string("\xD0") + vowel + mark;  // Đ makes it Vietnamese
            const std::optional<std::string> decoded = VietnameseWindowsTextToUtf8(bytes);
            ASSERT_TRUE(decoded) << std::hex << static_cast<int>(static_cast<unsigned char>(vowel));
            const QString text =
                QString::fromUtf8(decoded->data(), static_cast<qsizetype>(decoded->size()));
            EXPECT_EQ(text, text.normalized(QString::NormalizationForm_D)
                                .normalized(QString::NormalizationForm_C));
            EXPECT_EQ(text.size(), 2);  // Đ and one composed letter
            ++checked;
        }
    }
    EXPECT_EQ(checked, 120);
}

}  // namespace
}  // namespace kickvane::text
