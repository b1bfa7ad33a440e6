#pragma once

#include <algorithm>
#include <cctype>
#include <cstddef>
#include <optional>
#include <string_view>

/// How a file's bytes fall into lines. `Text` is a string_view or a KeptText: what is cut off one
/// is another of its kind.

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
        const std::string_view reach = std::string_view{rest_}.substr(0, longest_);
        const Text piece = rest_.substr(0, std::min(reach.find('\n'), reach.size() - 1) + 1);
        rest_.remove_prefix(piece.size());
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

/// The text of a piece: what stands before its first carriage return or NUL, and without the line
/// feed at its end.
template <class Text>
Text lineText(Text piece) {
    piece = piece.substr(0, piece.size() - (std::string_view{piece}.ends_with('\n') ? 1 : 0));
    for (const char end : {'\r', '\0'}) {
        piece = piece.substr(0, std::string_view{piece}.find(end));
    }
    return piece;
}

/// Whether there is more than white space and NULs in the bytes.
inline bool holdsWord(std::string_view bytes) {
    return std::ranges::any_of(
        bytes, [](unsigned char byte) { return byte != '\0' && std::isspace(byte) == 0; });
}

/// What stands behind the first word, with nothing but white space before it.
template <class Text>
Text behindWord(Text piece) {
    const std::string_view bytes = piece;
    const auto isSpace = [](unsigned char byte) { return std::isspace(byte) != 0; };
    const auto word = std::ranges::find_if_not(bytes, isSpace);
    const auto end = std::find_if(word, bytes.end(), isSpace);
    return piece.substr(static_cast<std::size_t>(end - bytes.begin()));
}

/// Counts the lines of a file of which something is in no record. A line that is read in several
/// pieces counts once.
class LostLines {
public:
    /// `left` is what of the piece is in no record: mostly its line feed. Inside the loops that
    /// read a million lines this would cost a tenth of their time.
    [[gnu::noinline]] void add(std::string_view piece, std::string_view left) {
        const bool isLost = left != "\n" && holdsWord(left);
        count_ += isLost && !isCounted_ ? 1 : 0;
        isCounted_ = (isLost || isCounted_) && !piece.ends_with('\n');
    }
    [[nodiscard]] std::size_t count() const { return count_; }

private:
    std::size_t count_ = 0;
    bool isCounted_ = false;
};
