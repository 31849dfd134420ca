// Draws the tool's artwork into the tool folder given as the only argument.
#include <QGuiApplication>
#include <cstdio>
#include <filesystem>
#include <system_error>

#include "artwork.h"
#include "drawing.h"

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: %s TOOL_FOLDER\n", argv[0]);
        return 2;
    }
    // Runs in the build, where there is no display.
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);

    namespace fs = std::filesystem;
    const fs::path tool = argv[1];
    std::error_code error;
    for (const char* folder : {"skin", "img", "icons"}) {
        fs::create_directories(tool / folder, error);
        if (error) {
            std::fprintf(stderr, "cannot create %s: %s\n", (tool / folder).c_str(),
                         error.message().c_str());
            return 1;
        }
    }
    if (!kickvane::artwork::LoadFonts()) {
        std::fprintf(stderr,
                     "DejaVu fonts missing in /usr/share/fonts/truetype/dejavu/ "
                     "(package fonts-dejavu-core)\n");
        return 1;
    }
    using namespace kickvane::artwork;
    const bool written = WriteSkins(tool) && WritePreviews(tool) && WriteIcons(tool) &&
                         WriteChime(tool / "sound.wav");
    if (!written) {
        std::fprintf(stderr, "cannot write the artwork into %s\n", tool.c_str());
        return 1;
    }
    return 0;
}
