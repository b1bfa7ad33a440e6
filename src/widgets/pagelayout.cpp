#include "widgets/pagelayout.h"

#include "platform/knumericspinbox.h"
#include "widgets/minimumsize.h"

void fixHeight(QWidget *widget, int height) {
    widget->setFixedHeight(minimumSizeFor(widget, {0, height}).height());
}

KNumericSpinBox *newNumberField(QWidget *parent, int minimum, int maximum, int value) {
    auto *field = new KNumericSpinBox(parent);
    field->setRange(minimum, maximum);
    field->setStep(1);
    field->setEditable(true);
    field->setValue(value);
    field->setFixedWidth(minimumSizeFor(field, {numberWidth, 0}).width());
    return field;
}
