#pragma once

#include "widgets/fieldrule.h"

/// What an address and a target may not hold, because the file would split them there.
inline FieldRule oneWordRule() {
    return {
        QStringLiteral(" \t,\r\n"), {}, 0, QStringLiteral("One word, without blanks and commas")};
}
