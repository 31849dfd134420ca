#pragma once

#include <QComboBox>
#include <QLabel>
#include <QObject>
#include <QPushButton>

#include "shell/widgets.h"

namespace kickvane::shell {

struct SkinLook;

// The window's buttons outside the panels: the hotkey box and the three commands along the
// bottom, the small buttons under the tab heads and, in the header, the update check and the two
// skins. Each caption has a mnemonic.
class CommandButtons final : public QObject {
    Q_OBJECT
public:
    explicit CommandButtons(QWidget* window);

    // Shows the hotkey text; `problem` non-empty says that it names no key, in red beside it.
    void showHotkey(const QString& text, const QString& problem);
    void recolour(const SkinLook& look);
    // While a start of the game is watched, "Khởi động FIFA" is disabled and says so.
    void showLaunchWatched(bool watched);

    HotkeyBox* hotkeyBox() const { return hotkey_; }
    QLabel* hotkeyProblem() const { return hotkeyProblem_; }
    QPushButton* save() const { return save_; }
    QPushButton* launch() const { return launch_; }
    QPushButton* quickLoad() const { return quickLoad_; }
    QPushButton* runHidden() const { return runHidden_; }
    QPushButton* info() const { return info_; }
    QPushButton* help() const { return help_; }
    QPushButton* translucent() const { return translucent_; }
    QPushButton* checkUpdate() const { return checkUpdate_; }
    QPushButton* download() const { return download_; }
    QPushButton* skin(int number) const { return number == 1 ? skin1_ : skin2_; }

signals:
    // The user has finished typing or choosing a hotkey name.
    void hotkeyEdited(const QString& text);

private:
    void paintNote(const SkinLook& look);
    QLabel* hotkeyLabel_;
    HotkeyBox* hotkey_;
    QLabel* hotkeyProblem_;
    QPushButton* save_;
    QPushButton* launch_;
    QPushButton* quickLoad_;
    QPushButton* runHidden_;
    QPushButton* info_;
    QPushButton* help_;
    QPushButton* translucent_;
    QPushButton* checkUpdate_;
    QPushButton* download_;
    QPushButton* skin1_;
    QPushButton* skin2_;
};

}  // namespace kickvane::shell
