#include "config/accesslist.h"

#include "config/settingvalues.h"

#include <algorithm>
#include <arpa/inet.h>
#include <array>

namespace {

constexpr std::size_t longestWord = 17;
constexpr std::size_t fullText = 255;

struct PrefixMask {
    char digit; ///< What stands behind the "/": its first character alone decides.
    const char *suffix;
    std::uint32_t mask; ///< In host byte order.
};

constexpr std::array<PrefixMask, 5> prefixMasks{{{'0', "/0", 0},
                                                 {'8', "/8", 0xff000000},
                                                 {'1', "/16", 0xffff0000},
                                                 {'2', "/24", 0xffffff00},
                                                 {'3', "/32", 0xffffffff}}};

constexpr AccessListEntry allHosts{.address = 0, .mask = 0};
constexpr AccessListEntry noHosts{.address = 0, .mask = 0xffffffff};
constexpr std::uint32_t singleHost = 0xffffffff;

std::optional<std::uint32_t> addressOf(std::string_view word) {
    in_addr address{};
    if (inet_aton(std::string{word}.c_str(), &address) == 0) {
        return std::nullopt;
    }
    return address.s_addr;
}

std::string textOf(std::uint32_t address) { return inet_ntoa(in_addr{address}); }

std::string_view withoutBlanks(std::string_view text) {
    return text.substr(std::min(text.find_first_not_of(' '), text.size()));
}

/// The mask that follows an address; `rest` begins with the character that ended the address.
std::uint32_t maskAfter(std::string_view rest) {
    if (rest.starts_with('/') && rest.size() > 1) {
        for (const PrefixMask &prefix : prefixMasks) {
            if (prefix.digit == rest[1]) {
                return htonl(prefix.mask);
            }
        }
    }
    if (rest.starts_with(' ')) {
        rest = withoutBlanks(rest);
        const std::size_t digits = rest.find_first_not_of("0123456789.");
        return addressOf(rest.substr(0, std::min(digits, longestWord))).value_or(singleHost);
    }
    return singleHost;
}

/// `item` reaches from the comma before to the end of the text, for only the word says where it
/// ends: a mask may still follow.
std::optional<AccessListEntry> parseItem(std::string_view item) {
    item = withoutBlanks(item);
    const std::size_t wordEnd = std::min(item.find_first_of(" /,\r\n"), longestWord);
    const std::string word{item.substr(0, wordEnd)};
    if (compareNoCase(word.c_str(), "none") == 0) {
        return noHosts;
    }
    if (compareNoCase(word.c_str(), "all") == 0 || word == "*") {
        return allHosts;
    }
    const std::optional<std::uint32_t> address = addressOf(word);
    if (!address) {
        return std::nullopt;
    }
    return AccessListEntry{.address = *address, .mask = maskAfter(item.substr(word.size()))};
}

std::string formatEntry(const AccessListEntry &entry) {
    if (entry == allHosts) {
        return "all";
    }
    if (entry == noHosts) {
        return "none";
    }
    for (const PrefixMask &prefix : prefixMasks) {
        if (htonl(prefix.mask) == entry.mask) {
            return textOf(entry.address) + prefix.suffix;
        }
    }
    return textOf(entry.address) + ' ' + textOf(entry.mask);
}

} // namespace

std::optional<AccessList> parseAccessList(std::string_view text) {
    text = text.substr(0, text.find('\0'));
    if (text.empty()) {
        return std::nullopt;
    }
    text = text.substr(0, text.find_first_of("\r\n"));
    AccessList list;
    list.entries.reserve(static_cast<std::size_t>(std::ranges::count(text, ',')) + 1);
    while (!text.empty()) {
        if (const std::optional<AccessListEntry> entry = parseItem(text)) {
            list.entries.push_back(*entry);
        }
        const std::size_t comma = text.find(',');
        text = comma == std::string_view::npos ? std::string_view{} : text.substr(comma + 1);
    }
    return list;
}

std::string formatAccessList(const AccessList &list) {
    std::string text;
    for (const AccessListEntry &entry : list.entries) {
        if (text.size() >= fullText) {
            break;
        }
        if (&entry != &list.entries.front()) {
            text += ", ";
        }
        text += formatEntry(entry);
    }
    return text;
}
