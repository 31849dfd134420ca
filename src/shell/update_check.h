#pragma once

#include <QByteArray>
#include <QDesktopServices>
#include <QObject>
#include <QPointer>
#include <QString>
#include <QTimer>
#include <QUrl>
#include <array>
#include <chrono>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "session/session.h"
#include "shell/dialogs.h"
#include "text/update_answer.h"

class QNetworkAccessManager;
class QNetworkReply;
class QPushButton;
class QWidget;

namespace kickvane::shell {

inline constexpr std::string_view kToolVersion = "v2.0-demo";

using text::DownloadLink;
using text::ReadFetchedText;
using text::VersionFromAnswer;

// True when the fetched answer names this tool's version (blanks and line ends around it do not
// count).
bool isCurrentVersion(std::string_view text);

// The message for a check that could not be done. Its reason starts a line of its own, and the
// reason's last two words are held together, so that no word stands alone on the last line.
QString checkFailedText(const QString& reason);

// The message for a newer version: the tool's own words, then the version exactly as it came.
QString newerVersionText(std::string_view version);

// Fetches the version file ("v" at the host's root) and the link file ("vlink") from the update
// host, each on its own, without blocking. Answers stay in memory and never come from a cache.
// A fetch that fails, gets an HTTP error status, runs out of time or grows beyond the size limit
// ends in a failure with a reason for the user, never in a text.
class UpdateCheck final : public QObject {
    Q_OBJECT
public:
    struct Options {
        QUrl host;  // scheme and host of the update host; any path is ignored
        std::chrono::milliseconds timeout{10000};  // for a whole fetch, redirects included
        qint64 maxBytes = 64 * 1024;
    };
    enum class File { Version, Link };

    // At most this many redirects are followed, each to the same origin or from http to https
    // on the same host.
    static constexpr int kMaxRedirects = 3;

    explicit UpdateCheck(Options options, QObject* parent = nullptr);
    ~UpdateCheck() override;

    // KICKVANE_UPDATE_HOST from the environment when set, else the host the build was made for.
    static QUrl defaultHost();
    // The options the tool runs with: the default host, 10 s and 64 KiB per fetch.
    static Options defaultOptions();

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

// What the window's update buttons do. The window creates the buttons (check visible, download
// hidden) and connects their clicks to check() and download(). The fetched version and link go
// to the session; buttons and session must outlive the flow.
class UpdateFlow final : public QObject {
    Q_OBJECT
public:
    using UrlOpener = std::function<bool(const QUrl&)>;

    UpdateFlow(UpdateCheck::Options options, session::Session& session, Dialogs& dialogs,
               QWidget* owner, QPushButton* checkButton, QPushButton* downloadButton,
               UrlOpener openUrl = &QDesktopServices::openUrl, QObject* parent = nullptr);

    // Asks the host for its version. The check button stays disabled until the answer is in;
    // a newer version swaps the check button for the download button for good.
    void check();
    // Opens the fetched link in the browser when it is a web address.
    void download();

    bool isChecking() const { return checking_; }

signals:
    void checkFinished();  // the answer or failure has been shown
    void linkFinished();   // the link fetch has ended, fetched or not

private:
    enum class LinkState { NotAsked, Pending, Fetched, Failed };

    void onVersion(const QString& text);
    void onVersionFailed(const QString& reason);
    void showMessage(const QString& text, Dialogs::Icon icon);

    UpdateCheck updates_;
    session::Session& session_;
    Dialogs& dialogs_;
    QPointer<QWidget> owner_;
    QPointer<QPushButton> checkButton_;
    QPointer<QPushButton> downloadButton_;
    UrlOpener openUrl_;
    bool checking_ = false;
    LinkState link_ = LinkState::NotAsked;
    QString linkFailure_;
};

}  // namespace kickvane::shell
