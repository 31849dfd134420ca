// A build without the window system: the window and the gallery are not there.
#include <iostream>

#include "commands.h"

namespace kickvane::app {

int RunWindowCommand(int&, char**, Args) {
    PrintUsage(std::cout);
    return 0;
}

int RunSkinGallery(Args) {
    std::cerr << "kickvane: this build has no window system\n";
    return 2;
}

}  // namespace kickvane::app
