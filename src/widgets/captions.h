#pragma once

#include "platform/kapplication.h"

#include <QSize>
#include <QString>

#include <vector>

class QLabel;
class QWidget;

QString translated(TranslatableText caption);

/// What a caption calls its field: without "&", and without ":" or "..." at its end.
QString plainName(QString caption);

/// The captions of one form's fields. All are as wide as the widest of them needs, so that the
/// fields beside them begin at one x.
class CaptionColumn {
public:
    /// A height of 0 leaves the captions' height to their rows.
    explicit CaptionColumn(QSize minimum) : minimum_{minimum} {}

    /// A label in the field's parent, with the field as its buddy.
    QLabel *newCaption(const QString &caption, QWidget *field);

private:
    QSize minimum_;
    std::vector<QLabel *> labels_;
};
