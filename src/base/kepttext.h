#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// A text whose bytes stay where they are until the process ends, so that records, their copies and
/// whatever shows them hold views of one text instead of texts of their own. Only `keep` makes one
/// that is not empty, and parts of one are such again: it cannot dangle.
///
/// The price: the bytes of a text that is replaced or removed stay, too, and so does all of a file
/// that records hold parts of, be it one that was loaded and cancelled.
class KeptText {
public:
    constexpr KeptText() = default;

    // NOLINTNEXTLINE(google-explicit-constructor): to be read like any other text.
    constexpr operator std::string_view() const { return bytes_; }

    [[nodiscard]] bool empty() const { return bytes_.empty(); }
    [[nodiscard]] std::size_t size() const { return bytes_.size(); }
    [[nodiscard]] const char *data() const { return bytes_.data(); }
    [[nodiscard]] char front() const { return bytes_.front(); }
    [[nodiscard]] bool starts_with(char first) const { return bytes_.starts_with(first); }
    [[nodiscard]] bool starts_with(std::string_view first) const {
        return bytes_.starts_with(first);
    }

    [[nodiscard]] KeptText substr(std::size_t from,
                                  std::size_t length = std::string_view::npos) const {
        return KeptText{bytes_.substr(from, length)};
    }
    void remove_prefix(std::size_t length) { bytes_.remove_prefix(length); }

private:
    explicit constexpr KeptText(std::string_view bytes) : bytes_{bytes} {}
    friend KeptText keep(std::string text);

    std::string_view bytes_;
};

/// Takes the text, one that was typed or a whole file, to where it stays. Throws std::bad_alloc.
KeptText keep(std::string text);
