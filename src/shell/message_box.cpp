#include "shell/message_box.h"

#include <QMessageBox>
#include <QWidget>
#include <memory>

#include "shell/qt_text.h"
#include "text/vni.h"

namespace kickvane::shell {

QString NoticeTitle() {
    return ToQString(text::VniToUnicodeUtf8(kNoticeTitleVni));
}

QMessageBox* NewPlainMessageBox(QMessageBox::Icon icon, const QString& title, const QString& text,
                                QWidget* owner) {
    auto* box = new QMessageBox(icon, title, QString(), QMessageBox::Ok, owner);
    box->setTextFormat(Qt::PlainText);
    box->setText(text);
    return box;
}

int ShowMessageW(std::string_view text, std::string_view title, int style, QWidget* owner) {
    const std::unique_ptr<QMessageBox> box(NewPlainMessageBox(
        style == kStyleInformation ? QMessageBox::Information : QMessageBox::NoIcon,
        ToQString(text::VniToUnicodeUtf8(title)), ToQString(text::VniToUnicodeUtf8(text)), owner));
    box->exec();
    return 1;
}

}  // namespace kickvane::shell
