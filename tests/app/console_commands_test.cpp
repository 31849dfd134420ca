#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <string_view>

#include "commands.h"

namespace kickvane::app {
namespace {

// What a command printed on the error stream, and its exit code.
struct Ran {
    int code;
    std::string errors;
};

template <typename Command>
Ran Capture(Command command) {
    std::ostringstream captured;
    std::streambuf* previous = std::cerr.rdbuf(captured.rdbuf());
    const int code = command();
    std::cerr.rdbuf(previous);
    return {code, captured.str()};
}

// A build without the window, started without a command or asked for the gallery, fails and
// says why, in Vietnamese, followed by the commands it does have.
TEST(ConsoleOnlyBuild, WindowAndGalleryExitWithCode2AndSayThereIsNoWindow) {
    int argc = 1;
    char name[] = "kickvane";
    char* argv[] = {name, nullptr};
    const std::string_view folder[] = {"--tool-folder", "/tmp"};
    for (const Ran& ran :
         {Capture([&] { return RunWindowCommand(argc, argv, {}); }),
          Capture([&] { return RunWindowCommand(argc, argv, Args(folder)); }), Capture([] {
              const std::string_view out[] = {"sheet.png"};
              return RunSkinGallery(Args(out));
          })}) {
        EXPECT_EQ(ran.code, 2);
        EXPECT_EQ(ran.errors.rfind("kickvane: bản này không có cửa sổ", 0), 0u) << ran.errors;
        EXPECT_NE(ran.errors.find("apply"), std::string::npos) << ran.errors;
    }
}

}  // namespace
}  // namespace kickvane::app
