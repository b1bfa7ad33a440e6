#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

/// The program's only way to the product's files: a whole file in, a whole file out. Files are
/// plain bytes; nothing here converts them.

/// The bytes of the regular file at `path`; none when it cannot be opened or read. A directory
/// counts as a file that cannot be opened, and so does anything that need not have an end (a
/// device, a pipe). Throws std::bad_alloc when the file is larger than the memory.
std::optional<std::string> readWholeFile(const std::string &path);

/// Replaces the contents of the file at `path` in place, so that its owner, mode and links stay;
/// creates it where it is missing. False when it could not be opened or not be written whole.
bool rewriteFile(const std::string &path, std::string_view bytes);

/// Whether rewriteFile would get to open the file, as far as the user's rights decide it. Opens
/// nothing and changes nothing.
bool mayRewrite(const std::string &path);

/// Cuts bytes into the pieces that the C library's line reading gives: up to and including a line
/// feed, but at most `longest` bytes, the line feed counted among them. So a line of exactly
/// `longest` bytes leaves its line feed to the next piece.
class LinePieces {
public:
    static constexpr std::size_t unlimited = std::string_view::npos;

    explicit LinePieces(std::string_view bytes, std::size_t longest = unlimited)
        : rest_{bytes}, longest_{longest} {}

    /// The next piece, never empty; none at the end of the bytes.
    std::optional<std::string_view> next();

private:
    std::string_view rest_;
    std::size_t longest_;
};

/// What a C string made of the piece would hold: everything before its first NUL.
std::string_view beforeNul(std::string_view piece);

/// The text of a line: what stands before its first carriage return, line feed or NUL.
std::string_view lineText(std::string_view piece);
