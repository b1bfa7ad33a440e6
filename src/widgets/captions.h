#pragma once

#include <QSize>
#include <QString>

#include <initializer_list>

class QLabel;
class QWidget;

/// The caption in the user's language.
QString translated(const char *caption);

/// A label's size widened to the widest of the captions, so that fields below each other
/// begin in one line.
QSize widened(QSize label, std::initializer_list<QString> captions);

/// A label of at least that size in which the whole caption is seen.
QLabel *newLabel(const QString &caption, QSize size, QWidget *parent);
