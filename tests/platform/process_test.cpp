#include "platform/process.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <thread>

#include "platform/scoped_env.h"
#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::ScopedEnv;
using testing::TempDir;
using testing::WriteFile;

void WriteExecutable(const fs::path& path, std::string_view content) {
    WriteFile(path, content);
    fs::permissions(path, fs::perms::owner_all);
}

// Waits for a file that a started program writes; generous, since the machine may be busy.
bool WaitForFile(const fs::path& path) {
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (std::chrono::steady_clock::now() < deadline) {
        if (fs::exists(path)) {
            return true;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }
    return false;
}

TEST(StartDetached, RunsProgramInWorkingFolder_WithArgumentsUntouchedByAShell) {
    TempDir dir;
    fs::create_directories(dir / "game");
    // The report is written beside and renamed into place, so a file that exists is whole.
    WriteExecutable(dir / "tools/launcher.sh",
                    "#!/bin/sh\n"
                    "{ pwd; printf '%s\\n' \"$#\" \"$@\"; cat; echo end; } > report.tmp\n"
                    "mv report.tmp report.txt\n");

    const Status started = StartDetached(dir / "tools/launcher.sh",
                                         {"two words", "$(touch injected)", ""}, dir / "game");
    ASSERT_TRUE(started.ok()) << started.reason();
    // The tool keeps no child: the middle process is reaped and the program is not ours.
    errno = 0;
    EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);

    ASSERT_TRUE(WaitForFile(dir / "game/report.txt"));
    // Standard input is empty (/dev/null), so `cat` ends at once and adds nothing.
    EXPECT_EQ(ReadText(dir / "game/report.txt"),
              fs::canonical(dir / "game").string() + "\n3\ntwo words\n$(touch injected)\n\nend\n");
    EXPECT_FALSE(fs::exists(dir / "game/injected"));
}

TEST(StartDetached, FailsWithReason_WhenProgramOrFolderCannotBeUsed) {
    TempDir dir;
    WriteFile(dir / "plain.txt", "not a program");
    WriteExecutable(dir / "ok.sh", "#!/bin/sh\nexit 0\n");

    const Status missing = StartDetached(dir / "Gameloader.exe", {}, dir.path());
    EXPECT_FALSE(missing.ok());
    EXPECT_NE(missing.reason().find("Gameloader.exe"), std::string::npos) << missing.reason();

    const Status notExecutable = StartDetached(dir / "plain.txt", {}, dir.path());
    EXPECT_FALSE(notExecutable.ok());
    EXPECT_FALSE(notExecutable.reason().empty());

    const Status noFolder = StartDetached(dir / "ok.sh", {}, dir / "missing");
    EXPECT_FALSE(noFolder.ok());
    EXPECT_NE(noFolder.reason().find("missing"), std::string::npos) << noFolder.reason();

    EXPECT_FALSE(StartDetached("", {}, dir.path()).ok());
}

TEST(IsNativeExecutable, AcceptsElfAndScripts_RejectsWindowsProgramsAndPlainFiles) {
    TempDir dir;
    WriteExecutable(dir / "run.sh", "#!/bin/sh\necho hi\n");
    WriteExecutable(dir / "Gameloader.exe", std::string("MZ\x90\0\3\0\0\0", 8));
    WriteFile(dir / "notes.sh", "#!/bin/sh\necho hi\n");  // a script without the executable bit
    WriteExecutable(dir / "empty", "");
    fs::create_directories(dir / "folder");

    EXPECT_TRUE(IsNativeExecutable(fs::read_symlink("/proc/self/exe")));
    EXPECT_TRUE(IsNativeExecutable(dir / "run.sh"));
    EXPECT_FALSE(IsNativeExecutable(dir / "Gameloader.exe"));
    EXPECT_FALSE(IsNativeExecutable(dir / "notes.sh"));
    EXPECT_FALSE(IsNativeExecutable(dir / "empty"));
    EXPECT_FALSE(IsNativeExecutable(dir / "folder"));
    EXPECT_FALSE(IsNativeExecutable(dir / "missing"));
}

TEST(FindOnPath, FindsExecutablesInPathFolders_NeverInTheCurrentFolder) {
    const fs::path sh = FindOnPath("sh");
    ASSERT_FALSE(sh.empty());
    EXPECT_TRUE(sh.is_absolute());
    EXPECT_TRUE(IsNativeExecutable(sh));

    TempDir dir;
    WriteExecutable(dir / "bin/kv-tool", "#!/bin/sh\n");
    WriteFile(dir / "other/kv-plain", "#!/bin/sh\n");
    ScopedEnv path("PATH", ":" + (dir / "other").string() + ":" + (dir / "bin").string());
    EXPECT_EQ(FindOnPath("kv-tool"), dir / "bin/kv-tool");
    EXPECT_TRUE(FindOnPath("kv-plain").empty());  // not executable
    EXPECT_TRUE(FindOnPath("kv-missing").empty());
    EXPECT_TRUE(FindOnPath("").empty());

    // An empty PATH entry would mean the current folder, where anything may lie.
    WriteExecutable(dir / "cwd/kv-here", "#!/bin/sh\n");
    const fs::path previous = fs::current_path();
    fs::current_path(dir / "cwd");
    EXPECT_TRUE(FindOnPath("kv-here").empty());
    fs::current_path(previous);
}

}  // namespace
}  // namespace kickvane::platform
