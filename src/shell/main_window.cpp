#include "shell/main_window.h"

#include <QApplication>
#include <QCloseEvent>
#include <QCursor>
#include <QLabel>
#include <QPainter>

#include "engine/apply.h"
#include "engine/quick_load.h"
#include "platform/filesystem.h"

namespace kickvane::shell {

namespace {

using catalog::GroupId;
using catalog::OptionArray;

constexpr std::array<int, kTabCount> kTabTops{65, 110, 156, 202};
constexpr int kTabLeft = 9;
constexpr QRect kPanelRect(104, 46, 321, 357);
const std::array<QString, kTabCount> kTabCaptions{QStringLiteral("Chung"), QStringLiteral("Bóng"),
                                                  QStringLiteral("Tỉ số"), QStringLiteral("Khác")};

// Colours of the entries in the light skin, the look at every start.
const QColor kEntryBackground(0xE0, 0xE0, 0xE0);
const QColor kLabelBackground(0xC0, 0xC0, 0xC0);

QIcon ToolIcon(const std::filesystem::path& toolFolder) {
    QIcon icon;
    for (const char* size : {"16", "32", "64"}) {
        const std::filesystem::path file = platform::ResolveCaseInsensitive(
            toolFolder / "icons" / (std::string("kickvane-") + size + ".png"));
        if (platform::IsRegularFile(file)) {
            icon.addFile(QString::fromStdString(file.string()));
        }
    }
    if (icon.isNull()) {
        // Without its icon files the tool still needs an icon, or the tray would show nothing.
        QPixmap drawn(32, 32);
        drawn.fill(Qt::transparent);
        QPainter painter(&drawn);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setBrush(QColor(0x2E, 0x8B, 0x3E));
        painter.setPen(Qt::NoPen);
        painter.drawEllipse(1, 1, 30, 30);
        painter.setBrush(Qt::white);
        painter.drawEllipse(8, 8, 16, 16);
        icon.addPixmap(drawn);
    }
    return icon;
}

QString FromUtf8(std::string_view text) {
    return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
}

void Paint(QWidget* widget, const QColor& background, const QColor& text = Qt::black) {
    QPalette palette = widget->palette();
    palette.setColor(QPalette::Window, background);
    palette.setColor(QPalette::WindowText, text);
    widget->setPalette(palette);
    widget->setAutoFillBackground(true);
}

ClickableLabel* MakeLabel(std::string_view text, QWidget* parent, const QRect& geometry) {
    auto* label = new ClickableLabel(FromUtf8(text), parent);
    label->setGeometry(geometry);
    label->setCursor(Qt::PointingHandCursor);
    Paint(label, kLabelBackground);
    return label;
}

QLabel* MakeHeading(const QString& text, QWidget* parent, const QPoint& at) {
    auto* heading = new QLabel(text, parent);
    QFont font = heading->font();
    font.setBold(true);
    heading->setFont(font);
    heading->move(at);
    heading->adjustSize();
    return heading;
}

QString StepLine(const engine::StepOutcome& step) {
    const catalog::PatchCategory& category =
        catalog::Categories()[static_cast<size_t>(step.step.category)];
    return QStringLiteral("• %1: %2 (%3)")
        .arg(FromUtf8(category.label).trimmed(), FromUtf8(engine::Describe(step.step)),
             FromUtf8(step.reason));
}

}  // namespace

MainWindow::MainWindow(std::filesystem::path toolFolder, ShellServices services, QWidget* parent)
    : QWidget(parent, Qt::Window | Qt::WindowTitleHint | Qt::WindowSystemMenuHint |
                          Qt::WindowMinimizeButtonHint | Qt::WindowCloseButtonHint |
                          Qt::MSWindowsFixedSizeDialogHint),
      toolFolder_(std::move(toolFolder)),
      services_(std::move(services)),
      ui_(*services_.dialogs, this, services_.playSound) {
    setWindowTitle(QStringLiteral("Kickvane v2.0"));
    setFixedSize(kClientWidth, kClientHeight);
    QFont small = font();
    small.setPointSizeF(8.5);
    setFont(small);

    buildTabs();
    buildButtons();
    buildTrayMenu();

    // Start-up, in order: the fade-in, the icons, the first panel and tab set-up, the tray icon,
    // the hotkey poll, the hotkey list and the settings. A step that cannot be done leaves its
    // part as designed; the window still opens.
    fadeTimer_.setInterval(FadeModel::kInterval);
    connect(&fadeTimer_, &QTimer::timeout, this, &MainWindow::fadeTick);
    startFade(240, 15);

    const QIcon icon = ToolIcon(toolFolder_);
    setWindowIcon(icon);

    currentTab_ = 0;
    initTabs();
    paintTabs();

    tray_ = services_.makeTray ? services_.makeTray(icon, &trayMenu_)
                               : std::make_unique<SystemTrayIcon>(icon, &trayMenu_);
    connect(tray_.get(), &TrayIcon::menuRequested, this,
            [this] { trayMenu_.popup(QCursor::pos()); });
    tray_->Add();

    if (services_.keySampler) {
        poll_ = std::make_unique<engine::HotkeyPoll>(*services_.keySampler);
    }
    hotkeyTimer_.setInterval(engine::HotkeyPoll::kInterval);
    connect(&hotkeyTimer_, &QTimer::timeout, this, &MainWindow::pollHotkey);
    hotkeyTimer_.start();

    for (int key = 1; key <= 12; ++key) {
        hotkey_->addItem(QStringLiteral("F%1").arg(key));
    }
    hotkey_->setCurrentIndex(6);

    loadSettings();
}

MainWindow::~MainWindow() = default;

QString MainWindow::skinFile(const QString& skin, const QString& suffix) const {
    const std::filesystem::path file =
        platform::ResolveCaseInsensitive(toolFolder_ / "skin" / (skin + suffix).toStdString());
    return QString::fromStdString(file.string());
}

void MainWindow::buildTabs() {
    for (int i = 0; i < kTabCount; ++i) {
        auto* tab = new TabHead(kTabCaptions[static_cast<size_t>(i)], this);
        tab->setGeometry(kTabLeft, kTabTops[static_cast<size_t>(i)], 90, 32);
        connect(tab, &TabHead::clicked, this, [this, i] { selectTab(i); });
        tabs_[static_cast<size_t>(i)] = tab;

        auto* panel = new PictureBox(this);
        panel->setGeometry(
            kPanelRect.translated(0, i * 4));  // design positions; set-up aligns them
        panels_[static_cast<size_t>(i)] = panel;
    }
    buildCategoryPanel(panels_[0]);
    MakeHeading(QStringLiteral("Chọn quả bóng:"), panels_[1], {12, 10});
    buildGroupPanel(panels_[1], GroupId::Ball, 40);
    MakeHeading(QStringLiteral("Chọn bảng tỉ số:"), panels_[2], {12, 10});
    buildGroupPanel(panels_[2], GroupId::Scoreboard, 40);
    buildVariantFrames(panels_[3]);
}

void MainWindow::buildCategoryPanel(QWidget* panel) {
    auto* folderLabel = new QLabel(QStringLiteral("Thư mục cài FIFA Online 2:"), panel);
    folderLabel->setGeometry(10, 8, 300, 18);
    gameFolder_ = new QLineEdit(panel);
    gameFolder_->setGeometry(10, 28, 212, 25);
    browse_ = new QPushButton(QStringLiteral("Đổi thư mục"), panel);
    browse_->setGeometry(226, 27, 86, 27);
    connect(browse_, &QPushButton::clicked, this, &MainWindow::browseGameFolder);

    for (const catalog::PatchCategory& category : catalog::Categories()) {
        const int i = category.switchIndex;
        const int x = i < 7 ? 8 : 162;
        const int y = 68 + (i % 7) * 40;
        auto* check = new QCheckBox(panel);
        check->setGeometry(x, y + 2, 20, 20);
        Paint(check, kEntryBackground);
        connect(check, &QCheckBox::clicked, this, [this, check, i](bool checked) {
            check->setTristate(false);
            selection_.setSwitchValue(i, checked ? 1 : 0);
        });
        checks_[static_cast<size_t>(i)] = check;

        auto* label = MakeLabel(category.label, panel, QRect(x + 22, y, 128, 24));
        connect(label, &ClickableLabel::clicked, this,
                [this, i] { emit labelClicked(catalog::LabelArray::UniLabel, i); });
        categoryLabels_[static_cast<size_t>(i)] = label;
    }
}

void MainWindow::buildGroupPanel(QWidget* panel, GroupId id, int top) {
    const catalog::VariantGroup& group = catalog::Group(id);
    int row = 0;
    for (const catalog::PatchOption& option : group.options) {
        const int y = top + row++ * 36;
        auto* button = new QRadioButton(panel);
        button->setAutoExclusive(false);
        button->setGeometry(20, y + 2, 20, 20);
        Paint(button, kEntryBackground);
        auto* label = MakeLabel(option.label, panel, QRect(44, y, 250, 24));
        options_.push_back({group.array, option.index, button, label});
    }
}

void MainWindow::buildVariantFrames(QWidget* panel) {
    struct Frame {
        GroupId group;
        QString caption;
        QRect rect;
    };
    const std::array<Frame, 3> frames{{
        {GroupId::Adboard, QStringLiteral("Biển quảng cáo"), QRect(8, 8, 305, 108)},
        {GroupId::Pitch, QStringLiteral("Mặt cỏ"), QRect(8, 124, 305, 108)},
        {GroupId::Mark, QStringLiteral("Mark cầu thủ"), QRect(8, 240, 305, 108)},
    }};
    for (size_t f = 0; f < frames.size(); ++f) {
        auto* frame = new PictureBox(panel);
        frame->setGeometry(frames[f].rect);
        frame->setBackground(kEntryBackground);
        groupFrames_[f] = frame;
        MakeHeading(frames[f].caption, frame, {8, 4});
        int row = 0;
        for (const catalog::PatchOption& option : catalog::Group(frames[f].group).options) {
            const int y = 26 + row++ * 20;
            auto* button = new QRadioButton(frame);
            button->setAutoExclusive(false);
            button->setGeometry(10, y, 18, 18);
            Paint(button, kEntryBackground);
            auto* label = MakeLabel(option.label, frame, QRect(32, y - 1, 200, 19));
            options_.push_back({OptionArray::UniOption1, option.index, button, label});
        }
    }
}

void MainWindow::buildButtons() {
    for (const OptionWidgets& option : options_) {
        const OptionArray array = option.array;
        const int index = option.index;
        connect(option.button, &QRadioButton::clicked, this,
                [this, array, index] { onOptionClicked(array, index); });
        const catalog::VariantGroup* group = catalog::GroupOfOption(array, index);
        connect(option.label, &ClickableLabel::clicked, this,
                [this, group, index] { emit labelClicked(group->labels, index); });
    }

    hotkeyLabel_ = new QLabel(QStringLiteral("Phím tắt:"), this);
    hotkeyLabel_->setGeometry(9, 446, 60, 22);
    hotkey_ = new QComboBox(this);
    hotkey_->setEditable(true);
    hotkey_->setMaxVisibleItems(12);
    hotkey_->setGeometry(62, 445, 60, 24);

    save_ = new QPushButton(QStringLiteral("Lưu thiết lập"), this);
    save_->setGeometry(130, 442, 92, 30);
    connect(save_, &QPushButton::clicked, this, &MainWindow::saveSettings);
    launch_ = new QPushButton(QStringLiteral("Khởi động FIFA"), this);
    launch_->setGeometry(226, 442, 104, 30);
    connect(launch_, &QPushButton::clicked, this, &MainWindow::launchGame);
    quickLoad_ = new QPushButton(QStringLiteral("Nạp nhanh"), this);
    quickLoad_->setGeometry(334, 442, 84, 30);
    connect(quickLoad_, &QPushButton::clicked, this, &MainWindow::quickLoad);

    // The small command buttons under the tab heads.
    const auto small = [this](const QString& caption, int top) {
        auto* button = new QPushButton(caption, this);
        button->setGeometry(kTabLeft, top, kTabHeadWidth, 26);
        return button;
    };
    runHidden_ = small(QStringLiteral("Chạy ẩn"), 262);
    connect(runHidden_, &QPushButton::clicked, this, &MainWindow::runHidden);
    info_ = small(QStringLiteral("Thông tin"), 292);
    connect(info_, &QPushButton::clicked, this, &MainWindow::showAbout);
    help_ = small(QStringLiteral("Hướng dẫn"), 322);
    connect(help_, &QPushButton::clicked, this, &MainWindow::showHelp);
    translucent_ = small(QStringLiteral("Trans"), 352);
    connect(translucent_, &QPushButton::clicked, this, [this] { makeTranslucent(160); });

    // The header: the update check and the two skins.
    checkUpdate_ = new QPushButton(QStringLiteral("Kiểm tra cập nhật"), this);
    checkUpdate_->setGeometry(176, 10, 118, 26);
    download_ = new QPushButton(QStringLiteral("Tải về"), this);
    download_->setGeometry(176, 10, 118, 26);
    download_->hide();
    updateFlow_ =
        std::make_unique<UpdateFlow>(services_.updates, toolFolder_, *services_.dialogs, this,
                                     checkUpdate_, download_, &hidden_.pban, &hidden_.vlk);
    connect(checkUpdate_, &QPushButton::clicked, updateFlow_.get(), &UpdateFlow::check);
    connect(download_, &QPushButton::clicked, updateFlow_.get(), &UpdateFlow::download);
    skin1_ = new QPushButton(QStringLiteral("skin 1"), this);
    skin1_->setGeometry(302, 10, 56, 26);
    connect(skin1_, &QPushButton::clicked, this, [this] { applySkin(LightSkin()); });
    skin2_ = new QPushButton(QStringLiteral("skin 2"), this);
    skin2_->setGeometry(362, 10, 56, 26);
    connect(skin2_, &QPushButton::clicked, this, [this] { applySkin(DarkSkin()); });

    connect(this, &MainWindow::labelClicked, this, &MainWindow::showPreview);
}

void MainWindow::buildTrayMenu() {
    // Captions are kept as "[utf8]" and the text; the menu shows the text.
    const auto add = [this](const char* stored, void (MainWindow::*action)()) {
        const QString caption = QString::fromUtf8(stored).remove(0, 6);
        connect(trayMenu_.addAction(caption), &QAction::triggered, this, action);
    };
    add("[utf8]Khởi động FIFA", &MainWindow::launchGameFromTray);
    add("[utf8]Hiện chương trình", &MainWindow::showFromTray);
    add("[utf8]Nạp nhanh", &MainWindow::quickLoad);
    add("[utf8]Thông tin", &MainWindow::showAbout);
    add("[utf8]Thoát", &MainWindow::exitFromTray);
}

void MainWindow::initTabs() {
    tabHeight_ = static_cast<int16_t>(tabs_[0]->height());
    layoutPanels(skinFile(LightSkin().name, QStringLiteral("_panel.jpg")));
    LoadPicture(background_, skinFile(hidden_.skn, QStringLiteral("_bg.jpg")));
}

void MainWindow::layoutPanels(const QString& panelPicture) {
    // Every panel takes panel 0's colour, left and width, and sits just below the tab heads' top.
    for (int i = 0; i < kTabCount; ++i) {
        PictureBox* panel = panels_[static_cast<size_t>(i)];
        panel->setBackground(panels_[0]->background());
        panel->setPictureFile(panelPicture);
        panel->move(i > 0 ? panels_[0]->x() : panel->x(), tabHeight_ + 16);
        if (i > 0) {
            panel->resize(panels_[0]->width(), panel->height());
        }
    }
}

void MainWindow::paintTabs() {
    for (int i = 0; i < kTabCount; ++i) {
        const bool selected = i == currentTab_;
        TabHead* tab = tabs_[static_cast<size_t>(i)];
        panels_[static_cast<size_t>(i)]->setVisible(selected);
        if (selected) {
            tab->raise();
            tab->setPictureFile(skinFile(hidden_.skn, QStringLiteral("_selected.jpg")));
        } else {
            tab->setPictureFile(skinFile(hidden_.skn, QStringLiteral("_unselect.jpg")));
            tab->setBackground(kUnselectedTabColour);
        }
        tab->resize(kTabHeadWidth, kTabHeadHeight);
    }
}

void MainWindow::selectTab(int index) {
    if (index < 0 || index >= kTabCount) {
        return;
    }
    currentTab_ = index;
    paintTabs();
    update();
}

void MainWindow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), palette().color(QPalette::Window));
    if (!background_.isNull()) {
        painter.drawPixmap(0, 0, background_);
    }
}

QCheckBox* MainWindow::categoryCheck(int switchIndex) const {
    return checks_.at(static_cast<size_t>(switchIndex));
}

ClickableLabel* MainWindow::categoryLabel(int switchIndex) const {
    return categoryLabels_.at(static_cast<size_t>(switchIndex));
}

QRadioButton* MainWindow::optionButton(OptionArray array, int index) const {
    for (const OptionWidgets& option : options_) {
        if (option.array == array && option.index == index) {
            return option.button;
        }
    }
    return nullptr;
}

ClickableLabel* MainWindow::optionLabel(OptionArray array, int index) const {
    for (const OptionWidgets& option : options_) {
        if (option.array == array && option.index == index) {
            return option.label;
        }
    }
    return nullptr;
}

void MainWindow::onOptionClicked(OptionArray array, int index) {
    // Clicking an option button always chooses it; its container's other buttons clear.
    selection_.setOptionValue(array, index, true);
    showSelection();
}

void MainWindow::showSelection() {
    for (const catalog::PatchCategory& category : catalog::Categories()) {
        QCheckBox* check = checks_[static_cast<size_t>(category.switchIndex)];
        const int value = selection_.switchValue(category.switchIndex);
        // A stored value other than 0 and 1 shows as greyed; only 1 counts as on.
        check->setTristate(value != 0 && value != 1);
        check->setCheckState(value == 0   ? Qt::Unchecked
                             : value == 1 ? Qt::Checked
                                          : Qt::PartiallyChecked);
    }
    for (const OptionWidgets& option : options_) {
        option.button->setChecked(selection_.optionValue(option.array, option.index));
    }
}

void MainWindow::loadSettings() {
    catalog::Settings settings{gameFolder_->text().toStdString(),
                               hotkey_->currentText().toStdString(), selection_};
    if (const Status loaded = catalog::LoadSettings(toolFolder_, settings); !loaded) {
        services_.dialogs->ShowMessage(
            this, NoticeTitle(),
            QStringLiteral("%1\nĐang dùng thiết lập mặc định.").arg(FromUtf8(loaded.reason())),
            Dialogs::Icon::Warning);
    }
    gameFolder_->setText(QString::fromStdString(settings.gameFolder));
    hotkey_->setCurrentText(QString::fromStdString(settings.hotkey));
    selection_ = settings.selection;
    showSelection();
}

catalog::Settings MainWindow::currentSettings() const {
    return {gameFolder_->text().toStdString(), hotkey_->currentText().toStdString(), selection_};
}

void MainWindow::saveSettings() {
    const Status saved = catalog::SaveSettings(toolFolder_, currentSettings());
    if (!saved) {
        services_.dialogs->ShowMessage(
            this, NoticeTitle(),
            QStringLiteral("Không lưu được thiết lập!\n%1").arg(FromUtf8(saved.reason())),
            Dialogs::Icon::Warning);
        return;
    }
    services_.dialogs->ShowPopup(hidden_.text2, 2);
}

void MainWindow::pollHotkey() {
    if (poll_ && !applying_ && poll_->Tick(hotkey_->currentText().toStdString())) {
        applyPatchesNow();
    }
}

void MainWindow::applyPatchesNow() {
    if (applying_) {
        return;  // A run and its messages finish before the next one starts.
    }
    applying_ = true;
    const engine::ApplyOutcome outcome =
        engine::ApplyPatches(toolFolder_, gameFolder_->text().toStdString(), selection_, ui_);
    applying_ = false;
    const std::vector<engine::StepOutcome> failures = outcome.Failures();
    if (failures.empty()) {
        return;
    }
    QStringList lines;
    for (const engine::StepOutcome& failure : failures) {
        lines << StepLine(failure);
    }
    services_.dialogs->ShowNotice(
        this, NoticeTitle(),
        QStringLiteral("Đã chép xong, nhưng %1 bước không thành công:\n%2")
            .arg(failures.size())
            .arg(lines.join(QLatin1Char('\n'))));
}

void MainWindow::launchGame() {
    if (services_.launchGame(gameFolder_->text().toStdString(), ui_) !=
        engine::LaunchResult::Started) {
        return;
    }
    hideToTray();
    services_.dialogs->ShowPopup(hidden_.tAlert, 2);
}

void MainWindow::browseGameFolder() {
    if (auto folder = services_.dialogs->PickFolder(
            this, QStringLiteral("Chon thu muc cai dat FIFA Online 2"))) {
        gameFolder_->setText(*folder);
    }
}

void MainWindow::quickLoad() {
    if (auto folder = services_.dialogs->PickFolder(
            this, QStringLiteral("Ho tro nap nhanh cac file Face va Ball"))) {
        hidden_.cpn = *folder;
    }
    const engine::QuickLoadOutcome outcome =
        engine::QuickLoad(toolFolder_, hidden_.cpn.toStdString(), ui_);
    if (!outcome.failures.empty()) {
        QStringList lines;
        for (const std::string& failure : outcome.failures) {
            lines << QStringLiteral("• ") + FromUtf8(failure);
        }
        services_.dialogs->ShowNotice(
            this, NoticeTitle(),
            QStringLiteral("Một số file không chép được:\n") + lines.join(QLatin1Char('\n')));
    }
}

SkinLook LightSkin() {
    return {QStringLiteral("skin1"), kEntryBackground, Qt::black, kLabelBackground};
}

SkinLook DarkSkin() {
    // The labels take the system's menu text colour as their background.
    return {QStringLiteral("skin2"), QColor(0x40, 0x40, 0x40), Qt::white,
            QApplication::palette().color(QPalette::Active, QPalette::WindowText)};
}

QColor MainWindow::labelTextColour() const {
    return categoryLabels_[0]->palette().color(QPalette::WindowText);
}

void MainWindow::closeEvent(QCloseEvent* event) {
    // Closing the window ends the tool; its tray icon goes with it at once.
    tray_->Remove();
    QWidget::closeEvent(event);
    emit closed();
}

void MainWindow::startFade(int target, int step) {
    fade_.Start(target, step);
    fadeTimer_.start();
}

void MainWindow::fadeTick() {
    const FadeModel::Tick tick = fade_.Step();
    setWindowOpacity(tick.alpha / 255.0);
    if (tick.ended) {
        fadeTimer_.stop();
        QApplication::beep();
    }
}

TranslucentResult MainWindow::makeTranslucent(int alpha) {
    if (alpha < 0 || alpha > 255) {
        return TranslucentResult::OutOfRange;
    }
    setWindowOpacity(alpha / 255.0);
    return TranslucentResult::Applied;
}

void MainWindow::applySkin(const SkinLook& look) {
    LoadPicture(background_, skinFile(look.name, QStringLiteral("_bg.jpg")));
    layoutPanels(skinFile(look.name, QStringLiteral("_panel.jpg")));
    for (size_t i = 0; i < checks_.size(); ++i) {
        Paint(checks_[i], look.entryBackground);
        Paint(categoryLabels_[i], look.labelBackground, look.labelText);
    }
    for (const OptionWidgets& option : options_) {
        Paint(option.button, look.entryBackground);
        Paint(option.label, look.labelBackground, look.labelText);
    }
    for (PictureBox* frame : groupFrames_) {
        frame->setBackground(look.entryBackground);
    }
    // Headings on the panels and in the frames, and the hotkey's caption, follow the labels' text
    // colour, so they stay readable on the dark pictures of skin 2.
    QList<QLabel*> headings{hotkeyLabel_};
    for (PictureBox* panel : panels_) {
        headings += panel->findChildren<QLabel*>();
    }
    for (QLabel* heading : headings) {
        if (!qobject_cast<ClickableLabel*>(heading)) {
            QPalette palette = heading->palette();
            palette.setColor(QPalette::WindowText, look.labelText);
            heading->setPalette(palette);
        }
    }
    hidden_.skn = look.name;
    paintTabs();
    update();
    services_.dialogs->ShowPopup(hidden_.skintxt, 1);
}

void MainWindow::showPreview(catalog::LabelArray labels, int index) {
    const std::filesystem::path picture = PreviewPicture(toolFolder_, labels, index);
    if (picture.empty()) {
        return;
    }
    if (!preview_) {
        preview_ = new PreviewWindow(this);
    }
    preview_->show();
    preview_->raise();
    preview_->ShowPicture(picture);
}

void MainWindow::hideToTray() {
    // Without a tray host the window could not come back from hiding; it minimises instead.
    if (tray_->Shown()) {
        hide();
    } else {
        showMinimized();
    }
}

void MainWindow::runHidden() {
    startFade(150, -15);
    hideToTray();
    services_.dialogs->ShowPopup(hidden_.tAlert, 2);
}

void MainWindow::showFromTray() {
    showNormal();
    raise();
    activateWindow();
    startFade(255, 15);
}

void MainWindow::launchGameFromTray() {
    services_.launchGame(gameFolder_->text().toStdString(), ui_);
}

QWidget* MainWindow::showSideWindow(QPointer<QWidget>& window, QWidget* (*create)(QWidget*)) {
    if (!window) {
        window = create(this);
    }
    window->show();
    window->raise();
    return window;
}

void MainWindow::showAbout() {
    showSideWindow(about_, CreateAboutWindow);
}

void MainWindow::showHelp() {
    showSideWindow(helpWindow_, CreateHelpWindow);
}

void MainWindow::exitFromTray() {
    tray_->Remove();
    emit exitRequested();
}

}  // namespace kickvane::shell
