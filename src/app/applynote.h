#pragma once

#include <QString>

/// What the line above the buttons says: which files an apply will not save, and what it takes away
/// of them although nobody edited it. Empty where there is nothing to say. No more than
/// `maximumNames` settings are named.
QString applyNote(qsizetype maximumNames);
