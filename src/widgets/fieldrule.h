#pragma once

#include <QString>

class QLineEdit;

/// What a field takes from the user, because the file could not carry more. The text that the
/// program puts into the field stays as it is, whatever the rule, and what it holds against the
/// rule may stay in what is typed.
struct FieldRule {
    QString refused;         ///< Characters that the text must not hold.
    QString refusedFirst;    ///< Characters that it must not begin with.
    qsizetype mostBytes = 0; ///< Longer input is cut between two characters; 0 for no limit.
    QString toolTip;         ///< Says so; it appears at the field when input is refused.
                     ///< Every field refuses what would make its text too long; see fieldtext.h.
};

/// A rule for a text of at most `mostBytes`, and nothing else.
FieldRule lengthRule(std::size_t mostBytes);

/// To be called when the field shows its first text; replaces the rule that it had.
void applyRule(QLineEdit *field, const FieldRule &rule);

/// Whether the text of a field that newField made is one that its rule refuses or cuts, which it
/// can be when neither keys nor clipboard put it there; its tool tip appears then.
bool holdsRefusedText(const QLineEdit *field);

/// Puts a text into the field; when the rule refuses it or would cut it, the field stays as it is
/// and its tool tip appears.
void replaceByRule(QLineEdit *field, const QString &text);
