#include "engine/apply.h"

#include "platform/filesystem.h"
#include "text/vni.h"

namespace kickvane::engine {

namespace {

// Runs one step of the plan against the run's roots; a step whose guard says no is not needed.
StepOutcome RunStep(const PlanStep& step, const Roots& roots) {
    StepOutcome outcome{step, StepState::Done, {}, {}};
    const bool needed = [&] {
        switch (step.guard) {
            case StepGuard::IfSourceFolderExists:
                return FolderExists(roots.Resolve(step.source));
            case StepGuard::IfGuardFolderMissing:
                return !FolderExists(roots.Resolve(step.guardFolder));
            case StepGuard::Always:
                break;
        }
        return true;
    }();
    if (!needed) {
        outcome.state = StepState::NotNeeded;
        return outcome;
    }
    Status status = Status::Ok();
    switch (step.kind) {
        case StepKind::MergeCopy:
            status =
                MergeCopy(roots.Resolve(step.source), roots.Resolve(step.target), &outcome.files);
            break;
        case StepKind::FileCopy:
            status = CopyFileInto(roots.Resolve(step.source), roots.Resolve(step.target),
                                  &outcome.files);
            break;
        case StepKind::MakeFolder:
            // The plan makes folders only so that the copy after it has a place to go; one that
            // exists already is what the plan wants, not a failure to report.
            if (FolderExists(roots.Resolve(step.target))) {
                outcome.state = StepState::NotNeeded;
                return outcome;
            }
            status = MakeFolder(roots.Resolve(step.target));
            if (!status && FolderExists(roots.Resolve(step.target))) {
                outcome.state = StepState::NotNeeded;  // another program made it meanwhile
                return outcome;
            }
            break;
    }
    if (!status) {
        outcome.state = StepState::Failed;
        outcome.failure = status.failure();
    }
    return outcome;
}

}  // namespace

std::vector<StepOutcome> ApplyOutcome::Failures() const {
    std::vector<StepOutcome> failures;
    for (const StepOutcome& step : steps) {
        if (step.state == StepState::Failed) {
            failures.push_back(step);
        }
    }
    return failures;
}

std::string ToolDataMissingText(const Roots& roots) {
    return "Không tìm thấy: " + platform::PathToUtf8(roots.toolData) + "\r\nKiểm tra lại đường dẫn";
}

std::string ToolDataTooLongText(const Roots& roots) {
    return "Đường dẫn quá dài: " + platform::PathToUtf8(roots.toolData) +
           "\r\nKiểm tra lại đường dẫn";
}

std::filesystem::path SignalSoundPath(const std::filesystem::path& toolFolder) {
    return platform::ResolveCaseInsensitive(toolFolder / "sound.wav");
}

ApplyOutcome ApplyPatches(const std::filesystem::path& toolFolder, std::string_view gameFolder,
                          const catalog::PatchSelection& selection) {
    ApplyOutcome outcome;
    const Roots roots = ResolveRoots(toolFolder, gameFolder);
    outcome.stoppedBy = CheckRoots(roots);
    switch (outcome.stoppedBy) {
        case RootProblem::ToolDataMissing:
            outcome.message = text::Message{text::Message::Kind::Plain, ToolDataMissingText(roots),
                                            std::string(kToolDataMissingTitle)};
            return outcome;
        case RootProblem::ToolDataTooLong:
            outcome.message = text::Message{text::Message::Kind::Plain, ToolDataTooLongText(roots),
                                            std::string(kToolDataMissingTitle)};
            return outcome;
        case RootProblem::DataMissing:
            outcome.message = text::Message{
                text::Message::Kind::Component, text::VniToUnicodeUtf8(kDataMissingVni), {}};
            return outcome;
        case RootProblem::DataTooLong:
            outcome.message = text::Message{
                text::Message::Kind::Component, text::VniToUnicodeUtf8(kDataTooLongVni), {}};
            return outcome;
        case RootProblem::None:
            break;
    }
    for (const PlanStep& step : BuildPlan(selection)) {
        outcome.steps.push_back(RunStep(step, roots));
    }
    outcome.signalSound = SignalSoundPath(toolFolder);
    return outcome;
}

}  // namespace kickvane::engine
