// Qt's own dialogs and menus in Vietnamese, and outside text shown as written, never as markup.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QDir>
#include <QFile>
#include <QFileDialog>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMessageBox>
#include <QRegularExpression>
#include <QSet>
#include <QTest>
#include <QTimer>
#include <QTreeView>
#include <QXmlStreamReader>

#include "shell/dialogs.h"
#include "window_fixture.h"

namespace kickvane::shell {
namespace {

// A caption as the player reads it: without its mnemonic and without the shortcut after a tab.
QString Readable(QString text) {
    text = text.section(QLatin1Char('\t'), 0, 0);
    text.remove(QRegularExpression(QStringLiteral("&(?!&)")));
    return text.trimmed();
}

// Qt's English words that the translation replaces: every source text of the translation file
// whose translation differs, and the words a player met before it existed.
QSet<QString> EnglishWords() {
    QSet<QString> words{QStringLiteral("Back"),
                        QStringLiteral("Parent Directory"),
                        QStringLiteral("Create New Folder"),
                        QStringLiteral("List View"),
                        QStringLiteral("Detail View"),
                        QStringLiteral("Rename"),
                        QStringLiteral("Delete"),
                        QStringLiteral("Show hidden files"),
                        QStringLiteral("New Folder"),
                        QStringLiteral("Undo"),
                        QStringLiteral("Copy"),
                        QStringLiteral("Paste"),
                        QStringLiteral("Select All"),
                        QStringLiteral("Cancel")};
    QFile file(QStringLiteral(KICKVANE_SOURCE_DIR "/src/shell/translations/qtbase_vi.ts"));
    EXPECT_TRUE(file.open(QIODevice::ReadOnly));
    QXmlStreamReader xml(&file);
    QString source;
    while (!xml.atEnd()) {
        if (xml.readNext() != QXmlStreamReader::StartElement) {
            continue;
        }
        if (xml.name() == u"source") {
            source = xml.readElementText();
        } else if (xml.name() == u"translation") {
            if (const QString translation = xml.readElementText(); translation != source) {
                words << Readable(source);
            }
        }
    }
    EXPECT_FALSE(xml.hasError()) << xml.errorString().toStdString();
    EXPECT_GT(words.size(), 100);
    return words;
}

// Every text of `root` and its children a player can see or hear read: captions, tool tips,
// actions, list heads and the entries of a menu.
QStringList VisibleTexts(QWidget& root) {
    QStringList texts;
    QList<QWidget*> widgets = root.findChildren<QWidget*>();
    widgets << &root;
    for (QWidget* widget : widgets) {
        texts << widget->toolTip() << widget->accessibleName();
        if (auto* label = qobject_cast<QLabel*>(widget)) {
            texts << label->text();
        } else if (auto* button = qobject_cast<QAbstractButton*>(widget)) {
            texts << button->text();
        } else if (auto* view = qobject_cast<QTreeView*>(widget); view && view->model()) {
            for (int column = 0; column < view->model()->columnCount(); ++column) {
                texts << view->model()->headerData(column, Qt::Horizontal).toString();
            }
        }
        for (QAction* action : widget->actions()) {
            texts << action->text() << action->toolTip();
            if (action->menu()) {
                texts << VisibleTexts(*action->menu());
            }
        }
    }
    for (QAction* action : root.findChildren<QAction*>()) {
        texts << action->text() << action->toolTip();
    }
    for (QString& text : texts) {
        text = Readable(text);
    }
    texts.removeAll(QString());
    return texts;
}

class QtWordsTest : public testing::WindowFixture {
protected:
    static void SetUpTestSuite() { ASSERT_TRUE(useVietnameseQtTexts()); }

    static void ExpectNoEnglish(QWidget& root) {
        static const QSet<QString> english = EnglishWords();
        const QStringList texts = VisibleTexts(root);
        EXPECT_FALSE(texts.isEmpty());
        for (const QString& text : texts) {
            EXPECT_FALSE(english.contains(text)) << text.toStdString();
        }
    }

    static void SavePicture(QWidget& widget, const QString& name) {
        QDir().mkpath(QStringLiteral(KICKVANE_ARTIFACTS));
        widget.grab().save(QStringLiteral(KICKVANE_ARTIFACTS "/") + name);
    }
};

TEST_F(QtWordsTest, FolderChooserSpeaksVietnameseAndShowsItsHeadsWhole) {
    std::filesystem::create_directories(dir_ / "Games");
    QFileDialog dialog;
    prepareFolderDialog(dialog, QStringLiteral("Chọn thư mục cài đặt FIFA Online 2"),
                        QString::fromStdString(dir_.path().string()));
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&dialog));
    // The detail view, whose heads Qt sized for English.
    auto* detailButton = dialog.findChild<QAbstractButton*>(QStringLiteral("detailModeButton"));
    ASSERT_NE(detailButton, nullptr);
    detailButton->click();
    ExpectNoEnglish(dialog);

    auto* details = dialog.findChild<QTreeView*>(QStringLiteral("treeView"));
    ASSERT_NE(details, nullptr);
    QHeaderView* header = details->header();
    for (int column = 0; column < header->count(); ++column) {
        EXPECT_GE(header->sectionSize(column), header->sectionSizeHint(column)) << column;
    }
    SavePicture(dialog, QStringLiteral("folder-chooser.png"));

    // A typed folder that does not exist: Qt's own box says so in Vietnamese, and shows the
    // typed text as written.
    auto* nameBox = dialog.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
    ASSERT_NE(nameBox, nullptr);
    nameBox->setText(QStringLiteral("<b>missing"));
    QString boxText;
    QTimer::singleShot(0, [&] {
        if (auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget())) {
            boxText = box->text();
            EXPECT_EQ(box->textFormat(), Qt::PlainText);
            ExpectNoEnglish(*box);
            box->close();
        }
    });
    static_cast<QDialog&>(dialog).accept();  // as the "Chọn" button does
    EXPECT_TRUE(boxText.contains(QStringLiteral("Không tìm thấy thư mục")))
        << boxText.toStdString();
    EXPECT_TRUE(boxText.contains(QStringLiteral("<b>missing"))) << boxText.toStdString();
}

TEST_F(QtWordsTest, TextBoxContextMenusAndStandardButtonsSpeakVietnamese) {
    auto window = Open();
    window->panels().gameFolderBox()->setText(QStringLiteral("C:\\Games"));
    std::unique_ptr<QMenu> menu(window->panels().gameFolderBox()->createStandardContextMenu());
    ExpectNoEnglish(*menu);
    std::unique_ptr<QMenu> hotkeyMenu(
        window->buttons().hotkeyBox()->lineEdit()->createStandardContextMenu());
    ExpectNoEnglish(*hotkeyMenu);

    QMessageBox box(QMessageBox::Question, QStringLiteral("Thông báo"), QStringLiteral("?"),
                    QMessageBox::Ok | QMessageBox::Cancel | QMessageBox::Yes | QMessageBox::No |
                        QMessageBox::Close);
    ExpectNoEnglish(box);
    EXPECT_EQ(Readable(box.button(QMessageBox::Cancel)->text()), "Huỷ");
}

// Paths, fetched answers and settings values can hold anything; markup in them stays text.
TEST_F(QtWordsTest, OutsideTextIsShownAsWrittenNeverAsMarkup) {
    auto window = Open();
    for (const QString& outside :
         {QStringLiteral("<img src=\"/usr/share/pixmaps/debian-logo.png\">"),
          QStringLiteral("<h1>404 Not Found</h1>"), QStringLiteral("Tom &amp; Jerry")}) {
        SCOPED_TRACE(outside.toStdString());
        QtDialogs dialogs;  // its boxes all come from one maker
        dialogs.showNotice(window.get(), QStringLiteral("Thông báo"), outside);
        auto* notice = window->findChild<QMessageBox*>();
        ASSERT_NE(notice, nullptr);
        EXPECT_EQ(notice->textFormat(), Qt::PlainText);
        auto* label = notice->findChild<QLabel*>(QStringLiteral("qt_msgbox_label"));
        ASSERT_NE(label, nullptr);
        EXPECT_EQ(label->textFormat(), Qt::PlainText);
        EXPECT_EQ(label->text(), outside);
        delete notice;

        // The hotkey's note quotes the text of the settings file.
        window->session().SetHotkeyText(outside.toStdString());
        window->buttons().showHotkey(outside,
                                     QString::fromStdString(window->session().HotkeyProblem()));
        EXPECT_EQ(window->buttons().hotkeyProblem()->textFormat(), Qt::PlainText);
        EXPECT_TRUE(window->buttons().hotkeyProblem()->text().contains(outside));
    }
}

}  // namespace
}  // namespace kickvane::shell
