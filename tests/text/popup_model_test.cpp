#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <memory>
#include <vector>

#include "text/popup_model.h"

namespace kickvane::text {
namespace {

constexpr int kLineHeightPx = 13;
constexpr Colour kCream = 0x00C0FFFF;

// A 1600 × 1080 screen whose work area ends at 1000 pixels, 15 twips per pixel.
class PopupTest : public ::testing::Test {
protected:
    std::unique_ptr<AlertPopupModel> Show(std::string_view text, int seconds, bool fade = false,
                                          bool autoFit = false, bool translucent = true) {
        PopupEnvironment env;
        env.screen = {1600, 1000, 1080, 15.0, 15.0};
        env.translucencySupported = translucent;
        env.slotTable = &slots_;
        env.labelHeight = [this](int widthPx, std::string_view shown) {
            measuredWidth_ = widthPx;
            return kLineHeightPx *
                   static_cast<int>(1 + std::count(shown.begin(), shown.end(), '\n'));
        };
        auto popup = std::make_unique<AlertPopupModel>(std::move(env));
        popup->DisplayMessage(text, seconds, fade, autoFit, true, kCream);
        return popup;
    }

    // Ticks while the popup is in `phase`; returns how many ticks that took.
    static int TicksIn(AlertPopupModel& popup, PopupPhase phase, int limit = 100000) {
        int ticks = 0;
        while (popup.Phase() == phase && ticks < limit) {
            popup.Tick();
            ++ticks;
        }
        return ticks;
    }

    PopupSlots slots_;
    int measuredWidth_ = 0;
};

TEST_F(PopupTest, SlidesUpInSlot1_RestsDisplaySecondsTimes80Ticks_ThenSlidesOutAndFreesSlot) {
    auto popup = Show("Hoàn tất!", 2);
    EXPECT_EQ(popup->Slot(), 1);
    EXPECT_EQ(popup->LeftTwips(), 1600 * 15 - 2400);
    EXPECT_EQ(popup->TopTwips(), 15000);
    EXPECT_EQ(popup->WindowPixels(), (PixelRect{1440, 1000, 160, 133}));
    popup->Tick();
    EXPECT_EQ(popup->TopTwips(), 14950);

    EXPECT_EQ(TicksIn(*popup, PopupPhase::kArriving), 40);
    EXPECT_EQ(popup->TopTwips(), 13000);
    EXPECT_TRUE(popup->Topmost());
    EXPECT_EQ(TicksIn(*popup, PopupPhase::kResting), 159);  // the arriving tick counts as the first

    popup->Tick();
    EXPECT_FALSE(popup->Topmost());
    EXPECT_EQ(popup->TopTwips(), 13050);
    TicksIn(*popup, PopupPhase::kLeaving);
    EXPECT_GT(popup->TopTwips(), 1080 * 15);
    EXPECT_TRUE(popup->Finished());
    EXPECT_EQ(slots_.Mask(), 0);
}

TEST_F(PopupTest, LaterPopupsStackInHigherSlots_RiseFaster_AndReuseFreedSlots) {
    auto first = Show("one", 1);
    TicksIn(*first, PopupPhase::kArriving);
    auto second = Show("two", 1);
    EXPECT_EQ(second->Slot(), 2);
    second->Tick();
    EXPECT_EQ(second->TopTwips(), 14900);
    TicksIn(*second, PopupPhase::kArriving);
    EXPECT_EQ(second->TopTwips(), 15000 - 2 * 2000);

    first->Click();
    TicksIn(*first, PopupPhase::kLeaving);
    EXPECT_EQ(slots_.Mask(), 0b10);
    EXPECT_EQ(Show("three", 1)->Slot(), 1);
    second.reset();  // a popup destroyed before it finished gives its slot back
    EXPECT_EQ(slots_.Mask(), 0);
}

TEST(PopupSlots, EighthAndLaterPopupsShareSlot8) {
    PopupSlots slots;
    for (int k = 1; k <= 7; ++k) {
        EXPECT_EQ(slots.Take(), k);
    }
    EXPECT_EQ(slots.Take(), 8);
    EXPECT_EQ(slots.Take(), 8);
    EXPECT_EQ(slots.Mask(), 0xFF);
    slots.Release(3);
    EXPECT_EQ(slots.Take(), 3);
}

TEST_F(PopupTest, ZeroSeconds_AddsCloseLine_AndWaitsForAClick) {
    auto popup = Show("Hello", 0);
    EXPECT_EQ(popup->Text(), "(click here to close)\r\nHello");
    EXPECT_EQ(popup->LabelPixels().top, 5);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::kArriving), 41);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::kResting, 5000), 5000);
    popup->Click();
    EXPECT_EQ(popup->Phase(), PopupPhase::kLeaving);
}

TEST_F(PopupTest, NegativeSeconds_IgnoresClicks_UntilCloseActivate) {
    auto popup = Show("Hello", -1);
    EXPECT_EQ(popup->Text(), "Hello");
    EXPECT_EQ(popup->LabelPixels().top, 5);
    TicksIn(*popup, PopupPhase::kArriving);
    popup->Click();
    popup->SetCloseActivate(false);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::kResting, 500), 500);
    EXPECT_FALSE(popup->CloseActivate());
    popup->SetCloseActivate(true);
    EXPECT_EQ(popup->Phase(), PopupPhase::kLeaving);
}

TEST_F(PopupTest, AutoFit_FitsSlot1ToItsLabel_FrameIncluded_HigherSlotsKeepHeight) {
    auto first = Show("a\nb", 1, false, true);
    EXPECT_EQ(measuredWidth_, 150);
    EXPECT_EQ(first->LabelPixels(), (PixelRect{5, 10, 150, 26}));
    EXPECT_EQ(first->HeightTwips(), (10 + 26 + 10) * 15);
    EXPECT_EQ(first->Frame().lines.at(1), (FrameLine{159, 45, 0, 45, kButtonFaceColour}));
    EXPECT_EQ(first->Frame().lines.at(5), (FrameLine{158, 44, 1, 44, kCream}));
    TicksIn(*first, PopupPhase::kArriving);
    EXPECT_EQ(first->TopTwips(), 15000 - 46 * 15);

    EXPECT_EQ(Show("a\nb", 1, false, true)->HeightTwips(), 2000);
}

TEST_F(PopupTest, Fade_ShowsTranslucentInPlace_TurnsOpaque_ThenFadesToZeroAndUnloads) {
    auto popup = Show("Hello", 2, true);
    EXPECT_EQ(popup->TopTwips(), 13000);
    EXPECT_TRUE(popup->Topmost());
    EXPECT_EQ(popup->Alpha(), 204);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::kArriving), 10);
    EXPECT_EQ(popup->Alpha(), 255);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::kResting), 160);

    std::vector<int> alphas;
    while (!popup->Finished()) {
        popup->Tick();
        alphas.push_back(*popup->Alpha());
        EXPECT_EQ(popup->TopTwips(), 13000);
    }
    ASSERT_EQ(alphas.size(), 52u);  // 2, 4, ... 100 per cent, 102 (no change), unload
    EXPECT_TRUE(std::is_sorted(alphas.rbegin(), alphas.rend()));
    EXPECT_EQ(alphas[14], 178);  // 30 per cent: 178.5 rounds to even
    EXPECT_EQ(alphas[24], 128);  // 50 per cent: 127.5 rounds to even
    EXPECT_EQ(alphas[49], 0);

    auto opaque = Show("Hello", 2, true, false, false);
    int ticks = 0;
    for (; !opaque->Finished(); ++ticks) {
        opaque->Tick();
        EXPECT_FALSE(opaque->Alpha().has_value());
    }
    EXPECT_EQ(ticks, 10 + 160 + 52);
}

TEST_F(PopupTest, ClickWhileRising_SlidesDownFromWhereItIs) {
    auto popup = Show("Hello", 2);
    for (int i = 0; i < 5; ++i) {
        popup->Tick();
    }
    popup->Click();
    popup->Tick();
    EXPECT_EQ(popup->TopTwips(), 15000 - 4 * 50);
    EXPECT_FALSE(popup->Topmost());
}

TEST_F(PopupTest, StopsAtRestingTop_WhenItIsNoMultipleOfTheStep) {
    auto popup = Show("one line", 1, false, true);  // (10 + 13 + 10) × 15 = 495 twips high
    int highest = popup->TopTwips();
    while (popup->Phase() != PopupPhase::kLeaving) {
        popup->Tick();
        highest = std::min(highest, popup->TopTwips());
    }
    EXPECT_EQ(highest, 15000 - 495);
}

TEST(PopupModel, ConvertsScreenToTwips_HalvesToEven_AndSurvivesHugeSeconds) {
    PopupSlots slots;
    PopupEnvironment env;
    env.screen = {1001, 1001, 1200, 14.5, 14.5};  // 14514.5 twips
    env.slotTable = &slots;
    AlertPopupModel popup(env);
    popup.DisplayMessage("x", INT_MAX, false, false, false, 0);
    EXPECT_EQ(popup.TopTwips(), 14514);
    EXPECT_EQ(popup.LeftTwips(), 14514 - 2400);
    for (int i = 0; i < 1000; ++i) {
        popup.Tick();
    }
    EXPECT_EQ(popup.Phase(), PopupPhase::kResting);
    EXPECT_TRUE(popup.Frame().windowShape.has_value());
}

}  // namespace
}  // namespace kickvane::text
