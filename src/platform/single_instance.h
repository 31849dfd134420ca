#pragma once

#include <chrono>
#include <memory>
#include <optional>
#include <string>

namespace kickvane::platform {

// One running copy per user. The first copy holds a lock for its lifetime (released by the
// system even when the process dies) and listens for short commands from later starts, such as
// "trigger" from `kickvane trigger`.
class SingleInstance {
public:
    virtual ~SingleInstance() = default;

    // A descriptor that becomes readable when a command is waiting (for an event loop's notifier).
    // -1 where there is none: on Windows, or when no private runtime folder was available. Then
    // TakeCommand is polled from a timer (it returns nullopt at once when nothing waits).
    virtual int CommandDescriptor() const = 0;

    // The next waiting command, or nullopt when none is waiting. Never blocks. Its sender
    // hears that it was taken.
    virtual std::optional<std::string> TakeCommand() = 0;
};

// Becomes the running copy for this user and `name`; null when another copy runs already.
// `name` separates unrelated uses (tests pass their own).
std::unique_ptr<SingleInstance> AcquireSingleInstance(const std::string& name = "kickvane");

// How a command sent to the running copy fared.
enum class Delivery {
    Delivered,   // the running copy took it
    Queued,      // a copy runs and holds the command, but is busy: it takes it when done
    NotRunning,  // no copy listens
    NoAnswer,    // a copy runs but accepted nothing in time (stopped, or hung): the command is lost
    Refused,     // not a command that can be sent (empty, too long, several lines)
};

// How long a sender waits for the running copy to take its command before it calls it busy.
inline constexpr std::chrono::milliseconds kAnswerWait{1500};

// Sends a command to the running copy and waits up to `answerWait` for it to be taken.
Delivery SendToRunningInstance(const std::string& command, const std::string& name = "kickvane",
                               std::chrono::milliseconds answerWait = kAnswerWait);

}  // namespace kickvane::platform
