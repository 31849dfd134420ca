// The first tab's category labels show whole, in the font at hand and in the wide stand-in that
// takes the place of Tahoma or Segoe UI where those are missing, at Windows' 8 and 9 points.
#include <QApplication>
#include <QFontDatabase>

#include "shell/catalog_panels.h"
#include "shell/qt_text.h"
#include "shell/widgets.h"
#include "window_fixture.h"

namespace kickvane::testing {
namespace {

class LabelFitTest : public WindowFixture {
protected:
    void TearDown() override { QApplication::setFont(saved_); }

    // The labels that would lose part of their text: what a word-wrapped label draws of it does
    // not fit in its box, or one word is wider than the box.
    QStringList Clipped() {
        auto window = Open();
        QStringList clipped;
        for (const catalog::PatchCategory& category : catalog::Categories()) {
            const QLabel* label = window->panels().categoryLabel(category.switchIndex);
            const QRect box = label->contentsRect();
            const QRect drawn = label->fontMetrics().boundingRect(
                box, Qt::TextWordWrap | label->alignment(), label->text());
            bool wordTooWide = false;
            for (const QString& word : label->text().split(QLatin1Char(' '), Qt::SkipEmptyParts)) {
                wordTooWide |= label->fontMetrics().horizontalAdvance(word) > box.width();
            }
            if (!box.contains(drawn) || wordTooWide) {
                clipped << label->text() + QStringLiteral(" (%1)").arg(label->font().family());
            }
        }
        return clipped;
    }

    const QFont saved_ = QApplication::font();
};

TEST_F(LabelFitTest, CategoryLabelsShowWholeInTheFontAtHandAndTheWideStandIn) {
    EXPECT_EQ(Clipped(), QStringList());
    if (!QFontDatabase::families().contains(QStringLiteral("DejaVu Sans"))) {
        GTEST_SKIP() << "no DejaVu Sans here";
    }
    for (const int points : {8, 9}) {
        QApplication::setFont(QFont(QStringLiteral("DejaVu Sans"), points));
        EXPECT_EQ(Clipped(), QStringList()) << points << " pt";
    }
}

}  // namespace
}  // namespace kickvane::testing
