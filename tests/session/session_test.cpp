#include "session/session.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "support/fake_keys.h"
#include "support/fake_program.h"
#include "support/trees.h"

namespace kickvane::session {
namespace {

using testing::FakeKeySampler;
using testing::WriteFile;
using Kind = text::Message::Kind;
namespace fs = std::filesystem;

constexpr int kF7 = 0x76;

class SessionTest : public testing::ToolAndGameTest {
protected:
    std::unique_ptr<Session> Open(Launcher launch = game::LaunchGame) {
        auto keys = std::make_unique<FakeKeySampler>();
        keys_ = keys.get();
        return std::make_unique<Session>(tool(), std::move(keys), std::move(launch));
    }

    FakeKeySampler* keys_ = nullptr;
};

TEST_F(SessionTest, HotkeyFromTheSettingsAppliesOnPressAndABadTextKeepsTheLastKey) {
    WriteSettings("f7");  // names no key: nothing is in use yet, and the session says so
    auto session = Open();
    EXPECT_FALSE(session->HotkeyValid());
    EXPECT_EQ(session->ActiveHotkey(), "");
    EXPECT_EQ(session->HotkeyProblem(), "\"f7\" không phải phím F1–F12: phím tắt chưa hoạt động.");
    keys_->pressed.insert(kF7);
    EXPECT_FALSE(session->PollHotkey());

    session->SetHotkeyText("F7");
    EXPECT_TRUE(session->HotkeyProblem().empty());
    keys_->pressed.insert(kF7);
    const std::optional<ApplyRun> run = session->PollHotkey();
    ASSERT_TRUE(run);
    EXPECT_EQ(run->shown.signalSound, tool() / "sound.wav");
    EXPECT_TRUE(run->shown.messages.empty());
    EXPECT_TRUE(fs::exists(game() / "data2/cmn/base.dds"));

    session->SetHotkeyText("F");  // halfway through typing "F9"
    EXPECT_EQ(session->ActiveHotkey(), "F7");
    EXPECT_EQ(session->HotkeyProblem(), "\"F\" không phải phím F1–F12: vẫn dùng F7.");
    EXPECT_EQ(session->Settings().hotkey, "F");  // saved as typed
}

TEST_F(SessionTest, UnreadableSettingsAreNamedAndNothingIsCopied) {
    WriteFile(tool() / "ThietLap.ini", std::string("\x01\x00\x7F\x00junk", 8));
    auto session = Open();
    EXPECT_FALSE(session->SettingsRead());
    ASSERT_TRUE(session->SettingsProblem());
    EXPECT_EQ(session->SettingsProblem()->kind, Kind::Warning);

    const ApplyRun run = session->Apply();
    EXPECT_TRUE(run.refused);
    EXPECT_TRUE(run.apply.steps.empty());
    EXPECT_TRUE(run.shown.signalSound.empty());
    ASSERT_EQ(run.shown.messages.size(), 1u);
    EXPECT_EQ(run.shown.messages[0], *session->SettingsProblem());
    EXPECT_FALSE(fs::exists(game() / "data2/cmn/base.dds"));
    // The tray keeps the last real run's line: a refused run copied nothing.
    EXPECT_FALSE(RunStatusLine(run, {9, 30}));
}

TEST_F(SessionTest, FailedStepsFollowTheSoundInOneNotice_AStoppedRunHasItsMessageAndNoSound) {
    WriteSettings("F7");
    fs::remove_all(game() / "zdata");
    auto session = Open();
    const ApplyRun run = session->Apply();
    EXPECT_FALSE(run.shown.signalSound.empty());
    ASSERT_EQ(run.shown.messages.size(), 1u);
    const text::Message& notice = run.shown.messages[0];
    EXPECT_EQ(notice.kind, Kind::Notice);
    EXPECT_EQ(notice.title, "Thông báo");
    EXPECT_TRUE(notice.text.starts_with(
        "Đã chép xong, nhưng " + std::to_string(run.apply.Failures().size()) +
        " bước không thành công:\n• Thay đổi bóng: không chép được vào zdata\\data2\\ball: "
        "trò chơi không có thư mục này\n"))
        << notice.text;
    // The player reads paths from the game folder, and none of the tool's inner names.
    for (const char* inner : {"DataRoot", "merge", "->", "ExtrasFolder", "/"}) {
        EXPECT_EQ(notice.text.find(inner), std::string::npos) << inner << " in " << notice.text;
    }

    fs::remove_all(game() / "data2");
    const ApplyRun stopped = session->Apply();
    EXPECT_TRUE(stopped.apply.Stopped());
    ASSERT_EQ(stopped.shown.messages.size(), 1u);
    EXPECT_EQ(stopped.shown.messages[0].kind, Kind::Component);
    EXPECT_TRUE(stopped.shown.signalSound.empty());
    EXPECT_FALSE(stopped.shown.popup);
}

TEST_F(SessionTest, AFailedSaveWarnsWithTheReasonAndNoPopup) {
    auto session = Open();
    fs::create_directories(tool() / "ThietLap.ini");  // a folder where the file goes
    const Outcome failed = session->Save();
    EXPECT_FALSE(failed.popup);
    ASSERT_EQ(failed.messages.size(), 1u);
    EXPECT_EQ(failed.messages[0].kind, Kind::Warning);
    EXPECT_EQ(failed.messages[0].text,
              "Không lưu được thiết lập!\nKhông thay được ThietLap.ini: ở đó là một thư mục, "
              "không phải file.");
}

// A settings file the start could not read may still hold the user's choice: the first save
// keeps it as ThietLap.ini.bak, replacing an older copy, and says so; later saves just save.
TEST_F(SessionTest, FirstSaveOverAnUnreadableFileKeepsItBesideAndSaysSo) {
    const std::string unreadable = "[Thiet lap]\r\nDuongDan=" + std::string(1100 * 1024, 'x');
    WriteFile(tool() / "ThietLap.ini", unreadable);  // larger than the reader accepts
    WriteFile(tool() / "thietlap.ini.BAK", "an older backup");
    auto session = Open();
    ASSERT_FALSE(session->SettingsRead());
    session->SetGameFolder("D:\\FO2");

    const Outcome first = session->Save();
    ASSERT_TRUE(first.popup);
    EXPECT_EQ(first.popup->text, kSavedKeepingOldPopupText);
    EXPECT_EQ(testing::ReadText(tool() / "thietlap.ini.BAK"), unreadable);
    std::vector<std::string> backups;  // the older one's name is kept, in its letter case
    for (const auto& entry : fs::directory_iterator(tool())) {
        if (entry.path().extension() == ".BAK" || entry.path().extension() == ".bak") {
            backups.push_back(entry.path().filename().string());
        }
    }
    EXPECT_EQ(backups, std::vector<std::string>{"thietlap.ini.BAK"});
    EXPECT_EQ(catalog::LoadSettings(tool()).settings.gameFolder, "D:\\FO2");
    EXPECT_TRUE(session->SettingsRead());
    EXPECT_TRUE(session->Apply().apply.Stopped());  // no longer refused: the file is the user's

    session->SetGameFolder("E:\\FO2");
    EXPECT_EQ(session->Save().popup, (Popup{"Đã lưu thiết lập!", 2}));
    EXPECT_EQ(testing::ReadText(tool() / "thietlap.ini.BAK"), unreadable);
}

// A start is watched for a moment; one that fails at once, from the window or the tray, says
// which program failed and leaves the window. (The window's start that goes well, hiding the
// window, is the launch button's test.)
TEST_F(SessionTest, LaunchThatFailsAtOnceSaysWhyAndStays_ATrayStartLeavesTheWindow) {
    using Kind = platform::ProgramState::Kind;
    std::deque<platform::ProgramState> script{testing::ProgramIs(Kind::Running),
                                              testing::ProgramIs(Kind::Exited, 1)};
    auto session = Open([&](std::string_view folder) {
        EXPECT_EQ(folder, "C:\\Program Files");
        game::LaunchStart start;
        start.plan.way = game::LaunchWay::Lutris;
        start.program = std::make_unique<testing::FakeProgramWatch>(script);
        return start;
    });
    testing::FakeClock clock;
    session->SetLaunchClock(clock.function());
    for (LaunchFrom from : {LaunchFrom::Window, LaunchFrom::Tray}) {
        EXPECT_TRUE(session->Launch(from).watching());
        std::optional<LaunchRun> failed;
        for (int tick = 0; tick < 5 && !failed; ++tick) {
            failed = session->TickLaunch();
        }
        ASSERT_TRUE(failed);
        EXPECT_FALSE(failed->started());
        EXPECT_FALSE(failed->hideToTray);
        EXPECT_FALSE(failed->shown.popup);
        ASSERT_EQ(failed->shown.messages.size(), 1u);
        EXPECT_EQ(failed->shown.messages[0].text,
                  "Không khởi động được FIFA: Lutris dừng ngay với mã lỗi 1.");
    }

    // A start from the tray that went well leaves the window as it is.
    script = {testing::ProgramIs(Kind::Exited, 0)};
    const LaunchRun fromTray = session->Launch(LaunchFrom::Tray);
    EXPECT_TRUE(fromTray.started());
    EXPECT_FALSE(fromTray.hideToTray);
    EXPECT_FALSE(fromTray.shown.popup);

    auto missing = Open();  // the real launcher: no Gameloader.exe in the default folder
    const LaunchRun failed = missing->Launch(LaunchFrom::Window);
    EXPECT_FALSE(failed.started());
    EXPECT_FALSE(failed.hideToTray);
    EXPECT_FALSE(failed.shown.popup);
    ASSERT_EQ(failed.shown.messages.size(), 1u);
    EXPECT_EQ(failed.shown.messages[0].text,
              "Không tìm thấy Gameloader.exe hoặc đường dẫn không chính xác!");
}

// A set the player drops beside the catalog's is chosen, saved, applied like the others; when
// its folder goes while the window is away, the group takes its default and the player hears it.
TEST_F(SessionTest, AddedBallIsChosenSavedAppliedAndFallsBackWhenItsFolderGoes) {
    WriteSettings("F7");
    WriteFile(tool() / u8"extras/Ball/Bóng Tết/textures/ball10.dds", "tet ball");
    auto session = Open();
    ASSERT_NE(session->AddedVariants().Find(catalog::GroupId::Ball, "Bóng Tết"), nullptr);
    EXPECT_FALSE(session->TakeGoneNotice());

    session->ChooseAdded(catalog::GroupId::Ball, "No such set");  // not listed: nothing changes
    EXPECT_EQ(session->Selection().Chosen(catalog::GroupId::Ball), 1);
    session->ChooseAdded(catalog::GroupId::Ball, "Bóng Tết");
    EXPECT_EQ(session->Selection().ChosenAdded(catalog::GroupId::Ball), "Bóng Tết");
    EXPECT_FALSE(session->Save().popup->text.empty());
    const ApplyRun run = session->Apply();
    EXPECT_TRUE(run.apply.Failures().empty());
    EXPECT_EQ(testing::ReadText(game() / "zdata/data2/ball/textures/ball10.dds"), "tet ball");

    // A second start reads the choice back.
    EXPECT_EQ(Open()->Selection().ChosenAdded(catalog::GroupId::Ball), "Bóng Tết");

    fs::remove_all(tool() / u8"extras/Ball/Bóng Tết");
    fs::create_directories(tool() / "extras/Ball/Empty one");
    const Outcome refreshed = session->RefreshAddedVariants();
    ASSERT_EQ(refreshed.messages.size(), 1u);
    EXPECT_EQ(refreshed.messages[0].text,
              "Không còn thư mục của bộ đã chọn, đã chọn lại mặc định:\n"
              "• extras\\Ball\\Bóng Tết → Europa League 2011");
    EXPECT_EQ(session->Selection().Chosen(catalog::GroupId::Ball), 1);
    EXPECT_EQ(SkippedLine(session->AddedVariants(), catalog::GroupId::Ball),
              "Bỏ qua: Empty one (thư mục trống)");
    EXPECT_TRUE(session->RefreshAddedVariants().messages.empty());  // said once

    // Started afresh on the saved file, the gone choice is said once at start.
    auto restarted = Open();
    const std::optional<text::Message> notice = restarted->TakeGoneNotice();
    ASSERT_TRUE(notice);
    EXPECT_NE(notice->text.find("Bóng Tết"), std::string::npos);
    EXPECT_FALSE(restarted->TakeGoneNotice());
    EXPECT_EQ(restarted->Selection().Chosen(catalog::GroupId::Ball), 1);
}

// The version found is kept for the window even when the settings file cannot take it.
TEST_F(SessionTest, ANewVersionIsKeptWhenTheSettingsFileCannotBeWritten) {
    auto session = Open();
    fs::create_directory(tool() / "ThietLap.ini");  // a folder in its place: the write fails
    EXPECT_FALSE(session->RecordNewVersion("v2.2"));
    EXPECT_EQ(session->Updates().versionText, "v2.2");
}

#ifndef _WIN32
// Windows searches its registry, shortcuts and drives instead (the Wine tests cover that).
TEST_F(SessionTest, GameSearchRunsOnAnotherThreadInTheFoldersItWasGiven) {
    auto session = Open();
    const fs::path home = tool().parent_path() / "home";
    WriteFile(home / ".wine/system.reg", "WINE REGISTRY Version 2\n");
    WriteFile(home / ".wine/drive_c/FIFA/Gameloader.exe", "MZ");
    session->SetGameSearchFolders({home, home / ".config", home / ".local/share", {}});
    const GameSearch search = session->GameSearchCommand();
    session.reset();  // the command owns what it needs

    std::atomic<bool> cancel{false};
    GameSearchOutcome found;
    std::thread([&] { found = search(cancel); }).join();
    ASSERT_EQ(found.games.size(), 1u);
    EXPECT_EQ(fs::canonical(found.games[0].folder), fs::canonical(home / ".wine/drive_c/FIFA"));
}
#endif

}  // namespace
}  // namespace kickvane::session
