#pragma once

#include "widgets/captions.h"
#include "widgets/textfield.h"

/// What an address and a target may not hold, because the file would split them there or skip it
/// before them. NUL would become a blank.
inline FieldRule oneWordRule() {
    return {.refused = QStringLiteral(" \t,\r\n\v\f") + QChar(u'\0'),
            .toolTip = translated(translatable("One word, without blanks and commas"))};
}

/// The same for what a line begins with: the file skips lines that begin with these.
inline FieldRule aliasAddressRule() {
    FieldRule rule = oneWordRule();
    rule.refusedFirst = QStringLiteral("#|");
    rule.toolTip = translated(
        translatable("One word, without blanks and commas; not beginning with \"#\" or \"|\""));
    return rule;
}
