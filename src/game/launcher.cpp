#include "game/launcher.h"

#include "platform/process.h"

namespace kickvane::game {

LaunchStart LaunchGame(std::string_view gameFolder) {
    LaunchDecision decision =
        PlanLaunch(gameFolder, UserFolders::FromEnvironment(), platform::FindOnPath);
    LaunchStart start{decision.problem, std::move(decision.plan), nullptr};
    if (start.problem == LaunchProblem::None) {
        const LaunchPlan& plan = start.plan;
        start.program = platform::StartWatched(plan.program, plan.arguments, plan.workingFolder,
                                               true, plan.environment);
    }
    return start;
}

LaunchWatch::LaunchWatch(std::unique_ptr<platform::ProgramWatch> program, Clock now,
                         std::chrono::milliseconds watchTime)
    : program_(std::move(program)), now_(std::move(now)), deadline_(now_() + watchTime) {}

LaunchVerdict LaunchWatch::Tick() {
    if (verdict_ != LaunchVerdict::Watching) {
        return verdict_;
    }
    using Kind = platform::ProgramState::Kind;
    state_ = program_ ? program_->Poll() : platform::ProgramState{Kind::Running, 0, {}};
    switch (state_.kind) {
        case Kind::NotRun:
        case Kind::Killed:
            verdict_ = LaunchVerdict::Failed;
            break;
        case Kind::Exited:
            verdict_ = state_.code == 0 ? LaunchVerdict::Started : LaunchVerdict::Failed;
            break;
        case Kind::Running:
            if (now_() >= deadline_) {
                verdict_ = LaunchVerdict::Started;
            }
            break;
        case Kind::Starting:
            // Not known yet whether it could be run at all: wait for that, even past the time.
            break;
    }
    if (verdict_ != LaunchVerdict::Watching) {
        program_.reset();
    }
    return verdict_;
}

}  // namespace kickvane::game
