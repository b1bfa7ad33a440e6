#pragma once

#include "base/byteset.h"
#include "base/bytesink.h"
#include "base/kepttext.h"

#include <cstddef>
#include <cstring>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

/// The program's only way to the product's files: a whole file in, a whole file out. Files are
/// plain bytes; nothing here converts them.

/// The bytes of the regular file at `path`; none when it cannot be opened or read. A directory
/// counts as a file that cannot be opened, and so does anything that need not have an end (a
/// device, a pipe). Throws std::bad_alloc when the file is larger than the memory.
std::optional<FileBytes> readWholeFile(const std::string &path);

/// Replaces the contents of the file at `path` in place by what `format(sink)` puts, so that its
/// owner, mode and links stay; creates it where it is missing. False when it could not be opened
/// or not be written whole.
///
/// `format` is called twice and must put the same both times: first to measure, so that room for
/// all of it is had before the first old byte is touched. Where there is no room, or memory runs
/// out while it is measured (std::bad_alloc is passed on), the file keeps what it holds; one that
/// was missing may be left empty. The second time it must not throw; what takes memory belongs into
/// the first, or before both. A device that fails on the way leaves new bytes before old ones.
bool rewriteFile(const std::string &path, const std::function<void(ByteSink &)> &format);
bool rewriteFile(const std::string &path, std::string_view bytes);

/// Whether rewriteFile would get to open the file, as far as the user's rights decide it. Opens
/// nothing and changes nothing.
bool mayRewrite(const std::string &path);

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
