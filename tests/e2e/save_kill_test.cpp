// The program killed (SIGKILL) at random moments while it saves its settings: the file is
// always the whole old or the whole new one, and what killed saves leave behind is gone after the
// next save once it has lain untouched for a few seconds.
#include <gtest/gtest.h>
#include <signal.h>

#include <algorithm>
#include <chrono>
#include <random>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "support/process.h"
#include "support/temp_dir.h"

namespace kickvane::testing {
namespace {

using Clock = std::chrono::steady_clock;

// A value of about 100 KiB that names its save, so that a torn file cannot pass for a whole one.
std::string ValueOf(int save) {
    return "save " + std::to_string(save) + " " + std::string(100000 + save * 7, 'a' + save % 26);
}

std::string FileWith(int save) {
    return "[Thiet lap]\r\nPhimTat=F7\r\nGiaTri=" + ValueOf(save) + "\r\n";
}

// Starts `kickvane ini set FILE "Thiet lap" GiaTri VALUE`, kills it after `delay` unless it
// has ended, and returns whether it ended by itself with success.
bool SaveAndMaybeKill(const fs::path& file, int save, std::chrono::microseconds delay) {
    ChildProcess child(
        {KICKVANE_BINARY, "ini", "set", file.string(), "Thiet lap", "GiaTri", ValueOf(save)});
    EXPECT_TRUE(child.started()) << "cannot start " << KICKVANE_BINARY;
    const auto deadline = Clock::now() + delay;
    while (child.Running()) {
        if (Clock::now() >= deadline) {
            ::kill(child.pid(), SIGKILL);
            break;
        }
        std::this_thread::sleep_for(std::chrono::microseconds(20));
    }
    return child.Wait() == 0;
}

std::set<std::string> Leftovers(const fs::path& folder) {
    std::set<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder)) {
        if (entry.path().filename() != "ThietLap.ini") {
            names.insert(entry.path().filename().string());
        }
    }
    return names;
}

TEST(SaveKill, TheSettingsFileIsAlwaysWholeAndLeftoversGoWithTheNextSave) {
    TempDir dir;
    const fs::path file = dir / "ThietLap.ini";
    WriteFile(file, FileWith(0));

    // How long one save takes here, so that the kills spread over its whole length.
    const auto start = Clock::now();
    ASSERT_TRUE(SaveAndMaybeKill(file, 1, std::chrono::seconds(10)));
    const auto saveTime =
        std::chrono::duration_cast<std::chrono::microseconds>(Clock::now() - start);
    ASSERT_EQ(testing::ReadText(file), FileWith(1));

    std::mt19937 random(std::random_device{}());
    std::uniform_int_distribution<long> delay(0, saveTime.count() * 3 / 2);
    int lastWhole = 1;
    int killed = 0;
    size_t leftoversSeen = 0;
    for (int save = 2; save < 202; ++save) {
        const std::set<std::string> before = Leftovers(dir.path());
        const bool completed =
            SaveAndMaybeKill(file, save, std::chrono::microseconds(delay(random)));
        const std::string now = testing::ReadText(file);
        if (now == FileWith(save)) {
            lastWhole = save;
        } else {
            ASSERT_EQ(now, FileWith(lastWhole)) << "save " << save << " tore the file";
        }
        ASSERT_FALSE(completed && lastWhole != save) << "save " << save;
        killed += completed ? 0 : 1;
        leftoversSeen = std::max(leftoversSeen, before.size());
    }
    // A temporary file is only taken for abandoned once it has lain unchanged for a while: until
    // then it may be one whose writer is about to lock it.
    std::this_thread::sleep_for(std::chrono::seconds(6));
    ASSERT_TRUE(SaveAndMaybeKill(file, 202, std::chrono::seconds(10)));
    EXPECT_TRUE(Leftovers(dir.path()).empty());
    std::cout << "[ figures  ] 200 saves, " << killed << " killed, at most " << leftoversSeen
              << " leftover files seen before a save, one save takes about " << saveTime.count()
              << " us\n";
}

}  // namespace
}  // namespace kickvane::testing
