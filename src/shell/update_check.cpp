#include "shell/update_check.h"

#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QNetworkRequest>
#include <QPushButton>
#include <QWidget>
#include <utility>

#include "shell/fetch_problem.h"
#include "shell/message_box.h"
#include "shell/qt_text.h"
#include "text/utf.h"
#include "text/vni.h"

#ifndef KICKVANE_UPDATE_HOST
#define KICKVANE_UPDATE_HOST "http://kickvane.example.net/"
#endif

namespace kickvane::shell {

namespace {

bool isWebScheme(const QString& scheme) {
    return scheme.compare(u"http", Qt::CaseInsensitive) == 0 ||
           scheme.compare(u"https", Qt::CaseInsensitive) == 0;
}

int defaultPort(const QString& scheme) {
    return scheme.compare(u"https", Qt::CaseInsensitive) == 0 ? 443 : 80;
}

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

const QString kTimedOut = fetchProblemText(FetchProblem::TimedOut);
const QString kTooLarge = fetchProblemText(FetchProblem::TooLarge);
const QString kRedirectRefused = fetchProblemText(FetchProblem::RedirectRefused);
const QString kTooManyRedirects = fetchProblemText(FetchProblem::TooManyRedirects);
const QString kBadHost = fetchProblemText(FetchProblem::BadHost);

}  // namespace

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

UpdateCheck::UpdateCheck(Options options, QObject* parent)
    : QObject(parent), options_(std::move(options)), network_(new QNetworkAccessManager(this)) {
    for (const File file : {File::Version, File::Link}) {
        Transfer& t = transfer(file);
        t.deadline.setSingleShot(true);
        connect(&t.deadline, &QTimer::timeout, this,
                [this, file] { fail(file, transfer(file).earlyFailure.value_or(kTimedOut)); });
    }
}

UpdateCheck::~UpdateCheck() {
    release(File::Version);
    release(File::Link);
}

QUrl UpdateCheck::defaultHost() {
    const QString fromEnvironment = qEnvironmentVariable("KICKVANE_UPDATE_HOST").trimmed();
    return QUrl(fromEnvironment.isEmpty() ? QString::fromUtf8(KICKVANE_UPDATE_HOST)
                                          : fromEnvironment);
}

UpdateCheck::Options UpdateCheck::defaultOptions() {
    Options options;
    options.host = defaultHost();
    return options;
}

bool UpdateCheck::allowsRedirect(const QUrl& origin, const QUrl& current, const QUrl& target) {
    if (!target.isValid() || !isWebScheme(target.scheme()) || target.host().isEmpty() ||
        target.host().compare(origin.host(), Qt::CaseInsensitive) != 0) {
        return false;
    }
    const bool toHttps = target.scheme().compare(u"https", Qt::CaseInsensitive) == 0;
    if (current.scheme().compare(u"https", Qt::CaseInsensitive) == 0 && !toHttps) {
        return false;  // never back to plain http
    }
    if (target.scheme().compare(origin.scheme(), Qt::CaseInsensitive) == 0) {
        return target.port(defaultPort(target.scheme())) ==
               origin.port(defaultPort(origin.scheme()));
    }
    // From http to https on the same host: the secure service sits on its usual port.
    return toHttps && target.port(443) == 443;
}

QUrl UpdateCheck::address(File file) const {
    QUrl url;
    url.setScheme(options_.host.scheme());
    url.setAuthority(options_.host.authority());
    url.setPath(file == File::Version ? QStringLiteral("/v") : QStringLiteral("/vlink"));
    return url;
}

bool UpdateCheck::isFetching(File file) const {
    return transfer(file).deadline.isActive();
}

void UpdateCheck::fetch(File file) {
    release(file);
    Transfer& t = transfer(file);
    const QUrl url = address(file);
    t.deadline.start(options_.timeout);
    if (!url.isValid() || !isWebScheme(url.scheme()) || url.host().isEmpty()) {
        // Reported from the event loop like every other outcome.
        t.earlyFailure = kBadHost;
        t.deadline.start(0);
        return;
    }
    request(file, url);
}

void UpdateCheck::request(File file, const QUrl& url) {
    QNetworkRequest request(url);
    // A stale answer must never pass for a fresh one, and nothing is kept on disk.
    request.setAttribute(QNetworkRequest::CacheLoadControlAttribute,
                         QNetworkRequest::AlwaysNetwork);
    request.setAttribute(QNetworkRequest::CacheSaveControlAttribute, false);
    // Redirects are followed here, not by Qt, so that each one is checked and counted.
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute,
                         QNetworkRequest::ManualRedirectPolicy);

    Transfer& t = transfer(file);
    QNetworkReply* reply = network_->get(request);
    t.reply = reply;
    t.current = url;
    t.body.clear();
    connect(reply, &QNetworkReply::metaDataChanged, this,
            [this, file, reply] { onMetaData(file, reply); });
    connect(reply, &QNetworkReply::readyRead, this, [this, file, reply] { onData(file, reply); });
    connect(reply, &QNetworkReply::finished, this,
            [this, file, reply] { onFinished(file, reply); });
}

void UpdateCheck::onMetaData(File file, QNetworkReply* reply) {
    if (transfer(file).reply != reply) {
        return;
    }
    const int status = reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    const QVariant length = reply->header(QNetworkRequest::ContentLengthHeader);
    if (status >= 200 && status < 300 && length.isValid() &&
        length.toLongLong() > options_.maxBytes) {
        fail(file, kTooLarge);
    }
}

bool UpdateCheck::takeBody(File file, QNetworkReply* reply) {
    Transfer& t = transfer(file);
    t.body += reply->readAll();
    if (t.body.size() > options_.maxBytes) {
        fail(file, kTooLarge);
        return false;
    }
    return true;
}

void UpdateCheck::onData(File file, QNetworkReply* reply) {
    if (transfer(file).reply == reply) {
        takeBody(file, reply);
    }
}

void UpdateCheck::follow(File file, const QUrl& target) {
    Transfer& t = transfer(file);
    const QUrl next = t.current.resolved(target);
    if (++t.redirects > kMaxRedirects) {
        fail(file, kTooManyRedirects);
    } else if (!allowsRedirect(address(file), t.current, next)) {
        fail(file, kRedirectRefused);
    } else {
        drop(t);
        request(file, next);
    }
}

void UpdateCheck::onFinished(File file, QNetworkReply* reply) {
    Transfer& t = transfer(file);
    if (t.reply != reply || !takeBody(file, reply)) {
        return;
    }
    const QVariant status = reply->attribute(QNetworkRequest::HttpStatusCodeAttribute);
    const int code = status.toInt();
    const QVariant target = reply->attribute(QNetworkRequest::RedirectionTargetAttribute);
    if (code >= 300 && code < 400 && target.isValid()) {
        follow(file, target.toUrl());
    } else if (status.isValid() && (code < 200 || code >= 300)) {
        fail(file, fetchProblemText(FetchProblem::HttpStatus, code));
    } else if (reply->error() != QNetworkReply::NoError) {
        fail(file, networkErrorText(reply->error()));
    } else if (!status.isValid()) {
        fail(file, fetchProblemText(FetchProblem::NotHttp));
    } else {
        succeed(file);
    }
}

void UpdateCheck::release(File file) {
    Transfer& t = transfer(file);
    t.deadline.stop();
    t.earlyFailure.reset();
    t.body.clear();
    t.redirects = 0;
    drop(t);
}

void UpdateCheck::drop(Transfer& t) {
    if (QNetworkReply* reply = t.reply) {
        t.reply = nullptr;
        reply->disconnect(this);
        reply->abort();
        reply->deleteLater();
    }
}

void UpdateCheck::succeed(File file) {
    const QByteArray body = std::move(transfer(file).body);
    release(file);
    const QString text = QString::fromStdString(
        ReadFetchedText(std::string_view(body.constData(), static_cast<size_t>(body.size()))));
    if (file == File::Version) {
        emit versionFetched(text);
    } else {
        emit linkFetched(text);
    }
}

void UpdateCheck::fail(File file, const QString& reason) {
    release(file);
    if (file == File::Version) {
        emit versionFailed(reason);
    } else {
        emit linkFailed(reason);
    }
}

UpdateFlow::UpdateFlow(UpdateCheck::Options options, session::Session& session, Dialogs& dialogs,
                       QWidget* owner, QPushButton* checkButton, QPushButton* downloadButton,
                       UrlOpener openUrl, QObject* parent)
    : QObject(parent),
      updates_(std::move(options)),
      session_(session),
      dialogs_(dialogs),
      owner_(owner),
      checkButton_(checkButton),
      downloadButton_(downloadButton),
      openUrl_(std::move(openUrl)) {
    connect(&updates_, &UpdateCheck::versionFetched, this, &UpdateFlow::onVersion);
    connect(&updates_, &UpdateCheck::versionFailed, this, &UpdateFlow::onVersionFailed);
    connect(&updates_, &UpdateCheck::linkFetched, this, [this](const QString& text) {
        session_.RecordDownloadLink(text.toStdString());
        link_ = LinkState::Fetched;
        emit linkFinished();
    });
    connect(&updates_, &UpdateCheck::linkFailed, this, [this](const QString& reason) {
        link_ = LinkState::Failed;
        linkFailure_ = reason;
        emit linkFinished();
    });
}

void UpdateFlow::check() {
    if (checking_) {
        return;
    }
    checking_ = true;
    if (checkButton_) {
        checkButton_->setEnabled(false);
    }
    updates_.fetchVersion();
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
    updates_.fetchLink();
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
