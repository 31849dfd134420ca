#include <gtest/gtest.h>

#include "game/launcher.h"
#include "support/fake_program.h"

namespace kickvane::game {
namespace {

using Kind = platform::ProgramState::Kind;
using testing::FakeClock;
using testing::FakeProgramWatch;
using testing::ProgramIs;
using namespace std::chrono_literals;

struct Case {
    const char* what;
    std::deque<platform::ProgramState> states;  // one per tick, the last one stays
    std::chrono::milliseconds step;             // the clock's move before each tick
    LaunchVerdict verdict;
    int ticksToDecide;
};

TEST(LaunchWatch, DecidesFromTheProgramsEndWithinTheWatch_OrItsRunningAtItsEnd) {
    const auto starting = ProgramIs(Kind::Starting), running = ProgramIs(Kind::Running);
    using V = LaunchVerdict;
    const Case cases[] = {
        {"runs on", {starting, running}, 500ms, V::Started, 4},
        {"ends with an error", {running, ProgramIs(Kind::Exited, 3)}, 500ms, V::Failed, 2},
        {"hands over and ends well", {ProgramIs(Kind::Exited, 0)}, 100ms, V::Started, 1},
        {"killed", {running, ProgramIs(Kind::Killed, 9)}, 100ms, V::Failed, 2},
        {"cannot run", {ProgramIs(Kind::NotRun)}, 0ms, V::Failed, 1},
        // Not known yet whether it runs at all: the watch waits for that past its time.
        {"slow to start", {starting, starting, starting, running}, 1500ms, V::Started, 4},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        FakeClock clock;
        bool released = false;
        LaunchWatch watch(std::make_unique<FakeProgramWatch>(c.states, &released), clock.function(),
                          2000ms);
        int ticks = 0;
        while (watch.Verdict() == LaunchVerdict::Watching && ticks < 20) {
            clock.now += c.step;
            watch.Tick();
            ++ticks;
            EXPECT_EQ(released, watch.Verdict() != LaunchVerdict::Watching);
        }
        EXPECT_EQ(watch.Verdict(), c.verdict);
        EXPECT_EQ(ticks, c.ticksToDecide);
        EXPECT_EQ(watch.State().kind, c.states.back().kind);
        EXPECT_EQ(watch.State().code, c.states.back().code);
    }
}

TEST(LaunchWatch, AVerdictStays_EvenWhenTheProgramEndsLater) {
    FakeClock clock;
    LaunchWatch watch(
        std::make_unique<FakeProgramWatch>(std::deque{
            ProgramIs(Kind::Running), ProgramIs(Kind::Running), ProgramIs(Kind::Exited, 1)}),
        clock.function(), 2000ms);
    EXPECT_EQ(watch.Tick(), LaunchVerdict::Watching);
    clock.now += 2000ms;
    // The program's end after the watch is its own business (the game closed, say).
    EXPECT_EQ(watch.Tick(), LaunchVerdict::Started);
    EXPECT_EQ(watch.Tick(), LaunchVerdict::Started);
    EXPECT_EQ(watch.State().kind, Kind::Running);
}

}  // namespace
}  // namespace kickvane::game
