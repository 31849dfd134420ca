#include "skin/gallery.h"

#include <memory>
#include <ostream>
#include <string>
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
constexpr WindowHandle kHotWindow = 1;  // the window the gallery's cursor rests on
constexpr WindowHandle kCalmWindow = 2;

// The gallery's cursor always rests on kHotWindow, so hot looks can be shown side by side.
class FixedPointer final : public PointerProbe {
public:
    Status WindowAtCursor(WindowHandle& window) const override {
        window = kHotWindow;
        return Status::Ok();
    }
};

// Lays out labelled rows of cells on the sheet, left to right, wrapping at the sheet's edge.
class Sheet {
public:
    explicit Sheet(QImage& image) : image_(image) {}

    void Title(const QString& text) {
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
    void Row(const QString& label) {
        Finish();
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
    Rect Cell(int width, int height, const QString& caption) {
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

    int Finish() {
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

QString N(int v) {
    return QString::number(v);
}

// Draws every painter; collects the failures the reporting painters return.
void DrawPainters(Skin& skin, ImageSurface& dc, Sheet& sheet, std::vector<std::string>& faults) {
    const auto check = [&](Status s, const char* what) {
        if (!s) {
            faults.push_back(std::string(what) + ": " + s.reason());
        }
    };

    sheet.Row("ThemeButton");
    for (int state : {1, 2, 3, 4, 5}) {
        const char* names[] = {"", "normal", "hot", "pressed", "disabled", "default"};
        skin.ThemeButton(0, dc, state, false, false, sheet.Cell(80, 24, names[state]));
    }
    skin.ThemeButton(0, dc, 1, false, false, sheet.Cell(140, 40, "normal, large"));

    sheet.Row("ThemeCheck");
    for (int state = 1; state <= 12; ++state) {
        check(skin.ThemeCheck(0, dc, state, 0, sheet.Cell(13, 13, N(state))), "ThemeCheck");
    }
    sheet.Row("ThemeOption");
    for (int state = 1; state <= 8; ++state) {
        check(skin.ThemeOption(0, dc, state, 0, sheet.Cell(13, 13, N(state))), "ThemeOption");
    }

    sheet.Row("ThemeProgress");
    {
        const Rect lying = sheet.Cell(180, 18, "lying, 60 %");
        skin.ThemeProgress(0, dc, 0, lying.right, lying.bottom,
                           Rect{lying.left, lying.top, lying.left + 110, lying.bottom});
        const Rect upright = sheet.Cell(18, 100, "upright, 40 %");
        skin.ThemeProgress(0, dc, 1, upright.right, upright.bottom,
                           Rect{upright.left, upright.top, upright.right, upright.top + 42});
        const Rect empty = sheet.Cell(180, 18, "trough only");
        skin.ThemeProgress(0, dc, 0, empty.right, empty.bottom, Rect{empty.left, empty.top, 0, 0});
    }

    sheet.Row("ThemeScroll buttons");
    for (bool vertical : {false, true}) {
        for (int part : {0, 1}) {
            struct Look {
                int state;
                WindowHandle window;
                const char* name;
            };
            for (const Look& look : {Look{0, kCalmWindow, "normal"}, Look{0, kHotWindow, "hover"},
                                     Look{2, kCalmWindow, "hot"}, Look{1, kCalmWindow, "pressed"},
                                     Look{3, kCalmWindow, "disabled"}}) {
                skin.ThemeScroll(look.window, dc, sheet.Cell(17, 17, look.name), part, look.state,
                                 vertical);
            }
        }
    }
    sheet.Row("ThemeScroll bars");
    {
        const Rect bar = sheet.Cell(200, 17, "lying bar");
        skin.ThemeScroll(kCalmWindow, dc, Rect{bar.left + 17, bar.top, bar.right - 17, bar.bottom},
                         2, 0, false);
        skin.ThemeScroll(kCalmWindow, dc, Rect{bar.left, bar.top, bar.left + 17, bar.bottom}, 0, 0,
                         false);
        skin.ThemeScroll(kCalmWindow, dc, Rect{bar.right - 17, bar.top, bar.right, bar.bottom}, 1,
                         0, false);
        skin.ThemeScroll(kCalmWindow, dc, Rect{bar.left + 50, bar.top, bar.left + 110, bar.bottom},
                         5, 0, false);
        const Rect upright = sheet.Cell(17, 120, "upright bar");
        skin.ThemeScroll(kCalmWindow, dc,
                         Rect{upright.left, upright.top + 17, upright.right, upright.bottom - 17},
                         3, 0, true);
        skin.ThemeScroll(kCalmWindow, dc,
                         Rect{upright.left, upright.top, upright.right, upright.top + 17}, 0, 0,
                         true);
        skin.ThemeScroll(kCalmWindow, dc,
                         Rect{upright.left, upright.bottom - 17, upright.right, upright.bottom}, 1,
                         0, true);
        skin.ThemeScroll(kCalmWindow, dc,
                         Rect{upright.left, upright.top + 30, upright.right, upright.top + 70}, 5,
                         1, true);
        for (int state = 0; state < 4; ++state) {
            skin.ThemeScroll(0, dc, sheet.Cell(50, 17, "thumb " + N(state)), 5, state, false);
        }
        for (int state = 0; state < 3; ++state) {
            skin.ThemeScroll(0, dc, sheet.Cell(17, 17, "box " + N(state)), 4, state, false);
        }
    }

    sheet.Row("ThemeSpinButton");
    for (int button : {2, 1, 0, 3}) {
        const bool upright = button == 1 || button == 2;
        const char* names[] = {"left", "down", "up", "right"};
        for (int state = 0; state < 4; ++state) {
            skin.ThemeSpinButton(dc, state, button,
                                 sheet.Cell(upright ? 17 : 10, upright ? 10 : 17,
                                            QString(names[button]) + " " + N(state)));
        }
    }

    sheet.Row("ThemeTrackbar");
    for (int orientation : {0, 1}) {
        const bool lying = orientation == 0;
        const Rect channelCell =
            sheet.Cell(lying ? 120 : 24, lying ? 24 : 100, lying ? "lying" : "upright");
        const Rect channel = lying ? Rect{channelCell.left, channelCell.top + 9, channelCell.right,
                                          channelCell.top + 13}
                                   : Rect{channelCell.left + 9, channelCell.top,
                                          channelCell.left + 13, channelCell.bottom};
        skin.ThemeTrackbar(0, dc, true, false, 1, 0, orientation, channel);
        const Rect thumb = lying ? Rect{channelCell.left + 40, channelCell.top,
                                        channelCell.left + 51, channelCell.top + 21}
                                 : Rect{channelCell.left, channelCell.top + 40,
                                        channelCell.left + 21, channelCell.top + 51};
        skin.ThemeTrackbar(0, dc, true, false, 1, 1, orientation, thumb);
        for (int ticks : {0, 1, 2}) {
            for (int look = 0; look < 3; ++look) {
                const int width = lying ? (ticks == 2 ? 15 : 11) : 21;
                const int height = lying ? 21 : (ticks == 2 ? 15 : 11);
                const char* looks[] = {"", " hot", " off"};
                skin.ThemeTrackbar(0, dc, look != 2, look == 1, ticks, 1, orientation,
                                   sheet.Cell(width, height, "t" + N(ticks) + looks[look]));
            }
        }
    }

    sheet.Row("ThemeTab");
    {
        const Rect panel = sheet.Cell(260, 90, "panel and heads 0-3");
        skin.ThemeTab(0, dc, 0, 0, Rect{panel.left, panel.top + 22, panel.right, panel.bottom}, 0);
        const int states[] = {0, 1, 3, 2};  // the selected head last, over its neighbours
        const int lefts[] = {0, 60, 180, 120};
        for (int i = 0; i < 4; ++i) {
            const int top = states[i] == 2 ? panel.top : panel.top + 2;
            skin.ThemeTab(
                0, dc, 1, states[i],
                Rect{panel.left + lefts[i] + 2, top, panel.left + lefts[i] + 62, panel.top + 23},
                0);
        }
    }

    sheet.Row("ThemeListbox");
    skin.ThemeListbox(kCalmWindow, dc, 1, sheet.Cell(180, 24, "plDraw 1"));
    skin.ThemeListbox(kCalmWindow, dc, 2, sheet.Cell(180, 24, "plDraw 2"));

    sheet.Row("ThemeCombobox");
    {
        const Rect field = sheet.Cell(180, 21, "field, text, button");
        skin.ThemeCombobox(kCalmWindow, dc, 0, 0, field);
        skin.ThemeCombobox(kCalmWindow, dc, 2, 0,
                           Rect{field.left + 4, field.top, field.right - 17, field.bottom});
        skin.ThemeCombobox(kCalmWindow, dc, 1, 1,
                           Rect{field.right - 15, field.top + 1, field.right - 1, field.bottom});
        const Rect selected = sheet.Cell(120, 18, "selection");
        skin.ThemeCombobox(kCalmWindow, dc, 1, 0, selected);
        skin.ThemeCombobox(kCalmWindow, dc, 2, 0, selected);
        for (int state = 1; state <= 4; ++state) {
            const Rect cell = sheet.Cell(17, 20, "button " + N(state));
            skin.ThemeCombobox(0, dc, state, 1,
                               Rect{cell.left + 2, cell.top, cell.right, cell.bottom + 1});
        }
        const Rect push = sheet.Cell(60, 21, "plDraw 2");
        skin.ThemeCombobox(0, dc, 0, 2, Rect{push.left + 2, push.top, push.right, push.bottom + 1});
    }

    sheet.Row("ThemePropertyGrid");
    skin.ThemePropertyGrid(0, dc, 0, 1, sheet.Cell(90, 50, "panel"));
    skin.ThemePropertyGrid(0, dc, 1, 1, sheet.Cell(90, 50, "focus"));
    for (int state = 0; state < 3; ++state) {
        skin.ThemePropertyGrid(0, dc, state, 0, sheet.Cell(90, 18, "cell " + N(state)));
    }

    sheet.Row("ThemeDate");
    {
        const Rect date = sheet.Cell(140, 22, "field and button");
        skin.ThemeDate(0, dc, 0, 1, date);
        skin.ThemeDate(0, dc, 0, 2,
                       Rect{date.right - 19, date.top + 2, date.right - 2, date.bottom - 2});
    }

    sheet.Row("DrawListview");
    for (int state = 0; state < 4; ++state) {
        skin.DrawListview(0, dc, 0, state, sheet.Cell(80, 21, "header " + N(state)));
    }
    skin.DrawListview(0, dc, 1, 0, sheet.Cell(80, 21, "plDraw 1"));
    skin.DrawListview(0, dc, 2, 0, sheet.Cell(80, 40, "plDraw 2"));

    sheet.Row("ThemeStatusBar");
    {
        const Rect bar = sheet.Cell(400, 22, "bar, panels, progress, grip");
        skin.ThemeStatusBar(0, dc, 0, bar);
        skin.ThemeStatusBar(0, dc, 2, Rect{bar.left + 4, bar.top + 3, bar.left + 150, bar.bottom});
        skin.ThemeStatusBar(0, dc, 3,
                            Rect{bar.left + 160, bar.top + 3, bar.left + 300, bar.bottom - 1});
        skin.ThemeStatusBar(0, dc, 4,
                            Rect{bar.left + 160, bar.top + 3, bar.left + 240, bar.bottom - 1});
        skin.ThemeStatusBar(0, dc, 1, Rect{bar.right - 18, bar.top, bar.right, bar.bottom});
        skin.ThemeStatusBar(0, dc, 5, sheet.Cell(200, 22, "simple mode"));
    }

    sheet.Row("ThemeCommandBarMenu");
    for (int part = 0; part <= 11; ++part) {
        for (int state = 0; state <= 2; ++state) {
            const bool mark = part >= 3 && part <= 7;
            skin.ThemeCommandBarMenu(0, dc, part, state,
                                     sheet.Cell(mark ? 20 : 48, 20, N(part) + "/" + N(state)));
        }
    }

    sheet.Row("ThemeUniToolbar");
    {
        const Rect bar = sheet.Cell(360, 30, "background and items");
        // The toolbar paints from (0, 0); draw it on its own picture and place that.
        QImage toolbar(bar.right - bar.left, bar.bottom - bar.top, QImage::Format_RGB32);
        toolbar.fill(QColor(236, 239, 244));
        ImageSurface tb(toolbar);
        skin.ThemeUniToolbar(0, tb, 0, 0, 0, 0, 0, 0, 0, toolbar.width(), toolbar.height());
        int left = 4;
        for (int status : {1, 2, 3, 4, 5}) {
            skin.ThemeUniToolbar(0, tb, 1, 0, left, 2, left + 23, 26, status, 0, 0);
            left += 27;
        }
        skin.ThemeUniToolbar(0, tb, 2, 0, left, 2, left + 34, 26, 1, 0, 0);
        left += 38;
        skin.ThemeUniToolbar(0, tb, 3, 0, left, 2, left + 11, 26, 2, 0, 0);
        left += 15;
        skin.ThemeUniToolbar(0, tb, 4, 0, left, 2, left + 15, 26, 2, 0, 0);
        left += 19;
        skin.ThemeUniToolbar(0, tb, 5, 0, left, 2, left + 60, 26, 0, 0, 0);
        check(dc.Copy(toolbar, Piece{0, 0, toolbar.width(), toolbar.height()},
                      Piece{bar.left, bar.top, toolbar.width(), toolbar.height()}),
              "toolbar");
    }

    sheet.Row("ThemeMDITab");
    {
        const Rect strip = sheet.Cell(300, 60, "strip, tabs, frame, buttons");
        const auto f = [](int v) { return static_cast<float>(v); };
        int measure = 0;
        check(skin.ThemeMDITab(0, dc, 6, f(strip.left), f(strip.top + 18), f(strip.right),
                               f(strip.bottom), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 1, f(strip.left), f(strip.top), f(strip.right),
                               f(strip.top + 19), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 5, f(strip.left + 84), f(strip.top + 2), f(strip.left + 164),
                               f(strip.top + 19), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 12, f(strip.left + 164), f(strip.top + 2),
                               f(strip.left + 165), f(strip.top + 19), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 5, f(strip.left + 165), f(strip.top + 2), f(strip.left + 245),
                               f(strip.top + 19), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 2, f(strip.left + 4), f(strip.top + 1), f(strip.left + 84),
                               f(strip.top + 19), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 10, f(strip.right - 36), f(strip.top + 3),
                               f(strip.right - 20), f(strip.top + 17), measure),
              "ThemeMDITab");
        check(skin.ThemeMDITab(0, dc, 11, f(strip.right - 18), f(strip.top + 3), f(strip.right - 2),
                               f(strip.top + 17), measure),
              "ThemeMDITab");
    }

    sheet.Row("ThemeMenus");
    {
        const int cases[][2] = {{0, 0}, {1, 0}, {1, 1}, {2, 0}, {2, 1}, {3, 0},
                                {4, 0}, {4, 1}, {5, 0}, {5, 1}, {5, 2}, {6, 0}};
        for (const auto& [part, state] : cases) {
            const Rect cell = sheet.Cell(48, 20, N(part) + "/" + N(state));
            skin.ThemeMenus(0, dc, part, state, cell.left, cell.top, cell.right, cell.bottom);
        }
    }

    sheet.Row("ThemePopupColor");
    for (int part = 0; part <= 3; ++part) {
        check(skin.ThemePopupColor(0, dc, part, sheet.Cell(30, 20, N(part))), "ThemePopupColor");
    }

    sheet.Row("DrawTextbox");
    {
        const Rect box = sheet.Cell(160, 22, "bState 0");
        skin.DrawTextbox(0, dc, 0, box.left, box.top, box.right, box.bottom);
    }
}

void DrawPictures(const Skin& skin, ImageSurface& dc, Sheet& sheet,
                  std::vector<std::string>& faults) {
    sheet.Row("The 32 pictures");
    for (const NamedPicture& picture : ListPictures(skin.Pictures())) {
        const QImage& image = *picture.image;
        const Rect cell = sheet.Cell(image.width(), image.height(), picture.name);
        if (Status s = dc.Copy(image, Piece{0, 0, image.width(), image.height()},
                               Piece{cell.left, cell.top, image.width(), image.height()});
            !s) {
            faults.push_back(std::string(picture.name) + ": " + s.reason());
        }
    }
}

}  // namespace

int RunSkinGallery(const std::filesystem::path& outPng, std::ostream& err) {
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
        err << "skin-gallery: the running application has no GUI support for fonts\n";
        return 1;
    }

    QImage image(kSheetWidth, 4000, QImage::Format_RGB32);
    image.fill(QColor(236, 239, 244));
    ImageSurface dc(image);
    Skin skin;
    skin.SetPointerProbe(std::make_shared<FixedPointer>());
    skin.SetWindowTextReader([](WindowHandle) { return std::string("Sân cỏ mùa xuân"); });

    Sheet sheet(image);
    sheet.Title("Kickvane skin gallery");
    std::vector<std::string> faults;
    DrawPainters(skin, dc, sheet, faults);
    DrawPictures(skin, dc, sheet, faults);
    const int height = std::min(sheet.Finish(), image.height());

    if (!faults.empty()) {
        for (const std::string& fault : faults) {
            err << "skin-gallery: " << fault << '\n';
        }
        return 1;
    }
    const QString path = QString::fromStdString(outPng.string());
    if (!image.copy(0, 0, kSheetWidth, height).save(path, "PNG")) {
        err << "skin-gallery: cannot write " << outPng.string() << '\n';
        return 1;
    }
    return 0;
}

}  // namespace kickvane::skin
