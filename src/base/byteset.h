#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>

/// A set of bytes with a search that asks one table a byte.
class ByteSet {
public:
    constexpr explicit ByteSet(std::string_view members) {
        for (const char member : members) {
            holds_.at(static_cast<unsigned char>(member)) = true;
        }
    }

    /// The bytes for which `belongs(unsigned char)` holds, as it does at the time of the call:
    /// character classes follow the process's locale.
    template <class Belongs>
    static ByteSet of(Belongs belongs) {
        ByteSet set{{}};
        for (unsigned byte = 0; byte < set.holds_.size(); ++byte) {
            set.holds_[byte] = belongs(static_cast<unsigned char>(byte));
        }
        return set;
    }

    [[nodiscard]] bool holds(char byte) const { return holds_[static_cast<unsigned char>(byte)]; }

    /// How many bytes at the beginning of the text are members.
    [[nodiscard]] std::size_t span(std::string_view text) const { return span(text, true); }
    /// How many bytes at the beginning of the text are no members.
    [[nodiscard]] std::size_t spanBefore(std::string_view text) const { return span(text, false); }

private:
    [[nodiscard]] std::size_t span(std::string_view text, bool areMembers) const {
        const auto end = std::find_if(text.begin(), text.end(), [this, areMembers](char byte) {
            return holds(byte) != areMembers;
        });
        return static_cast<std::size_t>(end - text.begin());
    }

    std::array<bool, 256> holds_{};
};
