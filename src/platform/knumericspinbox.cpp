#include "platform/knumericspinbox.h"

#include <QLineEdit>
#include <QSignalBlocker>
#include <QWheelEvent>

#include <algorithm>

KNumericSpinBox::KNumericSpinBox(QWidget *parent) : QSpinBox(parent) {
    // Some languages' digits or separators would show a stored number other than it is.
    setLocale(QLocale::c());
    setFocusPolicy(Qt::StrongFocus); // The wheel does not give the focus.
    connect(this, &QSpinBox::valueChanged, this, &KNumericSpinBox::confine);
}

void KNumericSpinBox::setRange(int minimum, int maximum) {
    minimum_ = minimum;
    maximum_ = maximum;
    QSpinBox::setRange(minimum, maximum);
}

void KNumericSpinBox::setValue(int value) {
    // The toolkit's box clamps what is set; so its range reaches out to the value while that
    // stands.
    stored_ = value;
    {
        const QSignalBlocker noChangeYet{this};
        QSpinBox::setRange(std::min(minimum_, value), std::max(maximum_, value));
    }
    QSpinBox::setValue(value);
    // The field is made for the range; a number with more digits may not be seen whole in it.
    setToolTip(value < minimum_ || value > maximum_ ? text() : QString{});
}

void KNumericSpinBox::setEditable(bool editable) { lineEdit()->setReadOnly(!editable); }

void KNumericSpinBox::wheelEvent(QWheelEvent *event) {
    // A page is scrolled over its fields without changing them.
    if (hasFocus()) {
        QSpinBox::wheelEvent(event);
    } else {
        event->ignore();
    }
}

void KNumericSpinBox::confine(int value) {
    if (value != stored_) {
        QSpinBox::setRange(minimum_, maximum_);
        setToolTip({});
    }
}
