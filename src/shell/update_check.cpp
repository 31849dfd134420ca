#include "shell/update_check.h"

#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QNetworkRequest>
#include <string_view>
#include <utility>

#include "shell/fetch_problem.h"
#include "text/update_answer.h"

namespace kickvane::shell {

namespace {

int defaultPort(const QString& scheme) {
    return scheme.compare(u"https", Qt::CaseInsensitive) == 0 ? 443 : 80;
}

const QString kTimedOut = fetchProblemText(FetchProblem::TimedOut);
const QString kTooLarge = fetchProblemText(FetchProblem::TooLarge);
const QString kRedirectRefused = fetchProblemText(FetchProblem::RedirectRefused);
const QString kTooManyRedirects = fetchProblemText(FetchProblem::TooManyRedirects);
const QString kBadHost = fetchProblemText(FetchProblem::BadHost);

}  // namespace

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
        text::ReadFetchedText(std::string_view(body.constData(), static_cast<size_t>(body.size()))));
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

namespace {

// UpdateCheck's signals, passed on to the fetcher's caller.
class SignalledFetcher final : public UpdateFetcher {
public:
    SignalledFetcher(const UpdateFetchOptions& options, Done done)
        : check_(options), done_(std::move(done)) {
        QObject::connect(&check_, &UpdateCheck::versionFetched, &check_,
                         [this](const QString& text) { done_(File::Version, true, text); });
        QObject::connect(&check_, &UpdateCheck::versionFailed, &check_,
                         [this](const QString& reason) { done_(File::Version, false, reason); });
        QObject::connect(&check_, &UpdateCheck::linkFetched, &check_,
                         [this](const QString& text) { done_(File::Link, true, text); });
        QObject::connect(&check_, &UpdateCheck::linkFailed, &check_,
                         [this](const QString& reason) { done_(File::Link, false, reason); });
    }

    void fetch(File file) override {
        file == File::Version ? check_.fetchVersion() : check_.fetchLink();
    }

private:
    UpdateCheck check_;
    Done done_;
};

}  // namespace

std::unique_ptr<UpdateFetcher> createUpdateFetcher(const UpdateFetchOptions& options,
                                                   UpdateFetcher::Done done) {
    return std::make_unique<SignalledFetcher>(options, std::move(done));
}

}  // namespace kickvane::shell
