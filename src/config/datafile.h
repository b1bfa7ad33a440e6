#pragma once

#include "base/textfile.h"
#include "config/settings.h"

#include <new>

/// The files beside the master file whose paths are settings of it.

/// The file's bytes; none when the setting has no value or the file cannot be opened. Throws
/// std::bad_alloc.
inline std::optional<std::string> readDataFile(const TextSetting &path) {
    return path.value ? readWholeFile(*path.value) : std::nullopt;
}

/// Rewrites the file with what `format()` returns; nothing happens when the setting has no value.
/// The bytes stand whole in memory before the file is touched, so that the moment in which it is
/// not whole is short, and running out of memory leaves it as it was.
template <class Format>
void rewriteDataFile(const TextSetting &path, Format format) {
    if (!path.value) {
        return;
    }
    try {
        rewriteFile(*path.value, format());
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
    }
}
