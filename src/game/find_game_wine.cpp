#include "game/find_game.h"

#include <set>
#include <system_error>

#include "game/game_managers.h"
#include "platform/filesystem.h"
#include "platform/windows_path.h"

namespace kickvane::game {

namespace {

constexpr std::string_view kLauncherName = "Gameloader.exe";

// "~/..." for folders below the home folder, to keep sources short.
std::string Shorten(const fs::path& path, const fs::path& home) {
    const std::string text = path.string();
    const std::string homeText = home.string();
    if (homeText.empty() || text.size() <= homeText.size() || !text.starts_with(homeText) ||
        text[homeText.size()] != '/') {
        return text;
    }
    std::string shortened(1, '~');
    shortened.append(text, homeText.size());
    return shortened;
}

GameSource SourceOf(const ManagedPrefix& entry, const fs::path& home) {
    GameSource source;
    source.kind = GameSource::Kind::ManagerProgram;
    source.manager = entry.manager;
    source.flatpak = entry.flatpak;
    source.name = entry.name;
    source.configFile = Shorten(entry.configFile, home);
    return source;
}

class Finder {
public:
    Finder(const UserFolders& folders, const SearchLimits& limits, const std::atomic<bool>* cancel)
        : folders_(folders), limits_(limits), cancel_(cancel) {}

    FindOutcome Run() {
        ManagerScan scan = ScanGameManagers(folders_);
        outcome_.looked = std::move(scan.looked);
        outcome_.skipped = std::move(scan.skipped);
        for (const ManagedPrefix& entry : scan.entries) {
            if (Cancelled()) {
                break;
            }
            const GameSource source = SourceOf(entry, folders_.home);
            if (!entry.executable.empty()) {
                // The program the manager starts, or the launcher beside it.
                const fs::path folder = entry.executable.parent_path();
                if (const auto launcher = platform::FindEntryIgnoringCase(folder, kLauncherName);
                    launcher && platform::IsRegularFile(*launcher)) {
                    Add(folder, entry.prefix, source);
                }
            }
            if (!entry.prefix.empty()) {
                SearchPrefix(entry.prefix, source);
            }
        }
        outcome_.cancelled = Cancelled();
        return std::move(outcome_);
    }

private:
    bool Cancelled() const { return cancel_ != nullptr && cancel_->load(); }

    void Add(const fs::path& folder, const fs::path& prefix, const GameSource& source) {
        std::error_code error;
        fs::path canonical = fs::canonical(folder, error);
        if (error) {
            canonical = folder.lexically_normal();
        }
        if (found_.insert(canonical).second) {
            outcome_.games.push_back({canonical, prefix, source});
        }
    }

    void SearchPrefix(const fs::path& prefix, GameSource source) {
        std::error_code error;
        const fs::path canonical = fs::canonical(prefix, error);
        if (error || !searched_.insert(canonical).second) {
            return;
        }
        for (const RecordedInstall& install : ReadRecordedInstalls(prefix, outcome_.skipped)) {
            const std::optional<fs::path> mapped =
                platform::WindowsPathInPrefix(prefix, install.windowsFolder);
            if (!mapped) {
                continue;
            }
            const fs::path folder = platform::ResolveCaseInsensitive(*mapped);
            if (const auto launcher = platform::FindEntryIgnoringCase(folder, kLauncherName);
                launcher && platform::IsRegularFile(*launcher)) {
                GameSource recorded = source;
                recorded.kind = GameSource::Kind::RegistryEntry;
                recorded.registryFile = install.registryFile;
                recorded.place = install.key;
                recorded.value = install.valueName;
                Add(folder, prefix, recorded);
            }
        }
        const fs::path driveC = prefix / "drive_c";
        const TreeSearch search = SearchTreeForFile(driveC, kLauncherName, limits_, cancel_);
        source.kind = GameSource::Kind::PrefixSearch;
        for (const fs::path& folder : search.folders) {
            Add(folder, prefix, source);
        }
        if (search.cutShort && !Cancelled()) {
            outcome_.cutShort = true;
            outcome_.skipped.push_back({driveC, SkipReason::SearchCut, search.entriesSeen, {}, {}});
        }
    }

    const UserFolders& folders_;
    const SearchLimits& limits_;
    const std::atomic<bool>* cancel_;
    FindOutcome outcome_;
    std::set<fs::path> found_;
    std::set<fs::path> searched_;
};

}  // namespace

FindOutcome FindGame(const UserFolders& folders, const SearchLimits& limits,
                     const std::atomic<bool>* cancel) {
    return Finder(folders, limits, cancel).Run();
}

}  // namespace kickvane::game
