#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalog/selection.h"
#include "engine/file_ops.h"
#include "engine/plan.h"
#include "engine/roots.h"
#include "text/message.h"

namespace kickvane::engine {

enum class StepState {
    Done,
    NotNeeded,  // its guard said no: the source is absent or the folder exists
    Failed,
};

struct StepOutcome {
    PlanStep step;
    StepState state = StepState::Done;
    Failure failure;  // why it failed, when it did
    CopyCount files;
};

struct ApplyOutcome {
    RootProblem stoppedBy = RootProblem::None;  // a folder check stopped the run: nothing copied
    std::optional<text::Message> message;       // the folder check's message
    std::vector<StepOutcome> steps;
    std::filesystem::path signalSound;  // to play once the copies are done; empty when stopped

    bool Stopped() const { return stoppedBy != RootProblem::None; }
    std::vector<StepOutcome> Failures() const;
};

// Messages of the two folder checks (the second one stored VNI-typed).
inline constexpr std::string_view kToolDataMissingTitle = "Thư mục nguồn";
std::string ToolDataMissingText(const Roots& roots);
std::string ToolDataTooLongText(const Roots& roots);
inline constexpr std::string_view kDataMissingVni =
    "Kho6ng ti2m tha61y thu7 mu5c chu71a FIFA Online 2\r\nVui lo2ng kie63m tra la5i d9u7o72ng "
    "da64n";
// The same when the system refuses the game's folder for the length of its path.
inline constexpr std::string_view kDataTooLongVni =
    "D9u7o72ng da64n thu7 mu5c chu71a FIFA Online 2 qua1 da2i\r\nVui lo2ng cho5n thu7 mu5c "
    "nga81n ho7n";

// Copies the chosen sets from the tool folder into the game folder. The folder checks come first
// and stop the run with their message, before anything is copied. Then every step runs in plan
// order; a step that fails is recorded and the run goes on. A run that was not stopped names the
// signal sound to play.
ApplyOutcome ApplyPatches(const std::filesystem::path& toolFolder, std::string_view gameFolder,
                          const catalog::PatchSelection& selection);

// The path of the signal sound in the tool folder.
std::filesystem::path SignalSoundPath(const std::filesystem::path& toolFolder);

}  // namespace kickvane::engine
