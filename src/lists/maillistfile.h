#pragma once

#include "base/recordlist.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

/// The mailing-list file: one block a list, keys in the first column, values without a blank before
/// them, then the three address lists:
///
///     #new
///     %name:cyclists
///     ...
///     #start member
///     ann@example.com
///     :bob@example.net
///     #end
///     ...
///     #endlist
///
/// A member behind ":" is on the digest. Reading puts lists and addresses at the head of their
/// chains, so that reading and writing reverse their order.

struct maillist_addr_entry {
    std::string addr;
    maillist_addr_entry *next = nullptr;
};

/// Whether a member gets the digest rather than each message.
inline bool isOnDigest(const maillist_addr_entry &member) { return member.addr.starts_with(':'); }

/// An address as its record holds it.
inline std::string_view addressStored(const maillist_addr_entry &entry) { return entry.addr; }

/// A member's address proper.
inline std::string_view addressShown(const maillist_addr_entry &member) {
    return std::string_view{member.addr}.substr(isOnDigest(member) ? 1 : 0);
}

using AddressChain = RecordChain<maillist_addr_entry>;

constexpr std::uint32_t MAILLIST_OPEN = 2;
constexpr std::uint32_t MAILLIST_MEMBERS_POST = 4;
constexpr std::uint32_t MAILLIST_REPLY_TO = 8;
constexpr std::uint32_t MAILLIST_DIGEST = 16;
constexpr std::uint32_t MAILLIST_BLOCK_MIME = 32;

struct maillist_entry {
    std::string name;
    std::string post;
    std::string admin; ///< Where people subscribe.
    std::string support;
    std::string footer; ///< This and the next: path of a file.
    std::string header;
    std::string modrt;       ///< The moderator's address.
    std::string info;        ///< Path of a file.
    std::int32_t diglen = 0; ///< kB
    std::int32_t digno = 0;  ///< Messages.
    std::int32_t digcnt =
        0; ///< This and the next belong to the mail service: only carried through.
    std::int32_t digcur = 0;
    std::uint32_t flags = 0; ///< MAILLIST_... bits; others are carried through.
    AddressChain member;
    AddressChain allow;
    AddressChain block;
    maillist_entry *next = nullptr;
};

extern RecordChain<maillist_entry> maillist_list;

/// Puts the lists of the file's bytes at the head of `lists`. Throws std::bad_alloc with what was
/// read until then in the chain.
void parseMailLists(std::string_view bytes, RecordChain<maillist_entry> &lists);

/// Addresses that begin with "#" are left out: such a line would end its section and take the
/// addresses behind it along.
std::string formatMailLists(const RecordChain<maillist_entry> &lists);

/// The addresses of a plain text file, in its order: every line that holds "@", whole. A line is
/// taken in pieces of at most 254 bytes. Throws std::bad_alloc.
std::vector<std::string> parseAddressLines(std::string_view bytes);

/// Fills maillist_list anew from the file; empty when it cannot be read.
void readMailListFile();
void writeMailListFile();
