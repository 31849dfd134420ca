#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "platform/status.h"

namespace kickvane::platform {

// Variables set for a started program on top of the tool's own environment (name, value); a name
// that the environment has already gets the new value.
using EnvironmentAdditions = std::vector<std::pair<std::string, std::string>>;

// What became of a started program, as far as is known at the moment of asking.
struct ProgramState {
    enum class Kind {
        Starting,  // not yet known whether it could be run
        Running,   // it runs (or its end could not be learnt)
        Exited,    // it ended by itself; `code` is its exit code
        Killed,    // a signal ended it; `code` is the signal's number
        NotRun,    // it could not be run; `failure` says why
    };
    Kind kind = Kind::Starting;
    int code = 0;
    Failure failure;

    bool ended() const { return kind == Kind::Exited || kind == Kind::Killed; }
};

// A started program, watched without waiting for it. Dropping the watch leaves the program
// running on its own: it outlives the tool and never lingers as a zombie of the tool's.
class ProgramWatch {
public:
    virtual ~ProgramWatch() = default;
    // The program's state now; never blocks. Once it has ended or could not run, the answer
    // stays the same.
    virtual ProgramState Poll() = 0;
};

// Starts a program in `workingFolder` and returns without waiting for it, with a watch on it.
// Arguments are passed as they are, never through a shell. On Windows `minimised` asks for a
// minimised first window. A program that cannot be run (missing, not executable, a bad working
// folder) shows as NotRun with the system's error, on POSIX too, where the program is run by a
// process of its own.
std::unique_ptr<ProgramWatch> StartWatched(const std::filesystem::path& program,
                                           const std::vector<std::string>& arguments,
                                           const std::filesystem::path& workingFolder,
                                           bool minimised = false,
                                           const EnvironmentAdditions& environment = {});

// The watch of a program that could not be started at all: NotRun with `failure`, for good.
std::unique_ptr<ProgramWatch> NotRunWatch(Failure failure);

// The full path of a program found on PATH; empty when there is none.
std::filesystem::path FindOnPath(const std::string& name);

// True when `file` can be run directly by this system (on Linux: executable, as an ELF program
// or a script with a #! line). A Windows program on Linux needs Wine instead.
bool IsNativeExecutable(const std::filesystem::path& file);

}  // namespace kickvane::platform
