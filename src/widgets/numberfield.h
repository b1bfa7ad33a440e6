#pragma once

class KNumericSpinBox;
class QWidget;

/// A field of the usual width for a whole number from `minimum` to `maximum`, to be typed or
/// stepped by 1. It begins with the stored `value`, be that inside the range or not.
KNumericSpinBox *newNumberField(QWidget *parent, int minimum, int maximum, int value);
