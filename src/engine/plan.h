#pragma once

#include <string>
#include <vector>

#include "catalog/selection.h"
#include "engine/roots.h"

namespace kickvane::engine {

enum class StepKind {
    MergeCopy,   // folder source into folder target
    FileCopy,    // single file source into folder target
    MakeFolder,  // create target
};

// When a step runs at all. Only the interface graphics test their sources, and only the emblem
// and net folders are made when missing; every other step always runs.
enum class StepGuard {
    Always,
    IfSourceFolderExists,
    IfGuardFolderMissing,  // `guardFolder` is tested
};

struct PlanStep {
    int category;  // switch index of the category that owns the step
    StepKind kind;
    Location source;  // unused for MakeFolder
    Location target;
    StepGuard guard = StepGuard::Always;
    Location guardFolder{};

    friend bool operator==(const PlanStep&, const PlanStep&) = default;
};

// The copies of the categories that are on, in switch order, for their chosen variants.
std::vector<PlanStep> BuildPlan(const catalog::PatchSelection& selection);

// One line for people: "merge \extras\Ball\UCL 2011 -> ZDataRoot\ball".
std::string Describe(const PlanStep& step);

}  // namespace kickvane::engine
