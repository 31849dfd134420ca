#pragma once

#include <QString>
#include <QUrl>
#include <chrono>
#include <functional>
#include <memory>

namespace kickvane::shell {

// Where and how the update check asks.
struct UpdateFetchOptions {
    QUrl host;  // scheme and host of the update host; any path is ignored
    std::chrono::milliseconds timeout{10000};  // for a whole fetch, redirects included
    qint64 maxBytes = 64 * 1024;
};

// KICKVANE_UPDATE_HOST from the environment when set, else the host the build was made for.
QUrl defaultUpdateHost();
// The options the tool runs with: the default host, 10 s and 64 KiB per fetch.
UpdateFetchOptions defaultUpdateOptions();

inline bool isWebScheme(const QString& scheme) {
    return scheme.compare(u"http", Qt::CaseInsensitive) == 0 ||
           scheme.compare(u"https", Qt::CaseInsensitive) == 0;
}

// Fetches the update host's version file and link file without blocking. The code behind it
// needs Qt Network, which a window that never checks never loads: where the window is a module,
// the fetcher is a module of its own beside it, loaded by the first check.
class UpdateFetcher {
public:
    enum class File { Version, Link };
    // How a fetch ended, from the event loop: the text fetched, or why it failed (Vietnamese).
    using Done = std::function<void(File file, bool fetched, const QString& textOrReason)>;

    virtual ~UpdateFetcher() = default;
    // Starts a fetch; one still running for the same file is dropped without a word.
    virtual void fetch(File file) = 0;
};

// A fetcher reporting to `done`; null, with `error` saying why, when its code cannot be loaded.
std::unique_ptr<UpdateFetcher> makeUpdateFetcher(const UpdateFetchOptions& options,
                                                 UpdateFetcher::Done done, QString& error);

}  // namespace kickvane::shell
