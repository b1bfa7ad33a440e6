#pragma once

#include <string>
#include <string_view>

class QLineEdit;
class QWidget;

/// How bytes get into a line edit and out of it; no page reads or fills a field in another way.

/// An empty line edit that cuts nothing, however long the text.
QLineEdit *newField(QWidget *parent);

/// A text of more than a megabyte, for which a line edit would take seconds and more, is not shown
/// whole and cannot be edited; `fieldBytes` gives it back as it is.
void showBytes(QLineEdit *field, std::string_view bytes);

/// The field's text without what no record and no setting may hold: a line edit keeps pasted line
/// breaks (and NUL), which become blanks here.
std::string fieldBytes(const QLineEdit *field);
