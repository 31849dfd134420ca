#include "engine/hotkey_poll.h"

#include <gtest/gtest.h>

#include "support/fake_keys.h"

namespace kickvane::engine {
namespace {

constexpr int kF7 = 0x76;
constexpr int kF9 = 0x78;

TEST(HotkeyPoll, TicksOnlyForThePressedOrHeldKeyItKeeps) {
    testing::FakeKeySampler keys;
    HotkeyPoll poll(&keys);
    keys.pressed.insert(kF7);
    EXPECT_FALSE(poll.Tick());  // no key chosen yet

    EXPECT_TRUE(poll.SetHotkey("F7"));
    keys.pressed.insert(kF7);
    EXPECT_TRUE(poll.Tick());   // pressed since the last sample
    EXPECT_FALSE(poll.Tick());  // released meanwhile
    keys.held.insert(kF7);
    EXPECT_TRUE(poll.Tick());

    // Names are compared exactly; one that names no key leaves F7 in use.
    for (const char* name : {"f7", "", "F13", "F7 "}) {
        EXPECT_FALSE(poll.SetHotkey(name)) << name;
        EXPECT_EQ(poll.Key(), kF7) << name;
    }
    EXPECT_TRUE(poll.SetHotkey("F9"));
    EXPECT_FALSE(poll.Tick());  // F7 is still held, but no longer the hotkey
    keys.pressed.insert(kF9);
    EXPECT_TRUE(poll.Tick());

    HotkeyPoll withoutKeyState(nullptr);
    EXPECT_TRUE(withoutKeyState.SetHotkey("F12"));
    EXPECT_FALSE(withoutKeyState.Tick());
}

// Where key events wake the tool, the timer is needed only while the key is held.
TEST(HotkeyPoll, NeedsTicksOnlyWhileTheKeyIsHeld_WhereKeyEventsWake) {
    testing::FakeKeySampler keys;
    HotkeyPoll poll(&keys);
    ASSERT_TRUE(poll.SetHotkey("F7"));
    EXPECT_TRUE(poll.NeedsTicks());  // no events: always polled

    keys.wake = 5;
    EXPECT_EQ(poll.WakeDescriptor(), 5);
    EXPECT_FALSE(poll.NeedsTicks());
    keys.pressed.insert(kF7);
    EXPECT_TRUE(poll.Tick());
    EXPECT_FALSE(poll.NeedsTicks());  // a short press: done
    keys.held.insert(kF7);
    EXPECT_TRUE(poll.Tick());
    EXPECT_TRUE(poll.NeedsTicks());  // held: runs again on every tick
    EXPECT_TRUE(poll.Tick());
    keys.held.clear();
    EXPECT_FALSE(poll.Tick());
    EXPECT_FALSE(poll.NeedsTicks());
}

}  // namespace
}  // namespace kickvane::engine
