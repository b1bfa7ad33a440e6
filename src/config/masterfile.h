#pragma once

#include "base/productfile.h"
#include "config/settingvalues.h"

#include <set>
#include <string>
#include <string_view>

/// The master file and its template share one line format. The first character decides:
///
///     | comment
///     %key: value, up to the end of the line
///     <tab>the next comma-separated part of the value
///
/// On reading, a value is its key line and all continuation lines (anything that does not begin
/// with "%" or "|") up to the next key line, joined with ","; comments and empty lines between them
/// do not end it. On writing, the template gives keys, order and comments, the store the values.

struct LettersAlike {
    bool operator()(const std::string &a, const std::string &b) const {
        return compareNoCase(a.c_str(), b.c_str()) < 0;
    }
};
using KeyNames = std::set<std::string, LettersAlike>;

/// What the next rewriting takes away although nobody edited it.
struct LostSettings {
    KeyNames keys;            ///< The template has them not, or other values; or theirs are cut.
    KeyNames accessLists;     ///< These lose items, or have some widened or narrowed.
    std::size_t fetchers = 0; ///< Entries that cannot be read. Who parses them counts them.
};

/// As the file was read or rewritten last.
extern LostSettings lostSettings;

/// Hands each key and value to the store, in the order of the file, and notes what will be lost of
/// them with that template.
void parseMasterConfig(std::string_view bytes, std::string_view masterTemplate = {});

/// Appends the master file for the store's values. A key line that the store has no text for is
/// kept as the template has it, and so is one without a colon.
void formatMasterConfig(std::string_view masterTemplate, std::string &bytes);

/// Fills the store. 0; 1 after a line on standard output when the file cannot be opened; 2 when
/// memory ran out.
int readMasterConfig();

/// Rewrites the master file from the template; leaves it alone when there is no template, or when
/// it was there and could not be read whole.
void writeMasterConfig();

/// Why writeMasterConfig will not do so, as far as that is known; none where it will.
std::optional<TranslatableText> masterFileObstacle();
