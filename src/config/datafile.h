#pragma once

#include "base/textfile.h"
#include "config/settings.h"

#include <new>

/// The files beside the master file whose paths are settings of it.

/// The file's bytes, kept; none when the setting has no value or the file cannot be opened. Throws
/// std::bad_alloc.
inline std::optional<KeptText> readDataFile(const TextSetting &path) {
    std::optional<FileBytes> file = path.value ? readWholeFile(*path.value) : std::nullopt;
    return file ? std::optional{keep(std::move(*file))} : std::nullopt;
}

/// Rewrites the file with what `format(sink)` puts; nothing happens when the setting has no value.
template <class Format>
void rewriteDataFile(const TextSetting &path, Format format) {
    if (!path.value) {
        return;
    }
    try {
        rewriteFile(*path.value, format);
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
    }
}
