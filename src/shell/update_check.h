#pragma once

#include <QByteArray>
#include <QObject>
#include <QPointer>
#include <QString>
#include <QTimer>
#include <QUrl>
#include <array>
#include <memory>
#include <optional>

#include "shell/update_fetcher.h"

class QNetworkAccessManager;
class QNetworkReply;

namespace kickvane::shell {

// Fetches the version file ("v" at the host's root) and the link file ("vlink") from the update
// host, each on its own, without blocking. Answers stay in memory and never come from a cache.
// A fetch that fails, gets an HTTP error status, runs out of time or grows beyond the size limit
// ends in a failure with a reason for the user, never in a text.
class UpdateCheck final : public QObject {
    Q_OBJECT
public:
    using Options = UpdateFetchOptions;
    using File = UpdateFetcher::File;

    // At most this many redirects are followed, each to the same origin or from http to https
    // on the same host.
    static constexpr int kMaxRedirects = 3;

    explicit UpdateCheck(Options options, QObject* parent = nullptr);
    ~UpdateCheck() override;

    // Whether a fetch that started at `origin` and now stands at `current` may go on to `target`.
    static bool allowsRedirect(const QUrl& origin, const QUrl& current, const QUrl& target);

    QUrl address(File file) const;
    bool isFetching(File file) const;

    // Starts a fetch; one still running for the same file is dropped without a signal.
    void fetchVersion() { fetch(File::Version); }
    void fetchLink() { fetch(File::Link); }

signals:
    void versionFetched(QString text);
    void versionFailed(QString reason);
    void linkFetched(QString text);
    void linkFailed(QString reason);

private:
    struct Transfer {
        QPointer<QNetworkReply> reply;
        QUrl current;  // where the redirects have led so far
        int redirects = 0;
        QByteArray body;
        QTimer deadline;                      // runs while the fetch does
        std::optional<QString> earlyFailure;  // reported when the deadline fires
    };

    void fetch(File file);
    void onMetaData(File file, QNetworkReply* reply);
    void onData(File file, QNetworkReply* reply);
    // Adds what has arrived to the body; false (and the fetch failed) once it is too large.
    bool takeBody(File file, QNetworkReply* reply);
    void request(File file, const QUrl& url);
    void follow(File file, const QUrl& target);
    void onFinished(File file, QNetworkReply* reply);
    void release(File file);  // ends the fetch without a signal
    void drop(Transfer& t);   // lets go of the current reply
    void succeed(File file);
    void fail(File file, const QString& reason);
    Transfer& transfer(File file) { return transfers_[file == File::Version ? 0 : 1]; }
    const Transfer& transfer(File file) const { return transfers_[file == File::Version ? 0 : 1]; }

    Options options_;
    QNetworkAccessManager* network_;
    std::array<Transfer, 2> transfers_;
};

// The fetcher of the update check, built on UpdateCheck.
std::unique_ptr<UpdateFetcher> createUpdateFetcher(const UpdateFetchOptions& options,
                                                   UpdateFetcher::Done done);

}  // namespace kickvane::shell
