#pragma once

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

/// Hands each key and value to the store, in the order of the file.
void parseMasterConfig(std::string_view bytes);

/// Appends the master file for the store's values. A key line that the store has no text for is
/// kept as the template has it, and so is one without a colon.
void formatMasterConfig(std::string_view masterTemplate, std::string &bytes);

/// Fills the store. 0; 1 after a line on standard output when the file cannot be opened; 2 when
/// memory ran out.
int readMasterConfig();

/// Rewrites the master file from the template; leaves it alone when there is no template, or when
/// it was there and could not be read whole.
void writeMasterConfig();
