#include "shell/command_buttons.h"

#include "shell/skin_look.h"

namespace kickvane::shell {

namespace {

constexpr int kSmallLeft = 9;
constexpr int kSmallWidth = 82;

QPushButton* makeButton(const QString& caption, QWidget* parent, const QRect& geometry) {
    auto* button = new QPushButton(caption, parent);
    button->setGeometry(geometry);
    return button;
}

}  // namespace

CommandButtons::CommandButtons(QWidget* window) : QObject(window) {
    hotkeyLabel_ = new QLabel(QStringLiteral("&Phím tắt:"), window);
    hotkeyLabel_->setGeometry(9, 446, 60, 22);
    hotkey_ = new HotkeyBox(window);
    hotkey_->setMaxVisibleItems(12);
    hotkey_->setGeometry(62, 445, 60, 24);
    for (int key = 1; key <= 12; ++key) {
        hotkey_->addItem(QStringLiteral("F%1").arg(key));
    }
    hotkey_->setCurrentIndex(6);
    hotkeyLabel_->setBuddy(hotkey_);
    connect(hotkey_, &HotkeyBox::nameChosen, this, &CommandButtons::hotkeyEdited);
    // Above the hotkey box, in the free band under the panels.
    hotkeyProblem_ = new QLabel(window);
    hotkeyProblem_->setGeometry(9, 408, 410, 30);
    hotkeyProblem_->setWordWrap(true);
    hotkeyProblem_->setMargin(2);
    paintNote(lightSkin());
    hotkeyProblem_->setTextFormat(Qt::PlainText);  // it quotes the text from the settings file
    hotkeyProblem_->hide();

    save_ = makeButton(QStringLiteral("&Lưu thiết lập"), window, {130, 442, 92, 30});
    launch_ = makeButton(QStringLiteral("Khởi động &FIFA"), window, {226, 442, 104, 30});
    quickLoad_ = makeButton(QStringLiteral("&Nạp nhanh"), window, {334, 442, 84, 30});

    runHidden_ = makeButton(QStringLiteral("&Chạy ẩn"), window, {kSmallLeft, 262, kSmallWidth, 26});
    info_ = makeButton(QStringLiteral("&Thông tin"), window, {kSmallLeft, 292, kSmallWidth, 26});
    help_ = makeButton(QStringLiteral("&Hướng dẫn"), window, {kSmallLeft, 322, kSmallWidth, 26});
    translucent_ = makeButton(QStringLiteral("T&rans"), window, {kSmallLeft, 352, kSmallWidth, 26});

    // The header's right end, clear of the banner's title and version on the left.
    checkUpdate_ = makeButton(QStringLiteral("&Kiểm tra cập nhật"), window, {210, 10, 108, 26});
    download_ = makeButton(QStringLiteral("Tải &về"), window, checkUpdate_->geometry());
    download_->hide();
    skin1_ = makeButton(QStringLiteral("skin &1"), window, {322, 10, 46, 26});
    skin2_ = makeButton(QStringLiteral("skin &2"), window, {372, 10, 46, 26});
}

void CommandButtons::showHotkey(const QString& text, const QString& problem) {
    if (hotkey_->currentText() != text) {
        hotkey_->setCurrentText(text);
    }
    hotkeyProblem_->setText(problem);
    hotkeyProblem_->setVisible(!problem.isEmpty());
}

void CommandButtons::showLaunchWatched(bool watched) {
    launch_->setEnabled(!watched);
    launch_->setText(watched ? QStringLiteral("Đang mở FIFA…") : QStringLiteral("Khởi động &FIFA"));
}

void CommandButtons::paintNote(const SkinLook& look) {
    // On a ground of its own: over the skins' pictures red text could not be read.
    paint(hotkeyProblem_, look.noteBackground, look.noteText);
}

void CommandButtons::recolour(const SkinLook& look) {
    paintNote(look);
    // The hotkey's caption follows the labels' text colour, readable on both backgrounds.
    QPalette palette = hotkeyLabel_->palette();
    palette.setColor(QPalette::WindowText, look.labelText);
    hotkeyLabel_->setPalette(palette);
}

}  // namespace kickvane::shell
