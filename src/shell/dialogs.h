#pragma once

#include <QString>
#include <functional>
#include <optional>

class QFileDialog;
class QWidget;

namespace kickvane::shell {

// The dialogs the window opens. The real ones are Qt's; tests record instead of blocking.
class Dialogs {
public:
    enum class Icon { Information, Warning };

    virtual ~Dialogs() = default;

    // A folder picker that opens at `start` (a folder as the user typed it, or empty); nullopt
    // when the user cancels.
    virtual std::optional<QString> pickFolder(QWidget* owner, const QString& title,
                                              const QString& start) = 0;

    // A message box with one OK button; returns when the user has closed it.
    virtual void showMessage(QWidget* owner, const QString& title, const QString& text,
                             Icon icon = Icon::Information) = 0;

    // A message that does not wait: the window goes on while it is open.
    virtual void showNotice(QWidget* owner, const QString& title, const QString& text) = 0;

    // The corner popup that confirms an action.
    virtual void showPopup(const QString& text, int displaySeconds) = 0;

    // A red corner popup that reports failures without taking the focus; a click on it calls
    // `onClick`.
    virtual void showFailureAlert(const QString& text, int displaySeconds,
                                  std::function<void()> onClick) = 0;
};

// Installs the Vietnamese words of Qt's own dialogs, menus and buttons (the folder chooser, a
// text box's context menu, the standard buttons); false when the translation cannot be loaded.
// Called once the application object exists.
bool useVietnameseQtTexts();

// Where a folder picker opens: the folder named by `wanted` (a native path or a Windows path in
// the Wine prefix) or its nearest parent that exists, else the home folder.
QString folderDialogStart(const QString& wanted);

// Sets up Qt's own folder dialog in Vietnamese, opening at folderDialogStart(start) and listing
// hidden folders too (Wine prefixes live in ~/.wine and ~/.local/share).
void prepareFolderDialog(QFileDialog& dialog, const QString& title, const QString& start);

// Qt's file dialog, message boxes and the alert popup.
class QtDialogs final : public Dialogs {
public:
    std::optional<QString> pickFolder(QWidget* owner, const QString& title,
                                      const QString& start) override;
    void showMessage(QWidget* owner, const QString& title, const QString& text, Icon icon) override;
    void showNotice(QWidget* owner, const QString& title, const QString& text) override;
    void showPopup(const QString& text, int displaySeconds) override;
    void showFailureAlert(const QString& text, int displaySeconds,
                          std::function<void()> onClick) override;
};

}  // namespace kickvane::shell
