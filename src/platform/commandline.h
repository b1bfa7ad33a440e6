#pragma once

#include <QStringList>

struct CommandLine {
    bool isInitOnly = false;
    QStringList pages; ///< Empty when all pages are wanted.
};

/// "-init" (or "--init") is the init-only mode; "-h" and "-v" (or "--help" and "--version") print
/// and end the process with 0. Every other argument names a page, one of `pageNames`. An unknown
/// option or page ends the process with 2 and one line on standard error.
CommandLine parseCommandLine(int argc, char **argv, const char *name, const QStringList &pageNames);
