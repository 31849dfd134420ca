#include "shell/message_box.h"

#include <QMessageBox>
#include <QWidget>

#include "shell/qt_text.h"
#include "text/vni.h"

namespace kickvane::shell {

QString NoticeTitle() {
    return ToQString(text::VniToUnicodeUtf8(kNoticeTitleVni));
}

int ShowMessageW(std::string_view text, std::string_view title, int style, QWidget* owner) {
    QMessageBox box(style == kStyleInformation ? QMessageBox::Information : QMessageBox::NoIcon,
                    ToQString(text::VniToUnicodeUtf8(title)),
                    ToQString(text::VniToUnicodeUtf8(text)), QMessageBox::Ok, owner);
    box.exec();
    return 1;
}

}  // namespace kickvane::shell
