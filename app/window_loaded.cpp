// The window's code lives in a module beside the program (in the build and the portable folder) or
// in the installed library folder, and is loaded on first use.
#include <system_error>

#include "platform/filesystem.h"
#include "platform/module.h"
#include "window_entry.h"

namespace kickvane::app {

namespace {

namespace fs = std::filesystem;

// The module's file, or an empty path when it is in neither place.
fs::path ModuleFile(const fs::path& programFolder) {
    for (const fs::path& file :
         {programFolder / KICKVANE_WINDOW_MODULE_NAME,
          programFolder / KICKVANE_WINDOW_MODULE_FROM_PROGRAM / KICKVANE_WINDOW_MODULE_NAME}) {
        std::error_code ec;
        if (fs::is_regular_file(file, ec)) {
            return file;
        }
    }
    return {};
}

}  // namespace

std::optional<WindowEntry> FindWindowEntry(std::string& error) {
    const fs::path programFolder = platform::ProgramFolder();
    const fs::path file = ModuleFile(programFolder);
    if (file.empty()) {
        error = std::string(KICKVANE_WINDOW_MODULE_NAME) + " is missing beside the program in " +
                platform::PathToUtf8(programFolder);
        return std::nullopt;
    }
    static platform::Module module(file);  // loaded once, kept for the process's life
    WindowEntry entry;
    entry.openWindow =
        reinterpret_cast<decltype(entry.openWindow)>(module.Find("kickvane_open_window"));
    entry.drawSkinGallery = reinterpret_cast<decltype(entry.drawSkinGallery)>(
        module.Find("kickvane_draw_skin_gallery"));
    if (!entry.openWindow || !entry.drawSkinGallery) {
        error = module.error();
        return std::nullopt;
    }
    return entry;
}

}  // namespace kickvane::app
