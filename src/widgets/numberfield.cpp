#include "widgets/numberfield.h"

#include "platform/knumericspinbox.h"
#include "widgets/leastsize.h"

namespace {

constexpr int usualWidth = 60;

} // namespace

KNumericSpinBox *newNumberField(QWidget *parent, int lowest, int highest, int value) {
    auto *field = new KNumericSpinBox(parent);
    field->setRange(lowest, highest);
    field->setStep(1);
    field->setEditable(true);
    field->setValue(value);
    field->setFixedWidth(leastSize(field, {usualWidth, 0}).width());
    return field;
}
