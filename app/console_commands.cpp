// A build without the window system: the window and the gallery are not there.
#include <iostream>

#include "commands.h"

namespace kickvane::app {

namespace {

// Asked for something that needs the window: says so and lists what this build can do.
int NoWindow() {
    std::cerr << "kickvane: bản này không có cửa sổ; hãy dùng một trong các lệnh dưới đây.\n\n";
    PrintUsage(std::cerr);
    return 2;
}

}  // namespace

int RunWindowCommand(int&, char**, Args) {
    return NoWindow();
}

int RunSkinGallery(Args) {
    return NoWindow();
}

}  // namespace kickvane::app
