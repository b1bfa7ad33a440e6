#pragma once

#include "base/recordlist.h"
#include "config/settingvalues.h"

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

/// The mailboxes that the service collects mail from, as the setting pop.hosts holds them: entries
/// of user:password@server with any of the prefixes "-" and "*", and commas or line breaks between:
///
///     *ann:secret@pop.example.com,-*bob:hidden@mail.example.net
///
/// A field ends at the next ":", "@", comma or line break, or when its array is full.

constexpr std::uint32_t POP_HOST_MINUS = 2;
constexpr std::uint32_t POP_HOST_STAR = 4;

struct pop_host {
    std::array<char, 32> user{}; ///< This and the next two: bytes, then at least one NUL.
    std::array<char, 32> password{};
    std::array<char, 64> server{};
    std::uint32_t flags = 0;
    pop_host *next = nullptr;
};

/// In the order of the text; the page puts new records at the head.
extern RecordChain<pop_host> pop_host_list;

template <std::size_t size>
std::string_view popHostText(const std::array<char, size> &field) {
    return field.data();
}

/// Puts as much of the text as fits into one of the record's arrays.
template <std::size_t size>
void setPopHostText(std::array<char, size> &field, std::string_view text) {
    field.fill('\0');
    text.copy(field.data(), size - 1);
}

/// Fills pop_host_list anew. Entries without their ":" or "@" are dropped. Every record gets the
/// star flag. Out of memory keeps the records made so far. How many entries are not whole in a
/// record of their own.
std::size_t parsePopHosts(TextOrNone text);

/// Whether memory sufficed for all of the text that was parsed last. Otherwise pop_host_list must
/// not take the text's place.
bool popHostsAreWhole();

/// pop_host_list with a line feed behind each entry.
std::string formatPopHosts();
