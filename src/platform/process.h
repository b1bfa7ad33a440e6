#pragma once

#include <sys/types.h>

/// What the process shares with the one that started it: signals, descriptors, commands.

/// To be called first. Run by root, the toolkit gets no bus to look for: it would look for one by
/// way of the display, where any program of its user can answer. Standard input, output and error
/// become /dev/null where they are closed: the next file, or the display's connection, would
/// otherwise take their place and get the program's messages. No write ends the process from here
/// on, neither into a pipe that nobody reads nor past the file size limit.
void prepareProcess();

/// As long as one lives, SIGTERM, SIGINT and SIGHUP wait; then they do what they would have done.
/// One at a time.
class EndSignalsHeld {
public:
    EndSignalsHeld();
    EndSignalsHeld(const EndSignalsHeld &) = delete;
    EndSignalsHeld &operator=(const EndSignalsHeld &) = delete;
    ~EndSignalsHeld();

    /// Starts the command in the shell, which finds signals and environment as this process found
    /// them. The process's number, or -1 where none can be started.
    static pid_t startShellCommand(const char *command);
};

/// Waits for the end of a process that was started; not at all for -1.
void waitForCommand(pid_t command);
