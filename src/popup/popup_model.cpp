#include "popup/popup_model.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace kickvane::popup {
namespace {

constexpr int kLabelLeftPx = 5;
constexpr int kStickyLabelTopPx = 5;
constexpr int kTimedLabelTopPx = 10;
constexpr int kLabelMarginPx = 10;  // label width = client width - this; auto-fit space below
constexpr double kSlideStepSlot1Points = 2.5;  // per tick
constexpr double kSlideStepHigherSlotsPoints = 5;
constexpr int kFadeStartPercent = 20;
constexpr int kFadeStepPercent = 2;
constexpr int kFadeEndPercent = 100;

int ClampToInt(long long value) {
    return static_cast<int>(std::clamp<long long>(value, std::numeric_limits<int>::min(),
                                                  std::numeric_limits<int>::max()));
}

int RoundToInt(double value) {
    if (!std::isfinite(value)) {
        return 0;
    }
    constexpr double kLimit = std::numeric_limits<int>::max();
    return ClampToInt(RoundHalfEven(std::clamp(value, -kLimit, kLimit)));
}

constexpr double kPointsPerInch = 72;

double SaneDotsPerInch(double dpi) {
    return std::isfinite(dpi) && dpi > 0.0 ? dpi : 96.0;
}

}  // namespace

long long RoundHalfEven(double value) {
    const double below = std::floor(value);
    const double fraction = value - below;
    double result = below;
    if (fraction > 0.5 || (fraction == 0.5 && std::fmod(below, 2.0) != 0.0)) {
        result = below + 1.0;
    }
    return static_cast<long long>(result);
}

PopupSlots& PopupSlots::Shared() {
    static PopupSlots slots;
    return slots;
}

int PopupSlots::Take() {
    int slot = kSlotCount;
    for (int k = 1; k < kSlotCount; ++k) {
        if ((mask_ & (1u << (k - 1))) == 0) {
            slot = k;
            break;
        }
    }
    mask_ = static_cast<std::uint8_t>(mask_ | (1u << (slot - 1)));
    return slot;
}

void PopupSlots::Release(int slot) {
    if (slot >= 1 && slot <= kSlotCount) {
        mask_ = static_cast<std::uint8_t>(mask_ ^ (1u << (slot - 1)));
    }
}

AlertPopupModel::AlertPopupModel(PopupEnvironment environment)
    : env_(std::move(environment)),
      slots_(env_.slotTable ? *env_.slotTable : PopupSlots::Shared()) {
    env_.screen.dotsPerInchX = SaneDotsPerInch(env_.screen.dotsPerInchX);
    env_.screen.dotsPerInchY = SaneDotsPerInch(env_.screen.dotsPerInchY);
}

AlertPopupModel::~AlertPopupModel() {
    // A popup that goes away early (the program ends) must not keep its slot.
    if (initialised_ && !finished_) {
        slots_.Release(slot_);
    }
}

void AlertPopupModel::Initialise() {
    const ScreenMetrics& screen = env_.screen;
    workBottom_ = PointsFromPixelsY(screen.workAreaBottomPx);
    screenHeight_ = PointsFromPixelsY(screen.screenHeightPx);
    // Just below the work area at its right-hand side.
    left_ = PointsFromPixelsX(screen.workAreaRightPx) - kPopupInitialWidthPoints;
    top_ = workBottom_;
    width_ = kPopupInitialWidthPoints;
    height_ = kPopupInitialHeightPoints;
    slot_ = slots_.Take();
    initialised_ = true;
}

void AlertPopupModel::DisplayMessage(std::string_view message, int displaySeconds,
                                     const PopupStyle& style) {
    if (finished_) {
        return;
    }
    sticky_ = displaySeconds < 1;
    noClickClose_ = displaySeconds < 0;
    if (displaySeconds >= 1) {
        ticksLeft_ = ClampToInt(static_cast<long long>(displaySeconds) * kPopupTicksPerSecond);
        text_ = message;
    } else {
        ticksLeft_ = 1;
        text_ = displaySeconds == 0 ? std::string(kClickToCloseLine) + "\r\n" + std::string(message)
                                    : std::string(message);
    }
    if (!initialised_) {
        Initialise();
    }

    label_.left = kLabelLeftPx;
    label_.top = sticky_ ? kStickyLabelTopPx : kTimedLabelTopPx;
    label_.width = std::max(0, ClientWidthPx() - kLabelMarginPx);
    if (env_.labelHeight) {
        // Bounded so that the auto-fit height stays a sane size.
        constexpr int kMaxLabelHeightPx = 100000;
        label_.height = std::clamp(env_.labelHeight(label_.width, text_), 0, kMaxLabelHeightPx);
        if (slot_ == 1 && style.autoFit) {
            height_ = PointsFromPixelsY(label_.top + label_.height + kLabelMarginPx);
        }
    } else {
        label_.height = std::max(0, ClientHeightPx() - label_.top - kLabelLeftPx);
    }

    fadeMode_ = style.fade;
    fill_ = style.fill;
    if (fadeMode_) {
        fadePercent_ = kFadeStartPercent;
        top_ = std::max(RestingTop(), 0.0);
        SetTransparency(fadePercent_);
        topmost_ = true;
    } else {
        slideStep_ = slot_ > 1 ? kSlideStepHigherSlotsPoints : kSlideStepSlot1Points;
    }
    DrawFrame(style.square, style.backColour);
    shown_ = true;
}

void AlertPopupModel::Tick() {
    if (!shown_ || finished_) {
        return;
    }
    if (fadeMode_) {
        FadeTick();
    } else {
        SlideTick();
    }
}

void AlertPopupModel::SlideTick() {
    if (ticksLeft_ > 0) {
        const double resting = RestingTop();
        const double stop = std::max(resting, 0.0);
        if (top_ > 0 && resting < top_) {
            // Stops at the resting place instead of passing it and jumping back on arrival.
            top_ = std::max(top_ - slideStep_, stop);
        } else {
            if (!arrived_) {
                top_ = stop;
                arrived_ = true;
                topmost_ = true;
            }
            if (!sticky_) {
                --ticksLeft_;
            }
        }
        return;
    }
    if (top_ <= screenHeight_) {
        if (arrived_) {
            arrived_ = false;
            topmost_ = false;
        }
        top_ += slideStep_;
    } else {
        Unload();
    }
}

void AlertPopupModel::FadeTick() {
    if (ticksLeft_ > 0) {
        if (fadePercent_ > 0) {
            fadePercent_ -= kFadeStepPercent;
            SetTransparency(fadePercent_);
        } else if (!sticky_) {
            --ticksLeft_;
        }
        return;
    }
    if (fadePercent_ > kFadeEndPercent) {
        Unload();
    } else {
        fadePercent_ += kFadeStepPercent;
        SetTransparency(fadePercent_);
    }
}

void AlertPopupModel::Click() {
    if (shown_ && !noClickClose_) {
        ticksLeft_ = 0;
    }
}

void AlertPopupModel::Dismiss() {
    ticksLeft_ = 0;
}

PopupPhase AlertPopupModel::Phase() const {
    if (!shown_) {
        return PopupPhase::Hidden;
    }
    if (finished_) {
        return PopupPhase::Finished;
    }
    if (ticksLeft_ <= 0) {
        return PopupPhase::Leaving;
    }
    const bool atRest = fadeMode_ ? fadePercent_ <= 0 : arrived_;
    return atRest ? PopupPhase::Resting : PopupPhase::Arriving;
}

PixelRect AlertPopupModel::WindowPixels() const {
    return {RoundToInt(left_ * env_.screen.dotsPerInchX / kPointsPerInch),
            RoundToInt(top_ * env_.screen.dotsPerInchY / kPointsPerInch), ClientWidthPx(),
            ClientHeightPx()};
}

double AlertPopupModel::RestingTop() const {
    return workBottom_ - height_ * slot_;
}

double AlertPopupModel::PointsFromPixelsX(double pixels) const {
    return pixels * kPointsPerInch / env_.screen.dotsPerInchX;
}

double AlertPopupModel::PointsFromPixelsY(double pixels) const {
    return pixels * kPointsPerInch / env_.screen.dotsPerInchY;
}

int AlertPopupModel::ClientWidthPx() const {
    return RoundToInt(width_ * env_.screen.dotsPerInchX / kPointsPerInch);
}

int AlertPopupModel::ClientHeightPx() const {
    return RoundToInt(height_ * env_.screen.dotsPerInchY / kPointsPerInch);
}

void AlertPopupModel::SetTransparency(int percent) {
    if (!env_.translucencySupported) {
        return;
    }
    // alpha = (100 - percent) / 100 × 255; multiplying first keeps the halves exact.
    const long long alpha = RoundHalfEven((100.0 - percent) * 255.0 / 100.0);
    if (alpha < 0 || alpha > 255) {
        return;
    }
    alpha_ = static_cast<std::uint8_t>(alpha);
}

void AlertPopupModel::DrawFrame(bool square, Colour backColour) {
    const int w = ClientWidthPx();
    const int h = ClientHeightPx();
    frame_ = PopupFrame{};
    if (square) {
        frame_.lines = {
            {w - 1, h - 1, w - 1, 0, kButtonFaceColour},
            {w - 1, h - 1, 0, h - 1, kButtonFaceColour},
            {w - 1, 0, 0, 0, kButtonFaceColour},
            {0, h - 1, 0, 0, kButtonFaceColour},
            {w - 2, h - 2, w - 2, 1, backColour},
            {w - 2, h - 2, 1, h - 2, backColour},
            {w - 2, 1, 1, 1, backColour},
            {1, h - 2, 1, 1, backColour},
        };
    } else {
        frame_.shapes = {
            {0, 0, w - 1, h - 1, 20, 20, kButtonFaceColour},
            {1, 1, w - 2, h - 2, 18, 18, backColour},
        };
        frame_.windowShape = RoundedRect{0, 0, w, h, 19, 19, {}};
    }
}

void AlertPopupModel::Unload() {
    finished_ = true;
    slots_.Release(slot_);
}

}  // namespace kickvane::popup
