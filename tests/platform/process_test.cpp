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
using testing::WriteProgram;

// Polls the watch until its answer is no longer Starting (or, with `ended`, until the program
// has ended or could not run).
ProgramState PollUntil(ProgramWatch& watch, bool ended) {
    ProgramState state = watch.Poll();
    WaitFor(
        [&] {
            state = watch.Poll();
            return ended ? state.ended() || state.kind == ProgramState::Kind::NotRun
                         : state.kind != ProgramState::Kind::Starting;
        },
        std::chrono::seconds(30));
    return state;
}

TEST(StartWatched, RunsProgramInWorkingFolder_WithArgumentsUntouchedByAShell_AndOutlivesItsWatch) {
    TempDir dir;
    fs::create_directories(dir / "game");
    const ScopedEnv kept("KICKVANE_TEST_KEPT", "kept");
    const ScopedEnv replaced("WINEPREFIX", "/old/prefix");
    // The program waits for "go", which the test makes only once the watch is gone. The report
    // is written beside and renamed into place, so a file that exists is whole.
    WriteProgram(dir / "tools/launcher.sh",
                 "#!/bin/sh\n"
                 "while [ ! -e go ]; do sleep 0.05; done\n"
                 "{ pwd; printf '%s\\n' \"$#\" \"$@\"; cat; echo "
                 "\"$KICKVANE_TEST_KEPT|$WINEPREFIX|$WINEARCH\"; "
                 "} > report.tmp\n"
                 "mv report.tmp report.txt\n");

    auto watch =
        StartWatched(dir / "tools/launcher.sh", {"two words", "$(touch injected)", ""},
                     dir / "game", false, {{"WINEPREFIX", "/new prefix"}, {"WINEARCH", "win32"}});
    EXPECT_EQ(PollUntil(*watch, false).kind, ProgramState::Kind::Running);
    EXPECT_EQ(watch->Poll().kind, ProgramState::Kind::Running);
    watch.reset();
    // The tool keeps no child: the watching process is reaped and the program is not ours.
    errno = 0;
    EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);

    WriteFile(dir / "game/go", "");
    ASSERT_TRUE(
        WaitFor([&] { return fs::exists(dir / "game/report.txt"); }, std::chrono::seconds(30)));
    // Standard input is empty (/dev/null), so `cat` ends at once and adds nothing. The variables
    // are added or replaced for the program only.
    EXPECT_EQ(ReadText(dir / "game/report.txt"),
              fs::canonical(dir / "game").string() +
                  "\n3\ntwo words\n$(touch injected)\n\nkept|/new prefix|win32\n");
    EXPECT_FALSE(fs::exists(dir / "game/injected"));
    EXPECT_EQ(GetEnv("WINEPREFIX"), "/old/prefix");
}

TEST(StartWatched, TellsHowTheProgramEnded_AndLeavesNoChildOnceItHas) {
    TempDir dir;
    const fs::path sh = FindOnPath("sh");
    ASSERT_FALSE(sh.empty());
    // {program, arguments, kind, code}
    const std::tuple<fs::path, std::vector<std::string>, ProgramState::Kind, int> cases[] = {
        {FindOnPath("false"), {}, ProgramState::Kind::Exited, 1},
        {sh, {"-c", "exit 3"}, ProgramState::Kind::Exited, 3},
        {sh, {"-c", "exit 0"}, ProgramState::Kind::Exited, 0},
        {sh, {"-c", "kill -9 $$"}, ProgramState::Kind::Killed, 9}};
    for (const auto& [program, arguments, kind, code] : cases) {
        auto watch = StartWatched(program, arguments, dir.path());
        const ProgramState state = PollUntil(*watch, true);
        EXPECT_EQ(state.kind, kind) << arguments.size();
        EXPECT_EQ(state.code, code) << program;
        // The answer stays, and the watching process is gone already.
        EXPECT_EQ(watch->Poll().kind, kind);
        errno = 0;
        EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1);
        EXPECT_EQ(errno, ECHILD);
    }

    // A program that runs until told to stop is running at every look meanwhile.
    auto waiting = StartWatched(sh, {"-c", "while [ ! -e stop ]; do sleep 0.05; done"}, dir.path());
    EXPECT_EQ(PollUntil(*waiting, false).kind, ProgramState::Kind::Running);
    EXPECT_EQ(waiting->Poll().kind, ProgramState::Kind::Running);
    WriteFile(dir / "stop", "");
    const ProgramState stopped = PollUntil(*waiting, true);
    EXPECT_EQ(stopped.kind, ProgramState::Kind::Exited);
    EXPECT_EQ(stopped.code, 0);
}

TEST(StartWatched, ProgramThatCannotRun_IsNotRunWithTheSystemsError) {
    TempDir dir;
    WriteFile(dir / "plain.txt", "not a program");
    WriteProgram(dir / "ok.sh", "#!/bin/sh\nexit 0\n");
    // {program, folder, action, cause}
    const std::tuple<fs::path, fs::path, FailedAction, FailureCause> cases[] = {
        {dir / "Gameloader.exe", dir.path(), FailedAction::Run, FailureCause::NotFound},
        {dir / "plain.txt", dir.path(), FailedAction::Run, FailureCause::NoPermission},
        {dir / "ok.sh", dir / "missing", FailedAction::EnterFolder, FailureCause::NotFound},
        {"", dir.path(), FailedAction::Run, FailureCause::Other}};
    for (const auto& [program, folder, action, cause] : cases) {
        const ProgramState state = PollUntil(*StartWatched(program, {}, folder), true);
        ASSERT_EQ(state.kind, ProgramState::Kind::NotRun) << program;
        EXPECT_EQ(state.failure.action, action) << program;
        EXPECT_EQ(state.failure.cause(), cause) << program;
        EXPECT_EQ(state.failure.path, action == FailedAction::Run ? program : folder);
    }
    const ProgramState badName =
        StartWatched(dir / "ok.sh", {}, dir.path(), false, {{"A=B", "x"}})->Poll();
    EXPECT_EQ(badName.kind, ProgramState::Kind::NotRun);
    errno = 0;
    EXPECT_EQ(::waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);
}

TEST(IsNativeExecutable, AcceptsElfAndScripts_RejectsWindowsProgramsAndPlainFiles) {
    TempDir dir;
    WriteProgram(dir / "run.sh", "#!/bin/sh\necho hi\n");
    WriteProgram(dir / "Gameloader.exe", std::string("MZ\x90\0\3\0\0\0", 8));
    WriteFile(dir / "notes.sh", "#!/bin/sh\necho hi\n");  // a script without the executable bit
    WriteProgram(dir / "empty", "");
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
    WriteProgram(dir / "bin/kv-tool", "#!/bin/sh\n");
    WriteFile(dir / "other/kv-plain", "#!/bin/sh\n");  // not executable
    WriteProgram(dir / "cwd/kv-here", "#!/bin/sh\n");
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
