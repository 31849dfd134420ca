#pragma once

#include <optional>
#include <span>
#include <string_view>

// The fixed table of everything the tool can replace in the game: fourteen categories that the
// user switches on or off, and five groups of variants, each owned by one category.
namespace kickvane::catalog {

inline constexpr int kCategoryCount = 14;

// The rows of option buttons, one per tab. The three groups of the "Khác" tab share one row and
// are kept apart by their containers.
enum class OptionArray { Ball, Scoreboard, Other };

// The rows of labels, one per tab, which also name the preview pictures of their entries.
enum class LabelArray { Category, Ball, Scoreboard, Other };

enum class GroupId { Ball, Scoreboard, Adboard, Pitch, Mark };
inline constexpr int kGroupCount = 5;

struct PatchOption {
    std::string_view key;    // key in the group's settings section
    std::string_view label;  // shown beside the option button
    int index;               // index in the group's option array (and label array)
    bool isDefault;
    // The variant's set below the tool's "extras" folder ("\Ball\UCL 2011"); empty for the
    // option that restores the base set.
    std::string_view sourceFolder = {};
};

struct VariantGroup {
    GroupId id;
    int ownerSwitch;  // switch index of the owning category
    std::string_view section;
    OptionArray array;
    LabelArray labels;
    int panel;      // the tab panel that shows the group
    int container;  // groups with the same container would share one choice; here each has its own
    std::span<const PatchOption> options;
};

struct PatchCategory {
    std::string_view key;  // key in section "Thay doi"
    std::string_view label;
    int switchIndex;  // index among the check boxes and their labels
    int defaultValue;
    std::optional<GroupId> group;
};

inline constexpr std::string_view kCategorySection = "Thay doi";

// Categories in switch order, and groups in catalog order (ball, scoreboard, adboard, pitch, mark).
std::span<const PatchCategory> Categories();
std::span<const VariantGroup> Groups();
const VariantGroup& Group(GroupId id);

// The group that owns option button `index` of `array`, or null when there is no such button.
const VariantGroup* GroupOfOption(OptionArray array, int index);

}  // namespace kickvane::catalog
