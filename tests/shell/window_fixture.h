#pragma once

#include <gtest/gtest.h>

#include <QTest>

#include "fakes.h"
#include "shell/main_window.h"
#include "support/temp_dir.h"

namespace kickvane::testing {

// A main window on a temporary tool folder, with recording dialogs, a fake key sampler and tray,
// and an update host where nothing listens.
class WindowFixture : public ::testing::Test {
protected:
    std::unique_ptr<shell::MainWindow> Open(std::filesystem::path folder = {}) {
        shell::ShellServices services;
        services.dialogs = &dialogs_;
        services.keySampler = std::make_unique<FakeKeySampler>();
        keys_ = static_cast<FakeKeySampler*>(services.keySampler.get());
        services.playSound = [this](const std::filesystem::path& wav) { sounds_.push_back(wav); };
        services.makeTray = [this](const QIcon&, QMenu*) {
            auto tray = std::make_unique<FakeTray>();
            tray->hostRunning = hostRunning_;
            tray_ = tray.get();
            return tray;
        };
        if (countLaunches_) {
            services.launchGame = [this](std::string_view, engine::EngineUi&) {
                ++launches_;
                return engine::LaunchResult::Started;
            };
        }
        services.updates.host = QUrl(QStringLiteral("http://127.0.0.1:9/"));
        std::filesystem::create_directories(tool());
        return std::make_unique<shell::MainWindow>(folder.empty() ? tool() : folder,
                                                   std::move(services));
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
    FakeKeySampler* keys_ = nullptr;
    FakeTray* tray_ = nullptr;
    std::vector<fs::path> sounds_;
    bool hostRunning_ = true;
    bool countLaunches_ = false;  // launches are counted instead of started
    int launches_ = 0;
};

}  // namespace kickvane::testing
