#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <sys/types.h>

/// The program's only way to the product's files: a whole file in, a whole file out. Files are
/// plain bytes; nothing here converts them.

struct FileRead {
    std::optional<std::string> bytes; ///< None when the file cannot be opened, or not read whole.
    bool isMissing = false;           ///< There is none, so that nothing can be lost of it.
};

/// Reads the regular file at `path`. A directory counts as a file that cannot be opened, and so
/// does anything that need not have an end (a device, a pipe). Throws std::bad_alloc when the file
/// is larger than the memory.
FileRead readWholeFile(const std::string &path);

/// Replaces the contents of the file at `path` in place, so that its owner, mode and links stay;
/// creates it where it is missing. False when it could not be opened or not be written whole.
///
/// Space for all of it is set aside before the first old byte is touched. Where there is not enough
/// the file keeps what it holds; one that was missing is left empty. A device that fails on the way
/// leaves new bytes before old ones. When this returns, the bytes are on the disk, where the file
/// is on one. The process has to ignore SIGXFSZ and SIGPIPE; see prepareProcess.
///
/// `newFileMode` is the mode of a file that was missing, less the process's umask.
bool rewriteFile(const std::string &path, std::string_view bytes, mode_t newFileMode = 0666);

/// What would keep rewriteFile from opening the file, as far as asking tells: 0 for nothing, or an
/// error number. A missing file counts by its folder. Opens nothing and changes nothing.
int rewritingError(const std::string &path);

/// Keeps other processes that take it too out of the file's folder as long as it lives; waits for
/// theirs. Where it cannot be had there is none.
std::shared_ptr<void> lockFolderOf(const std::string &path);
