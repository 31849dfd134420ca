#pragma once

#include <chrono>

namespace kickvane::shell {

// The main window's fade: its opacity moves by a step every tick until it reaches a target, and
// then the fade ends with a beep. Plain state driven by advance(), so tests need no timer.
class FadeModel {
public:
    static constexpr std::chrono::milliseconds kInterval{20};

    // Starts a fade, or changes the target and step of the one that runs.
    void start(int target, int step) {
        target_ = target;
        step_ = step;
        running_ = true;
    }

    struct Tick {
        int alpha;         // the opacity to apply now, 0 to 255
        bool firstInLife;  // the window takes translucency from now on
        bool ended;        // the fade is over: stop the timer and beep
    };

    // One tick of a running fade.
    Tick advance() {
        const bool first = !layered_;
        layered_ = true;
        alpha_ += step_;
        alpha_ = alpha_ < 0 ? 0 : (alpha_ > 255 ? 255 : alpha_);
        const bool ended = (step_ > 0 && alpha_ >= target_) || (step_ < 0 && alpha_ <= target_);
        if (ended) {
            running_ = false;
        }
        return {alpha_, first, ended};
    }

    bool running() const { return running_; }
    int alpha() const { return alpha_; }
    int target() const { return target_; }
    int step() const { return step_; }

private:
    int target_ = 0;
    int step_ = 0;
    int alpha_ = 0;  // what the fade applied last; 0 before the first tick
    bool running_ = false;
    bool layered_ = false;
};

// Result codes of an immediate opacity change.
enum class TranslucentResult { Applied = 0, OutOfRange = 1, Failed = 2 };

}  // namespace kickvane::shell
