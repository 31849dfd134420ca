#include "engine/run_summary.h"

#include <gtest/gtest.h>

namespace kickvane::engine {
namespace {

StepOutcome Step(int category, StepKind kind, StepState state) {
    return {PlanStep{category, kind, {Root::Extras, "\\a"}, {Root::Data, "\\a"}}, state, {}, {}};
}

TEST(RunSummaryTest, CountsCopiedSetsByCategoryAndFailedSteps) {
    ApplyOutcome outcome;
    outcome.steps = {
        Step(0, StepKind::MergeCopy, StepState::Done),
        Step(0, StepKind::MergeCopy, StepState::Done),  // same set twice
        Step(1, StepKind::FileCopy, StepState::Done),
        Step(3, StepKind::MergeCopy, StepState::NotNeeded),
        Step(4, StepKind::MakeFolder, StepState::Done),  // a folder made is no set copied
        Step(5, StepKind::MergeCopy, StepState::Failed),
        Step(6, StepKind::MergeCopy, StepState::Failed),
    };
    EXPECT_EQ(RunSummary(outcome, {20, 15}), "Lần chạy lúc 20:15: đã chép 2 bộ, 2 lỗi");
    outcome.steps.resize(3);
    EXPECT_EQ(RunSummary(outcome, {7, 5}), "Lần chạy lúc 07:05: đã chép 2 bộ, 0 lỗi");
}

TEST(RunSummaryTest, RunsThatCopyNothingSayWhy) {
    ApplyOutcome outcome;
    EXPECT_EQ(RunSummary(outcome, {0, 0}), "Lần chạy lúc 00:00: chưa chọn mục nào để chép");
    outcome.stoppedBy = RootProblem::DataMissing;
    EXPECT_EQ(RunSummary(outcome, {23, 59}),
              "Lần chạy lúc 23:59: đã dừng, không tìm thấy thư mục FIFA Online 2");
    outcome.stoppedBy = RootProblem::ToolDataMissing;
    EXPECT_EQ(RunSummary(outcome, {9, 30}),
              "Lần chạy lúc 09:30: đã dừng, thiếu thư mục dữ liệu của công cụ");
}

}  // namespace
}  // namespace kickvane::engine
