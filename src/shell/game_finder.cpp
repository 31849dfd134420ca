#include "shell/game_finder.h"

#include <QApplication>
#include <QDialog>
#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QVBoxLayout>
#include <memory>

#include "session/game_words.h"
#include "shell/message_box.h"
#include "shell/qt_text.h"

namespace kickvane::shell {

namespace {

constexpr int kButtonWidth = 40;
constexpr int kGap = 4;
const QString kTitle = QStringLiteral("Tìm FIFA Online 2");

// The button's caption; "m" is its mnemonic.
const QString kCaption = QStringLiteral("Tì&m");

// A found folder is kept only once the settings are saved; the finder says so.
const QString kSaveToKeep = QStringLiteral("Bấm \"Lưu thiết lập\" để giữ thư mục này.");

// A message box is some 500 pixels wide at most; the paths in it are laid out narrower, so that
// the box never breaks them itself.
constexpr int kPlaceWidth = 420;

// A path laid out for `widget`'s font in lines of at most `width` pixels, continued lines
// indented.
QString brokenPath(const QString& path, const QWidget& widget, int width) {
    const QFontMetrics metrics = widget.fontMetrics();
    return pathLines(path, width,
                     [&](const QString& text) { return metrics.horizontalAdvance(text); })
        .join(QStringLiteral("\n    "));
}

// A box that does not hold up the window; its text is shown as written.
void openInformation(QWidget* owner, const QString& text) {
    QMessageBox* box = newPlainMessageBox(QMessageBox::Information, kTitle, text, owner);
    box->setAttribute(Qt::WA_DeleteOnClose);
    box->open();
}

// The list of several finds; the chosen folder goes into the box.
void openChoice(QWidget* owner, QLineEdit* box, const std::vector<session::FoundGame>& games) {
    auto* dialog = new QDialog(owner);
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setWindowTitle(kTitle);
    auto* layout = new QVBoxLayout(dialog);
    layout->addWidget(
        new QLabel(QStringLiteral("Tìm thấy nhiều bản FIFA Online 2. Chọn một:"), dialog));
    auto* list = new QListWidget(dialog);
    list->setAccessibleName(QStringLiteral("Các thư mục tìm thấy"));
    list->setMinimumWidth(520);
    const int pathWidth = list->minimumWidth() - 48;  // the frame, the margins, a scroll bar
    for (const session::FoundGame& game : games) {
        auto* item = new QListWidgetItem(brokenPath(pathToQString(game.folder), *list, pathWidth) +
                                         QStringLiteral("\n    ") +
                                         toQString(session::SourceText(game.source)));
        item->setData(Qt::UserRole, pathToQString(game.folder));
        list->addItem(item);
    }
    list->setCurrentRow(0);
    layout->addWidget(list);
    layout->addWidget(new QLabel(kSaveToKeep, dialog));
    auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, dialog);
    buttons->button(QDialogButtonBox::Ok)->setText(QStringLiteral("Chọn"));
    buttons->button(QDialogButtonBox::Cancel)->setText(QStringLiteral("Huỷ"));
    layout->addWidget(buttons);
    QObject::connect(buttons, &QDialogButtonBox::accepted, dialog, &QDialog::accept);
    QObject::connect(buttons, &QDialogButtonBox::rejected, dialog, &QDialog::reject);
    QObject::connect(list, &QListWidget::itemDoubleClicked, dialog, &QDialog::accept);
    QObject::connect(dialog, &QDialog::accepted, box, [box, list] {
        if (const QListWidgetItem* item = list->currentItem()) {
            box->setText(item->data(Qt::UserRole).toString());
        }
    });
    dialog->open();
}

void openNothingFound(QWidget* owner, const session::GameSearchOutcome& outcome) {
    QString text = QStringLiteral("Không tìm thấy Gameloader.exe.\n\nĐã tìm trong:");
    for (const std::string& place : outcome.looked) {
        text += QStringLiteral("\n  ") + brokenPath(toQString(place), *owner, kPlaceWidth);
    }
    if (!outcome.skipped.empty()) {
        text += QStringLiteral("\n\nBỏ qua (không đọc được):");
        for (const session::SkippedFile& skipped : outcome.skipped) {
            text += QStringLiteral("\n  ") +
                    brokenPath(pathToQString(skipped.path), *owner, kPlaceWidth) +
                    QStringLiteral(": ") + toQString(session::SkippedReasonText(skipped));
        }
    }
    openInformation(owner, text);
}

}  // namespace

GameFinderButton::GameFinderButton(QLineEdit* gameFolderBox, session::GameSearch search)
    : QPushButton(kCaption, gameFolderBox->parentWidget()),
      gameFolderBox_(gameFolderBox),
      search_(std::move(search)) {
    setToolTip(
        QStringLiteral("Tìm thư mục cài FIFA Online 2 trong Wine và các trình quản lý game"));
    setAccessibleName(QStringLiteral("Tìm thư mục game"));
    connect(this, &QPushButton::clicked, this, &GameFinderButton::start);
}

GameFinderButton::~GameFinderButton() {
    const bool running = !finished_;
    stopWorker();
    if (running) {
        QApplication::restoreOverrideCursor();
    }
}

void GameFinderButton::stopWorker() {
    cancel_ = true;
    if (worker_.joinable()) {
        worker_.join();
    }
}

void GameFinderButton::start() {
    if (searching()) {
        return;
    }
    stopWorker();
    cancel_ = false;
    finished_ = false;
    setEnabled(false);
    setText(QStringLiteral("…"));
    QApplication::setOverrideCursor(Qt::BusyCursor);
    // The search reads folders that may be slow or huge; the window goes on meanwhile. Its
    // result comes back to the window's thread through the event queue.
    worker_ = std::thread([this, search = search_] {
        auto outcome = std::make_shared<session::GameSearchOutcome>(search(cancel_));
        QMetaObject::invokeMethod(
            this, [this, outcome] { finish(*outcome); }, Qt::QueuedConnection);
    });
}

void GameFinderButton::finish(const session::GameSearchOutcome& outcome) {
    finished_ = true;
    if (worker_.joinable()) {
        worker_.join();
    }
    QApplication::restoreOverrideCursor();
    setText(kCaption);
    setEnabled(true);
    if (outcome.games.size() == 1) {
        const QString folder = pathToQString(outcome.games.front().folder);
        gameFolderBox_->setText(folder);
        openInformation(window(), QStringLiteral("Đã tìm thấy FIFA Online 2:\n    ") +
                                      brokenPath(folder, *this, kPlaceWidth) +
                                      QStringLiteral("\n\n") + kSaveToKeep);
    } else if (outcome.games.size() > 1) {
        openChoice(window(), gameFolderBox_, outcome.games);
    } else {
        openNothingFound(window(), outcome);
    }
    emit searchFinished();
}

QStringList pathLines(const QString& path, int width,
                      const std::function<int(const QString&)>& measure) {
    QStringList lines;
    QString line;
    qsizetype start = 0;
    while (start < path.size()) {
        // One name with the separator after it.
        qsizetype end = start;
        while (end < path.size() && path[end] != u'/' && path[end] != u'\\') {
            ++end;
        }
        while (end < path.size() && (path[end] == u'/' || path[end] == u'\\')) {
            ++end;
        }
        const QString piece = path.mid(start, end - start);
        if (!line.isEmpty() && measure(line + piece) > width) {
            lines << line;
            line.clear();
        }
        line += piece;
        start = end;
    }
    if (!line.isEmpty() || lines.isEmpty()) {
        lines << line;
    }
    return lines;
}

GameFinderButton* addGameFinder(QLineEdit* gameFolderBox, QPushButton* browseButton,
                                session::GameSearch search) {
    auto* button = new GameFinderButton(gameFolderBox, std::move(search));
    QRect box = gameFolderBox->geometry();
    box.setWidth(box.width() - kButtonWidth - kGap);
    gameFolderBox->setGeometry(box);
    button->setGeometry(box.right() + 1 + kGap, browseButton->y(), kButtonWidth,
                        browseButton->height());
    QWidget::setTabOrder(gameFolderBox, button);
    QWidget::setTabOrder(button, browseButton);
    return button;
}

}  // namespace kickvane::shell
