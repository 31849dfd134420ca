// What every system's process start shares.
#include "platform/process.h"

namespace kickvane::platform {

namespace {

class FixedWatch final : public ProgramWatch {
public:
    explicit FixedWatch(ProgramState state) : state_(std::move(state)) {}
    ProgramState Poll() override { return state_; }

private:
    ProgramState state_;
};

}  // namespace

std::unique_ptr<ProgramWatch> NotRunWatch(Failure failure) {
    ProgramState state;
    state.kind = ProgramState::Kind::NotRun;
    state.failure = std::move(failure);
    return std::make_unique<FixedWatch>(std::move(state));
}

}  // namespace kickvane::platform
