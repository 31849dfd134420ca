#pragma once

#include <QCheckBox>
#include <QLineEdit>
#include <QObject>
#include <QPushButton>
#include <QRadioButton>
#include <QScrollArea>
#include <array>
#include <string>
#include <vector>

#include "catalog/added_variants.h"
#include "catalog/selection.h"
#include "shell/widgets.h"

namespace kickvane::shell {

struct SkinLook;

inline constexpr int kTabCount = 4;
inline constexpr int kTabHeadWidth = 82;
inline constexpr int kTabHeadHeight = 31;
inline const QColor kUnselectedTabColour{0xE0, 0xE0, 0xE0};

// The four tab heads and their panels, as children of the window: the game folder and the
// categories on the first panel, balls on the second, scoreboards on the third, adboards, pitches
// and marks on the fourth. The panels show a selection and report what the user changes.
class CatalogPanels final : public QObject {
    Q_OBJECT
public:
    explicit CatalogPanels(QWidget* window);

    int currentTab() const { return currentTab_; }
    int tabHeight() const { return tabHeight_; }
    // Shows panel `index`; the keyboard focus moves to its tab head rather than jumping to
    // whatever follows the hidden panel.
    void selectTab(int index);
    // Every panel takes panel 0's colour, left and width, just below the tab heads, with
    // `panelPicture` drawn on it.
    void layoutPanels(const QString& panelPicture);
    void paintTabs(const QString& selectedPicture, const QString& unselectedPicture);
    void recolour(const SkinLook& look);

    void showSelection(const catalog::PatchSelection& selection);
    // Shows the variants the player added after each group's catalog options, replacing those
    // shown before, and under each group the line that names its skipped folders (empty: none).
    // The catalog's options keep their places; a group with more than its room scrolls.
    void showAddedVariants(const catalog::AddedVariants& added,
                           const std::array<QString, catalog::kGroupCount>& skippedLines);
    void showGameFolder(const QString& folder);

    TabHead* tabHead(int index) const { return tabs_[static_cast<size_t>(index)]; }
    PictureBox* panel(int index) const { return panels_[static_cast<size_t>(index)]; }
    QCheckBox* categoryCheck(int switchIndex) const;
    ClickableLabel* categoryLabel(int switchIndex) const;
    QRadioButton* optionButton(catalog::OptionArray array, int index) const;
    ClickableLabel* optionLabel(catalog::OptionArray array, int index) const;
    QRadioButton* addedButton(catalog::GroupId group, const QString& name) const;
    ClickableLabel* addedLabel(catalog::GroupId group, const QString& name) const;
    QLabel* skippedLine(catalog::GroupId group) const;
    QScrollArea* groupArea(catalog::GroupId group) const;
    QLineEdit* gameFolderBox() const { return gameFolder_; }
    QPushButton* browseButton() const { return browse_; }

signals:
    void tabSelected(int index);
    void categoryToggled(int switchIndex, bool on);
    void optionChosen(catalog::OptionArray array, int index);
    // A catalog label was clicked: label array and index, for the preview.
    void labelClicked(catalog::LabelArray labels, int index);
    // The same for a variant the player added, by its folder name (UTF-8).
    void addedChosen(catalog::GroupId group, const std::string& name);
    void addedLabelClicked(catalog::GroupId group, const std::string& name);
    void addedLabelHovered(catalog::GroupId group, const std::string& name);
    void gameFolderEdited(const QString& folder);
    void browseRequested();

private:
    struct OptionWidgets {
        catalog::OptionArray array;
        int index;
        QRadioButton* button;
        ClickableLabel* label;
    };

    // Where a group's rows go: a scroll area over the room the group has, rows at a fixed step.
    struct RowLook {
        int buttonX, buttonY, buttonSize;  // buttonY: from the row's top
        int labelX, labelY, labelWidth, labelHeight;
        int step;
    };
    struct AddedWidgets {
        std::string name;
        QRadioButton* button;
        ClickableLabel* label;
    };
    struct GroupView {
        QScrollArea* area = nullptr;
        QWidget* rows = nullptr;
        QLabel* skipped = nullptr;
        QRect room;  // the area's geometry without the skipped line
        RowLook look{};
        int catalogRows = 0;
        std::vector<AddedWidgets> added;
    };

    void buildCategoryPanel(QWidget* panel);
    // The scroll area of a group over `room` of `parent`, rows starting at the room's top + 4.
    GroupView& makeGroupView(catalog::GroupId group, QWidget* parent, const QRect& room,
                             const RowLook& look);
    QRect rowButton(const GroupView& view, int row) const;
    QRect rowLabel(const GroupView& view, int row) const;
    void fitRows(GroupView& view);
    void paintAdded(const AddedWidgets& widgets) const;
    void buildGroupPanel(QWidget* panel, catalog::GroupId group, int top);
    void buildVariantFrames(QWidget* panel);
    void addOption(const catalog::VariantGroup& group, const catalog::PatchOption& option,
                   QRadioButton* button, ClickableLabel* label);
    const OptionWidgets* findOption(catalog::OptionArray array, int index) const;

    QWidget* window_;
    int currentTab_ = 0;
    int tabHeight_ = 32;
    std::array<TabHead*, kTabCount> tabs_{};
    std::array<PictureBox*, kTabCount> panels_{};
    std::array<QCheckBox*, catalog::kCategoryCount> checks_{};
    std::array<ClickableLabel*, catalog::kCategoryCount> categoryLabels_{};
    std::vector<OptionWidgets> options_;
    std::array<PictureBox*, 3> groupFrames_{};
    std::array<GroupView, catalog::kGroupCount> groupViews_{};
    QColor entryColour_;
    QColor labelColour_;
    QColor labelTextColour_ = Qt::black;
    QLineEdit* gameFolder_ = nullptr;
    QPushButton* browse_ = nullptr;
};

}  // namespace kickvane::shell
