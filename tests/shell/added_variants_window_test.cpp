// The window with sets the player added: shown after the catalog's options, chosen and previewed;
// folders that cannot be a choice named under their group. Saving the choice is the session's
// test and the end-to-end window test's.
#include <gtest/gtest.h>

#include <QScrollBar>

#include "shell/qt_text.h"
#include "support/trees.h"
#include "window_fixture.h"

namespace kickvane::shell {
namespace {

using catalog::GroupId;
using catalog::OptionArray;
using testing::WriteFile;
namespace fs = std::filesystem;

class AddedVariantsWindowTest : public testing::WindowFixture {
protected:
    // Two added sets in every group, the first of each with a preview picture.
    void AddTwoSetsPerGroup(const fs::path& tool) {
        const std::array<std::pair<const char*, std::array<const char*, 2>>, 5> sets{{
            {"Ball", {"Bóng Tết 2026", "<b>World Cup 2026"}},
            {"scoreboard", {"K+ Sports 2026", "Đài Truyền hình"}},
            {"adboard", {"V-League 2026", "Ngoại hạng Anh"}},
            {"pitch", {"Sọc ngang", "Ô vuông lớn"}},
            {"Indicator", {"Mũi tên đỏ", "Vòng xanh"}},
        }};
        for (const auto& [group, names] : sets) {
            for (const char* name : names) {
                WriteFile(tool / "extras" / group / name / "textures/set.dds", name);
            }
            QImage picture(60, 40, QImage::Format_RGB32);
            picture.fill(Qt::darkGreen);
            picture.save(pathToQString(tool / "extras" / group / names[0] / "Preview.PNG"), "PNG");
        }
    }
};

TEST_F(AddedVariantsWindowTest, AddedSetsShowAfterTheCatalogAreChosenAndPreviewed) {
    AddTwoSetsPerGroup(tool());
    fs::create_directories(tool() / "extras/adboard/Trống");
    auto window = Open();
    window->show();
    CatalogPanels& panels = window->panels();

    // After the catalog's options, which keep their places; markup in a name stays text.
    const QRect lastCatalog = panels.optionButton(OptionArray::Ball, 3)->geometry();
    QRadioButton* tet = panels.addedButton(GroupId::Ball, QStringLiteral("Bóng Tết 2026"));
    ASSERT_NE(tet, nullptr);
    EXPECT_EQ(tet->geometry().left(), lastCatalog.left());
    EXPECT_EQ(tet->geometry().top(), lastCatalog.top() + 2 * 36);  // in name order, second
    EXPECT_EQ(tet->parentWidget(), panels.optionButton(OptionArray::Ball, 3)->parentWidget());
    ClickableLabel* markup = panels.addedLabel(GroupId::Ball, QStringLiteral("<b>World Cup 2026"));
    ASSERT_NE(markup, nullptr);
    EXPECT_EQ(markup->textFormat(), Qt::PlainText);
    EXPECT_EQ(panels.optionLabel(OptionArray::Ball, 3)->nextInFocusChain(),
              panels.addedButton(GroupId::Ball, markup->text()));
    EXPECT_EQ(panels.optionButton(OptionArray::Other, 4)->geometry(), QRect(10, 4, 18, 18));

    // The framed adboards have no room for six rows: the group scrolls; the empty folder is named.
    QScrollArea* adboards = panels.groupArea(GroupId::Adboard);
    EXPECT_GT(adboards->widget()->height(), adboards->viewport()->height());
    Click(panels.tabHead(3));
    QCoreApplication::processEvents();
    EXPECT_TRUE(adboards->verticalScrollBar()->isVisible());
    EXPECT_FALSE(panels.groupArea(GroupId::Ball)->verticalScrollBar()->isVisibleTo(window.get()));
    EXPECT_EQ(panels.skippedLine(GroupId::Adboard)->toolTip(), "Bỏ qua: Trống (thư mục trống)");
    EXPECT_TRUE(panels.skippedLine(GroupId::Pitch)->text().isEmpty());

    // Choosing one clears the catalog's option of its group only.
    Click(panels.tabHead(3));
    Click(panels.addedButton(GroupId::Pitch, QStringLiteral("Sọc ngang")));
    EXPECT_TRUE(panels.addedButton(GroupId::Pitch, QStringLiteral("Sọc ngang"))->isChecked());
    EXPECT_FALSE(panels.optionButton(OptionArray::Other, 4)->isChecked());
    EXPECT_TRUE(panels.optionButton(OptionArray::Other, 0)->isChecked());
    EXPECT_TRUE(panels.optionButton(OptionArray::Other, 8)->isChecked());
    Click(panels.optionButton(OptionArray::Other, 5));
    EXPECT_FALSE(panels.addedButton(GroupId::Pitch, QStringLiteral("Sọc ngang"))->isChecked());
    Click(panels.addedButton(GroupId::Pitch, QStringLiteral("Sọc ngang")));

    // Previews: the set's own picture, else the note, never the picture shown before.
    Click(panels.addedLabel(GroupId::Pitch, QStringLiteral("Sọc ngang")));
    PreviewWindow* preview = window->sideWindows().preview();
    ASSERT_NE(preview, nullptr);
    EXPECT_TRUE(preview->pictureFile().endsWith("Sọc ngang/Preview.PNG"));
    Click(panels.addedLabel(GroupId::Pitch, QStringLiteral("Ô vuông lớn")));
    EXPECT_TRUE(preview->pictureFile().isEmpty());
    EXPECT_EQ(preview->findChild<QLabel*>()->text(), "Chưa có ảnh xem trước cho mục này.");
    // With the preview open, pointing at a set is enough.
    QEnterEvent enter(QPointF(3, 3), QPointF(3, 3), QPointF(3, 3));
    QCoreApplication::sendEvent(panels.addedLabel(GroupId::Pitch, QStringLiteral("Sọc ngang")),
                                &enter);
    EXPECT_TRUE(preview->pictureFile().endsWith("Sọc ngang/Preview.PNG"));
}

TEST_F(AddedVariantsWindowTest, SetsDroppedWhileInTheTrayShowWhenTheWindowComesBack) {
    auto window = Open();
    window->show();
    EXPECT_EQ(window->panels().addedButton(GroupId::Mark, QStringLiteral("Vòng xanh")), nullptr);
    WriteFile(tool() / "extras/Indicator/Vòng xanh/mark.dds", "x");
    window->tray().entry(QStringLiteral("Hiện chương trình"))->trigger();
    EXPECT_NE(window->panels().addedButton(GroupId::Mark, QStringLiteral("Vòng xanh")), nullptr);
}

}  // namespace
}  // namespace kickvane::shell
