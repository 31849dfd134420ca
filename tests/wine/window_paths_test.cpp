// Folders with Vietnamese names reach the window's commands whole on Windows, where a path made
// from a plain string would be read in the ANSI code page.
#include "shell/qt_text.h"
#include "shell/window_fixture.h"

namespace kickvane::testing {
namespace {

using WindowPathsTest = WindowFixture;

TEST_F(WindowPathsTest, QuickLoadCopiesFromAVietnameseFolderAndOpensThereNextTime) {
    const fs::path toolFolder = dir_ / "Công cụ";
    const fs::path faces = dir_ / "Khuôn mặt";
    fs::create_directories(toolFolder / "data/data2/players/heads/textures");
    fs::create_directories(faces);
    WriteFile(faces / "face1.dds", "face");
    const QString facesText = QStringLiteral("%1/Khuôn mặt").arg(shell::pathToQString(dir_.path()));
    auto window = Open(toolFolder);

    dialogs_.folders = {facesText, std::nullopt};
    Click(window->buttons().quickLoad());
    Click(window->buttons().quickLoad());  // cancelled: loads the same folder again
    EXPECT_EQ(dialogs_.messages, QStringList());
    EXPECT_EQ(dialogs_.popups, QStringList({"Hoàn tất!|2", "Hoàn tất!|2"}));
    ASSERT_EQ(dialogs_.starts.size(), 2);
    EXPECT_EQ(shell::qStringToPath(dialogs_.starts[1]), shell::qStringToPath(facesText));
    EXPECT_TRUE(fs::exists(toolFolder / "data/data2/players/heads/textures/face1.dds"));
}

TEST_F(WindowPathsTest, PathsAndTextRoundTripThroughQt) {
    for (const char* name : {"Khuôn mặt", "Sân vận động", "Cổ động viên", "ASCII"}) {
        const fs::path path = dir_ / name;
        const QString text = shell::pathToQString(path);
        EXPECT_TRUE(text.endsWith(QString::fromUtf8(name))) << name;
        EXPECT_EQ(shell::qStringToPath(text), path) << name;
    }
}

}  // namespace
}  // namespace kickvane::testing
