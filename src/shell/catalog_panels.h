#pragma once

#include <QCheckBox>
#include <QLineEdit>
#include <QObject>
#include <QPushButton>
#include <QRadioButton>
#include <array>
#include <vector>

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
    void showGameFolder(const QString& folder);

    TabHead* tabHead(int index) const { return tabs_[static_cast<size_t>(index)]; }
    PictureBox* panel(int index) const { return panels_[static_cast<size_t>(index)]; }
    QCheckBox* categoryCheck(int switchIndex) const;
    ClickableLabel* categoryLabel(int switchIndex) const;
    QRadioButton* optionButton(catalog::OptionArray array, int index) const;
    ClickableLabel* optionLabel(catalog::OptionArray array, int index) const;
    QLineEdit* gameFolderBox() const { return gameFolder_; }
    QPushButton* browseButton() const { return browse_; }

signals:
    void tabSelected(int index);
    void categoryToggled(int switchIndex, bool on);
    void optionChosen(catalog::OptionArray array, int index);
    // A catalog label was clicked: label array and index, for the preview.
    void labelClicked(catalog::LabelArray labels, int index);
    void gameFolderEdited(const QString& folder);
    void browseRequested();

private:
    struct OptionWidgets {
        catalog::OptionArray array;
        int index;
        QRadioButton* button;
        ClickableLabel* label;
    };

    void buildCategoryPanel(QWidget* panel);
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
    QLineEdit* gameFolder_ = nullptr;
    QPushButton* browse_ = nullptr;
};

}  // namespace kickvane::shell
