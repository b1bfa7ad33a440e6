#include "platform/process.h"

#include <array>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

constexpr const char *busVariable = "DBUS_SESSION_BUS_ADDRESS";
bool isBusHidden = false;

struct SignalHandler {
    int signal;
    void (*other)(int); ///< That which is not in use.
};

// Where they are ignored, the write fails like any other.
std::array<SignalHandler, 2> writeSignals{{{SIGPIPE, SIG_IGN}, {SIGXFSZ, SIG_IGN}}};

void hold(int signal);

// Caught rather than blocked: a blocked signal would still reach one of the toolkit's threads and
// end the process there.
std::array<SignalHandler, 3> endSignals{{{SIGTERM, hold}, {SIGINT, hold}, {SIGHUP, hold}}};

std::atomic<unsigned> arrived{0}; ///< A bit for each signal that waits.
std::atomic<bool> areHeld{false};

void raiseArrived() {
    const unsigned waiting = arrived.exchange(0);
    for (const auto &[signal, other] : endSignals) {
        if ((waiting & 1U << signal) != 0) {
            [[maybe_unused]] const int result = std::raise(signal);
        }
    }
}

/// May run in another thread of the toolkit, and still do so when the main thread holds no more.
void hold(int signal) {
    arrived |= 1U << signal;
    if (!areHeld) {
        raiseArrived();
    }
}

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
    const char *bus = std::getenv(busVariable);
    isBusHidden = ::geteuid() == 0 && (bus == nullptr || *bus == '\0') &&
                  ::setenv(busVariable, "disabled:", 1) == 0;
}

pid_t EndSignalsHeld::startShellCommand(const char *command) {
    const pid_t number = ::fork();
    if (number == 0) {
        exchange(writeSignals);
        exchange(endSignals);
        if (isBusHidden) {
            ::unsetenv(busVariable);
        }
        ::execl("/bin/sh", "sh", "-c", command, nullptr);
        ::_exit(127); // As the shell does for what it cannot start.
    }
    return number;
}

void waitForCommand(pid_t command) {
    while (command > 0 && ::waitpid(command, nullptr, 0) < 0 && errno == EINTR) {
    }
}

EndSignalsHeld::EndSignalsHeld() {
    areHeld = true;
    exchange(endSignals);
}

EndSignalsHeld::~EndSignalsHeld() {
    exchange(endSignals);
    areHeld = false;
    raiseArrived();
}
