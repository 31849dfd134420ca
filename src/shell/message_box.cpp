#include "shell/message_box.h"

#include <QMessageBox>
#include <QWidget>
#include <memory>

#include "shell/qt_text.h"
#include "text/vni.h"

namespace kickvane::shell {

QString noticeTitle() {
    return toQString(text::VniToUnicodeUtf8(kNoticeTitleVni));
}

QMessageBox* newPlainMessageBox(QMessageBox::Icon icon, const QString& title, const QString& text,
                                QWidget* owner) {
    auto* box = new QMessageBox(icon, title, QString(), QMessageBox::Ok, owner);
    box->setTextFormat(Qt::PlainText);
    box->setText(text);
    return box;
}

void showVniMessage(std::string_view text, std::string_view title, MessageIcon icon,
                    QWidget* owner) {
    const std::unique_ptr<QMessageBox> box(newPlainMessageBox(
        icon == MessageIcon::Information ? QMessageBox::Information : QMessageBox::NoIcon,
        toQString(text::VniToUnicodeUtf8(title)), toQString(text::VniToUnicodeUtf8(text)), owner));
    box->exec();
}

}  // namespace kickvane::shell
