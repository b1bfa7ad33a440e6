#pragma once

// The real program in a process of its own, on the product of the test that starts it.

#include <QProcess>

#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <functional>
#include <linux/capability.h>
#include <poll.h>
#include <string>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <unistd.h>

/// Whether the lines, run in the product's folder, end with 0.
inline bool shell(const std::string &lines) {
    return std::system(("exec 2>/dev/null\n" + lines).c_str()) == 0;
}

/// Makes an empty product and enters it. What is started has no rights to files beyond those of
/// their modes, as most users.
inline bool enterProduct() {
    umask(022);
    unsetenv("DBUS_SESSION_BUS_ADDRESS"); // As where a desktop makes the program root's.
    prctl(PR_CAPBSET_DROP, CAP_DAC_OVERRIDE);
    prctl(PR_CAPBSET_DROP, CAP_DAC_READ_SEARCH);
    return shell("chattr -R -a '" TEST_PRODUCT "'; rm -rf '" TEST_PRODUCT
                 "'; mkdir -p '" TEST_PRODUCT "/disk'") &&
           chdir(TEST_PRODUCT) == 0;
}

/// With its buttons pressed from here.
struct Program : QProcess {
    explicit Program(
        const QStringList &arguments = {}, const std::function<void()> &prepare = [] {},
        const QStringList &variables = {}) {
        int ends[2];
        socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends);
        setProcessChannelMode(ForwardedErrorChannel);
        setStandardOutputFile(nullDevice());
        setChildProcessModifier([&] {
            setpgid(0, 0);
            prctl(PR_SET_PDEATHSIG, SIGKILL);
            close_range(3, ~0U, CLOSE_RANGE_CLOEXEC);
            dup2(ends[1], DRIVER_LINE);
            prepare();
        });
        setEnvironment(systemEnvironment() + variables);
        start(TEST_PROGRAM, arguments);
        number = static_cast<pid_t>(processId());
        line = ends[0];
        ::close(ends[1]);
    }
    ~Program() override {
        if (number > 0) {
            ::kill(-number, SIGKILL); // And whatever it has started.
        }
        waitForFinished();
        ::close(line);
    }
    static constexpr int hangs = 999; ///< In place of a status.
    /// The next letter that it says; "-" once it is gone, "?" when it hangs.
    [[nodiscard]] char heard(int patience = 60'000) const {
        char letter = '-';
        pollfd end{line, POLLIN, 0};
        return poll(&end, 1, patience) == 1 ? (recv(line, &letter, 1, 0), letter) : '?';
    }
    [[nodiscard]] bool isReady() const { return heard() == 'r'; }
    void press(char letter) const { send(line, &letter, 1, MSG_NOSIGNAL); }
    [[nodiscard]] bool does(char letter) const { return press(letter), heard() == letter; }
    [[nodiscard]] bool applies() const { return does('A'); }
    /// The exit status, or the signal that ended it as a negative number.
    int end() {
        const bool isEnded = waitForFinished(60'000);
        return isEnded ? exitCode() * (exitStatus() == CrashExit ? -1 : 1) : hangs;
    }
    int line;
    pid_t number;
};
