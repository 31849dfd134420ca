#include "game/launcher.h"

#include "game/launch_plan.h"
#include "platform/filesystem.h"
#include "platform/process.h"
#include "text/failure_text.h"
#include "text/vni.h"

namespace kickvane::game {

namespace {

LaunchOutcome NotStarted(LaunchResult result, std::string text) {
    return {result, text::Message{text::Message::Kind::Component, std::move(text), {}}, {}};
}

}  // namespace

LaunchOutcome LaunchGame(std::string_view gameFolder) {
    const LaunchDecision decision =
        PlanLaunch(gameFolder, UserFolders::FromEnvironment(), platform::FindOnPath);
    if (decision.problem == LaunchProblem::LauncherMissing) {
        return NotStarted(LaunchResult::LauncherMissing,
                          text::VniToUnicodeUtf8(kLauncherMissingVni));
    }
    if (decision.problem == LaunchProblem::WineMissing) {
        return NotStarted(LaunchResult::WineMissing, std::string(kWineMissingText));
    }
    const LaunchPlan& plan = decision.plan;
    const Status started = platform::StartDetached(plan.program, plan.arguments, plan.workingFolder,
                                                   true, plan.environment);
    if (!started) {
        return NotStarted(
            LaunchResult::StartFailed,
            std::string(kStartFailedText) +
                text::FailureText(started.failure(),
                                  {platform::NativePathFromUserText(gameFolder), {}}));
    }
    LaunchOutcome outcome;
    outcome.startedThrough = plan.description;
    return outcome;
}

}  // namespace kickvane::game
