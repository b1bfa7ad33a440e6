#include "platform/process.h"

#include <cstdlib>
#include <fcntl.h>
#include <malloc.h>
#include <unistd.h>

namespace {

constexpr std::array<int, 3> endSignals{SIGTERM, SIGINT, SIGHUP};

/// A write into a pipe that nobody reads, or past the file size limit, then fails like any other.
constexpr std::array<int, 2> writeSignals{SIGPIPE, SIGXFSZ};

/// What the process was started with.
std::array<struct sigaction, writeSignals.size()> startActions{};
bool isPrepared = false;

std::array<volatile std::sig_atomic_t, endSignals.size()> arrived{};

void hold(int signal) {
    for (std::size_t index = 0; index < endSignals.size(); ++index) {
        if (endSignals.at(index) == signal) {
            arrived.at(index) = 1;
        }
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
    // A heap for each of the toolkit's threads would set aside 128 MB of address space for itself.
    ::mallopt(M_ARENA_MAX, 1);
    struct sigaction ignore = {};
    ignore.sa_handler = SIG_IGN;
    for (std::size_t index = 0; index < writeSignals.size(); ++index) {
        ::sigaction(writeSignals.at(index), &ignore, &startActions.at(index));
    }
    isPrepared = true;
}

void runShellCommand(const char *command) {
    std::array<struct sigaction, writeSignals.size()> now{};
    for (std::size_t index = 0; isPrepared && index < writeSignals.size(); ++index) {
        ::sigaction(writeSignals.at(index), &startActions.at(index), &now.at(index));
    }
    [[maybe_unused]] const int status = std::system(command);
    for (std::size_t index = 0; isPrepared && index < writeSignals.size(); ++index) {
        ::sigaction(writeSignals.at(index), &now.at(index), nullptr);
    }
}

// A blocked signal would still reach one of the toolkit's threads and end the process there: each
// is caught instead, whichever thread gets it.

EndSignalsHeld::EndSignalsHeld() {
    struct sigaction caught = {};
    caught.sa_handler = hold;
    caught.sa_flags = SA_RESTART;
    for (std::size_t index = 0; index < endSignals.size(); ++index) {
        arrived.at(index) = 0;
        ::sigaction(endSignals.at(index), nullptr, &before_.at(index));
        if (before_.at(index).sa_handler != SIG_IGN) {
            ::sigaction(endSignals.at(index), &caught, nullptr);
        }
    }
}

EndSignalsHeld::~EndSignalsHeld() {
    for (std::size_t index = 0; index < endSignals.size(); ++index) {
        ::sigaction(endSignals.at(index), &before_.at(index), nullptr);
    }
    for (std::size_t index = 0; index < endSignals.size(); ++index) {
        if (arrived.at(index) != 0) {
            [[maybe_unused]] const int result = std::raise(endSignals.at(index));
        }
    }
}
