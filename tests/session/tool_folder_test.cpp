#include "session/tool_folder.h"

#include <gtest/gtest.h>

#include "game/fake_home.h"

namespace kickvane::session {
namespace {

namespace fs = std::filesystem;
using testing::FakeHome;
using testing::WriteFile;

// The system install (bin/ and share/kickvane) is the install test's.
TEST(ToolFolder, PortableWhenWritable_ElseUserFolderSeededOnceWithoutOverwriting) {
    FakeHome home;
    const fs::path portable = home / "portable";
    const fs::path user = home / ".local/share";
    const fs::path seeded = user / "kickvane";
    WriteFile(portable / "data/data2/ball/ball.dds", "ball");
    WriteFile(portable / "skin/skin1/a.jpg", "skin");
    WriteFile(portable / "sound.wav", "RIFF");
    const ToolFolderChoice writable =
        ChooseToolFolder(portable, user, [](const fs::path&) { return true; });
    EXPECT_EQ(writable.folder, portable);
    EXPECT_TRUE(writable.seedFrom.empty());
    const ToolFolderChoice readOnly =
        ChooseToolFolder(portable, user, [](const fs::path&) { return false; });
    EXPECT_EQ(readOnly.folder, seeded);
    EXPECT_EQ(readOnly.seedFrom, portable);
    EXPECT_EQ(ChooseToolFolder(home / "bare", user).folder, home / "bare");  // neither layout

    // The user changed a file before the first seeding ended; it is kept. Once seeded, nothing
    // is copied again, not even files the user removed.
    WriteFile(seeded / "sound.wav", "mine");
    ASSERT_TRUE(SeedToolFolder(portable, seeded).ok());
    EXPECT_EQ(testing::ReadText(seeded / "skin/skin1/a.jpg"), "skin");
    EXPECT_EQ(testing::ReadText(seeded / "sound.wav"), "mine");
    fs::remove(seeded / "skin/skin1/a.jpg");
    WriteFile(portable / "data/data2/ball/ball.dds", "new ball");
    ASSERT_TRUE(SeedToolFolder(portable, seeded).ok());
    EXPECT_FALSE(fs::exists(seeded / "skin/skin1/a.jpg"));
    EXPECT_EQ(testing::ReadText(seeded / "data/data2/ball/ball.dds"), "ball");

    WriteFile(home / "file", "x");  // a folder that cannot be created
    EXPECT_FALSE(SeedToolFolder(portable, home / "file/kickvane").ok());
}

}  // namespace
}  // namespace kickvane::session
