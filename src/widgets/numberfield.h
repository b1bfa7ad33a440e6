#pragma once

class KNumericSpinBox;
class QWidget;

/// A field of the usual width for a whole number from `lowest` to `highest`, to be typed or stepped
/// by 1. It begins with the stored `value`, be that inside the range or not.
KNumericSpinBox *newNumberField(QWidget *parent, int lowest, int highest, int value);
