#pragma once

#include <gtest/gtest.h>

#include <QTest>
#include <deque>

#include "fakes.h"
#include "shell/main_window.h"
#include "support/fake_program.h"
#include "support/temp_dir.h"

namespace kickvane::testing {

// A main window and its session on a temporary tool folder, with recording dialogs, a fake key
// sampler and tray, and an update host where nothing listens.
class WindowFixture : public ::testing::Test {
protected:
    std::unique_ptr<shell::MainWindow> Open(std::filesystem::path folder = {}) {
        std::filesystem::create_directories(tool());
        auto keys = std::make_unique<FakeKeySampler>();
        keys_ = keys.get();
        session::Launcher launch = game::LaunchGame;
        if (countLaunches_) {
            launch = [this](std::string_view) {
                ++launches_;
                game::LaunchStart start;
                start.plan.way = game::LaunchWay::Wine;
                if (!launchScript_.empty()) {
                    start.program = std::make_unique<FakeProgramWatch>(launchScript_);
                }
                return start;
            };
        }
        sessions_.push_back(std::make_unique<session::Session>(folder.empty() ? tool() : folder,
                                                               std::move(keys), std::move(launch)));
        sessions_.back()->SetLaunchClock(launchClock_.function());

        shell::ShellServices services;
        services.dialogs = &dialogs_;
        services.playSound = [this](const std::filesystem::path& wav) { sounds_.push_back(wav); };
        services.makeTray = [this](const QIcon&, QMenu*) {
            auto tray = std::make_unique<FakeTray>();
            tray->hostRunning = hostRunning_;
            tray_ = tray.get();
            return tray;
        };
        services.updates.host = QUrl(QStringLiteral("http://127.0.0.1:9/"));
        return std::make_unique<shell::MainWindow>(*sessions_.back(), std::move(services));
    }

    fs::path tool() const { return dir_ / "tool"; }
    fs::path game() const { return dir_ / "game"; }

    static void Click(QWidget* widget) {
        QTest::mouseClick(widget, Qt::LeftButton, {}, QPoint(5, 5));
    }

    static void FinishFade(shell::MainWindow& window) {
        for (int i = 0; i < 100 && window.fade().running(); ++i) {
            window.fadeTick();
        }
    }

    TempDir dir_;
    RecordingDialogs dialogs_;
    std::deque<std::unique_ptr<session::Session>> sessions_;  // outlive their windows
    FakeKeySampler* keys_ = nullptr;
    FakeTray* tray_ = nullptr;
    std::vector<fs::path> sounds_;
    bool hostRunning_ = true;
    bool countLaunches_ = false;  // launches are counted instead of started
    int launches_ = 0;
    // What a counted launch's program does, one state per look; empty: it starts at once.
    std::deque<platform::ProgramState> launchScript_;
    FakeClock launchClock_;
};

}  // namespace kickvane::testing
