#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kickvane::popup {

// The alert popup as a model without a window or a timer: a window shows what the model says and
// calls Tick() every kPopupTickInterval. The window's place and size are kept in points (1/72
// inch), so a popup has the same size and speed on screens of any density; everything drawn
// inside it is in pixels.

// The popup was timed on a timer that fired at the system timer's granularity; keeping that
// interval keeps the length of a popup's life (DisplaySeconds × kPopupTicksPerSecond ticks).
inline constexpr std::chrono::microseconds kPopupTickInterval{15625};
inline constexpr int kPopupTicksPerSecond = 80;

// A colour: an RGB value (0xRRGGBB), or the system's colour of a button's face, which the window
// takes from its palette.
struct Colour {
    std::uint32_t rgb = 0;
    bool buttonFace = false;
    friend bool operator==(const Colour&, const Colour&) = default;
};
inline constexpr Colour kButtonFaceColour{0, true};
inline constexpr Colour kPopupBackgroundColour{0x00C000};  // green
inline constexpr Colour kPopupTextColour{0xFFFFFF};
// The fill of a popup that reports failures: a dark red that white text reads well on (6.8:1),
// and that is not taken for a confirmation.
inline constexpr Colour kFailurePopupColour{0xB00000};
inline constexpr std::string_view kPopupCaption = "Thông báo";
inline constexpr std::string_view kPopupFontFamily = "Tahoma";
inline constexpr double kPopupFontPointSize = 9.75;
inline constexpr double kPopupInitialWidthPoints = 120;
inline constexpr double kPopupInitialHeightPoints = 100;
// The first line of a popup that waits for a click.
inline constexpr std::string_view kClickToCloseLine = "(click here to close)";

// The eight places in which popups stack upwards from the bottom of the work area. Slots 1 to 7
// belong to one popup each; when they are all taken, further popups share slot 8. Used on the
// user-interface thread only.
class PopupSlots {
public:
    static constexpr int kSlotCount = 8;

    // The slots that all popups of the process share.
    static PopupSlots& Shared();

    // Takes the lowest free slot from 1 to 7, or slot 8 when those are all taken.
    int Take();
    // Toggles the slot's bit: clears it for slots 1 to 7. Slot 8 is never looked at when taking.
    void Release(int slot);
    // Bit k - 1 is set while slot k (1 to 7) is taken.
    std::uint8_t Mask() const { return mask_; }

private:
    std::uint8_t mask_ = 0;
};

struct ScreenMetrics {
    int workAreaRightPx = 0;     // right edge of the desktop work area (exclusive), in pixels
    int workAreaBottomPx = 0;    // bottom edge of the desktop work area (exclusive), in pixels
    int screenHeightPx = 0;      // height of the whole screen, in pixels
    double dotsPerInchX = 96.0;  // the screen's logical density
    double dotsPerInchY = 96.0;
};

// The height in pixels that the label needs to show `text` (UTF-8) wrapped to `widthPx`.
using LabelHeightFn = std::function<int(int widthPx, std::string_view text)>;

struct PopupEnvironment {
    ScreenMetrics screen;
    // The window system can make a window translucent; without it fade mode keeps its timing but
    // the window stays opaque.
    bool translucencySupported = false;
    // Without it the label fills the popup below its top and auto-fit leaves the height alone.
    LabelHeightFn labelHeight;
    // Null: PopupSlots::Shared().
    PopupSlots* slotTable = nullptr;
};

struct PixelRect {
    int left = 0;
    int top = 0;
    int width = 0;
    int height = 0;
    friend bool operator==(const PixelRect&, const PixelRect&) = default;
};

struct FrameLine {
    int x1 = 0;
    int y1 = 0;
    int x2 = 0;
    int y2 = 0;
    Colour colour;
    friend bool operator==(const FrameLine&, const FrameLine&) = default;
};

// A rectangle with rounded corners from (left, top) to (right, bottom), corner ellipse of
// ellipseWidth × ellipseHeight.
struct RoundedRect {
    int left = 0;
    int top = 0;
    int right = 0;
    int bottom = 0;
    int ellipseWidth = 0;
    int ellipseHeight = 0;
    Colour colour;
    friend bool operator==(const RoundedRect&, const RoundedRect&) = default;
};

// What the popup draws in its client area (pixels), in drawing order, and the window's shape.
struct PopupFrame {
    std::vector<FrameLine> lines;            // square frame
    std::vector<RoundedRect> shapes;         // rounded frame
    std::optional<RoundedRect> windowShape;  // rounded frame: the window is cut to this (no colour)
};

enum class PopupPhase {
    Hidden,    // DisplayMessage not called yet
    Arriving,  // rising (slide) or fading in (fade)
    Resting,   // at its place, counting down unless sticky
    Leaving,   // sliding down or fading out
    Finished,  // unloaded: the window closes; the slot is free again
};

// How a popup shows itself. The tool's own popups slide, fit their height to the text, and have
// a square frame with a cream inner line.
struct PopupStyle {
    bool fade = false;            // fades in place instead of sliding
    bool autoFit = true;          // fits the height to the text (in slot 1)
    bool square = true;           // a two-line rectangular frame instead of rounded corners
    Colour backColour{0xFFFFC0};  // the inner line or shape: cream
    Colour fill = kPopupBackgroundColour;  // the background under the text
};

// The style of a popup that reports failures: the tool's own, on red.
inline PopupStyle FailureStyle() {
    PopupStyle style;
    style.fill = kFailurePopupColour;
    return style;
}

class AlertPopupModel {
public:
    explicit AlertPopupModel(PopupEnvironment environment);
    ~AlertPopupModel();  // releases the slot if the popup has not finished
    AlertPopupModel(const AlertPopupModel&) = delete;
    AlertPopupModel& operator=(const AlertPopupModel&) = delete;

    // Shows `message` (UTF-8). displaySeconds >= 1: stays that many × 80 ticks after arriving;
    // 0: stays until clicked; negative: stays until dismissed.
    void DisplayMessage(std::string_view message, int displaySeconds, const PopupStyle& style = {});

    // One step of the motion; call every kPopupTickInterval while the popup is shown.
    void Tick();
    // A click on the window or its text: the popup leaves unless it ignores clicks.
    void Click();
    // Sends the popup away at the next tick, even one that ignores clicks.
    void Dismiss();

    PopupPhase Phase() const;
    bool Shown() const { return shown_; }
    bool Finished() const { return finished_; }
    int Slot() const { return slot_; }  // 0 until shown

    // The window's place and size, in points.
    double LeftPoints() const { return left_; }
    double TopPoints() const { return top_; }
    double WidthPoints() const { return width_; }
    double HeightPoints() const { return height_; }
    PixelRect WindowPixels() const;
    // The label, in the window's client pixels.
    PixelRect LabelPixels() const { return label_; }
    const std::string& Text() const { return text_; }
    Colour Fill() const { return fill_; }
    const PopupFrame& Frame() const { return frame_; }
    bool Topmost() const { return topmost_; }
    // The window's opacity, 0 to 255; nullopt while it has never been made translucent.
    std::optional<std::uint8_t> Alpha() const { return alpha_; }

private:
    void Initialise();
    double RestingTop() const;
    double PointsFromPixelsX(double pixels) const;
    double PointsFromPixelsY(double pixels) const;
    int ClientWidthPx() const;
    int ClientHeightPx() const;
    void SetTransparency(int percent);
    void DrawFrame(bool square, Colour backColour);
    void SlideTick();
    void FadeTick();
    void Unload();

    PopupEnvironment env_;
    PopupSlots& slots_;

    // In points.
    double left_ = 0;
    double top_ = 0;
    double width_ = kPopupInitialWidthPoints;
    double height_ = kPopupInitialHeightPoints;
    double workBottom_ = 0;
    double screenHeight_ = 0;
    double slideStep_ = 0;

    int fadePercent_ = 0;  // the window's transparency while fading
    int ticksLeft_ = 0;
    int slot_ = 0;
    bool initialised_ = false;
    bool shown_ = false;
    bool finished_ = false;
    bool arrived_ = false;
    bool sticky_ = false;
    bool noClickClose_ = false;
    bool fadeMode_ = false;
    bool topmost_ = false;
    std::optional<std::uint8_t> alpha_;

    std::string text_;
    Colour fill_ = kPopupBackgroundColour;
    PixelRect label_;
    PopupFrame frame_;
};

// Rounds to the nearest whole number, halves to the even neighbour.
long long RoundHalfEven(double value);

}  // namespace kickvane::popup
