// Stop requests on POSIX systems: the signal handler writes one byte into a pipe whose other end
// the event loop watches (writing to a pipe is safe in a signal handler; nearly nothing else is).
#include <fcntl.h>
#include <signal.h>
#include <unistd.h>

#include <cerrno>
#include <initializer_list>

#include "platform/stop_signals.h"

namespace kickvane::platform {

namespace {

int writeEnd = -1;

void OnStopRequest(int) {
    const int saved = errno;
    const char byte = 1;
    (void)!::write(writeEnd, &byte, 1);  // a full pipe already says "stop"
    errno = saved;
}

}  // namespace

int WatchStopRequests() {
    static const int readEnd = [] {
        int fds[2];
        if (::pipe2(fds, O_CLOEXEC | O_NONBLOCK) != 0) {
            return -1;
        }
        writeEnd = fds[1];
        struct sigaction action {};
        action.sa_handler = OnStopRequest;
        ::sigemptyset(&action.sa_mask);
        action.sa_flags = SA_RESTART;
        for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
            ::sigaction(signal, &action, nullptr);
        }
        return fds[0];
    }();
    return readEnd;
}

}  // namespace kickvane::platform
