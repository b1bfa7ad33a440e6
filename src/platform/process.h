#pragma once

/// What the process shares with the one that started it: signals, descriptors, commands.

/// To be called first. Standard input, output and error become /dev/null where they are closed: the
/// next file, or the display's connection, would otherwise take their place and get the program's
/// messages. No write ends the process from here on, neither into a pipe that nobody reads nor past
/// the file size limit.
void prepareProcess();

/// Runs the command in the shell and waits for its end. It finds the signals as this process found
/// them.
void runShellCommand(const char *command);

/// As long as one lives, SIGTERM, SIGINT and SIGHUP wait; then they do what they would have done.
/// One at a time.
class EndSignalsHeld {
public:
    EndSignalsHeld();
    EndSignalsHeld(const EndSignalsHeld &) = delete;
    EndSignalsHeld &operator=(const EndSignalsHeld &) = delete;
    ~EndSignalsHeld();
};
