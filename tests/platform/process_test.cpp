#include "platform/process.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>

#include "platform/filesystem.h"
#include "platform/scoped_env.h"
#include "platform/wait_until.h"
#include "support/temp_dir.h"

namespace kickvane::platform {
namespace {

namespace fs = std::filesystem;
using testing::ReadText;
using testing::ScopedEnv;
using testing::TempDir;
using testing::WaitUntil;
using testing::WriteFile;

void WriteExecutable(const fs::path& path, std::string_view content) {
    WriteFile(path, content);
    fs::permissions(path, fs::perms::owner_all);
}

TEST(StartDetached, RunsProgramInWorkingFolder_WithArgumentsUntouchedByAShell_AndLeavesNoChild) {
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

    ASSERT_TRUE(
        WaitUntil([&] { return fs::exists(dir / "game/report.txt"); }, std::chrono::seconds(30)));
    // Standard input is empty (/dev/null), so `cat` ends at once and adds nothing.
    EXPECT_EQ(ReadText(dir / "game/report.txt"),
              fs::canonical(dir / "game").string() + "\n3\ntwo words\n$(touch injected)\n\nend\n");
    EXPECT_FALSE(fs::exists(dir / "game/injected"));
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

TEST(StartDetached, EnvironmentAdditionsReplaceOrAddVariables_AndLeaveTheRestAlone) {
    TempDir dir;
    const ScopedEnv kept("KICKVANE_TEST_KEPT", "kept");
    const ScopedEnv replaced("WINEPREFIX", "/old/prefix");
    WriteExecutable(
        dir / "env.sh",
        "#!/bin/sh\n"
        "printf '%s|%s|%s\\n' \"$KICKVANE_TEST_KEPT\" \"$WINEPREFIX\" \"$WINEARCH\" > r.tmp\n"
        "mv r.tmp r.txt\n");
    const Status started = StartDetached(dir / "env.sh", {}, dir.path(), false,
                                         {{"WINEPREFIX", "/new prefix"}, {"WINEARCH", "win32"}});
    ASSERT_TRUE(started.ok()) << started.reason();
    ASSERT_TRUE(WaitUntil([&] { return fs::exists(dir / "r.txt"); }, std::chrono::seconds(30)));
    EXPECT_EQ(ReadText(dir / "r.txt"), "kept|/new prefix|win32\n");
    EXPECT_EQ(GetEnv("WINEPREFIX"), "/old/prefix");  // the tool's own environment is unchanged

    EXPECT_FALSE(StartDetached(dir / "env.sh", {}, dir.path(), false, {{"A=B", "x"}}).ok());
}

}  // namespace
}  // namespace kickvane::platform
