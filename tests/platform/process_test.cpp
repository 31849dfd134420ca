#include "platform/process.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>

#include "platform/filesystem.h"
#include "platform/scoped_env.h"
#include "support/process.h"
#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::ScopedEnv;
using testing::TempDir;
using testing::WaitFor;
using testing::WriteFile;

void WriteExecutable(const fs::path& path, std::string_view content) {
    WriteFile(path, content);
    fs::permissions(path, fs::perms::owner_all);
}

TEST(StartDetached, RunsProgramInWorkingFolder_WithArgumentsUntouchedByAShell_AndLeavesNoChild) {
    TempDir dir;
    fs::create_directories(dir / "game");
    const ScopedEnv kept("KICKVANE_TEST_KEPT", "kept");
    const ScopedEnv replaced("WINEPREFIX", "/old/prefix");
    // The report is written beside and renamed into place, so a file that exists is whole.
    WriteExecutable(dir / "tools/launcher.sh",
                    "#!/bin/sh\n"
                    "{ pwd; printf '%s\\n' \"$#\" \"$@\"; cat; echo "
                    "\"$KICKVANE_TEST_KEPT|$WINEPREFIX|$WINEARCH\"; "
                    "} > report.tmp\n"
                    "mv report.tmp report.txt\n");

    const Status started =
        StartDetached(dir / "tools/launcher.sh", {"two words", "$(touch injected)", ""},
                      dir / "game", false, {{"WINEPREFIX", "/new prefix"}, {"WINEARCH", "win32"}});
    ASSERT_TRUE(started.ok()) << started.reason();
    // The tool keeps no child: the middle process is reaped and the program is not ours.
    errno = 0;
    EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);

    ASSERT_TRUE(
        WaitFor([&] { return fs::exists(dir / "game/report.txt"); }, std::chrono::seconds(30)));
    // Standard input is empty (/dev/null), so `cat` ends at once and adds nothing. The variables
    // are added or replaced for the program only.
    EXPECT_EQ(ReadText(dir / "game/report.txt"),
              fs::canonical(dir / "game").string() +
                  "\n3\ntwo words\n$(touch injected)\n\nkept|/new prefix|win32\n");
    EXPECT_FALSE(fs::exists(dir / "game/injected"));
    EXPECT_EQ(GetEnv("WINEPREFIX"), "/old/prefix");
    EXPECT_FALSE(
        StartDetached(dir / "tools/launcher.sh", {}, dir.path(), false, {{"A=B", "x"}}).ok());
}

TEST(StartDetached, FailsWithReason_WhenProgramOrFolderCannotBeUsed) {
    TempDir dir;
    WriteFile(dir / "plain.txt", "not a program");
    WriteExecutable(dir / "ok.sh", "#!/bin/sh\nexit 0\n");
    // {program, folder, a word the reason names}
    const std::tuple<fs::path, fs::path, std::string> cases[] = {
        {dir / "Gameloader.exe", dir.path(), "Gameloader.exe"},
        {dir / "plain.txt", dir.path(), ""},
        {dir / "ok.sh", dir / "missing", "missing"},
        {"", dir.path(), ""}};
    for (const auto& [program, folder, named] : cases) {
        const Status started = StartDetached(program, {}, folder);
        EXPECT_FALSE(started.ok()) << program;
        EXPECT_FALSE(started.reason().empty()) << program;
        EXPECT_NE(started.reason().find(named), std::string::npos) << started.reason();
    }
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
    for (const char* name : {"Gameloader.exe", "notes.sh", "empty", "folder", "missing"}) {
        EXPECT_FALSE(IsNativeExecutable(dir / name)) << name;
    }
}

TEST(FindOnPath, FindsExecutablesInPathFolders_NeverInTheCurrentFolder) {
    const fs::path sh = FindOnPath("sh");
    ASSERT_FALSE(sh.empty());
    EXPECT_TRUE(sh.is_absolute());

    TempDir dir;
    WriteExecutable(dir / "bin/kv-tool", "#!/bin/sh\n");
    WriteFile(dir / "other/kv-plain", "#!/bin/sh\n");  // not executable
    WriteExecutable(dir / "cwd/kv-here", "#!/bin/sh\n");
    // An empty PATH entry would mean the current folder, where anything may lie.
    ScopedEnv path("PATH", ":" + (dir / "other").string() + ":" + (dir / "bin").string());
    const fs::path previous = fs::current_path();
    fs::current_path(dir / "cwd");
    EXPECT_EQ(FindOnPath("kv-tool"), dir / "bin/kv-tool");
    for (const char* name : {"kv-plain", "kv-here", "kv-missing", ""}) {
        EXPECT_TRUE(FindOnPath(name).empty()) << name;
    }
    fs::current_path(previous);
}

}  // namespace
}  // namespace kickvane::platform
