#pragma once

#include "base/byteset.h"
#include "base/bytesink.h"
#include "base/kepttext.h"

#include <cstddef>
#include <cstring>
#include <functional>
#include <new>
#include <optional>
#include <string>
#include <string_view>
#include <sys/types.h>

/// The program's only way to the product's files: a whole file in, a whole file out. Files are
/// plain bytes; nothing here converts them.

struct FileRead {
    std::optional<FileBytes> bytes; ///< None when the file cannot be opened, or not read whole.
    bool isMissing = false;         ///< There is none, so that nothing can be lost of it.
};

/// Reads the regular file at `path`. A directory counts as a file that cannot be opened, and so
/// does anything that need not have an end (a device, a pipe). Throws std::bad_alloc when the file
/// is larger than the memory.
FileRead readWholeFile(const std::string &path);

/// Replaces the contents of the file at `path` in place by what `format(sink)` puts, so that its
/// owner, mode and links stay; creates it where it is missing. False when it could not be opened
/// or not be written whole.
///
/// `format` is called twice and must put the same both times: first to measure, so that room for
/// all of it is had before the first old byte is touched. Where there is no room, or memory runs
/// out while it is measured (std::bad_alloc is passed on), the file keeps what it holds; one that
/// was missing may be left empty. The second time it must not throw; what takes memory belongs into
/// the first, or before both. A device that fails on the way leaves new bytes before old ones. When
/// it returns, the bytes are on the disk, where the file is on one. The process has to ignore
/// SIGXFSZ and SIGPIPE; see prepareProcess.
///
/// `newFileMode` is the mode of a file that was missing, less the process's umask.
bool rewriteFile(const std::string &path, const std::function<void(ByteSink &)> &format,
                 mode_t newFileMode = 0666);
bool rewriteFile(const std::string &path, std::string_view bytes);

/// Whether rewriteFile would get to open the file, as far as the user's rights decide it. Opens
/// nothing and changes nothing.
bool mayRewrite(const std::string &path);

/// One of the product's files: read at the start, rewritten on every apply. What could not be read
/// whole is never rewritten, unless it was missing: that would take away what the file alone holds.
class ProductFile {
public:
    using Path = std::optional<std::string>; ///< None where the product has no such file.

    /// Reads the file and has `take(FileBytes)` make what is kept in memory of it. 0; 1 when there
    /// is none or it cannot be read; 2 when memory ran out, in `take` as well.
    template <class Take>
    int read(const Path &path, Take take) {
        isWhole_ = false;
        try {
            FileRead file = path ? readWholeFile(*path) : FileRead{std::nullopt, true};
            if (file.bytes) {
                take(*std::move(file.bytes));
            }
            isWhole_ = file.bytes || file.isMissing;
            return file.bytes ? 0 : 1;
        } catch (const std::bad_alloc &) {
            return 2;
        }
    }

    /// Like rewriteFile; nothing happens when there is no path, or memory runs out.
    void rewrite(const Path &path, const std::function<void(ByteSink &)> &format,
                 mode_t newFileMode = 0666) const;

private:
    bool isWhole_ = true;
};

/// Cuts bytes into the pieces that the C library's line reading gives: up to and including a line
/// feed, but at most `longest` bytes, the line feed counted among them. So a line of exactly
/// `longest` bytes leaves its line feed to the next piece.
template <class Text>
class LinePieces {
public:
    static constexpr std::size_t unlimited = std::string_view::npos;

    explicit LinePieces(Text bytes, std::size_t longest = unlimited)
        : rest_{bytes}, longest_{longest} {}

    /// The next piece, never empty; none at the end of the bytes.
    std::optional<Text> next() {
        if (rest_.empty()) {
            return std::nullopt;
        }
        // The search stays within the piece: short pieces of one endless line are cut in linear
        // time.
        const std::size_t reach = rest_.size() < longest_ ? rest_.size() : longest_;
        const void *lineFeed = std::memchr(rest_.data(), '\n', reach);
        const std::size_t length =
            lineFeed == nullptr
                ? reach
                : static_cast<std::size_t>(static_cast<const char *>(lineFeed) - rest_.data()) + 1;
        const Text piece = rest_.substr(0, length);
        rest_.remove_prefix(length);
        return piece;
    }

private:
    Text rest_;
    std::size_t longest_;
};

/// What a C string made of the piece would hold: everything before its first NUL.
template <class Text>
Text beforeNul(Text piece) {
    return piece.substr(0, std::string_view{piece}.find('\0'));
}

/// The text of a line: what stands before its first carriage return, line feed or NUL.
template <class Text>
Text lineText(Text piece) {
    static constexpr ByteSet ends{std::string_view{"\r\n\0", 3}};
    return piece.substr(0, ends.lengthBefore(piece));
}
