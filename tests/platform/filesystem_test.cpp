#include "platform/filesystem.h"
#include "platform/windows_path.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/file.h>
#include <sys/resource.h>
#include <unistd.h>

#include <atomic>
#include <chrono>
#include <csignal>
#include <fstream>
#include <functional>
#include <thread>

#include "platform/scoped_env.h"
#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

using testing::ReadText;
using testing::TempDir;
using testing::WriteFile;

size_t EntryCount(const fs::path& folder) {
    return static_cast<size_t>(
        std::distance(fs::directory_iterator(folder), fs::directory_iterator()));
}

// Runs `write` while files may grow to two bytes only, so that the write stops part-way.
Status WithTinyFileLimit(const std::function<Status()>& write) {
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit saved{};
    ::getrlimit(RLIMIT_FSIZE, &saved);
    rlimit tiny = saved;
    tiny.rlim_cur = 2;
    ::setrlimit(RLIMIT_FSIZE, &tiny);
    Status status = write();
    ::setrlimit(RLIMIT_FSIZE, &saved);
    return status;
}

TEST(ResolveCaseInsensitive, MatchesEveryComponentAndKeepsSpellingOfMissingTail) {
    TempDir dir;
    WriteFile(dir / "Data2/Ball/Textures/Ball10.DDS", "x");

    EXPECT_EQ(ResolveCaseInsensitive(dir / "data2/ball/textures/ball10.dds"),
              dir / "Data2/Ball/Textures/Ball10.DDS");
    // Below the first missing component the given spelling stays, so new folders get it.
    EXPECT_EQ(ResolveCaseInsensitive(dir / "data2/BALL/new/Deep"), dir / "Data2/Ball/new/Deep");
    // Doubled and trailing separators, as "D:\" + "\data2" gives, name the same folder.
    EXPECT_EQ(ResolveCaseInsensitive(fs::path(dir.path().string() + "//DATA2//ball/")),
              dir / "Data2/Ball");
}

// Of several spellings the exact one wins, else the first in name order. Each folder gets the
// spellings in another order, so that no order of listing can pick the right one every time.
TEST(ResolveCaseInsensitive, OfSeveralSpellingsTakesTheExactElseTheFirstInNameOrder) {
    TempDir dir;
    const std::vector<std::string> spellings{"ball", "bALL", "BaLL", "Ball"};  // "BaLL" first
    for (size_t rotation = 0; rotation < spellings.size(); ++rotation) {
        const fs::path folder = dir / std::to_string(rotation);
        for (size_t i = 0; i < spellings.size(); ++i) {
            fs::create_directories(folder / spellings[(i + rotation) % spellings.size()]);
        }
        EXPECT_EQ(ResolveCaseInsensitive(folder / "BALL"), folder / "BaLL") << rotation;
        EXPECT_EQ(EntriesByFoldedName(folder).at("ball"), "BaLL") << rotation;
        for (const std::string& exact : spellings) {
            EXPECT_EQ(ResolveCaseInsensitive(folder / exact), folder / exact);
        }
    }
}

TEST(ReplaceFile, ReplacesContentTakesSourceTimeAndLeavesNoTemporaryFile) {
    TempDir dir;
    WriteFile(dir / "src/a.dds", "new content");
    WriteFile(dir / "dst/a.dds", "old");
    const auto sourceTime = fs::last_write_time(dir / "src/a.dds") - std::chrono::hours(30);
    fs::last_write_time(dir / "src/a.dds", sourceTime);

    EXPECT_FALSE(IsUpToDateCopy(dir / "src/a.dds", dir / "dst/a.dds"));
    ASSERT_TRUE(ReplaceFile(dir / "src/a.dds", dir / "dst/a.dds").ok());
    EXPECT_EQ(ReadText(dir / "dst/a.dds"), "new content");
    EXPECT_EQ(fs::last_write_time(dir / "dst/a.dds"), sourceTime);
    EXPECT_TRUE(IsUpToDateCopy(dir / "src/a.dds", dir / "dst/a.dds"));
    EXPECT_EQ(EntryCount(dir / "dst"), 1u);
}

TEST(ReplaceFile, ReaderOfTheOldFileKeepsReadingTheWholeOldFile) {
    TempDir dir;
    WriteFile(dir / "src/tex.dds", std::string(100000, 'N'));
    WriteFile(dir / "dst/tex.dds", std::string(50000, 'O'));
    std::ifstream game(dir / "dst/tex.dds", std::ios::binary);  // the running game holds it

    ASSERT_TRUE(ReplaceFile(dir / "src/tex.dds", dir / "dst/tex.dds").ok());
    std::string seen((std::istreambuf_iterator<char>(game)), std::istreambuf_iterator<char>());
    EXPECT_EQ(seen, std::string(50000, 'O'));
    EXPECT_EQ(ReadText(dir / "dst/tex.dds"), std::string(100000, 'N'));
}

TEST(ReplaceFile, FailureLeavesTargetWholeAndNamesThePath) {
    TempDir dir;
    WriteFile(dir / "dst/a.dds", "old");

    Status missingSource = ReplaceFile(dir / "src/none.dds", dir / "dst/a.dds");
    EXPECT_FALSE(missingSource.ok());
    EXPECT_NE(missingSource.reason().find("none.dds"), std::string::npos);

    WriteFile(dir / "src/dir.dds/inner", "x");  // a folder is no file to copy
    EXPECT_FALSE(ReplaceFile(dir / "src/dir.dds", dir / "dst/a.dds").ok());

    WriteFile(dir / "src/a.dds", "new content");
    EXPECT_FALSE(ReplaceFile(dir / "src/a.dds", dir / "missing/a.dds").ok());
    EXPECT_FALSE(
        WithTinyFileLimit([&] { return ReplaceFile(dir / "src/a.dds", dir / "dst/a.dds"); }).ok());

    EXPECT_EQ(ReadText(dir / "dst/a.dds"), "old");
    EXPECT_EQ(EntryCount(dir / "dst"), 1u);
}

TEST(FolderCopy, NewFilesAppearWholeWithTheSourcesModeAndTimeOrNotAtAll) {
    TempDir dir;
    WriteFile(dir / "src/a.dds", "new content");
    fs::permissions(dir / "src/a.dds", fs::perms::owner_read | fs::perms::owner_write |
                                           fs::perms::group_read | fs::perms::others_read);
    const auto sourceTime = fs::last_write_time(dir / "src/a.dds") - std::chrono::hours(30);
    fs::last_write_time(dir / "src/a.dds", sourceTime);
    fs::create_directories(dir / "dst");
    FolderCopy files(dir / "src", dir / "dst");
    bool copied = false;

    // A copy stopped part-way leaves no file under any name.
    EXPECT_FALSE(
        WithTinyFileLimit([&] { return files.Copy("a.dds", "a.dds", false, &copied); }).ok());
    EXPECT_EQ(EntryCount(dir / "dst"), 0u);

    ASSERT_TRUE(files.Copy("a.dds", "A.DDS", false, &copied).ok());
    EXPECT_TRUE(copied);
    EXPECT_EQ(ReadText(dir / "dst/A.DDS"), "new content");
    EXPECT_EQ(fs::last_write_time(dir / "dst/A.DDS"), sourceTime);
    EXPECT_EQ(fs::status(dir / "dst/A.DDS").permissions(),
              fs::status(dir / "src/a.dds").permissions());

    // A name that appeared after the caller looked is replaced all the same.
    WriteFile(dir / "dst/b.dds", "old");
    ASSERT_TRUE(files.Copy("a.dds", "b.dds", false, &copied).ok());
    EXPECT_EQ(ReadText(dir / "dst/b.dds"), "new content");
    EXPECT_EQ(EntryCount(dir / "dst"), 2u);
}

TEST(WriteFileAtomically, ReplacesWholeFileOrLeavesItAsItWas) {
    TempDir dir;
    WriteFile(dir / "settings.ini", "previous");
    ASSERT_TRUE(WriteFileAtomically(dir / "settings.ini", "next").ok());
    EXPECT_EQ(ReadText(dir / "settings.ini"), "next");

    EXPECT_FALSE(WithTinyFileLimit([&] {
                     return WriteFileAtomically(dir / "settings.ini", "longer");
                 }).ok());
    EXPECT_EQ(ReadText(dir / "settings.ini"), "next");
    EXPECT_EQ(EntryCount(dir.path()), 1u);
    EXPECT_FALSE(WriteFileAtomically(dir / "no/such/folder.ini", "x").ok());
}

TEST(TemporaryFiles, FitTheNameLimitAndOnlyThoseNothingWritesAreRemoved) {
    TempDir dir;
    const std::string longName = std::string(247, 'n') + ".dds";  // 251 bytes
    WriteFile(dir / "source.dds", "data");
    ASSERT_TRUE(ReplaceFile(dir / "source.dds", dir / longName).ok());
    ASSERT_TRUE(WriteFileAtomically(dir / longName, "new").ok());
    EXPECT_EQ(ReadText(dir / longName), "new");
    EXPECT_TRUE(IsTooLong(dir / std::string(256, 'n')));
    EXPECT_FALSE(IsTooLong(dir / "missing"));

    const fs::path killed = dir / ".ThietLap.ini.kv-Ab12Cd";
    const fs::path writing = dir / ".ThietLap.ini.kv-x9Y8z7";
    const fs::path other = dir / ".ThietLap.ini.kv-1";  // not one of ours
    for (const fs::path& file : {killed, writing, other}) {
        WriteFile(file, "part");
    }
    // A writer holds its temporary file locked for as long as it writes.
    const int held = ::open(writing.c_str(), O_RDONLY);
    ASSERT_EQ(::flock(held, LOCK_EX), 0);
    // Just written: it may be one whose writer has not locked it yet.
    RemoveStaleTemporaries(dir.path());
    EXPECT_TRUE(fs::exists(killed));
    RemoveStaleTemporaries(dir.path(), std::chrono::seconds(0));
    ::close(held);
    EXPECT_FALSE(fs::exists(killed));
    EXPECT_TRUE(fs::exists(writing));
    EXPECT_TRUE(fs::exists(other));
}

// A cleaner that takes every unlocked temporary file for abandoned, with no regard to its age,
// sweeps the folder over and over while saves run: the lock alone must keep every save whole.
TEST(TemporaryFiles, ASweepNeverRemovesTheFileOfASaveInProgress) {
    TempDir dir;
    const fs::path file = dir / "ThietLap.ini";
    std::atomic<bool> saving{true};
    std::thread sweeper([&] {
        while (saving) {
            RemoveStaleTemporaries(dir.path(), std::chrono::seconds(0));
        }
    });
    int failures = 0;
    std::string firstFailure;
    for (int save = 0; save < 2000; ++save) {
        const Status saved = WriteFileAtomically(file, "save " + std::to_string(save));
        if (!saved.ok() && failures++ == 0) {
            firstFailure = saved.reason();
        }
    }
    saving = false;
    sweeper.join();
    EXPECT_EQ(failures, 0) << firstFailure;
    EXPECT_EQ(ReadText(file), "save 1999");
}

TEST(ListPlainFiles, SkipsFoldersAndHiddenFiles) {
    TempDir dir;
    WriteFile(dir / "b.dds", "x");
    WriteFile(dir / "a.dds", "x");
    WriteFile(dir / ".hidden.dds", "x");
    WriteFile(dir / "heads/textures/face1.dds", "x");
    const std::vector<fs::path> files = ListPlainFiles(dir.path());
    ASSERT_EQ(files.size(), 2u);
    EXPECT_EQ(files[0].filename(), "a.dds");
    EXPECT_EQ(files[1].filename(), "b.dds");
    EXPECT_TRUE(ListPlainFiles(dir / "missing").empty());
}

class WinePrefixTest : public ::testing::Test {
protected:
    TempDir prefix_;
    testing::ScopedEnv env_{"WINEPREFIX", prefix_.path().string()};
};

TEST_F(WinePrefixTest, WindowsPathGoesThroughTheDriveMapping_WithDotsResolvedAsOnWindows) {
    fs::create_directories(prefix_ / "drive_c/Games");
    fs::create_directories(prefix_ / "dosdevices");
    fs::create_directory_symlink("../drive_c", prefix_ / "dosdevices/c:");
    fs::create_directories(prefix_ / "other");
    fs::create_directory_symlink(prefix_ / "other", prefix_ / "dosdevices/d:");

    EXPECT_EQ(NativePathFromUserText("C:\\Games\\FIFA Online 2\\data2"),
              prefix_ / "dosdevices/c:/Games/FIFA Online 2/data2");
    EXPECT_TRUE(IsDirectory(NativePathFromUserText("c:\\GAMES").parent_path()));
    EXPECT_EQ(NativePathFromUserText("D:\\\\data2"), prefix_ / "dosdevices/d:/data2");
    EXPECT_EQ(NativePathFromUserText("/home/u/game\\data2"), fs::path("/home/u/game/data2"));

    // "." and ".." are resolved as Windows resolves them, before the path enters the prefix: a
    // path never climbs above its drive's root and so never out of the prefix.
    EXPECT_EQ(NativePathFromUserText("C:\\..\\..\\elsewhere-game"),
              prefix_ / "dosdevices/c:/elsewhere-game");
    EXPECT_EQ(NativePathFromUserText("c:/Games/./FIFA/../../x/"), prefix_ / "dosdevices/c:/x");
    EXPECT_EQ(NativePathFromUserText("C:.."), prefix_ / "dosdevices/c:");
    EXPECT_EQ(NativePathFromUserText("/home/u/../v"), fs::path("/home/u/../v"));  // native: as is

    EXPECT_EQ(WindowsPathInPrefix(prefix_.path(), "d:\\a\\..\\..\\b\\"),
              prefix_ / "dosdevices/d:/b");
    EXPECT_EQ(WindowsPathInPrefix(prefix_.path(), "C:\\"), prefix_ / "dosdevices/c:");
    EXPECT_FALSE(WindowsPathInPrefix(prefix_.path(), "Q:\\x"));  // no such drive in the prefix
    EXPECT_FALSE(WindowsPathInPrefix(prefix_.path(), "relative\\x"));
    EXPECT_FALSE(WindowsPathInPrefix(prefix_.path(), "\\\\server\\share"));
}

TEST_F(WinePrefixTest, DriveCFallsBackToDriveFolderWithoutDosdevices) {
    EXPECT_EQ(NativePathFromUserText("C:\\Program Files\\data2"),
              prefix_ / "drive_c/Program Files/data2");
}

}  // namespace
}  // namespace kickvane::platform
