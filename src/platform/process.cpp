#include "platform/process.h"

#include <array>
#include <atomic>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <unistd.h>

namespace {

std::atomic<unsigned> arrived{0}; ///< A bit for each signal that waits.

void hold(int signal) { arrived |= 1U << signal; }

struct SignalHandler {
    int signal;
    void (*other)(int); ///< That which is not in use.
};

// Where they are ignored, the write fails like any other.
std::array<SignalHandler, 2> writeSignals{{{SIGPIPE, SIG_IGN}, {SIGXFSZ, SIG_IGN}}};

// Caught rather than blocked: a blocked signal would still reach one of the toolkit's threads and
// end the process there.
std::array<SignalHandler, 3> endSignals{{{SIGTERM, hold}, {SIGINT, hold}, {SIGHUP, hold}}};

template <std::size_t count>
void exchange(std::array<SignalHandler, count> &handlers) {
    for (auto &[signal, other] : handlers) {
        other = std::signal(signal, other);
    }
}

} // namespace

void prepareProcess() {
    for (int number = STDIN_FILENO; number <= STDERR_FILENO; ++number) {
        if (::fcntl(number, F_GETFD) < 0) {
            // The lowest number that is free: this one. A command inherits it as it would have
            // been given.
            [[maybe_unused]] const int opened = ::open("/dev/null", O_RDWR);
        }
    }
    exchange(writeSignals);
}

void runShellCommand(const char *command) {
    exchange(writeSignals);
    [[maybe_unused]] const int status = std::system(command);
    exchange(writeSignals);
}

EndSignalsHeld::EndSignalsHeld() { exchange(endSignals); }

EndSignalsHeld::~EndSignalsHeld() {
    exchange(endSignals);
    const unsigned waiting = arrived.exchange(0);
    for (const auto &[signal, other] : endSignals) {
        if ((waiting & 1U << signal) != 0) {
            [[maybe_unused]] const int result = std::raise(signal);
        }
    }
}
