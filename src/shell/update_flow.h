#pragma once

#include <QDesktopServices>
#include <QObject>
#include <QPointer>
#include <QString>
#include <QUrl>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "session/session.h"
#include "shell/dialogs.h"
#include "shell/update_fetcher.h"
#include "text/update_answer.h"

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

// What the window's update buttons do. The window creates the buttons (check visible, download
// hidden) and connects their clicks to check() and download(). The fetched version and link go
// to the session; buttons and session must outlive the flow.
class UpdateFlow final : public QObject {
    Q_OBJECT
public:
    using UrlOpener = std::function<bool(const QUrl&)>;

    UpdateFlow(UpdateFetchOptions options, session::Session& session, Dialogs& dialogs,
               QWidget* owner, QPushButton* checkButton, QPushButton* downloadButton,
               UrlOpener openUrl = &QDesktopServices::openUrl, QObject* parent = nullptr);
    ~UpdateFlow() override;

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

    // Starts a fetch, loading the fetcher first; false when it cannot be loaded.
    bool fetch(UpdateFetcher::File file);
    void onFetched(UpdateFetcher::File file, bool fetched, const QString& textOrReason);
    void onVersion(const QString& text);
    void onVersionFailed(const QString& reason);
    void showMessage(const QString& text, Dialogs::Icon icon);

    UpdateFetchOptions options_;
    std::unique_ptr<UpdateFetcher> updates_;  // loaded by the first check
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
