#include "shell/dialogs.h"

#include <QCoreApplication>
#include <QDateTime>
#include <QDir>
#include <QFileDialog>
#include <QFileSystemModel>
#include <QHeaderView>
#include <QIdentityProxyModel>
#include <QMessageBox>
#include <QTranslator>
#include <QTreeView>
#include <algorithm>
#include <array>
#include <filesystem>
#include <memory>

#include "platform/filesystem.h"
#include "shell/alert_popup.h"
#include "shell/message_box.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

// The folder list in Vietnamese: its column heads ("Name", "Size", ...), the type of a folder
// and its date, which Qt would write in English.
class VietnameseColumns final : public QIdentityProxyModel {
public:
    using QIdentityProxyModel::QIdentityProxyModel;

    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        static const std::array<QString, 4> kHeads{
            QStringLiteral("Tên"), QStringLiteral("Kích thước"), QStringLiteral("Loại"),
            QStringLiteral("Ngày sửa")};
        if (orientation == Qt::Horizontal && role == Qt::DisplayRole && section >= 0 &&
            section < static_cast<int>(kHeads.size())) {
            return kHeads[static_cast<size_t>(section)];
        }
        return QIdentityProxyModel::headerData(section, orientation, role);
    }

    QVariant data(const QModelIndex& index, int role) const override {
        const auto* files = qobject_cast<const QFileSystemModel*>(sourceModel());
        if (files && role == Qt::DisplayRole && (index.column() == 2 || index.column() == 3)) {
            const QModelIndex entry = mapToSource(index);
            const QFileInfo info = files->fileInfo(entry);
            if (index.column() == 3) {
                return files->lastModified(entry).toString(QStringLiteral("dd/MM/yyyy"));
            }
            if (info.isRoot()) {
                return QStringLiteral("Ổ đĩa");
            }
            if (info.isDir()) {
                return QStringLiteral("Thư mục");
            }
        }
        return QIdentityProxyModel::data(index, role);
    }
};
// The chooser's own boxes (a typed folder that does not exist) quote what the user typed: shown
// as written, never as markup.
class PlainTextBoxes final : public QObject {
public:
    using QObject::QObject;

    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() == QEvent::ChildPolished) {
            if (auto* box = qobject_cast<QMessageBox*>(static_cast<QChildEvent*>(event)->child())) {
                box->setTextFormat(Qt::PlainText);
            }
        }
        return QObject::eventFilter(watched, event);
    }
};

}  // namespace

bool useVietnameseQtTexts() {
    auto* translator = new QTranslator(QCoreApplication::instance());
    if (!translator->load(QStringLiteral(":/translations/qtbase_vi.qm"))) {
        delete translator;
        return false;
    }
    return QCoreApplication::installTranslator(translator);
}

QString folderDialogStart(const QString& wanted) {
    namespace fs = std::filesystem;
    const QString text = wanted.trimmed();
    if (!text.isEmpty()) {
        // A relative text would name a folder under the program's working folder, which is
        // nowhere the user has been.
        fs::path folder = platform::NativePathFromUserText(toUtf8(text));
        while (folder.is_absolute()) {
            const fs::path existing = platform::ResolveCaseInsensitive(folder);
            if (platform::IsDirectory(existing)) {
                return QDir::cleanPath(pathToQString(existing));
            }
            if (!folder.has_relative_path()) {
                break;  // the root itself is missing, as an unmapped drive is
            }
            folder = folder.parent_path();
        }
    }
    // Nothing typed yet: where Windows games live here, the Wine prefix's drive C.
    const fs::path home = platform::PathFromUtf8(platform::GetEnv("HOME"));
    for (const fs::path& prefix : {platform::PathFromUtf8(platform::GetEnv("WINEPREFIX")),
                                   home.empty() ? fs::path() : home / ".wine"}) {
        if (!prefix.empty() && platform::IsDirectory(prefix / "drive_c")) {
            return pathToQString(prefix / "drive_c");
        }
    }
    return QDir::homePath();
}

void prepareFolderDialog(QFileDialog& dialog, const QString& title, const QString& start) {
    // Qt's own dialog rather than the desktop's, so that every label can be Vietnamese.
    dialog.setOption(QFileDialog::DontUseNativeDialog);
    dialog.setFileMode(QFileDialog::Directory);
    dialog.setOption(QFileDialog::ShowDirsOnly);
    dialog.setFilter(dialog.filter() | QDir::Hidden);
    dialog.setWindowTitle(title);
    dialog.setLabelText(QFileDialog::LookIn, QStringLiteral("Tìm trong:"));
    dialog.setLabelText(QFileDialog::FileName, QStringLiteral("Thư mục:"));
    dialog.setLabelText(QFileDialog::FileType, QStringLiteral("Loại:"));
    dialog.setLabelText(QFileDialog::Accept, QStringLiteral("Chọn"));
    dialog.setLabelText(QFileDialog::Reject, QStringLiteral("Huỷ"));
    dialog.setProxyModel(new VietnameseColumns(&dialog));
    dialog.installEventFilter(new PlainTextBoxes(&dialog));
    // Qt sizes the detail view's columns for English heads; the Vietnamese ones need more room.
    if (auto* details = dialog.findChild<QTreeView*>(QStringLiteral("treeView"))) {
        QHeaderView* header = details->header();
        for (int column = 0; column < header->count(); ++column) {
            header->resizeSection(
                column, std::max(header->sectionSize(column), header->sectionSizeHint(column)));
        }
    }
    // A folder picker has no file types to choose ("Directories" only).
    for (const char* name : {"fileTypeCombo", "fileTypeLabel"}) {
        if (auto* widget = dialog.findChild<QWidget*>(QString::fromLatin1(name))) {
            widget->hide();
        }
    }
    // The side list: the home folder and the drives (the root on Linux), without Qt's English
    // "Computer".
    QList<QUrl> places{QUrl::fromLocalFile(QDir::homePath())};
    for (const QFileInfo& drive : QDir::drives()) {
        places << QUrl::fromLocalFile(drive.absoluteFilePath());
    }
    dialog.setSidebarUrls(places);
    dialog.setDirectory(folderDialogStart(start));
}

std::optional<QString> QtDialogs::pickFolder(QWidget* owner, const QString& title,
                                             const QString& start) {
    QFileDialog dialog(owner);
    prepareFolderDialog(dialog, title, start);
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty()) {
        return std::nullopt;
    }
    const QString folder = dialog.selectedFiles().constFirst();
    if (folder.isEmpty()) {
        return std::nullopt;
    }
    return QDir::toNativeSeparators(folder);
}

void QtDialogs::showMessage(QWidget* owner, const QString& title, const QString& text, Icon icon) {
    const std::unique_ptr<QMessageBox> box(
        newPlainMessageBox(icon == Icon::Warning ? QMessageBox::Warning : QMessageBox::Information,
                           title, text, owner));
    box->exec();
}

void QtDialogs::showNotice(QWidget* owner, const QString& title, const QString& text) {
    QMessageBox* box = newPlainMessageBox(QMessageBox::Warning, title, text, owner);
    box->setAttribute(Qt::WA_DeleteOnClose);
    box->setModal(false);
    box->show();
}

void QtDialogs::showPopup(const QString& text, int displaySeconds) {
    AlertPopup::open(text, displaySeconds);
}

void QtDialogs::showFailureAlert(const QString& text, int displaySeconds,
                                 std::function<void()> onClick) {
    auto* popup = new AlertPopup(AlertPopup::screenEnvironment());
    QObject::connect(popup, &AlertPopup::clicked, popup, std::move(onClick));
    popup->displayMessage(text, displaySeconds, popup::FailureStyle());
}

}  // namespace kickvane::shell
