#include "config/accesslist.h"

#include "base/lines.h"
#include "config/settingvalues.h"

#include <algorithm>
#include <arpa/inet.h>
#include <array>

namespace {

constexpr std::size_t longestWord = 17;
constexpr std::size_t fullText = 255;

struct PrefixMask {
    std::string_view suffix; ///< Its first digit alone decides.
    std::uint32_t mask;      ///< In host byte order.
};

constexpr std::array<PrefixMask, 5> prefixMasks{
    {{"/0", 0}, {"/8", 0xff000000}, {"/16", 0xffff0000}, {"/24", 0xffffff00}, {"/32", 0xffffffff}}};

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

/// Takes the mask that follows an address; `rest` begins with the character that ended the address.
std::uint32_t takeMask(std::string_view &rest) {
    if (rest.starts_with('/') && rest.size() > 1) {
        for (const auto &[suffix, mask] : prefixMasks) {
            if (suffix[1] == rest[1]) {
                rest.remove_prefix(rest.starts_with(suffix) ? suffix.size() : 0);
                return htonl(mask);
            }
        }
    }
    if (rest.starts_with(' ')) {
        const std::string_view word = withoutBlanks(rest);
        const std::size_t end = std::min(word.find_first_not_of("0123456789."), longestWord);
        if (const std::optional<std::uint32_t> mask = addressOf(word.substr(0, end))) {
            rest = word.substr(std::min(end, word.size()));
            return *mask;
        }
    }
    return singleHost;
}

/// Takes what it understands of the item, which reaches from the comma before to the end of the
/// text, for only the word says where it ends: a mask may still follow.
std::optional<AccessListEntry> takeItem(std::string_view &item) {
    item = withoutBlanks(item);
    const std::size_t wordEnd = std::min(item.find_first_of(" /,\r\n"), longestWord);
    const std::string word{item.substr(0, wordEnd)};
    const bool isNone = compareNoCase(word.c_str(), "none") == 0;
    const bool isAll = compareNoCase(word.c_str(), "all") == 0 || word == "*";
    const std::optional<std::uint32_t> address = addressOf(word);
    if (!isNone && !isAll && !address) {
        return std::nullopt;
    }
    item.remove_prefix(word.size());
    if (isNone || isAll) {
        return isNone ? noHosts : allHosts;
    }
    return AccessListEntry{.address = *address, .mask = takeMask(item)};
}

std::string formatEntry(const AccessListEntry &entry) {
    if (entry == allHosts) {
        return "all";
    }
    if (entry == noHosts) {
        return "none";
    }
    for (const auto &[suffix, mask] : prefixMasks) {
        if (htonl(mask) == entry.mask) {
            return textOf(entry.address).append(suffix);
        }
    }
    return textOf(entry.address) + ' ' + textOf(entry.mask);
}

} // namespace

std::optional<AccessList> parseAccessList(std::string_view text, bool *isWhole) {
    text = text.substr(0, text.find('\0'));
    if (text.empty()) {
        return std::nullopt;
    }
    text = text.substr(0, text.find_first_of("\r\n"));
    AccessList list;
    list.entries.reserve(static_cast<std::size_t>(std::ranges::count(text, ',')) + 1);
    while (!text.empty()) {
        if (const std::optional<AccessListEntry> entry = takeItem(text)) {
            list.entries.push_back(*entry);
        }
        const std::size_t comma = text.find(',');
        if (isWhole != nullptr && holdsWord(text.substr(0, comma))) {
            *isWhole = false;
        }
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

bool isKeptWhole(std::string_view text) {
    bool isWhole = true;
    const AccessList list = parseAccessList(text, &isWhole).value_or(AccessList{});
    return isWhole && parseAccessList(formatAccessList(list)).value_or(AccessList{}) == list;
}
