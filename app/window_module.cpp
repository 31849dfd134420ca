// The window's code behind its C entry points, in the window module or linked into the program.
#include <iostream>

#include "platform/filesystem.h"
#include "shell/run_window.h"
#include "skin/gallery.h"
#include "window_entry.h"

#if defined(__GNUC__) && !defined(_WIN32)
#define KICKVANE_EXPORT __attribute__((visibility("default")))
#else
#define KICKVANE_EXPORT
#endif

extern "C" KICKVANE_EXPORT int kickvane_open_window(int* argc, char** argv,
                                                    const char* toolFolder) {
    return kickvane::shell::runWindow(*argc, argv, kickvane::platform::PathFromUtf8(toolFolder));
}

extern "C" KICKVANE_EXPORT int kickvane_draw_skin_gallery(const char* outFile) {
    return kickvane::skin::runSkinGallery(kickvane::platform::PathFromUtf8(outFile), std::cerr);
}
