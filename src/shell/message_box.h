#pragma once

#include <QMessageBox>
#include <QString>
#include <string_view>

class QWidget;

namespace kickvane::shell {

inline constexpr int kStyleInformation = 64;  // information icon, one OK button
inline constexpr std::string_view kNoticeTitleVni = "Tho6ng ba1o";

// Shows a message box whose text and title are stored VNI-typed; both are converted first.
// Style 64 shows the information icon; every style has the one OK button the tool uses.
// Returns the identifier of the pressed button (1, OK).
int ShowMessageW(std::string_view text, std::string_view title, int style, QWidget* owner);

QString NoticeTitle();

// A message box with one OK button whose text is shown as written: the paths, fetched answers
// and settings values in it are never read as markup.
QMessageBox* NewPlainMessageBox(QMessageBox::Icon icon, const QString& title, const QString& text,
                                QWidget* owner);

}  // namespace kickvane::shell
