#pragma once

#include "config/accesslist.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// The five types of setting and their texts. Each handler works both ways: given a text it parses
/// it into the field and returns none; given none it leaves the field alone and returns its text.
/// Out of memory (std::bad_alloc) leaves the field absent where there was a text to parse.

using TextOrNone = std::optional<std::string_view>;

/// An absent text renders as none.
std::optional<std::string> textSetting(std::optional<std::string> &field, TextOrNone text);

/// Decimal. The field holds the number read times `scale` (a scale below 1 counts as 1), both
/// wrapped to 32 bits; the text is the quotient, truncated towards zero.
std::optional<std::string> numberSetting(std::int32_t &field, TextOrNone text, int scale);

/// "yes" or "no"; reads "true", "false", "on", "off" and "0" as well, and anything else as yes.
std::optional<std::string> boolSetting(std::int32_t &field, TextOrNone text);

/// "%2d:%2d"; the field holds hour * 256 + minute. Hours and minutes are bytes, not checked.
std::optional<std::string> timeSetting(std::int32_t &field, TextOrNone text);

/// An absent list renders as an empty text.
std::optional<std::string> accessListSetting(std::optional<AccessList> &field, TextOrNone text);

/// -1, 0 or 1, as the strings compare once the C library has lower-cased every byte; -1 when either
/// is null. The thread's locale decides what is a letter.
int compareNoCase(const char *a, const char *b);

std::string formatUnsigned(std::uint32_t value);

/// The integer that begins the text, by the rules of the C library's atoi; a number that does
/// not fit into 32 bits wraps.
std::int32_t parseInteger(std::string_view text);
