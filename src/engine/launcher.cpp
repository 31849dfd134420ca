#include "engine/launcher.h"

#include "engine/file_ops.h"
#include "platform/filesystem.h"
#include "platform/process.h"
#include "text/vni.h"

namespace kickvane::engine {

namespace {

LaunchOutcome NotStarted(LaunchResult result, std::string text) {
    return {result, text::Message{text::Message::Kind::Component, std::move(text), {}}};
}

}  // namespace

LaunchOutcome LaunchGame(std::string_view gameFolder) {
    const std::string folderText(gameFolder);
    const std::filesystem::path launcher = platform::ResolveCaseInsensitive(
        platform::NativePathFromUserText(folderText + "\\Gameloader.exe"));
    if (!FileExists(launcher)) {
        return NotStarted(LaunchResult::LauncherMissing,
                          text::VniToUnicodeUtf8(kLauncherMissingVni));
    }
    const std::filesystem::path workingFolder =
        platform::ResolveCaseInsensitive(platform::NativePathFromUserText(folderText));

    Status started = Status::Ok();
    if (platform::IsNativeExecutable(launcher)) {
        started = platform::StartDetached(launcher, {}, workingFolder, true);
    } else {
        const std::filesystem::path wine = platform::FindOnPath("wine");
        if (wine.empty()) {
            return NotStarted(LaunchResult::WineMissing, std::string(kWineMissingText));
        }
        started = platform::StartDetached(wine, {launcher.string()}, workingFolder, true);
    }
    if (!started) {
        return NotStarted(LaunchResult::StartFailed,
                          std::string(kStartFailedText) + started.reason());
    }
    return {};
}

}  // namespace kickvane::engine
