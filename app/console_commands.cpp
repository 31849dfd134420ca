// A build without the window system: the window and the gallery are not there.
#include <iostream>

#include "commands.h"
#include "platform/program.h"

namespace kickvane::app {

namespace {

// Asked for something that needs the window: says so and lists what this build can do. On
// Windows the program is started without a console of its own, so it joins its parent's first.
int NoWindow() {
    platform::UseParentConsole();
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
