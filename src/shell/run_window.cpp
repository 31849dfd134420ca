#include "shell/run_window.h"

#include <QApplication>
#include <QFont>
#include <QScreen>
#include <QSocketNotifier>
#include <QTimer>

#include "platform/single_instance.h"
#include "platform/sound.h"
#include "platform/stop_signals.h"
#include "popup/popup_model.h"
#include "shell/dialogs.h"
#include "shell/main_window.h"
#include "shell/message_box.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

constexpr std::string_view kAlreadyRunningVni = "U71ng du5ng d9ang cha5y ro62i ma2";

const QString kNoGlobalKeysText = QStringLiteral(
    "Không đọc được phím tắt toàn cục trong phiên làm việc này (không có máy chủ X).\n"
    "Hãy gắn lệnh \"kickvane trigger\" vào một phím tắt của màn hình nền: lệnh này chép các bộ "
    "đồ hoạ đã chọn vào game, như khi nhấn phím tắt.");

void centreOnScreen(QWidget& window) {
    if (const QScreen* screen = QGuiApplication::primaryScreen()) {
        const QRect area = screen->availableGeometry();
        window.move(area.center() - QPoint(window.width() / 2, window.height() / 2));
    }
}

}  // namespace

void useReadableFonts() {
    // A Wine prefix without Wine's own fonts has neither the system's dialog font ("MS Shell
    // Dlg", which Wine maps to Tahoma) nor Tahoma. Qt then takes the first family by name, which
    // can be DejaVu's math font: its Windows line height is four times its size, and line edits,
    // which centre their text by that height, draw it above the box. Sans-serif families with
    // Vietnamese letters stand in instead; where the named font exists they are never used.
    const QStringList readable{QStringLiteral("Tahoma"),
                               QStringLiteral("Segoe UI"),
                               QStringLiteral("Microsoft Sans Serif"),
                               QStringLiteral("Arial"),
                               QStringLiteral("DejaVu Sans"),
                               QStringLiteral("Liberation Sans"),
                               QStringLiteral("Noto Sans")};
    for (const QString& family :
         {QApplication::font().family(), toQString(popup::kPopupFontFamily)}) {
        QStringList others = readable;
        others.removeAll(family);
        QFont::insertSubstitutions(family, others);
    }
}

int runWindow(int& argc, char** argv, const std::filesystem::path& toolFolder) {
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("Kickvane"));
    useReadableFonts();
    useVietnameseQtTexts();

    const std::unique_ptr<platform::SingleInstance> instance = platform::AcquireSingleInstance();
    if (!instance) {
        showVniMessage(kAlreadyRunningVni, kNoticeTitleVni, MessageIcon::Information, nullptr);
        return 0;
    }

    QtDialogs dialogs;
    ShellServices services;
    services.dialogs = &dialogs;
    services.playSound = platform::PlaySoundAsync;
    session::Session session(toolFolder, platform::CreateKeySampler());

    MainWindow window(session, std::move(services));
    // The tool lives on in the tray while its window is hidden; closing the window or "Thoát"
    // in the tray menu ends it.
    QApplication::setQuitOnLastWindowClosed(false);
    QObject::connect(&window, &MainWindow::exitRequested, &app, &QApplication::quit,
                     Qt::QueuedConnection);
    QObject::connect(&window, &MainWindow::closed, &app, &QApplication::quit, Qt::QueuedConnection);

    // Commands from later starts: "kickvane trigger" applies the sets as the hotkey does. Where
    // the command channel has no descriptor to watch, it is asked on a timer instead.
    // Triggers that waited together (sent while the window was busy) make one run.
    auto takeCommands = [&] {
        bool triggered = false;
        while (const std::optional<std::string> command = instance->TakeCommand()) {
            triggered = triggered || *command == kTriggerCommand;
        }
        if (triggered) {
            window.applyPatchesNow();
        }
    };
    std::unique_ptr<QSocketNotifier> commandNotifier;
    QTimer commandTimer;
    if (instance->CommandDescriptor() >= 0) {
        commandNotifier =
            std::make_unique<QSocketNotifier>(instance->CommandDescriptor(), QSocketNotifier::Read);
        QObject::connect(commandNotifier.get(), &QSocketNotifier::activated, &window, takeCommands);
    } else {
        QObject::connect(&commandTimer, &QTimer::timeout, &window, takeCommands);
        commandTimer.start(200);
    }

    // SIGTERM, SIGINT and SIGHUP end the tool as "Thoát" does: the tray icon and the command
    // socket go, nothing is saved.
    std::unique_ptr<QSocketNotifier> stopNotifier;
    if (const int stopRequests = platform::WatchStopRequests(); stopRequests >= 0) {
        stopNotifier = std::make_unique<QSocketNotifier>(stopRequests, QSocketNotifier::Read);
        QObject::connect(stopNotifier.get(), &QSocketNotifier::activated, &window,
                         [&window] { window.exitFromTray(); });
    }

    centreOnScreen(window);
    window.show();
    if (!session.HasGlobalKeys()) {
        QTimer::singleShot(0, &window,
                           [&] { dialogs.showNotice(&window, noticeTitle(), kNoGlobalKeysText); });
    }
    return QApplication::exec();
}

}  // namespace kickvane::shell
