#include "shell/main_window.h"

#include <QApplication>
#include <QCloseEvent>
#include <QPainter>
#include <QTime>
#include <QTimer>
#include <utility>

#include "platform/filesystem.h"
#include "shell/message_box.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

QIcon toolIcon(const std::filesystem::path& toolFolder) {
    QIcon icon;
    for (const char* size : {"16", "32", "64"}) {
        const std::filesystem::path file = platform::ResolveCaseInsensitive(
            toolFolder / "icons" / (std::string("kickvane-") + size + ".png"));
        if (platform::IsRegularFile(file)) {
            icon.addFile(pathToQString(file));
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

}  // namespace

MainWindow::MainWindow(session::Session& session, ShellServices services, QWidget* parent)
    : QWidget(parent, Qt::Window | Qt::WindowTitleHint | Qt::WindowSystemMenuHint |
                          Qt::WindowMinimizeButtonHint | Qt::WindowCloseButtonHint |
                          Qt::MSWindowsFixedSizeDialogHint),
      session_(session),
      services_(std::move(services)),
      outcomes_(*services_.dialogs, this, services_.playSound),
      panels_(new CatalogPanels(this)),
      buttons_(new CommandButtons(this)),
      skins_(session_.ToolFolder(), *panels_),
      sideWindows_(this, session_.ToolFolder()) {
    setWindowTitle(QStringLiteral("Kickvane v2.0"));
    setFixedSize(kClientWidth, kClientHeight);
    QFont small = font();
    small.setPointSizeF(8.5);
    setFont(small);

    // Start-up, in order: the fade-in, the icons, the first panel and tab set-up, the tray icon,
    // the hotkey poll and the session's settings. A step that cannot be done leaves its part as
    // designed; the window still opens.
    fadeTimer_.setInterval(FadeModel::kInterval);
    connect(&fadeTimer_, &QTimer::timeout, this, &MainWindow::fadeTick);
    startFade(240, 15);

    const QIcon icon = toolIcon(session_.ToolFolder());
    setWindowIcon(icon);
    skins_.initialise();
    sideWindows_.keepClearFrom(buttons_->save());

    tray_ = std::make_unique<TrayMenu>(icon, services_.makeTray);
    connectTray();
    tray_->icon().add();

    // A started game is watched for a moment, on a timer that runs only then.
    launchTimer_.setInterval(session::kLaunchWatchInterval);
    connect(&launchTimer_, &QTimer::timeout, this, &MainWindow::watchLaunch);

    // The hotkey is sampled when a key event arrives and, while it is held (or where no events
    // come), on the poll's interval; an idle tool sleeps.
    hotkeyTimer_.setInterval(session::kHotkeyPollInterval);
    connect(&hotkeyTimer_, &QTimer::timeout, this, &MainWindow::pollHotkey);
    if (const int wake = session_.HotkeyWakeDescriptor(); wake >= 0) {
        hotkeyWake_ = std::make_unique<QSocketNotifier>(wake, QSocketNotifier::Read);
        connect(hotkeyWake_.get(), &QSocketNotifier::activated, this, &MainWindow::pollHotkey);
    }
    pollHotkey();

    addGameFinder(panels_->gameFolderBox(), panels_->browseButton(), session_.GameSearchCommand());
    updateFlow_ = std::make_unique<UpdateFlow>(services_.updates, session_, *services_.dialogs,
                                               this, buttons_->checkUpdate(), buttons_->download());
    showSession();
    connectPanels();
    connectButtons();
    panels_->tabHead(panels_->currentTab())->setFocus(Qt::OtherFocusReason);
    if (std::optional<text::Message> problem = session_.SettingsProblem()) {
        // Once the window is up, so the box has its owner on screen.
        QTimer::singleShot(
            0, this, [this, message = std::move(*problem)] { outcomes_.showMessage(message); });
    }
    if (std::optional<text::Message> gone = session_.TakeGoneNotice()) {
        QTimer::singleShot(0, this,
                           [this, message = std::move(*gone)] { outcomes_.showMessage(message); });
    }
}

MainWindow::~MainWindow() {
    // The child widgets go after this part of the window: a box that loses the focus (and so
    // reports its text) while they are destroyed must not call into it any more.
    buttons_->disconnect(this);
    panels_->disconnect(this);
}

void MainWindow::connectPanels() {
    connect(panels_, &CatalogPanels::tabSelected, this, [this] {
        skins_.paintTabs();
        update();
        moveFocusOffHotkey();
    });
    connect(panels_, &CatalogPanels::categoryToggled, this,
            [this](int switchIndex, bool on) { session_.SetCategoryOn(switchIndex, on); });
    connect(panels_, &CatalogPanels::optionChosen, this,
            [this](catalog::OptionArray array, int index) {
                // Clicking an option button always chooses it; its group's others clear.
                session_.ChooseOption(array, index);
                panels_->showSelection(session_.Selection());
            });
    connect(panels_, &CatalogPanels::addedChosen, this,
            [this](catalog::GroupId group, const std::string& name) {
                session_.ChooseAdded(group, name);
                panels_->showSelection(session_.Selection());
            });
    connect(panels_, &CatalogPanels::addedLabelClicked, this,
            [this](catalog::GroupId group, const std::string& name) {
                sideWindows_.showAddedPreview(group, name);
            });
    // While the preview is open, pointing at an added set shows its picture there.
    connect(panels_, &CatalogPanels::addedLabelHovered, this,
            [this](catalog::GroupId group, const std::string& name) {
                if (sideWindows_.preview() && sideWindows_.preview()->isVisible()) {
                    sideWindows_.showAddedPreview(group, name);
                }
            });
    connect(
        panels_, &CatalogPanels::labelClicked, this,
        [this](catalog::LabelArray labels, int index) { sideWindows_.showPreview(labels, index); });
    connect(panels_, &CatalogPanels::gameFolderEdited, this,
            [this](const QString& folder) { session_.SetGameFolder(toUtf8(folder)); });
    connect(panels_, &CatalogPanels::browseRequested, this, &MainWindow::browseGameFolder);
}

void MainWindow::connectButtons() {
    CommandButtons& b = *buttons_;
    connect(&b, &CommandButtons::hotkeyEdited, this, [this](const QString& text) {
        session_.SetHotkeyText(toUtf8(text));
        showHotkey();
    });
    connect(b.save(), &QPushButton::clicked, this, &MainWindow::saveSettings);
    connect(b.launch(), &QPushButton::clicked, this,
            [this] { launchGame(session::LaunchFrom::Window); });
    connect(b.quickLoad(), &QPushButton::clicked, this, &MainWindow::quickLoad);
    connect(b.runHidden(), &QPushButton::clicked, this, &MainWindow::runHidden);
    connect(b.info(), &QPushButton::clicked, this, [this] { sideWindows_.showAbout(); });
    connect(b.help(), &QPushButton::clicked, this, [this] { sideWindows_.showHelp(); });
    connect(b.translucent(), &QPushButton::clicked, this, [this] { makeTranslucent(160); });
    connect(b.checkUpdate(), &QPushButton::clicked, updateFlow_.get(), &UpdateFlow::check);
    connect(b.download(), &QPushButton::clicked, updateFlow_.get(), &UpdateFlow::download);
    connect(b.skin(1), &QPushButton::clicked, this, [this] { applySkin(lightSkin()); });
    connect(b.skin(2), &QPushButton::clicked, this, [this] { applySkin(darkSkin()); });
}

void MainWindow::connectTray() {
    connect(tray_.get(), &TrayMenu::launchRequested, this,
            [this] { launchGame(session::LaunchFrom::Tray); });
    connect(tray_.get(), &TrayMenu::showRequested, this, &MainWindow::showFromTray);
    connect(tray_.get(), &TrayMenu::quickLoadRequested, this, &MainWindow::quickLoad);
    connect(tray_.get(), &TrayMenu::aboutRequested, this, [this] { sideWindows_.showAbout(); });
    connect(tray_.get(), &TrayMenu::failuresRequested, this, &MainWindow::showLastFailures);
    connect(tray_.get(), &TrayMenu::exitRequested, this, &MainWindow::exitFromTray);
}

void MainWindow::showSession() {
    panels_->showGameFolder(toQString(session_.Settings().gameFolder));
    showAddedVariants();
    panels_->showSelection(session_.Selection());
    showHotkey();
}

void MainWindow::showAddedVariants() {
    std::array<QString, catalog::kGroupCount> skipped;
    for (const catalog::VariantGroup& group : catalog::Groups()) {
        skipped[static_cast<size_t>(group.id)] =
            toQString(session::SkippedLine(session_.AddedVariants(), group.id));
    }
    panels_->showAddedVariants(session_.AddedVariants(), skipped);
}

void MainWindow::showHotkey() {
    buttons_->showHotkey(toQString(session_.Settings().hotkey),
                         toQString(session_.HotkeyProblem()));
}

void MainWindow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.fillRect(rect(), palette().color(QPalette::Window));
    if (!skins_.background().isNull()) {
        painter.drawPixmap(0, 0, skins_.background());
    }
}

void MainWindow::pollHotkey() {
    if (applying_) {
        return;
    }
    std::optional<session::ApplyRun> run = session_.PollHotkey();
    if (session_.HotkeyNeedsTicks() != hotkeyTimer_.isActive()) {
        session_.HotkeyNeedsTicks() ? hotkeyTimer_.start() : hotkeyTimer_.stop();
    }
    if (run) {
        showRunAlone(*run);
    }
}

void MainWindow::runAgainIfAsked() {
    if (std::exchange(applyAgain_, false)) {
        QTimer::singleShot(0, this, [this] { applyPatchesNow(); });
    }
}

void MainWindow::applyPatchesNow() {
    if (applying_) {
        // A run and its messages finish before the next one starts; a request meanwhile (the
        // messages' dialogs keep events flowing) runs once after it, however many came.
        applyAgain_ = true;
        return;
    }
    showRunAlone(session_.Apply());
}

void MainWindow::showRunAlone(const session::ApplyRun& run) {
    // A run's box may wait for the user; key events meanwhile stay queued (the wake is off, or it
    // would fire again and again), and a press among them counts once the box is closed.
    applying_ = true;
    if (hotkeyWake_) {
        hotkeyWake_->setEnabled(false);
    }
    showRun(run);
    if (hotkeyWake_) {
        hotkeyWake_->setEnabled(true);
    }
    applying_ = false;
    runAgainIfAsked();
}

void MainWindow::showRun(const session::ApplyRun& run) {
    // The tooltip keeps the last result where no sound is heard.
    const QTime now = QTime::currentTime();
    if (const auto line = session::RunStatusLine(run, {now.hour(), now.minute()})) {
        tray_->icon().setStatusLine(toQString(*line));
    }
    if (!run.failureAlert || isActiveWindow()) {
        if (!run.refused) {
            // The tray's list belongs to the last run only.
            lastFailures_.reset();
            tray_->showFailuresEntry(false);
        }
        outcomes_.show(run.shown);
        return;
    }
    session::Outcome shown = run.shown;
    lastFailures_ = std::move(shown.messages.back());
    shown.messages.pop_back();
    outcomes_.show(shown);
    tray_->showFailuresEntry(true);
    services_.dialogs->showFailureAlert(toQString(run.failureAlert->text),
                                        run.failureAlert->seconds, [this] { showLastFailures(); });
}

void MainWindow::showLastFailures() {
    if (lastFailures_) {
        outcomes_.showMessage(*lastFailures_);
    }
}

void MainWindow::saveSettings() {
    outcomes_.show(session_.Save());
}

void MainWindow::launchGame(session::LaunchFrom from) {
    // While a start is watched, the session starts nothing more and the watch goes on.
    session::LaunchRun run = session_.Launch(from);
    if (!run.watching()) {
        showLaunch(std::move(run));
        return;
    }
    buttons_->showLaunchWatched(true);
    launchTimer_.start();
}

void MainWindow::watchLaunch() {
    std::optional<session::LaunchRun> run = session_.TickLaunch();
    if (!run) {
        return;
    }
    launchTimer_.stop();
    buttons_->showLaunchWatched(false);
    showLaunch(std::move(*run));
}

void MainWindow::showLaunch(session::LaunchRun run) {
    std::optional<session::Popup> popup = std::move(run.shown.popup);
    run.shown.popup.reset();
    outcomes_.show(run.shown);
    if (run.hideToTray && popup) {
        hideAndSay(*popup);
    } else if (popup) {
        outcomes_.showPopup(*popup);
    }
}

void MainWindow::browseGameFolder() {
    if (auto folder = services_.dialogs->pickFolder(
            this, QStringLiteral("Chọn thư mục cài đặt FIFA Online 2"),
            toQString(session_.Settings().gameFolder))) {
        panels_->showGameFolder(*folder);
    }
}

void MainWindow::quickLoad() {
    std::optional<std::filesystem::path> chosen;
    if (auto folder = services_.dialogs->pickFolder(
            this, QStringLiteral("Hỗ trợ nạp nhanh các file Face và Ball"),
            pathToQString(session_.QuickLoadFolder()))) {
        chosen = qStringToPath(*folder);
    }
    outcomes_.show(session_.QuickLoad(std::move(chosen)).shown);
}

void MainWindow::applySkin(const SkinLook& look) {
    skins_.apply(look);
    buttons_->recolour(look);
    update();
    outcomes_.showPopup({std::string(session::kSkinChangedPopupText), 1});
}

void MainWindow::closeEvent(QCloseEvent* event) {
    // Closing the window ends the tool; its tray icon goes with it at once.
    tray_->icon().remove();
    QWidget::closeEvent(event);
    emit closed();
}

void MainWindow::startFade(int target, int step) {
    fade_.start(target, step);
    fadeTimer_.start();
}

void MainWindow::fadeTick() {
    const FadeModel::Tick tick = fade_.advance();
    setAlpha(tick.alpha);
    if (tick.ended) {
        fadeTimer_.stop();
        QApplication::beep();
    }
}

void MainWindow::setAlpha(int alpha) {
    // On Windows a window at full opacity stops being a layered window, and Wine without a window
    // manager then draws another kind of title bar than for the translucent one. Full opacity
    // stays a hair below 1 there, which the system rounds to opaque, so the window stays layered
    // and keeps one title bar.
    static const bool staysLayered = QGuiApplication::platformName() == QLatin1String("windows");
    setWindowOpacity(alpha >= 255 && staysLayered ? 0.999 : alpha / 255.0);
}

TranslucentResult MainWindow::makeTranslucent(int alpha) {
    if (alpha < 0 || alpha > 255) {
        return TranslucentResult::OutOfRange;
    }
    setAlpha(alpha);
    return TranslucentResult::Applied;
}

void MainWindow::moveFocusOffHotkey() {
    // The focus rests in the hotkey box only while the user works in it: where it stayed, a key
    // or the wheel meant for something else would change the hotkey silently.
    const QWidget* focused = focusWidget();
    HotkeyBox* box = buttons_->hotkeyBox();
    if (focused && (focused == box || box->isAncestorOf(focused))) {
        panels_->tabHead(panels_->currentTab())->setFocus(Qt::OtherFocusReason);
    }
}

bool MainWindow::hideToTray() {
    moveFocusOffHotkey();
    // Without a tray host the window could not come back from hiding; it minimises instead.
    if (tray_->icon().shown()) {
        hide();
        return true;
    }
    showMinimized();
    return false;
}

void MainWindow::hideAndSay(const session::Popup& popup) {
    if (hideToTray()) {
        outcomes_.showPopup(popup);
    } else {
        outcomes_.showPopup({std::string(session::kNoTrayPopupText), popup.seconds});
    }
}

void MainWindow::runHidden() {
    startFade(150, -15);
    hideAndSay({std::string(session::kHiddenPopupText), 2});
}

void MainWindow::showFromTray() {
    moveFocusOffHotkey();
    showNormal();
    raise();
    activateWindow();
    startFade(255, 15);
    // Sets dropped into the groups' folders while the window was away show up now.
    const session::Outcome refreshed = session_.RefreshAddedVariants();
    showAddedVariants();
    panels_->showSelection(session_.Selection());
    outcomes_.show(refreshed);
}

void MainWindow::exitFromTray() {
    tray_->icon().remove();
    emit exitRequested();
}

}  // namespace kickvane::shell
