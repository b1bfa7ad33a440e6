#pragma once

#include "base/kepttext.h"

#include <cstddef>
#include <string>
#include <string_view>

class QLineEdit;
class QWidget;

/// How bytes get into a line edit and out of it; no page reads or fills a field in another way.

/// The longest text, in bytes, that a field shows whole and takes: a line edit needs time for each
/// keystroke that grows with its text.
constexpr std::size_t mostFieldBytes = 100'000;

/// An empty line edit that cuts nothing: what would take its text beyond mostFieldBytes is refused
/// whole, with a tool tip.
QLineEdit *newField(QWidget *parent);

/// Of a text longer than mostFieldBytes only the beginning is shown, and it cannot be edited.
void showBytes(QLineEdit *field, std::string_view bytes);

/// Whether the field was given a text that it does not show whole; then that text still holds.
bool showsPartOnly(const QLineEdit *field);

/// The field's text without what no record and no setting may hold: a line edit keeps pasted line
/// breaks (and NUL), which become blanks here. Not to be called when the field shows a part only.
std::string fieldBytes(const QLineEdit *field);

/// The field's text as a record takes it, which held `before` when the field was filled. A text
/// that was not changed is that one again, however long.
KeptText fieldText(const QLineEdit *field, KeptText before);
