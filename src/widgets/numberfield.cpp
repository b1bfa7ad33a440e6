#include "widgets/numberfield.h"

#include "platform/knumericspinbox.h"
#include "widgets/minimumsize.h"

namespace {

constexpr int usualWidth = 60;

} // namespace

KNumericSpinBox *newNumberField(QWidget *parent, int minimum, int maximum, int value) {
    auto *field = new KNumericSpinBox(parent);
    field->setRange(minimum, maximum);
    field->setStep(1);
    field->setEditable(true);
    field->setValue(value);
    field->setFixedWidth(minimumSizeFor(field, {usualWidth, 0}).width());
    return field;
}
