#pragma once

// The requests to end that the system sends a program: SIGTERM (a shutdown, `kill`), SIGINT
// (Ctrl+C) and SIGHUP (the session's end) on POSIX systems.
namespace kickvane::platform {

// From now on those requests no longer end the process at once: each makes the returned
// descriptor readable (for an event loop's notifier), so that the program can end in order.
// -1 where the system sends no such requests to a windowed program (Windows), or when they
// cannot be watched; they then keep their usual effect.
int WatchStopRequests();

}  // namespace kickvane::platform
