#include "shell/update_flow.h"

#include <QPushButton>
#include <QWidget>
#include <utility>

#include "shell/message_box.h"
#include "shell/qt_text.h"
#include "text/vni.h"

#ifndef KICKVANE_UPDATE_HOST
#define KICKVANE_UPDATE_HOST "http://kickvane.example.net/"
#endif

namespace kickvane::shell {

namespace {

QString fromVni(std::string_view text) {
    return QString::fromStdString(text::VniToUnicodeUtf8(text));
}

// A failure's reason with its last two words joined by a no-break space: a box that wraps it
// carries the last word over together with the one before.
QString withLastWordsHeld(const QString& reason) {
    QString held = reason.trimmed();
    if (const qsizetype lastBlank = held.lastIndexOf(QLatin1Char(' ')); lastBlank > 0) {
        held[lastBlank] = QChar::Nbsp;
    }
    return held;
}

}  // namespace

QUrl defaultUpdateHost() {
    const QString fromEnvironment = qEnvironmentVariable("KICKVANE_UPDATE_HOST").trimmed();
    return QUrl(fromEnvironment.isEmpty() ? QString::fromUtf8(KICKVANE_UPDATE_HOST)
                                          : fromEnvironment);
}

UpdateFetchOptions defaultUpdateOptions() {
    UpdateFetchOptions options;
    options.host = defaultUpdateHost();
    return options;
}

bool isCurrentVersion(std::string_view text) {
    return VersionFromAnswer(text) == kToolVersion;
}

QString checkFailedText(const QString& reason) {
    return QStringLiteral("Không kiểm tra được phiên bản mới:\n") + withLastWordsHeld(reason);
}

QString newerVersionText(std::string_view version) {
    // Only the tool's own VNI-typed words are converted: a fetched "beta1" must not become
    // "betá".
    return fromVni("D9a4 co1 phie6n ba3n mo71i! ") + toQString(version);
}

UpdateFlow::UpdateFlow(UpdateFetchOptions options, session::Session& session, Dialogs& dialogs,
                       QWidget* owner, QPushButton* checkButton, QPushButton* downloadButton,
                       UrlOpener openUrl, QObject* parent)
    : QObject(parent),
      options_(std::move(options)),
      session_(session),
      dialogs_(dialogs),
      owner_(owner),
      checkButton_(checkButton),
      downloadButton_(downloadButton),
      openUrl_(std::move(openUrl)) {}

UpdateFlow::~UpdateFlow() = default;

bool UpdateFlow::fetch(UpdateFetcher::File file) {
    if (!updates_) {
        QString error;
        updates_ = makeUpdateFetcher(
            options_,
            [this](UpdateFetcher::File done, bool fetched, const QString& textOrReason) {
                onFetched(done, fetched, textOrReason);
            },
            error);
        if (!updates_) {
            onFetched(file, false, error);
            return false;
        }
    }
    updates_->fetch(file);
    return true;
}

void UpdateFlow::onFetched(UpdateFetcher::File file, bool fetched, const QString& textOrReason) {
    if (file == UpdateFetcher::File::Version) {
        fetched ? onVersion(textOrReason) : onVersionFailed(textOrReason);
    } else if (fetched) {
        session_.RecordDownloadLink(textOrReason.toStdString());
        link_ = LinkState::Fetched;
        emit linkFinished();
    } else {
        link_ = LinkState::Failed;
        linkFailure_ = textOrReason;
        emit linkFinished();
    }
}

void UpdateFlow::check() {
    if (checking_) {
        return;
    }
    checking_ = true;
    if (checkButton_) {
        checkButton_->setEnabled(false);
    }
    fetch(UpdateFetcher::File::Version);
}

void UpdateFlow::onVersion(const QString& text) {
    // An empty answer, a web page or words are no version: nothing to announce or record.
    const std::optional<std::string> version = VersionFromAnswer(text.toStdString());
    if (!version) {
        checking_ = false;
        if (checkButton_) {
            checkButton_->setEnabled(true);
        }
        showMessage(QStringLiteral("Máy chủ cập nhật trả lời không phải số phiên bản"),
                    Dialogs::Icon::Warning);
        emit checkFinished();
        return;
    }
    checking_ = false;
    if (checkButton_) {
        checkButton_->setEnabled(true);
    }
    if (*version == kToolVersion) {
        session_.KeepVersion(*version);
        showMessage(fromVni("Chu7a co1 phie6n ba3n mo71i"), Dialogs::Icon::Information);
        emit checkFinished();
        return;
    }

    link_ = LinkState::Pending;
    fetch(UpdateFetcher::File::Link);
    if (checkButton_) {
        checkButton_->hide();  // until the tool closes
    }
    // Nothing reads the key back, so a failed write must not keep the user from hearing about
    // the new version.
    (void)session_.RecordNewVersion(*version);
    if (downloadButton_) {
        downloadButton_->show();
    }
    showMessage(newerVersionText(*version), Dialogs::Icon::Information);
    emit checkFinished();
}

void UpdateFlow::onVersionFailed(const QString& reason) {
    checking_ = false;
    if (checkButton_) {
        checkButton_->setEnabled(true);
    }
    showMessage(checkFailedText(reason), Dialogs::Icon::Warning);
    emit checkFinished();
}

void UpdateFlow::download() {
    const std::optional<std::string> link = DownloadLink(session_.Updates().downloadLink);
    const QUrl url = link ? QUrl(QString::fromStdString(*link), QUrl::TolerantMode) : QUrl();
    if (!url.isValid() || !isWebScheme(url.scheme()) || url.host().isEmpty()) {
        if (link_ == LinkState::Pending) {
            showMessage(
                QStringLiteral("Chưa nhận được đường dẫn tải về, xin thử lại sau giây lát."),
                Dialogs::Icon::Information);
        } else if (link_ == LinkState::Failed) {
            showMessage(QStringLiteral("Không lấy được đường dẫn tải về:\n") +
                            withLastWordsHeld(linkFailure_),
                        Dialogs::Icon::Warning);
        } else {
            showMessage(QStringLiteral("Đường dẫn tải về không hợp lệ."), Dialogs::Icon::Warning);
        }
        return;
    }
    if (!openUrl_ || !openUrl_(url)) {
        showMessage(QStringLiteral("Không mở được đường dẫn tải về."), Dialogs::Icon::Warning);
    }
}

void UpdateFlow::showMessage(const QString& text, Dialogs::Icon icon) {
    dialogs_.showMessage(owner_.data(), noticeTitle(), text, icon);
}

}  // namespace kickvane::shell
