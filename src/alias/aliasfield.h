#pragma once

#include "widgets/fieldrule.h"

/// What an address and a target may not hold, because the file would split them there or skip it
/// before them. NUL would become a blank.
inline FieldRule oneWordRule() {
    return {QStringLiteral(" \t,\r\n\v\f") + QChar(u'\0'),
            {},
            0,
            QStringLiteral("One word, without blanks and commas")};
}
