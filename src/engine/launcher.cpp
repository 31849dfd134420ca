#include "engine/launcher.h"

#include "engine/launch_plan.h"
#include "platform/process.h"

namespace kickvane::engine {

LaunchResult LaunchGame(std::string_view gameFolder, EngineUi& ui) {
    const LaunchDecision decision =
        PlanLaunch(gameFolder, UserFolders::FromEnvironment(), platform::FindOnPath);
    if (decision.problem == LaunchProblem::LauncherMissing) {
        ui.Messages().ShowText(ui.Messages().ConvertText(kLauncherMissingVni));
        return LaunchResult::LauncherMissing;
    }
    if (decision.problem == LaunchProblem::WineMissing) {
        ui.Messages().ShowText(kWineMissingText);
        return LaunchResult::WineMissing;
    }
    const LaunchPlan& plan = decision.plan;
    const Status started = platform::StartDetached(plan.program, plan.arguments, plan.workingFolder,
                                                   true, plan.environment);
    if (!started) {
        ui.Messages().ShowText(std::string(kStartFailedText) + started.reason());
        return LaunchResult::StartFailed;
    }
    return LaunchResult::Started;
}

}  // namespace kickvane::engine
