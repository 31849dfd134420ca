#include "shell/catalog_panels.h"

#include <QLabel>
#include <QScrollBar>

#include "platform/text.h"
#include "shell/qt_text.h"
#include "shell/skin_look.h"

namespace kickvane::shell {

namespace {

using catalog::GroupId;
using catalog::OptionArray;

constexpr std::array<int, kTabCount> kTabTops{65, 110, 156, 202};
constexpr int kTabLeft = 9;
constexpr QRect kPanelRect(104, 46, 321, 357);
// The category labels of the first tab: the left column ends before the right one's check boxes,
// the right one at the panel's edge.
constexpr int kLeftLabelWidth = 130;
constexpr int kRightLabelWidth = 134;
const std::array<QString, kTabCount> kTabCaptions{QStringLiteral("Chung"), QStringLiteral("Bóng"),
                                                  QStringLiteral("Tỉ số"), QStringLiteral("Khác")};

ClickableLabel* makeLabel(std::string_view text, QWidget* parent, const QRect& geometry) {
    auto* label = new ClickableLabel(toQString(text), parent);
    label->setGeometry(geometry);
    label->setCursor(Qt::PointingHandCursor);
    paint(label, kLabelBackground);
    return label;
}

QLabel* makeHeading(const QString& text, QWidget* parent, const QPoint& at) {
    auto* heading = new QLabel(text, parent);
    QFont font = heading->font();
    font.setBold(true);
    heading->setFont(font);
    heading->move(at);
    heading->adjustSize();
    return heading;
}

QRadioButton* makeOptionButton(QWidget* parent, const QRect& geometry) {
    auto* button = new QRadioButton(parent);
    button->setAutoExclusive(false);
    button->setGeometry(geometry);
    paint(button, kEntryBackground);
    return button;
}

// Keeps a widget's own background off, so the panel's picture shows through.
void seeThrough(QWidget* widget) {
    widget->setAutoFillBackground(false);
}

// The tab panels' rows: a button and a label per variant, 36 pixels apart; the framed groups of
// the fourth panel are tighter.
constexpr int kPanelRowsTop = 36;
constexpr int kFrameRowsTop = 22;
constexpr int kSkippedLineHeight = 16;

}  // namespace

CatalogPanels::CatalogPanels(QWidget* window)
    : QObject(window),
      window_(window),
      entryColour_(kEntryBackground),
      labelColour_(kLabelBackground) {
    for (int i = 0; i < kTabCount; ++i) {
        auto* tab = new TabHead(kTabCaptions[static_cast<size_t>(i)], window);
        tab->setGeometry(kTabLeft, kTabTops[static_cast<size_t>(i)], 90, 32);
        connect(tab, &TabHead::clicked, this, [this, i] { selectTab(i); });
        tabs_[static_cast<size_t>(i)] = tab;

        auto* panel = new PictureBox(window);
        panel->setGeometry(kPanelRect.translated(0, i * 4));  // design positions; layout aligns
        panels_[static_cast<size_t>(i)] = panel;
    }
    tabHeight_ = tabs_[0]->height();
    buildCategoryPanel(panels_[0]);
    makeHeading(QStringLiteral("Chọn quả bóng:"), panels_[1], {12, 10});
    buildGroupPanel(panels_[1], GroupId::Ball, kPanelRowsTop + 4);
    makeHeading(QStringLiteral("Chọn bảng tỉ số:"), panels_[2], {12, 10});
    buildGroupPanel(panels_[2], GroupId::Scoreboard, kPanelRowsTop + 4);
    buildVariantFrames(panels_[3]);
}

void CatalogPanels::buildCategoryPanel(QWidget* panel) {
    auto* folderLabel = new QLabel(QStringLiteral("Thư mục cài FIFA Online 2:"), panel);
    folderLabel->setGeometry(10, 8, 300, 18);
    gameFolder_ = new QLineEdit(panel);
    gameFolder_->setGeometry(10, 28, 212, 25);
    gameFolder_->setAccessibleName(folderLabel->text());
    connect(gameFolder_, &QLineEdit::textChanged, this, &CatalogPanels::gameFolderEdited);
    browse_ = new QPushButton(QStringLiteral("Đổ&i thư mục"), panel);
    browse_->setGeometry(226, 27, 86, 27);
    connect(browse_, &QPushButton::clicked, this, &CatalogPanels::browseRequested);

    for (const catalog::PatchCategory& category : catalog::Categories()) {
        const int i = category.switchIndex;
        const int x = i < 7 ? 8 : 162;
        const int y = 68 + (i % 7) * 40;
        auto* check = new QCheckBox(panel);
        check->setGeometry(x, y + 2, 20, 20);
        check->setAccessibleName(toQString(platform::TrimBlanks(category.label)));
        paint(check, kEntryBackground);
        connect(check, &QCheckBox::clicked, this, [this, check, i](bool checked) {
            check->setTristate(false);
            emit categoryToggled(i, checked);
        });
        checks_[static_cast<size_t>(i)] = check;

        // As wide as the column allows. A label that does not fit on one line in the font at
        // hand (Tahoma, Segoe UI, a wider stand-in) wraps between its words instead of losing
        // its end, in a taller box centred on its check box.
        const int width = i < 7 ? kLeftLabelWidth : kRightLabelWidth;
        auto* label = makeLabel(category.label, panel, QRect(x + 22, y, width, 24));
        label->setWordWrap(true);
        if (label->fontMetrics().horizontalAdvance(label->text()) > label->contentsRect().width()) {
            label->setGeometry(x + 22, y - 6, width, 36);
        }
        connect(label, &ClickableLabel::clicked, this,
                [this, i] { emit labelClicked(catalog::LabelArray::Category, i); });
        categoryLabels_[static_cast<size_t>(i)] = label;
    }
}

void CatalogPanels::addOption(const catalog::VariantGroup& group,
                              const catalog::PatchOption& option, QRadioButton* button,
                              ClickableLabel* label) {
    const OptionArray array = group.array;
    const int index = option.index;
    const catalog::LabelArray labels = group.labels;
    button->setAccessibleName(label->text());
    connect(button, &QRadioButton::clicked, this,
            [this, array, index] { emit optionChosen(array, index); });
    connect(label, &ClickableLabel::clicked, this,
            [this, labels, index] { emit labelClicked(labels, index); });
    options_.push_back({array, index, button, label});
}

void CatalogPanels::buildGroupPanel(QWidget* panel, GroupId id, int top) {
    const catalog::VariantGroup& group = catalog::Group(id);
    const QRect room(0, top - 4, panel->width(), panel->height() - (top - 4));
    GroupView& view = makeGroupView(id, panel, room, {20, 2, 20, 44, 0, 250, 24, 36});
    for (const catalog::PatchOption& option : group.options) {
        const int row = view.catalogRows++;
        addOption(group, option, makeOptionButton(view.rows, rowButton(view, row)),
                  makeLabel(option.label, view.rows, rowLabel(view, row)));
    }
    fitRows(view);
}

CatalogPanels::GroupView& CatalogPanels::makeGroupView(GroupId id, QWidget* parent,
                                                       const QRect& room, const RowLook& look) {
    GroupView& view = groupViews_[static_cast<size_t>(id)];
    view.room = room;
    view.look = look;
    view.area = new QScrollArea(parent);
    view.area->setGeometry(room);
    view.area->setFrameShape(QFrame::NoFrame);
    view.area->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    view.area->setVerticalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    view.area->setFocusPolicy(Qt::NoFocus);
    seeThrough(view.area);
    seeThrough(view.area->viewport());
    view.rows = new QWidget;
    view.area->setWidget(view.rows);
    seeThrough(view.rows);  // after setWidget, which turns the filling on
    view.skipped = new QLabel(parent);
    view.skipped->setTextFormat(Qt::PlainText);
    view.skipped->setGeometry(room.left() + 8, room.bottom() + 1 - kSkippedLineHeight,
                              room.width() - 16, kSkippedLineHeight);
    view.skipped->hide();
    return view;
}

QRect CatalogPanels::rowButton(const GroupView& view, int row) const {
    const RowLook& l = view.look;
    return QRect(l.buttonX, 4 + row * l.step + l.buttonY, l.buttonSize, l.buttonSize);
}

QRect CatalogPanels::rowLabel(const GroupView& view, int row) const {
    const RowLook& l = view.look;
    return QRect(l.labelX, 4 + row * l.step + l.labelY, l.labelWidth, l.labelHeight);
}

void CatalogPanels::fitRows(GroupView& view) {
    QRect room = view.room;
    if (!view.skipped->text().isEmpty()) {
        room.setBottom(room.bottom() - kSkippedLineHeight);
    }
    view.area->setGeometry(room);
    const int rows = view.catalogRows + static_cast<int>(view.added.size());
    const int height = 4 + (rows - 1) * view.look.step +
                       std::max(view.look.labelY + view.look.labelHeight,
                                view.look.buttonY + view.look.buttonSize) +
                       4;
    // The rows keep their width; the scroll bar, when needed, lies over the right margin.
    view.rows->resize(room.width() - view.area->verticalScrollBar()->sizeHint().width(), height);
}

void CatalogPanels::buildVariantFrames(QWidget* panel) {
    struct Frame {
        GroupId group;
        QString caption;
        QRect rect;
    };
    const std::array<Frame, 3> frames{{
        {GroupId::Adboard, QStringLiteral("Biển quảng cáo"), QRect(8, 8, 305, 108)},
        {GroupId::Pitch, QStringLiteral("Mặt cỏ"), QRect(8, 124, 305, 108)},
        {GroupId::Mark, QStringLiteral("Mark cầu thủ"), QRect(8, 240, 305, 108)},
    }};
    for (size_t f = 0; f < frames.size(); ++f) {
        auto* frame = new PictureBox(panel);
        frame->setGeometry(frames[f].rect);
        frame->setBackground(kEntryBackground);
        groupFrames_[f] = frame;
        makeHeading(frames[f].caption, frame, {8, 4});
        const catalog::VariantGroup& group = catalog::Group(frames[f].group);
        const QRect room(0, kFrameRowsTop, frame->width(), frame->height() - kFrameRowsTop);
        GroupView& view = makeGroupView(group.id, frame, room, {10, 0, 18, 32, -1, 200, 19, 20});
        for (const catalog::PatchOption& option : group.options) {
            const int row = view.catalogRows++;
            addOption(group, option, makeOptionButton(view.rows, rowButton(view, row)),
                      makeLabel(option.label, view.rows, rowLabel(view, row)));
        }
        fitRows(view);
    }
}

void CatalogPanels::layoutPanels(const QString& panelPicture) {
    for (int i = 0; i < kTabCount; ++i) {
        PictureBox* panel = panels_[static_cast<size_t>(i)];
        panel->setBackground(panels_[0]->background());
        panel->setPictureFile(panelPicture);
        panel->move(i > 0 ? panels_[0]->x() : panel->x(), tabHeight_ + 16);
        if (i > 0) {
            panel->resize(panels_[0]->width(), panel->height());
        }
    }
}

void CatalogPanels::paintTabs(const QString& selectedPicture, const QString& unselectedPicture) {
    // The new panel shows before the others hide, so the focus never falls through to the
    // widgets below the panels.
    panels_[static_cast<size_t>(currentTab_)]->setVisible(true);
    for (int i = 0; i < kTabCount; ++i) {
        const bool selected = i == currentTab_;
        TabHead* tab = tabs_[static_cast<size_t>(i)];
        panels_[static_cast<size_t>(i)]->setVisible(selected);
        if (selected) {
            tab->raise();
            tab->setPictureFile(selectedPicture);
        } else {
            tab->setPictureFile(unselectedPicture);
            tab->setBackground(kUnselectedTabColour);
        }
        tab->resize(kTabHeadWidth, kTabHeadHeight);
    }
}

void CatalogPanels::selectTab(int index) {
    if (index < 0 || index >= kTabCount) {
        return;
    }
    const QWidget* focused = window_->focusWidget();
    const bool focusOnOldPanel =
        focused && panels_[static_cast<size_t>(currentTab_)]->isAncestorOf(focused);
    currentTab_ = index;
    emit tabSelected(index);
    if (focusOnOldPanel || !focused) {
        tabs_[static_cast<size_t>(index)]->setFocus(Qt::OtherFocusReason);
    }
}

void CatalogPanels::recolour(const SkinLook& look) {
    const auto paintIndicator = [&look](QWidget* entry) {
        paint(entry, look.entryBackground);
        QPalette palette = entry->palette();
        palette.setColor(QPalette::Base, look.indicatorBase);
        palette.setColor(QPalette::Text, look.indicatorMark);
        entry->setPalette(palette);
    };
    for (size_t i = 0; i < checks_.size(); ++i) {
        paintIndicator(checks_[i]);
        paint(categoryLabels_[i], look.labelBackground, look.labelText);
    }
    for (const OptionWidgets& option : options_) {
        paintIndicator(option.button);
        paint(option.label, look.labelBackground, look.labelText);
    }
    for (PictureBox* frame : groupFrames_) {
        frame->setBackground(look.entryBackground);
    }
    entryColour_ = look.entryBackground;
    labelColour_ = look.labelBackground;
    labelTextColour_ = look.labelText;
    for (const GroupView& view : groupViews_) {
        for (const AddedWidgets& added : view.added) {
            paintAdded(added);
        }
    }
    // Headings on the panels and in the frames follow the labels' text colour, so they stay
    // readable on the dark pictures of skin 2.
    for (PictureBox* panel : panels_) {
        for (QLabel* heading : panel->findChildren<QLabel*>()) {
            if (!qobject_cast<ClickableLabel*>(heading)) {
                QPalette palette = heading->palette();
                palette.setColor(QPalette::WindowText, look.labelText);
                heading->setPalette(palette);
            }
        }
    }
}

void CatalogPanels::showSelection(const catalog::PatchSelection& selection) {
    for (const catalog::PatchCategory& category : catalog::Categories()) {
        QCheckBox* check = checks_[static_cast<size_t>(category.switchIndex)];
        const int value = selection.SwitchValue(category.switchIndex);
        // A stored value other than 0 and 1 shows as greyed; only 1 counts as on.
        check->setTristate(value != 0 && value != 1);
        check->setCheckState(value == 0   ? Qt::Unchecked
                             : value == 1 ? Qt::Checked
                                          : Qt::PartiallyChecked);
    }
    for (const OptionWidgets& option : options_) {
        option.button->setChecked(selection.OptionValue(option.array, option.index));
    }
    for (const catalog::VariantGroup& group : catalog::Groups()) {
        for (const AddedWidgets& added : groupViews_[static_cast<size_t>(group.id)].added) {
            added.button->setChecked(selection.AddedValue(group.id, added.name));
        }
    }
}

void CatalogPanels::paintAdded(const AddedWidgets& widgets) const {
    paint(widgets.button, entryColour_);
    paint(widgets.label, labelColour_, labelTextColour_);
}

void CatalogPanels::showAddedVariants(
    const catalog::AddedVariants& added,
    const std::array<QString, catalog::kGroupCount>& skippedLines) {
    for (const catalog::VariantGroup& group : catalog::Groups()) {
        GroupView& view = groupViews_[static_cast<size_t>(group.id)];
        for (const AddedWidgets& old : view.added) {
            delete old.button;
            delete old.label;
        }
        view.added.clear();
        const GroupId id = group.id;
        int row = view.catalogRows;
        // The keyboard reaches the added sets right after the group's last catalog option.
        const OptionWidgets* lastListed = findOption(group.array, group.options.back().index);
        QWidget* previous = lastListed ? lastListed->label : nullptr;
        for (const catalog::AddedVariant& variant : added.Of(id)) {
            // The folder's name is outside text: shown as it is, never read as markup.
            auto* label = makeLabel(variant.name, view.rows, rowLabel(view, row));
            label->setTextFormat(Qt::PlainText);
            label->setToolTip(label->text());
            auto* button = makeOptionButton(view.rows, rowButton(view, row));
            button->setAccessibleName(label->text());
            const std::string name = variant.name;
            connect(button, &QRadioButton::clicked, this,
                    [this, id, name] { emit addedChosen(id, name); });
            connect(label, &ClickableLabel::clicked, this,
                    [this, id, name] { emit addedLabelClicked(id, name); });
            connect(label, &ClickableLabel::hovered, this,
                    [this, id, name] { emit addedLabelHovered(id, name); });
            view.added.push_back({name, button, label});
            paintAdded(view.added.back());
            button->show();
            label->show();
            if (previous) {
                QWidget::setTabOrder(previous, button);
                QWidget::setTabOrder(button, label);
            }
            previous = label;
            ++row;
        }
        const QString& line = skippedLines[static_cast<size_t>(id)];
        const QFontMetrics metrics(view.skipped->font());
        view.skipped->setText(
            line.isEmpty() ? QString()
                           : metrics.elidedText(line, Qt::ElideRight, view.skipped->width()));
        view.skipped->setToolTip(line);
        view.skipped->setVisible(!line.isEmpty());
        fitRows(view);
    }
}

QRadioButton* CatalogPanels::addedButton(GroupId group, const QString& name) const {
    for (const AddedWidgets& added : groupViews_[static_cast<size_t>(group)].added) {
        if (toQString(added.name) == name) {
            return added.button;
        }
    }
    return nullptr;
}

ClickableLabel* CatalogPanels::addedLabel(GroupId group, const QString& name) const {
    for (const AddedWidgets& added : groupViews_[static_cast<size_t>(group)].added) {
        if (toQString(added.name) == name) {
            return added.label;
        }
    }
    return nullptr;
}

QLabel* CatalogPanels::skippedLine(GroupId group) const {
    return groupViews_[static_cast<size_t>(group)].skipped;
}

QScrollArea* CatalogPanels::groupArea(GroupId group) const {
    return groupViews_[static_cast<size_t>(group)].area;
}

void CatalogPanels::showGameFolder(const QString& folder) {
    if (gameFolder_->text() != folder) {
        gameFolder_->setText(folder);
    }
}

QCheckBox* CatalogPanels::categoryCheck(int switchIndex) const {
    return checks_.at(static_cast<size_t>(switchIndex));
}

ClickableLabel* CatalogPanels::categoryLabel(int switchIndex) const {
    return categoryLabels_.at(static_cast<size_t>(switchIndex));
}

const CatalogPanels::OptionWidgets* CatalogPanels::findOption(OptionArray array, int index) const {
    for (const OptionWidgets& option : options_) {
        if (option.array == array && option.index == index) {
            return &option;
        }
    }
    return nullptr;
}

QRadioButton* CatalogPanels::optionButton(OptionArray array, int index) const {
    const OptionWidgets* option = findOption(array, index);
    return option ? option->button : nullptr;
}

ClickableLabel* CatalogPanels::optionLabel(OptionArray array, int index) const {
    const OptionWidgets* option = findOption(array, index);
    return option ? option->label : nullptr;
}

}  // namespace kickvane::shell
