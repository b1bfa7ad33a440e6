#pragma once

#include <QSize>

class QWidget;

/// The one rule for given widths and heights, in pixels: they hold wherever the widget's text fits
/// into them, and otherwise grow to what the text needs with the widget's font and style. Serves
/// labels, buttons, check boxes, number fields, line edits and combo boxes; a given length of 0
/// stands for none.
QSize minimumSizeFor(const QWidget *widget, QSize given);
