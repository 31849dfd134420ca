#include "skin/gallery.h"

#include <memory>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include <QCoreApplication>
#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <QString>

#include "skin/image_surface.h"
#include "skin/skin.h"

namespace kickvane::skin {
namespace {

constexpr int kSheetWidth = 1180;
constexpr int kLabelWidth = 200;
constexpr int kCaptionHeight = 14;
constexpr int kGap = 10;

// Lays out labelled rows of cells on the sheet, left to right, wrapping at the sheet's edge.
class Sheet {
public:
    explicit Sheet(QImage& image) : image_(image) {}

    void title(const QString& text) {
        QPainter painter(&image_);
        QFont font = painter.font();
        font.setPointSize(font.pointSize() + 5);
        font.setBold(true);
        painter.setFont(font);
        painter.setPen(QColor(40, 56, 84));
        painter.drawText(QRect(kGap, y_, kSheetWidth - 2 * kGap, 34),
                         Qt::AlignLeft | Qt::AlignVCenter, text);
        y_ += 44;
    }

    // Starts a row of cells under `label`.
    void row(const QString& label) {
        finish();
        QPainter painter(&image_);
        painter.setPen(QColor(200, 208, 220));
        painter.drawLine(kGap, y_ - 5, kSheetWidth - kGap, y_ - 5);
        QFont font = painter.font();
        font.setBold(true);
        painter.setFont(font);
        painter.setPen(QColor(40, 56, 84));
        painter.drawText(QRect(kGap, y_, kLabelWidth - kGap, 20), Qt::AlignLeft | Qt::AlignTop,
                         label);
        x_ = kLabelWidth;
        rowTop_ = y_;
        rowBottom_ = y_ + 20;
    }

    // A cell of `width` x `height` with `caption` under it; returns where to paint.
    Rect cell(int width, int height, const QString& caption) {
        const QFontMetrics metrics(QFont{});
        const int captionWidth = metrics.horizontalAdvance(caption) + 4;
        const int slot = std::max(width, captionWidth);
        if (x_ + slot > kSheetWidth - kGap && x_ > kLabelWidth) {
            x_ = kLabelWidth;
            rowTop_ = rowBottom_ + kGap;
        }
        const Rect cell{x_, rowTop_, x_ + width, rowTop_ + height};
        QPainter painter(&image_);
        painter.setPen(QColor(90, 100, 118));
        QFont font = painter.font();
        font.setPointSize(std::max(6, font.pointSize() - 2));
        painter.setFont(font);
        painter.drawText(QRect(x_, rowTop_ + height + 2, slot + 40, kCaptionHeight),
                         Qt::AlignLeft | Qt::AlignTop, caption);
        x_ += slot + kGap;
        rowBottom_ = std::max(rowBottom_, rowTop_ + height + 2 + kCaptionHeight);
        return cell;
    }

    int finish() {
        y_ = std::max(y_, rowBottom_ + 2 * kGap);
        return y_;
    }

private:
    QImage& image_;
    int y_ = kGap;
    int x_ = kLabelWidth;
    int rowTop_ = kGap;
    int rowBottom_ = 0;
};

QString number(int v) {
    return QString::number(v);
}

// The text the gallery's list and combo boxes show.
constexpr const char* kItemText = "Sân cỏ mùa xuân";

// Draws every painter; collects the failures the reporting painters return. Row labels and
// captions keep the wording and numbering the sheet was first drawn with, so sheets compare.
void drawPainters(Skin& skin, ImageSurface& dc, Sheet& sheet, std::vector<std::string>& faults) {
    const auto check = [&](Status s, const char* what) {
        if (!s) {
            faults.push_back(std::string(what) + ": " + s.reason());
        }
    };
    constexpr ControlLook kLooks[] = {ControlLook::Normal, ControlLook::Hot, ControlLook::Pressed,
                                      ControlLook::Disabled};

    sheet.row("ThemeButton");
    {
        const char* names[] = {"normal", "hot", "pressed", "disabled", "default"};
        const ButtonLook looks[] = {ButtonLook::Normal, ButtonLook::Hot, ButtonLook::Pressed,
                                    ButtonLook::Disabled, ButtonLook::Default};
        for (int i = 0; i < 5; ++i) {
            skin.paintButton(dc, looks[i], sheet.cell(80, 24, names[i]));
        }
        skin.paintButton(dc, ButtonLook::Normal, sheet.cell(140, 40, "normal, large"));
    }

    sheet.row("ThemeCheck");
    for (CheckState state : {CheckState::Unticked, CheckState::Ticked, CheckState::Mixed}) {
        for (ControlLook look : kLooks) {
            const int n = 4 * static_cast<int>(state) + static_cast<int>(look) + 1;
            check(skin.paintCheckBox(dc, state, look, sheet.cell(13, 13, number(n))), "check box");
        }
    }
    sheet.row("ThemeOption");
    for (OptionState state : {OptionState::Clear, OptionState::Selected}) {
        for (ControlLook look : kLooks) {
            const int n = 4 * static_cast<int>(state) + static_cast<int>(look) + 1;
            check(skin.paintOptionButton(dc, state, look, sheet.cell(13, 13, number(n))),
                  "option button");
        }
    }

    sheet.row("ThemeProgress");
    {
        const Rect lying = sheet.cell(180, 18, "lying, 60 %");
        skin.paintProgressTrough(dc, Orientation::Horizontal, lying);
        skin.paintProgressBar(dc, Orientation::Horizontal,
                              Rect{lying.left, lying.top, lying.left + 110, lying.bottom});
        const Rect upright = sheet.cell(18, 100, "upright, 40 %");
        skin.paintProgressTrough(dc, Orientation::Vertical, upright);
        skin.paintProgressBar(dc, Orientation::Vertical,
                              Rect{upright.left, upright.top, upright.right, upright.top + 42});
        skin.paintProgressTrough(dc, Orientation::Horizontal, sheet.cell(180, 18, "trough only"));
    }

    sheet.row("ThemeScroll buttons");
    for (ArrowDirection direction :
         {ArrowDirection::Left, ArrowDirection::Right, ArrowDirection::Up, ArrowDirection::Down}) {
        struct Look {
            ScrollButtonLook look;
            const char* name;
        };
        for (const Look& look :
             {Look{ScrollButtonLook::Normal, "normal"}, Look{ScrollButtonLook::Hover, "hover"},
              Look{ScrollButtonLook::Hot, "hot"}, Look{ScrollButtonLook::Pressed, "pressed"},
              Look{ScrollButtonLook::Disabled, "disabled"}}) {
            skin.paintScrollButton(dc, direction, look.look, sheet.cell(17, 17, look.name));
        }
    }
    sheet.row("ThemeScroll bars");
    {
        const Rect bar = sheet.cell(200, 17, "lying bar");
        skin.paintScrollTrack(dc, Orientation::Horizontal,
                              Rect{bar.left + 17, bar.top, bar.right - 17, bar.bottom});
        skin.paintScrollButton(dc, ArrowDirection::Left, ScrollButtonLook::Normal,
                               Rect{bar.left, bar.top, bar.left + 17, bar.bottom});
        skin.paintScrollButton(dc, ArrowDirection::Right, ScrollButtonLook::Normal,
                               Rect{bar.right - 17, bar.top, bar.right, bar.bottom});
        skin.paintScrollThumb(dc, Orientation::Horizontal, ControlLook::Normal,
                              Rect{bar.left + 50, bar.top, bar.left + 110, bar.bottom});
        const Rect upright = sheet.cell(17, 120, "upright bar");
        skin.paintScrollTrack(
            dc, Orientation::Vertical,
            Rect{upright.left, upright.top + 17, upright.right, upright.bottom - 17});
        skin.paintScrollButton(dc, ArrowDirection::Up, ScrollButtonLook::Normal,
                               Rect{upright.left, upright.top, upright.right, upright.top + 17});
        skin.paintScrollButton(
            dc, ArrowDirection::Down, ScrollButtonLook::Normal,
            Rect{upright.left, upright.bottom - 17, upright.right, upright.bottom});
        skin.paintScrollThumb(
            dc, Orientation::Vertical, ControlLook::Hot,
            Rect{upright.left, upright.top + 30, upright.right, upright.top + 70});
        for (ControlLook look : kLooks) {
            skin.paintScrollThumb(dc, Orientation::Horizontal, look,
                                  sheet.cell(50, 17, "thumb " + number(static_cast<int>(look))));
        }
        const ControlLook boxes[] = {ControlLook::Normal, ControlLook::Pressed, ControlLook::Hot};
        for (int i = 0; i < 3; ++i) {
            skin.paintSizeBox(dc, boxes[i], sheet.cell(17, 17, "box " + number(i)));
        }
    }

    sheet.row("ThemeSpinButton");
    {
        struct Button {
            ArrowDirection direction;
            const char* name;
        };
        for (const Button& button :
             {Button{ArrowDirection::Up, "up"}, Button{ArrowDirection::Down, "down"},
              Button{ArrowDirection::Left, "left"}, Button{ArrowDirection::Right, "right"}}) {
            const bool upDown =
                button.direction == ArrowDirection::Up || button.direction == ArrowDirection::Down;
            for (ControlLook look : kLooks) {
                skin.paintSpinButton(
                    dc, button.direction, look,
                    sheet.cell(upDown ? 17 : 10, upDown ? 10 : 17,
                               QString(button.name) + " " + number(static_cast<int>(look))));
            }
        }
    }

    sheet.row("ThemeTrackbar");
    for (Orientation bar : {Orientation::Horizontal, Orientation::Vertical}) {
        const bool lying = bar == Orientation::Horizontal;
        const Rect channelCell =
            sheet.cell(lying ? 120 : 24, lying ? 24 : 100, lying ? "lying" : "upright");
        const Rect channel = lying ? Rect{channelCell.left, channelCell.top + 9, channelCell.right,
                                          channelCell.top + 13}
                                   : Rect{channelCell.left + 9, channelCell.top,
                                          channelCell.left + 13, channelCell.bottom};
        skin.paintTrackBarChannel(dc, channel);
        const Rect thumb = lying ? Rect{channelCell.left + 40, channelCell.top,
                                        channelCell.left + 51, channelCell.top + 21}
                                 : Rect{channelCell.left, channelCell.top + 40,
                                        channelCell.left + 21, channelCell.top + 51};
        skin.paintTrackBarThumb(dc, bar, ThumbPoint::BottomOrRight, ThumbLook::Normal, thumb);
        const ThumbPoint points[] = {ThumbPoint::TopOrLeft, ThumbPoint::BottomOrRight,
                                     ThumbPoint::None};
        for (int ticks = 0; ticks < 3; ++ticks) {
            struct Look {
                ThumbLook look;
                const char* name;
            };
            for (const Look& look : {Look{ThumbLook::Normal, ""}, Look{ThumbLook::Hot, " hot"},
                                     Look{ThumbLook::Disabled, " off"}}) {
                const int width = lying ? (ticks == 2 ? 15 : 11) : 21;
                const int height = lying ? 21 : (ticks == 2 ? 15 : 11);
                skin.paintTrackBarThumb(dc, bar, points[ticks], look.look,
                                        sheet.cell(width, height, "t" + number(ticks) + look.name));
            }
        }
    }

    sheet.row("ThemeTab");
    {
        const Rect panel = sheet.cell(260, 90, "panel and heads 0-3");
        skin.paintTabPanel(dc, Rect{panel.left, panel.top + 22, panel.right, panel.bottom});
        // The selected head last, over its neighbours.
        const TabLook looks[] = {TabLook::Normal, TabLook::Hot, TabLook::SelectedFocused,
                                 TabLook::Selected};
        const int lefts[] = {0, 60, 180, 120};
        for (int i = 0; i < 4; ++i) {
            const int top = looks[i] == TabLook::Selected ? panel.top : panel.top + 2;
            skin.paintTabHead(
                dc, looks[i],
                Rect{panel.left + lefts[i] + 2, top, panel.left + lefts[i] + 62, panel.top + 23});
        }
    }

    sheet.row("ThemeListbox");
    skin.paintListBoxItem(dc, ItemLook::Normal, sheet.cell(180, 24, "plDraw 1"), kItemText);
    skin.paintListBoxItem(dc, ItemLook::Hot, sheet.cell(180, 24, "plDraw 2"), kItemText);

    sheet.row("ThemeCombobox");
    {
        const Rect field = sheet.cell(180, 21, "field, text, button");
        skin.paintComboBox(dc, ComboPart::Field, field);
        skin.paintComboText(dc, Rect{field.left + 4, field.top, field.right - 17, field.bottom},
                            kItemText);
        skin.paintComboButton(dc, ControlLook::Normal,
                              Rect{field.right - 15, field.top + 1, field.right - 1, field.bottom});
        const Rect selected = sheet.cell(120, 18, "selection");
        skin.paintComboBox(dc, ComboPart::Selection, selected);
        skin.paintComboText(dc, selected, kItemText);
        for (ControlLook look : kLooks) {
            const Rect cell = sheet.cell(17, 20, "button " + number(static_cast<int>(look) + 1));
            skin.paintComboButton(dc, look,
                                  Rect{cell.left + 2, cell.top, cell.right, cell.bottom + 1});
        }
        const Rect push = sheet.cell(60, 21, "plDraw 2");
        skin.paintComboBox(dc, ComboPart::PushButton,
                           Rect{push.left + 2, push.top, push.right, push.bottom + 1});
    }

    sheet.row("ThemePropertyGrid");
    skin.paintPropertyGrid(dc, PropertyGridPart::Panel, sheet.cell(90, 50, "panel"));
    skin.paintPropertyGrid(dc, PropertyGridPart::FocusFrame, sheet.cell(90, 50, "focus"));
    skin.paintPropertyGrid(dc, PropertyGridPart::Cell, sheet.cell(90, 18, "cell 0"));
    skin.paintPropertyGrid(dc, PropertyGridPart::SelectedCell, sheet.cell(90, 18, "cell 1"));
    skin.paintPropertyGrid(dc, PropertyGridPart::CategoryRow, sheet.cell(90, 18, "cell 2"));

    sheet.row("ThemeDate");
    {
        const Rect date = sheet.cell(140, 22, "field and button");
        skin.paintDate(dc, DatePart::Field, date);
        skin.paintDate(dc, DatePart::DropButton,
                       Rect{date.right - 19, date.top + 2, date.right - 2, date.bottom - 2});
    }

    sheet.row("DrawListview");
    for (HeaderLook look :
         {HeaderLook::Empty, HeaderLook::Normal, HeaderLook::Hot, HeaderLook::Pressed}) {
        skin.paintListHeader(dc, look,
                             sheet.cell(80, 21, "header " + number(static_cast<int>(look))));
    }
    skin.paintListHeader(dc, HeaderLook::Normal, sheet.cell(80, 21, "plDraw 1"));
    skin.paintListOutline(dc, sheet.cell(80, 40, "plDraw 2"));

    sheet.row("ThemeStatusBar");
    {
        const Rect bar = sheet.cell(400, 22, "bar, panels, progress, grip");
        skin.paintStatusBar(dc, StatusBarPart::Bar, bar);
        skin.paintStatusBar(dc, StatusBarPart::Panel,
                            Rect{bar.left + 4, bar.top + 3, bar.left + 150, bar.bottom});
        skin.paintStatusBar(dc, StatusBarPart::ProgressTrough,
                            Rect{bar.left + 160, bar.top + 3, bar.left + 300, bar.bottom - 1});
        skin.paintStatusBar(dc, StatusBarPart::ProgressBar,
                            Rect{bar.left + 160, bar.top + 3, bar.left + 240, bar.bottom - 1});
        skin.paintStatusBar(dc, StatusBarPart::SizeGrip,
                            Rect{bar.right - 18, bar.top, bar.right, bar.bottom});
        skin.paintStatusBar(dc, StatusBarPart::SimpleBar, sheet.cell(200, 22, "simple mode"));
    }

    sheet.row("ThemeCommandBarMenu");
    for (int part = 0; part <= 11; ++part) {
        const auto menuPart = static_cast<MenuPart>(part);
        // Three looks of each part; a menu's own buttons have no normal look.
        MenuLook looks[] = {MenuLook::Normal, MenuLook::Hot, MenuLook::Disabled};
        if (menuPart == MenuPart::BarItem) {
            looks[2] = MenuLook::Open;
        } else if (menuPart == MenuPart::Button) {
            looks[0] = MenuLook::Hot, looks[1] = MenuLook::Pressed, looks[2] = MenuLook::Checked;
        }
        for (int i = 0; i < 3; ++i) {
            const bool mark = part >= 3 && part <= 7;
            skin.paintMenu(dc, menuPart, looks[i],
                           sheet.cell(mark ? 20 : 48, 20, number(part) + "/" + number(i)));
        }
    }

    sheet.row("ThemeUniToolbar");
    {
        const Rect bar = sheet.cell(360, 30, "background and items");
        // The toolbar is drawn on its own picture, which is then placed on the sheet.
        QImage toolbar(bar.right - bar.left, bar.bottom - bar.top, QImage::Format_RGB32);
        toolbar.fill(QColor(236, 239, 244));
        ImageSurface tb(toolbar);
        skin.paintToolbarBackground(tb, Rect{0, 0, toolbar.width(), toolbar.height()});
        int left = 4;
        for (ToolbarLook look : {ToolbarLook::Hot, ToolbarLook::Pressed, ToolbarLook::Checked,
                                 ToolbarLook::CheckedHot, ToolbarLook::Raised}) {
            skin.paintToolbarButton(tb, ToolbarButtonPart::Button, look,
                                    Rect{left, 4, left + 23, 26});
            left += 27;
        }
        skin.paintToolbarButton(tb, ToolbarButtonPart::ButtonWithDropDown, ToolbarLook::Hot,
                                Rect{left, 4, left + 34, 26});
        left += 38;
        skin.paintToolbarButton(tb, ToolbarButtonPart::DropDown, ToolbarLook::Pressed,
                                Rect{left, 4, left + 11, 26});
        left += 15;
        skin.paintToolbarComboButton(tb, ControlLook::Hot, Rect{left, 4, left + 15, 26});
        left += 19;
        skin.paintToolbarPanel(tb, Rect{left, 4, left + 60, 26});
        check(dc.copy(toolbar, Piece{0, 0, toolbar.width(), toolbar.height()},
                      Piece{bar.left, bar.top, toolbar.width(), toolbar.height()}),
              "toolbar");
    }

    sheet.row("ThemeMDITab");
    {
        const Rect strip = sheet.cell(300, 60, "strip, tabs, frame, buttons");
        const auto [l, t, r, b] = strip;
        const std::pair<WindowTabPart, Rect> parts[] = {
            {WindowTabPart::PageFrame, Rect{l, t + 18, r, b}},
            {WindowTabPart::Strip, Rect{l, t, r, t + 19}},
            {WindowTabPart::InactiveTab, Rect{l + 84, t + 2, l + 164, t + 19}},
            {WindowTabPart::Divider, Rect{l + 164, t + 2, l + 165, t + 19}},
            {WindowTabPart::InactiveTab, Rect{l + 165, t + 2, l + 245, t + 19}},
            {WindowTabPart::ActiveTab, Rect{l + 4, t + 1, l + 84, t + 19}},
            {WindowTabPart::HotButton, Rect{r - 36, t + 3, r - 20, t + 17}},
            {WindowTabPart::PressedButton, Rect{r - 18, t + 3, r - 2, t + 17}},
        };
        for (const auto& [part, box] : parts) {
            check(skin.paintWindowTab(dc, part, box), "window tab");
        }
    }

    sheet.row("ThemeMenus");
    {
        struct Case {
            MenuBox part;
            MenuBoxLook look;
            const char* caption;
        };
        const Case cases[] = {
            {MenuBox::Background, MenuBoxLook::Normal, "0/0"},
            {MenuBox::Item, MenuBoxLook::Normal, "1/0"},
            {MenuBox::Item, MenuBoxLook::Hot, "1/1"},
            {MenuBox::Margin, MenuBoxLook::Normal, "2/0"},
            {MenuBox::Margin, MenuBoxLook::Hot, "2/1"},
            {MenuBox::Separator, MenuBoxLook::Normal, "3/0"},
            {MenuBox::Highlight, MenuBoxLook::Normal, "4/0"},
            {MenuBox::Highlight, MenuBoxLook::Hot, "4/1"},
            {MenuBox::Button, MenuBoxLook::Normal, "5/0"},
            {MenuBox::Button, MenuBoxLook::Pressed, "5/1"},
            {MenuBox::Button, MenuBoxLook::Hot, "5/2"},
            {MenuBox::Outline, MenuBoxLook::Normal, "6/0"},
        };
        for (const Case& c : cases) {
            skin.paintMenuBox(dc, c.part, c.look, sheet.cell(48, 20, c.caption));
        }
    }

    sheet.row("ThemePopupColor");
    {
        const ColourPopupPart parts[] = {ColourPopupPart::Background, ColourPopupPart::SelectedCell,
                                         ColourPopupPart::SelectedCell, ColourPopupPart::Outline};
        for (int i = 0; i < 4; ++i) {
            check(skin.paintColourPopup(dc, parts[i], sheet.cell(30, 20, number(i))),
                  "colour popup");
        }
    }

    sheet.row("DrawTextbox");
    skin.paintTextBoxOutline(dc, sheet.cell(160, 22, "bState 0"));
}

void drawPictures(const Skin& skin, ImageSurface& dc, Sheet& sheet,
                  std::vector<std::string>& faults) {
    sheet.row("The 32 pictures");
    for (const NamedPicture& picture : listPictures(skin.pictures())) {
        const QImage& image = *picture.image;
        const Rect cell = sheet.cell(image.width(), image.height(), picture.name);
        if (Status s = dc.copy(image, Piece{0, 0, image.width(), image.height()},
                               Piece{cell.left, cell.top, image.width(), image.height()});
            !s) {
            faults.push_back(std::string(picture.name) + ": " + s.reason());
        }
    }
}

}  // namespace

int runSkinGallery(const std::filesystem::path& outPng, std::ostream& err) {
    // Fonts need a QGuiApplication; run one on the offscreen platform if the caller has none. The
    // application takes the options it reads out of argv, so each run gets a fresh copy.
    int argc = 3;
    char arg0[] = "kickvane";
    char arg1[] = "-platform";
    char arg2[] = "offscreen";
    char* argv[] = {arg0, arg1, arg2, nullptr};
    std::unique_ptr<QGuiApplication> ownApp;
    if (QCoreApplication::instance() == nullptr) {
        ownApp = std::make_unique<QGuiApplication>(argc, argv);
    } else if (qobject_cast<QGuiApplication*>(QCoreApplication::instance()) == nullptr) {
        err << "skin-gallery: chương trình đang chạy không vẽ được chữ\n";
        return 1;
    }

    QImage image(kSheetWidth, 4000, QImage::Format_RGB32);
    image.fill(QColor(236, 239, 244));
    ImageSurface dc(image);
    Skin skin;

    Sheet sheet(image);
    sheet.title("Kickvane skin gallery");
    std::vector<std::string> faults;
    drawPainters(skin, dc, sheet, faults);
    drawPictures(skin, dc, sheet, faults);
    const int height = std::min(sheet.finish(), image.height());

    if (!faults.empty()) {
        for (const std::string& fault : faults) {
            err << "skin-gallery: " << fault << '\n';
        }
        return 1;
    }
    const std::u8string utf8 = outPng.u8string();
    const QString path = QString::fromUtf8(reinterpret_cast<const char*>(utf8.data()),
                                           static_cast<qsizetype>(utf8.size()));
    if (!image.copy(0, 0, kSheetWidth, height).save(path, "PNG")) {
        err << "skin-gallery: không ghi được " << path.toStdString() << '\n';
        return 1;
    }
    return 0;
}

}  // namespace kickvane::skin
