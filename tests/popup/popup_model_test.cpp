#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <memory>
#include <vector>

#include "popup/popup_model.h"

namespace kickvane::popup {
namespace {

constexpr int kLineHeightPx = 13;
constexpr Colour kCream{0xFFFFC0};

// Ticks while the popup is in `phase`; returns how many ticks that took.
int TicksIn(AlertPopupModel& popup, PopupPhase phase, int limit = 100000) {
    int ticks = 0;
    for (; popup.Phase() == phase && ticks < limit; ++ticks) {
        popup.Tick();
    }
    return ticks;
}

// A 1600 × 1080 screen at 96 dots per inch whose work area ends at 1000 pixels (750 points).
class PopupTest : public ::testing::Test {
protected:
    std::unique_ptr<AlertPopupModel> Show(std::string_view text, int seconds, bool fade = false,
                                          bool autoFit = false, bool translucent = true) {
        PopupEnvironment env;
        env.screen = {1600, 1000, 1080, 96.0, 96.0};
        env.translucencySupported = translucent;
        env.slotTable = &slots_;
        env.labelHeight = [this](int widthPx, std::string_view shown) {
            measuredWidth_ = widthPx;
            return kLineHeightPx *
                   static_cast<int>(1 + std::count(shown.begin(), shown.end(), '\n'));
        };
        auto popup = std::make_unique<AlertPopupModel>(std::move(env));
        popup->DisplayMessage(text, seconds, {fade, autoFit, true, kCream});
        return popup;
    }

    PopupSlots slots_;
    int measuredWidth_ = 0;
};

TEST_F(PopupTest, Slot1RisesToItsRestingTop_RestsSecondsTimes80Ticks_ThenSlidesOutAndFreesIt) {
    auto popup = Show("Hoàn tất!", 2);
    EXPECT_EQ(popup->Slot(), 1);
    EXPECT_EQ(popup->WindowPixels(), (PixelRect{1440, 1000, 160, 133}));  // below the work area
    popup->Tick();
    EXPECT_DOUBLE_EQ(popup->TopPoints(), 750 - 2.5);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::Arriving), 40);
    EXPECT_DOUBLE_EQ(popup->TopPoints(), 750 - 100);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::Resting), 159);  // the arriving tick counts as the first
    TicksIn(*popup, PopupPhase::Leaving);
    EXPECT_GT(popup->TopPoints(), 1080 * 0.75);
    EXPECT_TRUE(popup->Finished());
    EXPECT_EQ(slots_.Mask(), 0);
}

TEST_F(PopupTest, Slot2RisesTwiceAsFarAndFast_AndFreedSlotsAreReused) {
    auto first = Show("one", 1);
    TicksIn(*first, PopupPhase::Arriving);
    auto second = Show("two", 1);
    EXPECT_EQ(second->Slot(), 2);
    second->Tick();
    EXPECT_DOUBLE_EQ(second->TopPoints(), 750 - 5);
    TicksIn(*second, PopupPhase::Arriving);
    EXPECT_DOUBLE_EQ(second->TopPoints(), 750 - 2 * 100);

    first->Click();
    TicksIn(*first, PopupPhase::Leaving);
    EXPECT_EQ(Show("three", 1)->Slot(), 1);
    second.reset();  // a popup destroyed before it finished gives its slot back
    EXPECT_EQ(slots_.Mask(), 0);

    PopupSlots slots;  // from the eighth on, popups share slot 8
    for (int slot : {1, 2, 3, 4, 5, 6, 7, 8, 8}) {
        EXPECT_EQ(slots.Take(), slot);
    }
}

TEST_F(PopupTest, ZeroSecondsWaitsForAClick_NegativeSecondsUntilDismissed) {
    auto sticky = Show("Hello", 0);
    EXPECT_EQ(sticky->Text(), "(click here to close)\r\nHello");
    EXPECT_EQ(sticky->LabelPixels().top, 5);
    EXPECT_EQ(TicksIn(*sticky, PopupPhase::Arriving), 41);
    EXPECT_EQ(TicksIn(*sticky, PopupPhase::Resting, 5000), 5000);
    sticky->Click();
    EXPECT_EQ(sticky->Phase(), PopupPhase::Leaving);

    auto clickProof = Show("Hello", -1);
    EXPECT_EQ(clickProof->Text(), "Hello");
    TicksIn(*clickProof, PopupPhase::Arriving);
    clickProof->Click();
    EXPECT_EQ(TicksIn(*clickProof, PopupPhase::Resting, 500), 500);
    clickProof->Dismiss();
    EXPECT_EQ(clickProof->Phase(), PopupPhase::Leaving);
}

TEST_F(PopupTest, AutoFitFitsSlot1ToItsLabel_FrameIncluded_HigherSlotsKeepTheirHeight) {
    auto first = Show("a\nb", 1, false, true);
    EXPECT_EQ(measuredWidth_, 150);
    EXPECT_DOUBLE_EQ(first->HeightPoints(), (10 + 26 + 10) * 0.75);
    EXPECT_EQ(first->Frame().lines.at(1).y1, 45);  // the frame's bottom line is on the new height
    TicksIn(*first, PopupPhase::Arriving);
    EXPECT_DOUBLE_EQ(first->TopPoints(), 750 - 46 * 0.75);

    EXPECT_DOUBLE_EQ(Show("a\nb", 1, false, true)->HeightPoints(), 100);
}

TEST_F(PopupTest, FadeShowsInPlace_TurnsOpaque_ThenFadesToZero_OrJustWaitsWithoutTranslucency) {
    auto popup = Show("Hello", 2, true);
    EXPECT_DOUBLE_EQ(popup->TopPoints(), 650);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::Arriving), 10);
    EXPECT_EQ(popup->Alpha(), 255);
    EXPECT_EQ(TicksIn(*popup, PopupPhase::Resting), 160);

    std::vector<int> alphas;
    while (!popup->Finished()) {
        popup->Tick();
        alphas.push_back(*popup->Alpha());
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

TEST_F(PopupTest, ClickWhileRisingSlidesDownFromWhereItIs) {
    auto popup = Show("Hello", 2);
    TicksIn(*popup, PopupPhase::Arriving, 5);
    popup->Click();
    popup->Tick();
    EXPECT_DOUBLE_EQ(popup->TopPoints(), 750 - 4 * 2.5);
    EXPECT_FALSE(popup->Topmost());
}

TEST_F(PopupTest, StopsAtItsRestingTop_WhenThatIsNoMultipleOfTheStep) {
    auto popup = Show("one line", 1, false, true);  // (10 + 13 + 10) × 0.75 = 24.75 points high
    double highest = popup->TopPoints();
    while (popup->Phase() != PopupPhase::Leaving) {
        popup->Tick();
        highest = std::min(highest, popup->TopPoints());
    }
    EXPECT_DOUBLE_EQ(highest, 750 - 24.75);
}

TEST(PopupModel, ADenserScreenShowsTheSameSizeInMorePixels_AndHugeSecondsDoNotOverflow) {
    PopupSlots slots;
    PopupEnvironment env;
    env.screen = {1001, 1001, 1200, 120.0, 120.0};
    env.slotTable = &slots;
    AlertPopupModel popup(env);
    popup.DisplayMessage("x", INT_MAX,
                         {.fade = false, .autoFit = false, .square = false, .backColour = {}});
    EXPECT_EQ(popup.WindowPixels(), (PixelRect{801, 1001, 200, 167}));  // 120 × 100 points
    EXPECT_EQ(popup.Frame().windowShape, (RoundedRect{0, 0, 200, 167, 19, 19, {}}));
    TicksIn(popup, PopupPhase::Arriving);
    EXPECT_EQ(popup.WindowPixels().top, 1001 - 167);
    EXPECT_EQ(TicksIn(popup, PopupPhase::Resting, 1000), 1000);
}

}  // namespace
}  // namespace kickvane::popup
