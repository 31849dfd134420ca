#include "shell/dialogs.h"

#include <QFileDialog>
#include <QMessageBox>

#include "shell/alert_popup.h"

namespace kickvane::shell {

std::optional<QString> QtDialogs::PickFolder(QWidget* owner, const QString& title) {
    const QString folder = QFileDialog::getExistingDirectory(owner, title);
    if (folder.isEmpty()) {
        return std::nullopt;
    }
    return folder;
}

void QtDialogs::ShowMessage(QWidget* owner, const QString& title, const QString& text, Icon icon) {
    QMessageBox box(icon == Icon::Warning ? QMessageBox::Warning : QMessageBox::Information, title,
                    text, QMessageBox::Ok, owner);
    box.exec();
}

void QtDialogs::ShowNotice(QWidget* owner, const QString& title, const QString& text) {
    auto* box = new QMessageBox(QMessageBox::Warning, title, text, QMessageBox::Ok, owner);
    box->setAttribute(Qt::WA_DeleteOnClose);
    box->setModal(false);
    box->show();
}

void QtDialogs::ShowPopup(const QString& text, int displaySeconds) {
    AlertPopup::Show(text, displaySeconds);
}

}  // namespace kickvane::shell
