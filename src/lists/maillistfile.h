#pragma once

#include "base/kepttext.h"
#include "base/productfile.h"
#include "base/recordlist.h"

#include <cstddef>
#include <cstdint>

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
    KeptText addr;
    maillist_addr_entry *next = nullptr;
};

/// Whether a member gets the digest rather than each message.
inline bool isOnDigest(const maillist_addr_entry &member) { return member.addr.starts_with(':'); }

inline KeptText addressStored(const maillist_addr_entry &entry) { return entry.addr; }

/// A member's address proper.
inline KeptText addressShown(const maillist_addr_entry &member) {
    return member.addr.substr(isOnDigest(member) ? 1 : 0);
}

using AddressChain = RecordChain<maillist_addr_entry>;

constexpr std::uint32_t MAILLIST_OPEN = 2;
constexpr std::uint32_t MAILLIST_MEMBERS_POST = 4;
constexpr std::uint32_t MAILLIST_REPLY_TO = 8;
constexpr std::uint32_t MAILLIST_DIGEST = 16;
constexpr std::uint32_t MAILLIST_BLOCK_MIME = 32;

/// A list without its addresses.
struct maillist_fields {
    KeptText name;
    KeptText post;
    KeptText admin; ///< Where people subscribe.
    KeptText support;
    KeptText footer; ///< This and the next: path of a file.
    KeptText header;
    KeptText modrt;          ///< The moderator's address.
    KeptText info;           ///< Path of a file.
    std::int32_t diglen = 0; ///< kB
    std::int32_t digno = 0;  ///< Messages.
    std::int32_t digcnt = 0; ///< This and the next are the mail service's: only carried through.
    std::int32_t digcur = 0;
    std::uint32_t flags = 0; ///< MAILLIST_... bits; others are carried through.
};

struct maillist_entry : maillist_fields {
    AddressChain member;
    AddressChain allow;
    AddressChain block;
    maillist_entry *next = nullptr;
};

extern RecordChain<maillist_entry> maillist_list;
extern ProductFile mailListFile;

/// Puts the lists of the file's bytes at the head of `lists`. Throws std::bad_alloc with what was
/// read until then in the chain. How many lines have a word that is in no record.
std::size_t parseMailLists(KeptText bytes, RecordChain<maillist_entry> &lists);

/// Addresses that begin with "#" are left out: such a line would end its section and take the
/// addresses behind it along. So would the rest of one of more than 249 bytes, which the file's
/// reader takes for a line of its own. How many are left out.
std::size_t formatMailLists(const RecordChain<maillist_entry> &lists, std::string &bytes);

/// The addresses of a plain text file: every line that holds "@", whole. A line is taken in pieces
/// of at most 254 bytes, and each address is put at the head. They are parts of the file, which so
/// costs its size for the process's life even where the editor is cancelled then. Throws
/// std::bad_alloc.
AddressChain parseAddressLines(KeptText bytes);

/// The maximum of bytes to be typed of a line: with its line feed it is read in one piece.
constexpr std::size_t longestTyped = 248;

/// How many of them are left for this text of a list.
std::size_t maximumBytesOf(KeptText maillist_entry::*field);

/// Fills maillist_list anew from the file; empty when it cannot be read.
void readMailListFile();
void writeMailListFile();
