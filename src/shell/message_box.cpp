#include "shell/message_box.h"

#include <QApplication>
#include <QMessageBox>
#include <QWidget>

#include "text/vni.h"

namespace kickvane::shell {

namespace {

QString FromUtf8(std::string_view text) {
    return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
}

}  // namespace

QString NoticeTitle() {
    return FromUtf8(text::VniToUnicodeUtf8(kNoticeTitleVni));
}

int ShowMessageW(std::string_view text, std::string_view title, int style, QWidget* owner) {
    QMessageBox box(style == kStyleInformation ? QMessageBox::Information : QMessageBox::NoIcon,
                    FromUtf8(text::VniToUnicodeUtf8(title)), FromUtf8(text::VniToUnicodeUtf8(text)),
                    QMessageBox::Ok, owner);
    box.exec();
    return 1;
}

void WindowMessageHelper::ShowText(std::string_view text) {
    dialogs_.ShowMessage(owner_, NoticeTitle(), FromUtf8(text));
}

std::string WindowMessageHelper::ReadWindowText(std::uintptr_t window) const {
    for (QWidget* widget : QApplication::allWidgets()) {
        if (widget->internalWinId() == static_cast<WId>(window)) {
            return widget->windowTitle().toStdString();
        }
    }
    return {};
}

}  // namespace kickvane::shell
