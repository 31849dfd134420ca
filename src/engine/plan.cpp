#include "engine/plan.h"

#include <array>
#include <optional>
#include <string_view>

#include "catalog/added_variants.h"

namespace kickvane::engine {

namespace {

using catalog::GroupId;
using catalog::PatchSelection;

// Switch indices of the categories, in the order they are applied.
enum Category {
    kBall = 0,
    kPitch = 1,
    kAdboard = 2,
    kInterface = 3,
    kEmblems = 4,
    kOther = 5,
    kFaces = 6,
    kBoots = 7,
    kKits = 8,
    kNets = 9,
    kScoreboard = 10,
    kMark = 11,
    kCrowd = 12,
    kStadiums = 13,
};

class PlanBuilder {
public:
    explicit PlanBuilder(std::vector<PlanStep>& steps) : steps_(steps) {}

    void Category(int category) { category_ = category; }

    void Merge(Root from, std::string_view fromPath, Root to, std::string_view toPath,
               StepGuard guard = StepGuard::Always) {
        steps_.push_back({category_,
                          StepKind::MergeCopy,
                          {from, std::string(fromPath)},
                          {to, std::string(toPath)},
                          guard,
                          {}});
    }

    // The same relative path on both sides: base set into the game.
    void Mirror(Root from, Root to, std::string_view path) { Merge(from, path, to, path); }

    void File(Root from, std::string_view fromPath, Root to, std::string_view toFolder) {
        steps_.push_back({category_,
                          StepKind::FileCopy,
                          {from, std::string(fromPath)},
                          {to, std::string(toFolder)},
                          StepGuard::Always,
                          {}});
    }

    // Make each folder in turn, but only while `guard` is missing.
    void MakeFoldersUnless(Location guard, std::initializer_list<std::string_view> folders) {
        for (std::string_view folder : folders) {
            steps_.push_back({category_,
                              StepKind::MakeFolder,
                              {},
                              {Root::Data, std::string(folder)},
                              StepGuard::IfGuardFolderMissing,
                              guard});
        }
    }

private:
    std::vector<PlanStep>& steps_;
    int category_ = 0;
};

constexpr std::array<std::string_view, 8> kInterfaceFolders{
    "\\gui\\hud\\chatting",     "\\gui\\hud\\DistanceToNet", "\\gui\\hud\\PK", "\\gui\\hud\\radar",
    "\\gui\\hud\\RefAdvantage", "\\gui\\hud\\watermark",     "\\gui\\loading", "\\gui\\font",
};

// The set of a group's chosen variant below the extras folder: an added variant's folder or a
// catalog option's set, the empty text for the option that restores the base set, and nullopt
// when the group has no chosen variant. Every variant of a group, added or not, is applied by the
// same steps from its set.
using ChosenSet = std::optional<std::string>;

ChosenSet SetOf(const PatchSelection& selection, GroupId group) {
    if (const std::string_view added = selection.ChosenAdded(group); !added.empty()) {
        return catalog::AddedVariant{group, std::string(added)}.SourceFolder();
    }
    if (const catalog::PatchOption* option = selection.ChosenOption(group)) {
        return std::string(option->sourceFolder);
    }
    return std::nullopt;
}

// Each function below adds one group's steps for its chosen variant: the variant's set from the
// extras folder, or the base set when the variant has none.

void AddBall(PlanBuilder& plan, const ChosenSet& chosen) {
    if (!chosen) {
        return;
    }
    if (chosen->empty()) {
        plan.Mirror(Root::ToolData, Root::Data, "\\ball");
        plan.Mirror(Root::ToolZData, Root::ZData, "\\ball");
    } else {
        plan.Merge(Root::Extras, *chosen, Root::ZData, "\\ball");
    }
}

void AddPitch(PlanBuilder& plan, const ChosenSet& chosen) {
    if (!chosen) {
        return;
    }
    if (chosen->empty()) {
        plan.Mirror(Root::ToolData, Root::Data, "\\pitch");
        plan.Mirror(Root::ToolZData, Root::ZData, "\\pitch");
        return;
    }
    // A variant's own grass, then the shared textures, then the base set's dirt and pitch lines
    // over whatever the variant brought, and the second tree's pitch reset to the base set.
    plan.Merge(Root::Extras, *chosen, Root::Data, "\\pitch\\textures");
    plan.Merge(Root::Extras, "\\pitch\\_textures", Root::Data, "\\pitch\\textures");
    plan.File(Root::ToolData, "\\pitch\\textures\\grass_dirt.dds", Root::Data, "\\pitch\\textures");
    plan.File(Root::ToolData, "\\pitch\\textures\\grass_pitchlines.dds", Root::Data,
              "\\pitch\\textures");
    plan.Mirror(Root::ToolZData, Root::ZData, "\\pitch");
}

void AddAdboard(PlanBuilder& plan, const ChosenSet& chosen) {
    if (chosen && chosen->empty()) {
        // The default restores only the main tree's adboards.
        plan.Mirror(Root::ToolData, Root::Data, "\\adboard");
    } else if (chosen) {
        plan.Merge(Root::Extras, *chosen, Root::ZData, "\\adboard");
    }
    plan.Mirror(Root::ToolData, Root::Data, "\\ingame_ad");
}

void AddScoreboard(PlanBuilder& plan, const ChosenSet& chosen) {
    if (!chosen) {
        return;
    }
    if (chosen->empty()) {
        plan.Mirror(Root::ToolData, Root::Data, "\\gui\\hud\\scoreboard");
        plan.Mirror(Root::ToolData, Root::Data, "\\gui\\hud\\namebar");
        return;
    }
    plan.Merge(Root::Extras, *chosen + "\\scoreboard", Root::Data, "\\gui\\hud\\scoreboard");
    plan.Merge(Root::Extras, *chosen + "\\namebar", Root::Data, "\\gui\\hud\\namebar");
}

void AddMark(PlanBuilder& plan, const ChosenSet& chosen) {
    if (!chosen) {
        return;
    }
    if (chosen->empty()) {
        plan.Mirror(Root::ToolData, Root::Data, "\\gui\\hud\\Indicator");
    } else {
        plan.Merge(Root::Extras, *chosen, Root::Data, "\\gui\\hud\\Indicator");
    }
}

}  // namespace

std::vector<PlanStep> BuildPlan(const PatchSelection& selection) {
    std::vector<PlanStep> steps;
    PlanBuilder plan(steps);
    for (int category = 0; category < catalog::kCategoryCount; ++category) {
        if (!selection.IsOn(category)) {
            continue;
        }
        plan.Category(category);
        switch (category) {
            case kBall:
                AddBall(plan, SetOf(selection, GroupId::Ball));
                break;
            case kPitch:
                AddPitch(plan, SetOf(selection, GroupId::Pitch));
                break;
            case kAdboard:
                AddAdboard(plan, SetOf(selection, GroupId::Adboard));
                break;
            case kInterface:
                for (std::string_view folder : kInterfaceFolders) {
                    plan.Merge(Root::ToolData, folder, Root::Data, folder,
                               StepGuard::IfSourceFolderExists);
                }
                break;
            case kEmblems:
                plan.MakeFoldersUnless({Root::Data, "\\teams\\emblems"},
                                       {"\\teams", "\\teams\\emblems"});
                plan.Mirror(Root::ToolData, Root::Data, "\\teams\\emblems");
                break;
            case kOther:
                plan.Mirror(Root::ToolData, Root::Data, "\\cmn");
                break;
            case kFaces:
                plan.Mirror(Root::ToolData, Root::Data, "\\players\\bodies");
                plan.Mirror(Root::ToolData, Root::Data, "\\players\\heads");
                break;
            case kBoots:
                plan.Mirror(Root::ToolData, Root::Data, "\\players\\accessories");
                break;
            case kKits:
                plan.Mirror(Root::ToolData, Root::Data, "\\players\\kit");
                break;
            case kNets:
                plan.MakeFoldersUnless({Root::Data, "\\net\\textures"},
                                       {"\\net", "\\net\\textures"});
                plan.Mirror(Root::ToolData, Root::Data, "\\net\\textures");
                break;
            case kScoreboard:
                AddScoreboard(plan, SetOf(selection, GroupId::Scoreboard));
                break;
            case kMark:
                AddMark(plan, SetOf(selection, GroupId::Mark));
                break;
            case kCrowd:
                plan.Mirror(Root::ToolZData, Root::ZData, "\\crowd\\textures");
                break;
            case kStadiums:
                plan.Mirror(Root::ToolZData, Root::ZData, "\\stadiums");
                break;
            default:
                break;
        }
    }
    return steps;
}

std::string Describe(const PlanStep& step) {
    auto where = [](const Location& location) {
        return std::string(RootName(location.root)) + location.relative;
    };
    std::string text;
    switch (step.kind) {
        case StepKind::MergeCopy:
            text = "merge " + where(step.source) + " -> " + where(step.target);
            break;
        case StepKind::FileCopy:
            text = "copy " + where(step.source) + " -> " + where(step.target);
            break;
        case StepKind::MakeFolder:
            text = "make folder " + where(step.target);
            break;
    }
    if (step.guard == StepGuard::IfSourceFolderExists) {
        text += " (if the source exists)";
    } else if (step.guard == StepGuard::IfGuardFolderMissing) {
        text += " (if " + where(step.guardFolder) + " is missing)";
    }
    return text;
}

}  // namespace kickvane::engine
