#pragma once

#include "base/kepttext.h"
#include "base/productfile.h"
#include "base/recordlist.h"

#include <cstdint>

/// The alias file, one alias a line: the address, then its targets behind commas or white space:
///
///     sales@example.com,ann,#staff,$news,[spool],bob@example.net,!carol
///
/// A target is one word. "!" before it sets its mark, then "#" makes it a list's administration
/// address. Lines that begin with "#", "|" or a blank, and lines of one word, are skipped.

enum AliasType : std::uint8_t {
    ALIAS_PLAIN = 0,
    ALIAS_BRACKET = 1,      ///< Begins with "[", which stays part of the text.
    ALIAS_LIST_ADMIN = 2,   ///< Stands behind a "#", which is not part of the text.
    ALIAS_ADDRESS = 3,      ///< Holds "@".
    ALIAS_LIST_POSTING = 4, ///< Holds "$".
};

struct alias_list_entry {
    KeptText alias;
    std::uint8_t type = ALIAS_PLAIN;
    std::uint8_t bang = 0; ///< 1 when "!" stands before the target; it is not part of the text.
    alias_list_entry *next = nullptr;
};

struct alias_entry {
    KeptText address;
    RecordChain<alias_list_entry> aliases;
    alias_entry *next = nullptr;
};

/// In the order of the file; the page puts new aliases at the head.
extern RecordChain<alias_entry> alias_list;
extern ProductFile aliasFile;

/// Puts the aliases of the file's bytes at the end of `list`. Throws std::bad_alloc with what was
/// read until then in the list. How many lines have a word that is in no record.
std::size_t parseAliases(KeptText bytes, RecordChain<alias_entry> &list);
void formatAliases(const RecordChain<alias_entry> &list, std::string &bytes);

/// Adds the file's aliases to alias_list. 0 when the file was read to its end, 1 when it cannot be
/// opened, 2 when memory ran out; what was read until then stays.
int readAliasFile();
void writeAliasFile();
