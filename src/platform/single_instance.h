#pragma once

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
    virtual int commandDescriptor() const = 0;

    // The next waiting command, or nullopt when none is waiting. Never blocks.
    virtual std::optional<std::string> TakeCommand() = 0;
};

// Becomes the running copy for this user and `name`; null when another copy runs already.
// `name` separates unrelated uses (tests pass their own).
std::unique_ptr<SingleInstance> AcquireSingleInstance(const std::string& name = "kickvane");

// Sends a command to the running copy. False when no copy is running or it did not take it.
bool SendToRunningInstance(const std::string& command, const std::string& name = "kickvane");

}  // namespace kickvane::platform
