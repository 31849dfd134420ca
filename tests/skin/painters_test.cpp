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

TEST(PaintersTest, CheckBoxAndOptionButton_CopyTheirCell_OptionShowsTheTargetAroundIt) {
    Skin& k = theSkin();
    QImage target = filled(40, 40, Qt::black);
    ImageSurface image(target);
    ASSERT_TRUE(
        k.paintCheckBox(image, CheckState::Unticked, ControlLook::Pressed, Rect{5, 7, 30, 30})
            .ok());
    EXPECT_EQ(target.copy(5, 7, 13, 13), k.pictures().checkBox.copy(0, 26, 13, 13));
    EXPECT_EQ(target.pixelColor(18, 7), QColor(Qt::black));  // 13 wide, whatever the box

    QImage under = filled(13, 13, Qt::black);
    ImageSurface dc(under);
    ASSERT_TRUE(
        k.paintOptionButton(dc, OptionState::Selected, ControlLook::Hot, Rect{0, 0, 13, 13}).ok());
    const QImage cell = k.pictures().optionButton.copy(0, 5 * 13, 13, 13);
    int shownThrough = 0;
    for (int y = 0; y < 13; ++y) {
        for (int x = 0; x < 13; ++x) {
            const bool key = (cell.pixel(x, y) & 0xFFFFFFu) == kMagentaKey;
            EXPECT_EQ(under.pixel(x, y), key ? QColor(Qt::black).rgb() : cell.pixel(x, y))
                << x << "," << y;
            shownThrough += key ? 1 : 0;
        }
    }
    EXPECT_GT(shownThrough, 0);
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

// Every painter in every look, drawn into a box in the middle of a white image: it draws there
// and nowhere else. The combo box's pictures start 2 pixels left of their box.
TEST(PaintersTest, EveryPainter_DrawsInsideItsBoxAndNowhereElse) {
    Skin& k = theSkin();
    const Rect box{10, 10, 50, 34};
    const Rect wider{8, 10, 50, 33};
    struct Case {
        std::string what;
        Paint paint;
        Rect allowed;
    };
    std::vector<Case> cases;
    const auto add = [&](std::string what, Paint paint, Rect allowed = Rect{10, 10, 50, 34}) {
        cases.push_back({std::move(what), std::move(paint), allowed});
    };
    constexpr ControlLook looks[] = {ControlLook::Normal, ControlLook::Hot, ControlLook::Pressed,
                                     ControlLook::Disabled};
    for (int i = 0; i < 5; ++i) {
        add("button", [&, i](Surface& dc) { k.paintButton(dc, ButtonLook(i), box); });
    }
    for (ControlLook look : looks) {
        for (int state = 0; state < 3; ++state) {
            add("check box", [&, look, state](Surface& dc) {
                (void)k.paintCheckBox(dc, CheckState(state), look, box);
            });
        }
        add("option", [&, look](Surface& dc) {
            (void)k.paintOptionButton(dc, OptionState::Selected, look, box);
        });
        add(
            "combo button", [&, look](Surface& dc) { k.paintComboButton(dc, look, box); }, wider);
        add("toolbar combo button",
            [&, look](Surface& dc) { k.paintToolbarComboButton(dc, look, box); });
        add("size box", [&, look](Surface& dc) { k.paintSizeBox(dc, look, box); });
        for (Orientation bar : {Orientation::Horizontal, Orientation::Vertical}) {
            add("scroll thumb",
                [&, look, bar](Surface& dc) { k.paintScrollThumb(dc, bar, look, box); });
        }
        for (int d = 0; d < 4; ++d) {
            add("spin button",
                [&, look, d](Surface& dc) { k.paintSpinButton(dc, ArrowDirection(d), look, box); });
        }
    }
    for (int d = 0; d < 4; ++d) {
        for (int look = 0; look < 5; ++look) {
            add("scroll button", [&, d, look](Surface& dc) {
                k.paintScrollButton(dc, ArrowDirection(d), ScrollButtonLook(look), box);
            });
        }
    }
    for (Orientation o : {Orientation::Horizontal, Orientation::Vertical}) {
        add("progress trough", [&, o](Surface& dc) { k.paintProgressTrough(dc, o, box); });
        add("progress bar", [&, o](Surface& dc) { k.paintProgressBar(dc, o, box); });
        add("scroll track", [&, o](Surface& dc) { k.paintScrollTrack(dc, o, box); });
        for (int point = 0; point < 3; ++point) {
            for (int look = 0; look < 3; ++look) {
                add("track bar thumb", [&, o, point, look](Surface& dc) {
                    k.paintTrackBarThumb(dc, o, ThumbPoint(point), ThumbLook(look), box);
                });
            }
        }
    }
    add("track bar channel", [&](Surface& dc) { k.paintTrackBarChannel(dc, box); });
    add("list box item",
        [&](Surface& dc) { k.paintListBoxItem(dc, ItemLook::Hot, box, "Sân cỏ mùa xuân"); });
    add("combo field", [&](Surface& dc) { k.paintComboBox(dc, ComboPart::Field, box); });
    add("combo selection", [&](Surface& dc) { k.paintComboBox(dc, ComboPart::Selection, box); });
    add(
        "combo push button", [&](Surface& dc) { k.paintComboBox(dc, ComboPart::PushButton, box); },
        wider);
    add("combo text", [&](Surface& dc) { k.paintComboText(dc, box, "Sân cỏ mùa xuân"); });
    for (int part = 0; part < 6; ++part) {
        add("status bar",
            [&, part](Surface& dc) { k.paintStatusBar(dc, StatusBarPart(part), box); });
    }
    add("tab panel", [&](Surface& dc) { k.paintTabPanel(dc, box); });
    for (int look = 0; look < 4; ++look) {
        add("tab head", [&, look](Surface& dc) { k.paintTabHead(dc, TabLook(look), box); });
        add("list header",
            [&, look](Surface& dc) { k.paintListHeader(dc, HeaderLook(look), box); });
    }
    add("list outline", [&](Surface& dc) { k.paintListOutline(dc, box); });
    for (int part = 0; part < 5; ++part) {
        add("property grid",
            [&, part](Surface& dc) { k.paintPropertyGrid(dc, PropertyGridPart(part), box); });
    }
    add("date field", [&](Surface& dc) { k.paintDate(dc, DatePart::Field, box); });
    add("date button", [&](Surface& dc) { k.paintDate(dc, DatePart::DropButton, box); });
    add("toolbar", [&](Surface& dc) { k.paintToolbarBackground(dc, box); });
    add("toolbar panel", [&](Surface& dc) { k.paintToolbarPanel(dc, box); });
    for (int part = 0; part < 3; ++part) {
        for (int look = 1; look < 6; ++look) {
            add("toolbar button", [&, part, look](Surface& dc) {
                k.paintToolbarButton(dc, ToolbarButtonPart(part), ToolbarLook(look), box);
            });
        }
    }
    const Rect lineEnd{10, 10, 51, 35};  // a separator's line includes its end point
    for (int look = 0; look < 3; ++look) {
        add(
            "separator",
            [&, look](Surface& dc) {
                k.paintMenuBox(dc, MenuBox::Separator, MenuBoxLook(look), box);
            },
            lineEnd);
    }
    for (int part = 0; part < 7; ++part) {
        add("window tab",
            [&, part](Surface& dc) { (void)k.paintWindowTab(dc, WindowTabPart(part), box); });
        for (int look = 0; look < 3; ++look) {
            if (MenuBox(part) == MenuBox::Separator) {
                continue;
            }
            add("menu box", [&, part, look](Surface& dc) {
                k.paintMenuBox(dc, MenuBox(part), MenuBoxLook(look), box);
            });
        }
    }
    for (int part = 0; part < 3; ++part) {
        add("colour popup",
            [&, part](Surface& dc) { (void)k.paintColourPopup(dc, ColourPopupPart(part), box); });
    }
    add("text box", [&](Surface& dc) { k.paintTextBoxOutline(dc, box); });
    for (int part = 0; part < 12; ++part) {
        for (int look = 0; look < 6; ++look) {
            add("menu", [&, part, look](Surface& dc) {
                k.paintMenu(dc, MenuPart(part), MenuLook(look), box);
            });
        }
    }

    const QColor white(Qt::white);
    int drewSomething = 0;
    for (const Case& c : cases) {
        QImage target = filled(60, 44, white);
        ImageSurface dc(target);
        c.paint(dc);
        bool inside = false;
        bool outside = false;
        for (int y = 0; y < target.height(); ++y) {
            for (int x = 0; x < target.width(); ++x) {
                if (target.pixelColor(x, y) == white) {
                    continue;
                }
                const bool in = x >= c.allowed.left && x < c.allowed.right && y >= c.allowed.top &&
                                y < c.allowed.bottom;
                (in ? inside : outside) = true;
            }
        }
        EXPECT_FALSE(outside) << c.what;
        drewSomething += inside ? 1 : 0;
    }
    // Only the looks that a part does not have leave the image white.
    EXPECT_GT(drewSomething, static_cast<int>(cases.size()) * 8 / 10);
}

// Rectangles at the ends of the coordinate range, inverted or far outside the image: nothing
// wraps around into view.
TEST(PaintersTest, RectanglesAtTheCoordinateLimits_DrawNothingIntoView) {
    const int lo = std::numeric_limits<int>::min();
    const int hi = std::numeric_limits<int>::max();
    Skin& k = theSkin();
    using BoxPaint = std::function<void(Surface&, const Rect&)>;
    std::vector<std::pair<std::string, BoxPaint>> painters;
    for (int look = 0; look < 4; ++look) {
        const std::string n = " " + std::to_string(look);
        painters.push_back({"button" + n, [&k, look](Surface& dc, const Rect& box) {
                                k.paintButton(dc, ButtonLook(look), box);
                            }});
        painters.push_back({"scroll button" + n, [&k, look](Surface& dc, const Rect& box) {
                                k.paintScrollButton(dc, ArrowDirection(look),
                                                    ScrollButtonLook(look), box);
                            }});
        painters.push_back({"spin button" + n, [&k, look](Surface& dc, const Rect& box) {
                                k.paintSpinButton(dc, ArrowDirection(look), ControlLook(look), box);
                            }});
        painters.push_back({"combo button" + n, [&k, look](Surface& dc, const Rect& box) {
                                k.paintComboButton(dc, ControlLook(look), box);
                            }});
        painters.push_back({"window tab" + n, [&k, look](Surface& dc, const Rect& box) {
                                (void)k.paintWindowTab(dc, WindowTabPart(look), box);
                            }});
        painters.push_back({"menu" + n, [&k, look](Surface& dc, const Rect& box) {
                                k.paintMenu(dc, MenuPart(6 + look), MenuLook::Normal, box);
                            }});
    }
    for (int part = 0; part < 6; ++part) {
        painters.push_back(
            {"status bar " + std::to_string(part), [&k, part](Surface& dc, const Rect& box) {
                 k.paintStatusBar(dc, StatusBarPart(part), box);
             }});
    }
    painters.push_back({"progress bar", [&k](Surface& dc, const Rect& box) {
                            k.paintProgressBar(dc, Orientation::Horizontal, box);
                        }});
    painters.push_back({"track bar thumb", [&k](Surface& dc, const Rect& box) {
                            k.paintTrackBarThumb(dc, Orientation::Vertical, ThumbPoint::None,
                                                 ThumbLook::Hot, box);
                        }});
    painters.push_back({"list box item", [&k](Surface& dc, const Rect& box) {
                            k.paintListBoxItem(dc, ItemLook::Normal, box, "x");
                        }});
    painters.push_back(
        {"combo text", [&k](Surface& dc, const Rect& box) { k.paintComboText(dc, box, "x"); }});
    for (const Rect& box : {Rect{hi, hi, lo, lo}, Rect{hi - 1, 0, hi, 5},
                            Rect{lo, lo, lo + 1, lo + 1}, Rect{lo, 0, lo + 40, 16}}) {
        for (const auto& [name, paint] : painters) {
            QImage target = filled(16, 16, Qt::white);
            ImageSurface dc(target);
            paint(dc, box);
            EXPECT_EQ(target, filled(16, 16, Qt::white))
                << name << " in " << box.left << "," << box.top << "," << box.right << ","
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
