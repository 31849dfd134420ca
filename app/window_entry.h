#pragma once

#include <optional>
#include <string>

// The entry points of the window's code (the Qt window and the skin gallery). A build for Linux
// puts that code in a module beside the program, loaded only when a window command runs, so the
// other commands start without loading Qt; the Windows program links it in.
extern "C" {
// Runs the window on the tool folder `toolFolder` (UTF-8) until the user ends it.
int kickvane_open_window(int* argc, char** argv, const char* toolFolder);
// Draws every themed control into the picture `outFile` (UTF-8).
int kickvane_draw_skin_gallery(const char* outFile);
}

namespace kickvane::app {

struct WindowEntry {
    decltype(&kickvane_open_window) openWindow = nullptr;
    decltype(&kickvane_draw_skin_gallery) drawSkinGallery = nullptr;
};

// The window's entry points, or nothing with the reason in `error`.
std::optional<WindowEntry> FindWindowEntry(std::string& error);

}  // namespace kickvane::app
