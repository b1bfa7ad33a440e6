#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// The addresses that a service lets in, asks for a password or shuts out. As text, its items have
/// commas between them. An item is "all", "none", or an IPv4 address with "/8", "/16", "/24", "/32"
/// or, after a blank, a mask of its own:
///
///     192.168.1.0/24, 10.0.0.0 255.255.128.0, 10.1.2.3/32

/// One item. Both numbers are in network byte order.
struct AccessListEntry {
    std::uint32_t address = 0;
    std::uint32_t mask = 0;

    bool operator==(const AccessListEntry &) const = default;
};

struct AccessList {
    std::vector<AccessListEntry> entries;

    bool operator==(const AccessList &) const = default;
};

/// The list that `text` describes, without the items that cannot be read; none for an empty text.
/// Where `isWhole` is given, it becomes false when something of the text is not in the list as it
/// stands. Throws std::bad_alloc.
std::optional<AccessList> parseAccessList(std::string_view text, bool *isWhole = nullptr);

/// The text of the list. Once it holds 255 characters no further entry is added, so that a longer
/// list is not whole in its text.
std::string formatAccessList(const AccessList &list);

/// Whether nothing is lost, widened or narrowed when the text is read and written. Throws
/// std::bad_alloc.
bool isKeptWhole(std::string_view text);
