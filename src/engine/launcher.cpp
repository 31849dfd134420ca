#include "engine/launcher.h"

#include "engine/file_ops.h"
#include "platform/filesystem.h"
#include "platform/process.h"

namespace kickvane::engine {

LaunchResult LaunchGame(std::string_view gameFolder, EngineUi& ui) {
    const std::string folderText(gameFolder);
    const std::filesystem::path launcher = platform::ResolveCaseInsensitive(
        platform::NativePathFromUserText(folderText + "\\Gameloader.exe"));
    if (!FileExists(launcher)) {
        ui.Messages().ShowText(ui.Messages().ConvertText(kLauncherMissingVni));
        return LaunchResult::LauncherMissing;
    }
    const std::filesystem::path workingFolder =
        platform::ResolveCaseInsensitive(platform::NativePathFromUserText(folderText));

    Status started = Status::Ok();
    if (platform::IsNativeExecutable(launcher)) {
        started = platform::StartDetached(launcher, {}, workingFolder, true);
    } else {
        const std::filesystem::path wine = platform::FindOnPath("wine");
        if (wine.empty()) {
            ui.Messages().ShowText(kWineMissingText);
            return LaunchResult::WineMissing;
        }
        started = platform::StartDetached(wine, {launcher.string()}, workingFolder, true);
    }
    if (!started) {
        ui.Messages().ShowText(std::string(kStartFailedText) + started.reason());
        return LaunchResult::StartFailed;
    }
    return LaunchResult::Started;
}

}  // namespace kickvane::engine
