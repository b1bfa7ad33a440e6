#pragma once

#include <QString>

/// What the line above the buttons says: which files an apply will not save, and what it takes away
/// of them although nobody edited it. Empty where there is nothing to say.
///
/// `unreadFetchers` are the entries that the list of fetchers cannot take; no more than
/// `maximumNames` settings are named.
QString applyNote(std::size_t unreadFetchers, std::size_t maximumNames);
