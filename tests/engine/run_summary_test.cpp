#include "engine/run_summary.h"

#include <gtest/gtest.h>

namespace kickvane::engine {
namespace {

StepOutcome Step(int category, StepKind kind, StepState state) {
    return {PlanStep{category, kind, {Root::Extras, "\\a"}, {Root::Data, "\\a"}}, state, {}, {}};
}

// Sets are counted once a category, folders made are no sets; a run that copies nothing says why.
TEST(RunSummaryTest, CountsCopiedSetsByCategoryAndFailedSteps_OrSaysWhyNothingWasCopied) {
    ApplyOutcome outcome;
    EXPECT_EQ(RunSummary(outcome, {0, 0}), "Lần chạy lúc 00:00: chưa chọn mục nào để chép");
    outcome.steps = {
        Step(0, StepKind::MergeCopy, StepState::Done),
        Step(0, StepKind::MergeCopy, StepState::Done),
        Step(1, StepKind::FileCopy, StepState::Done),
        Step(3, StepKind::MergeCopy, StepState::NotNeeded),
        Step(4, StepKind::MakeFolder, StepState::Done),
        Step(5, StepKind::MergeCopy, StepState::Failed),
    };
    EXPECT_EQ(RunSummary(outcome, {7, 5}), "Lần chạy lúc 07:05: đã chép 2 bộ, 1 lỗi");
    outcome.stoppedBy = RootProblem::DataMissing;
    EXPECT_EQ(RunSummary(outcome, {23, 59}),
              "Lần chạy lúc 23:59: đã dừng, không tìm thấy thư mục FIFA Online 2");
}

}  // namespace
}  // namespace kickvane::engine
