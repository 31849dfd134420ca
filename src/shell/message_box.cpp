#include "shell/message_box.h"

#include <QMessageBox>
#include <QWidget>

#include "shell/qt_text.h"
#include "text/vni.h"

namespace kickvane::shell {

QString noticeTitle() {
    return toQString(text::VniToUnicodeUtf8(kNoticeTitleVni));
}

void showVniMessage(std::string_view text, std::string_view title, MessageIcon icon,
                    QWidget* owner) {
    QMessageBox box(
        icon == MessageIcon::Information ? QMessageBox::Information : QMessageBox::NoIcon,
        toQString(text::VniToUnicodeUtf8(title)), toQString(text::VniToUnicodeUtf8(text)),
        QMessageBox::Ok, owner);
    box.exec();
}

}  // namespace kickvane::shell
