#include "engine/run_summary.h"

#include <cstdio>
#include <set>

namespace kickvane::engine {

namespace {

std::string TwoDigits(int value) {
    char text[8];
    std::snprintf(text, sizeof text, "%02d", value);
    return text;
}

}  // namespace

std::string RunSummary(const ApplyOutcome& outcome, ClockTime at) {
    std::string line = "Lần chạy lúc " + TwoDigits(at.hour) + ":" + TwoDigits(at.minute) + ": ";
    switch (outcome.stoppedBy) {
        case RootProblem::ToolDataMissing:
            return line + "đã dừng, thiếu thư mục dữ liệu của công cụ";
        case RootProblem::ToolDataTooLong:
            return line + "đã dừng, đường dẫn thư mục dữ liệu của công cụ quá dài";
        case RootProblem::DataTooLong:
            return line + "đã dừng, đường dẫn thư mục FIFA Online 2 quá dài";
        case RootProblem::DataMissing:
            return line + "đã dừng, không tìm thấy thư mục FIFA Online 2";
        case RootProblem::None:
            break;
    }
    if (outcome.steps.empty()) {
        return line + "chưa chọn mục nào để chép";
    }
    // A set is a category: it counts as copied once one of its copies has gone through. Steps
    // that were not needed and the folders made for the copies count for nothing.
    std::set<int> copiedSets;
    int failures = 0;
    for (const StepOutcome& step : outcome.steps) {
        if (step.state == StepState::Failed) {
            ++failures;
        } else if (step.state == StepState::Done && step.step.kind != StepKind::MakeFolder) {
            copiedSets.insert(step.step.category);
        }
    }
    return line + "đã chép " + std::to_string(copiedSets.size()) + " bộ, " +
           std::to_string(failures) + " lỗi";
}

}  // namespace kickvane::engine
