#include "widgets/pagelayout.h"

#include "platform/knumericspinbox.h"
#include "widgets/minimumsize.h"

#include <QWidget>

namespace {

/// A widget's place whose height depends on nothing but the two that it is made with.
class ShrinkingItem : public QWidgetItem {
public:
    ShrinkingItem(QWidget *widget, int full) : QWidgetItem(widget), full_{full} {}

    [[nodiscard]] QSize sizeHint() const override {
        return {QWidgetItem::sizeHint().width(), full_};
    }

private:
    int full_;
};

} // namespace

void addOfHeight(QBoxLayout *layout, QWidget *widget, int height, std::optional<int> padding) {
    const int full = minimumSizeFor(widget, {0, height}).height();
    widget->setMaximumHeight(full);
    widget->setMinimumHeight(padding ? widget->fontMetrics().height() + *padding : full);
    if (QWidget *parent = layout->parentWidget()) {
        widget->setParent(parent);
    }
    layout->addItem(new ShrinkingItem(widget, full));
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
