#include <functional>
#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <QCursor>
#include <QGuiApplication>
#include <QWindow>

#include "filled_image.h"
#include "recording_surface.h"
#include "skin/image_surface.h"
#include "skin/skin.h"

namespace kickvane::skin {
namespace {

using testing::filled;
using testing::RecordingSurface;

class FakePointer final : public PointerProbe {
public:
    explicit FakePointer(WindowHandle at, bool readable = true) : at_(at), readable_(readable) {}
    std::optional<WindowHandle> windowAtCursor() const override {
        return readable_ ? std::optional<WindowHandle>(at_) : std::nullopt;
    }

private:
    WindowHandle at_;
    bool readable_;
};

// One skin for all tests: generating the pictures is the slow part.
Skin& theSkin() {
    static Skin skin;
    return skin;
}

using Paint = std::function<void(Surface&)>;

TEST(PaintersTest, PartsWithoutThatLook_DrawNothing) {
    Skin& k = theSkin();
    const Rect box{0, 0, 40, 20};
    const Paint none[] = {
        [&](Surface& dc) {
            k.paintToolbarButton(dc, ToolbarButtonPart::DropDown, ToolbarLook::Flat, box);
        },
        [&](Surface& dc) { k.paintMenu(dc, MenuPart::BarItem, MenuLook::Normal, box); },
        [&](Surface& dc) { k.paintMenu(dc, MenuPart::ItemHighlight, MenuLook::Normal, box); },
        [&](Surface& dc) { k.paintMenu(dc, MenuPart::Button, MenuLook::Normal, box); },
        [&](Surface& dc) { k.paintMenu(dc, MenuPart::MarkBox, MenuLook::Checked, box); },
        [&](Surface& dc) { k.paintSizeBox(dc, ControlLook::Disabled, box); },
        [&](Surface& dc) { k.paintMenuBox(dc, MenuBox::Item, MenuBoxLook::Pressed, box); },
    };
    for (size_t i = 0; i < std::size(none); ++i) {
        RecordingSurface dc;
        none[i](dc);
        EXPECT_TRUE(dc.calls.empty()) << "case " << i;
    }
}

// Which cell each state and look copies, and the option button's keyed copy, are the gallery
// reference's to check; here, that a larger box does not stretch the 13-pixel cell.
TEST(PaintersTest, CheckBox_CopiesItsCellUnstretchedWhateverTheBox) {
    Skin& k = theSkin();
    QImage target = filled(40, 40, Qt::black);
    ImageSurface image(target);
    ASSERT_TRUE(
        k.paintCheckBox(image, CheckState::Unticked, ControlLook::Pressed, Rect{5, 7, 30, 30})
            .ok());
    EXPECT_EQ(target.copy(5, 7, 13, 13), k.pictures().checkBox.copy(0, 26, 13, 13));
    EXPECT_EQ(target.pixelColor(18, 7), QColor(Qt::black));
}

TEST(PaintersTest, ReportingPainters_ReturnFailuresOfTheirSurface) {
    QImage none;
    ImageSurface nowhere(none);
    Skin& k = theSkin();
    EXPECT_FALSE(
        k.paintColourPopup(nowhere, ColourPopupPart::SelectedCell, Rect{0, 0, 10, 10}).ok());
    EXPECT_FALSE(k.paintWindowTab(nowhere, WindowTabPart::ActiveTab, Rect{0, 0, 80, 20}).ok());
    EXPECT_FALSE(
        k.paintCheckBox(nowhere, CheckState::Ticked, ControlLook::Normal, Rect{0, 0, 13, 13}).ok());
    // Suppressing painters just draw nothing.
    k.paintButton(nowhere, ButtonLook::Normal, Rect{0, 0, 10, 10});
}

using BoxPaint = std::function<void(Surface&, const Rect&)>;

// Every painter in every look; `reach` is how far past each edge of its box it may draw.
struct Painter {
    std::string what;
    BoxPaint paint;
    Rect reach{0, 0, 0, 0};
};

std::vector<Painter> EveryPainter(Skin& k) {
    std::vector<Painter> all;
    const auto add = [&](std::string what, BoxPaint paint, Rect reach = {0, 0, 0, 0}) {
        all.push_back({std::move(what), std::move(paint), reach});
    };
    const Rect comboReach{-2, 0, 0, -1};  // the combo box's pictures start 2 pixels left
    for (int i = 0; i < 5; ++i) {
        add("button", [&k, i](Surface& dc, const Rect& b) { k.paintButton(dc, ButtonLook(i), b); });
    }
    for (ControlLook look :
         {ControlLook::Normal, ControlLook::Hot, ControlLook::Pressed, ControlLook::Disabled}) {
        for (int state = 0; state < 3; ++state) {
            add("check box", [&k, look, state](Surface& dc, const Rect& b) {
                (void)k.paintCheckBox(dc, CheckState(state), look, b);
            });
        }
        add("option", [&k, look](Surface& dc, const Rect& b) {
            (void)k.paintOptionButton(dc, OptionState::Selected, look, b);
        });
        add(
            "combo button",
            [&k, look](Surface& dc, const Rect& b) { k.paintComboButton(dc, look, b); },
            comboReach);
        add("toolbar combo button",
            [&k, look](Surface& dc, const Rect& b) { k.paintToolbarComboButton(dc, look, b); });
        add("size box", [&k, look](Surface& dc, const Rect& b) { k.paintSizeBox(dc, look, b); });
        for (Orientation bar : {Orientation::Horizontal, Orientation::Vertical}) {
            add("scroll thumb", [&k, look, bar](Surface& dc, const Rect& b) {
                k.paintScrollThumb(dc, bar, look, b);
            });
        }
        for (int d = 0; d < 4; ++d) {
            add("spin button", [&k, look, d](Surface& dc, const Rect& b) {
                k.paintSpinButton(dc, ArrowDirection(d), look, b);
            });
        }
    }
    for (int d = 0; d < 4; ++d) {
        for (int look = 0; look < 5; ++look) {
            add("scroll button", [&k, d, look](Surface& dc, const Rect& b) {
                k.paintScrollButton(dc, ArrowDirection(d), ScrollButtonLook(look), b);
            });
        }
    }
    for (Orientation o : {Orientation::Horizontal, Orientation::Vertical}) {
        add("progress trough",
            [&k, o](Surface& dc, const Rect& b) { k.paintProgressTrough(dc, o, b); });
        add("progress bar", [&k, o](Surface& dc, const Rect& b) { k.paintProgressBar(dc, o, b); });
        add("scroll track", [&k, o](Surface& dc, const Rect& b) { k.paintScrollTrack(dc, o, b); });
        for (int point = 0; point < 3; ++point) {
            for (int look = 0; look < 3; ++look) {
                add("track bar thumb", [&k, o, point, look](Surface& dc, const Rect& b) {
                    k.paintTrackBarThumb(dc, o, ThumbPoint(point), ThumbLook(look), b);
                });
            }
        }
    }
    add("track bar channel", [&k](Surface& dc, const Rect& b) { k.paintTrackBarChannel(dc, b); });
    for (ItemLook look : {ItemLook::Normal, ItemLook::Hot}) {
        add("list box item", [&k, look](Surface& dc, const Rect& b) {
            k.paintListBoxItem(dc, look, b, "Sân cỏ mùa xuân");
        });
    }
    for (int part = 0; part < 3; ++part) {
        add(
            "combo box",
            [&k, part](Surface& dc, const Rect& b) { k.paintComboBox(dc, ComboPart(part), b); },
            ComboPart(part) == ComboPart::PushButton ? comboReach : Rect{0, 0, 0, 0});
    }
    add("combo text",
        [&k](Surface& dc, const Rect& b) { k.paintComboText(dc, b, "Sân cỏ mùa xuân"); });
    for (int part = 0; part < 6; ++part) {
        add("status bar", [&k, part](Surface& dc, const Rect& b) {
            k.paintStatusBar(dc, StatusBarPart(part), b);
        });
    }
    add("tab panel", [&k](Surface& dc, const Rect& b) { k.paintTabPanel(dc, b); });
    for (int look = 0; look < 4; ++look) {
        add("tab head",
            [&k, look](Surface& dc, const Rect& b) { k.paintTabHead(dc, TabLook(look), b); });
        add("list header",
            [&k, look](Surface& dc, const Rect& b) { k.paintListHeader(dc, HeaderLook(look), b); });
    }
    add("list outline", [&k](Surface& dc, const Rect& b) { k.paintListOutline(dc, b); });
    for (int part = 0; part < 5; ++part) {
        add("property grid", [&k, part](Surface& dc, const Rect& b) {
            k.paintPropertyGrid(dc, PropertyGridPart(part), b);
        });
    }
    add("date field", [&k](Surface& dc, const Rect& b) { k.paintDate(dc, DatePart::Field, b); });
    add("date button",
        [&k](Surface& dc, const Rect& b) { k.paintDate(dc, DatePart::DropButton, b); });
    add("toolbar", [&k](Surface& dc, const Rect& b) { k.paintToolbarBackground(dc, b); });
    add("toolbar panel", [&k](Surface& dc, const Rect& b) { k.paintToolbarPanel(dc, b); });
    for (int part = 0; part < 3; ++part) {
        for (int look = 1; look < 6; ++look) {
            add("toolbar button", [&k, part, look](Surface& dc, const Rect& b) {
                k.paintToolbarButton(dc, ToolbarButtonPart(part), ToolbarLook(look), b);
            });
        }
    }
    for (int part = 0; part < 7; ++part) {
        add("window tab", [&k, part](Surface& dc, const Rect& b) {
            (void)k.paintWindowTab(dc, WindowTabPart(part), b);
        });
        for (int look = 0; look < 3; ++look) {
            // A separator's line includes its end point.
            add(
                MenuBox(part) == MenuBox::Separator ? "separator" : "menu box",
                [&k, part, look](Surface& dc, const Rect& b) {
                    k.paintMenuBox(dc, MenuBox(part), MenuBoxLook(look), b);
                },
                MenuBox(part) == MenuBox::Separator ? Rect{0, 0, 1, 1} : Rect{0, 0, 0, 0});
        }
    }
    for (int part = 0; part < 3; ++part) {
        add("colour popup", [&k, part](Surface& dc, const Rect& b) {
            (void)k.paintColourPopup(dc, ColourPopupPart(part), b);
        });
    }
    add("text box", [&k](Surface& dc, const Rect& b) { k.paintTextBoxOutline(dc, b); });
    for (int part = 0; part < 12; ++part) {
        for (int look = 0; look < 6; ++look) {
            add("menu", [&k, part, look](Surface& dc, const Rect& b) {
                k.paintMenu(dc, MenuPart(part), MenuLook(look), b);
            });
        }
    }
    return all;
}

// Every painter in every look, drawn into a box in the middle of a white image: it draws there
// and nowhere else.
TEST(PaintersTest, EveryPainter_DrawsInsideItsBoxAndNowhereElse) {
    const Rect box{10, 10, 50, 34};
    const QColor white(Qt::white);
    const std::vector<Painter> painters = EveryPainter(theSkin());
    int drewSomething = 0;
    for (const Painter& p : painters) {
        QImage target = filled(60, 44, white);
        ImageSurface dc(target);
        p.paint(dc, box);
        bool inside = false;
        bool outside = false;
        for (int y = 0; y < target.height(); ++y) {
            for (int x = 0; x < target.width(); ++x) {
                if (target.pixelColor(x, y) == white) {
                    continue;
                }
                const bool in = x >= box.left + p.reach.left && x < box.right + p.reach.right &&
                                y >= box.top + p.reach.top && y < box.bottom + p.reach.bottom;
                (in ? inside : outside) = true;
            }
        }
        EXPECT_FALSE(outside) << p.what;
        drewSomething += inside ? 1 : 0;
    }
    // Only the looks that a part does not have leave the image white.
    EXPECT_GT(drewSomething, static_cast<int>(painters.size()) * 8 / 10);
}

// Rectangles at the ends of the coordinate range, inverted or far outside the image: nothing
// wraps around into view.
TEST(PaintersTest, RectanglesAtTheCoordinateLimits_DrawNothingIntoView) {
    const int lo = std::numeric_limits<int>::min();
    const int hi = std::numeric_limits<int>::max();
    const std::vector<Painter> painters = EveryPainter(theSkin());
    for (const Rect& box : {Rect{hi, hi, lo, lo}, Rect{hi - 1, 0, hi, 5},
                            Rect{lo, lo, lo + 1, lo + 1}, Rect{lo, 0, lo + 40, 16}}) {
        for (const Painter& p : painters) {
            if (p.what == "separator" && box.left > box.right) {
                continue;  // a line from corner to corner: it does cross the view
            }
            QImage target = filled(16, 16, Qt::white);
            ImageSurface dc(target);
            p.paint(dc, box);
            EXPECT_EQ(target, filled(16, 16, Qt::white))
                << p.what << " in " << box.left << "," << box.top << "," << box.right << ","
                << box.bottom;
        }
    }
}

TEST(PaintersTest, IsUnderCursor_OnlyForTheWindowItself_NotItsParent) {
    Skin skin(makeSkinPictures());
    skin.setPointerProbe(std::make_shared<FakePointer>(42, false));
    EXPECT_FALSE(skin.isUnderCursor(42).has_value());

    QWindow parent;
    parent.setGeometry(100, 100, 200, 200);
    QWindow child(&parent);
    child.setGeometry(10, 10, 50, 50);
    parent.show();
    child.show();
    QCursor::setPos(130, 130);
    if (QCursor::pos() != QPoint(130, 130) ||
        QGuiApplication::topLevelAt(QCursor::pos()) == nullptr) {
        GTEST_SKIP() << "this platform does not place the cursor";
    }
    skin.setPointerProbe(std::make_shared<QtPointerProbe>());
    EXPECT_EQ(skin.isUnderCursor(static_cast<WindowHandle>(parent.winId())), false);
    EXPECT_EQ(skin.isUnderCursor(static_cast<WindowHandle>(child.winId())), true);
    QCursor::setPos(250, 250);
    EXPECT_EQ(skin.isUnderCursor(static_cast<WindowHandle>(parent.winId())), true);
}

}  // namespace
}  // namespace kickvane::skin
