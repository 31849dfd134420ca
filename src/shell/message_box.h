#pragma once

#include <QMessageBox>
#include <QString>
#include <string_view>

class QWidget;

namespace kickvane::shell {

inline constexpr std::string_view kNoticeTitleVni = "Tho6ng ba1o";

// The icon beside a message box's text.
enum class MessageIcon { None, Information };

// Shows a message box with one OK button, whose text and title are stored VNI-typed; both are
// converted first. Returns when the user has closed it.
void showVniMessage(std::string_view text, std::string_view title, MessageIcon icon,
                    QWidget* owner);

QString noticeTitle();

// A message box with one OK button whose text is shown as written: the paths, fetched answers
// and settings values in it are never read as markup.
QMessageBox* newPlainMessageBox(QMessageBox::Icon icon, const QString& title, const QString& text,
                                QWidget* owner);

}  // namespace kickvane::shell
