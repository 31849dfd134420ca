// Checks every tone letter against Qt's Unicode normaliser instead of a second copy of the table.
#include <gtest/gtest.h>

#include <QString>

#include "text/vni.h"

namespace kickvane::text {
namespace {

TEST(VniNormaliser, ToneDigitGivesComposedLetterAndMark_ForAll24LettersAndFiveTones) {
    const std::u16string letters = u"aâăeêioôơuưyAÂĂEÊIOÔƠUƯY";
    const char16_t marks[] = {0x0301, 0x0300, 0x0309, 0x0303, 0x0323};
    int checked = 0;
    for (const char16_t letter : letters) {
        for (int tone = 0; tone < 5; ++tone) {
            const QChar pair[] = {QChar(letter), QChar(marks[tone])};
            const QString composed = QString(pair, 2).normalized(QString::NormalizationForm_C);
            ASSERT_EQ(composed.size(), 1);
            const std::u16string typed{letter, static_cast<char16_t>(u'1' + tone)};
            EXPECT_EQ(VniToUnicode(typed), std::u16string(1, composed.at(0).unicode()))
                << "letter U+" << std::hex << static_cast<int>(letter) << " tone " << tone + 1;
            ++checked;
        }
    }
    EXPECT_EQ(checked, 120);
}

}  // namespace
}  // namespace kickvane::text
