#include "widgets/minimumsize.h"

#include <QPushButton>
#include <QSpinBox>
#include <QStyleOptionButton>
#include <QStyleOptionSpinBox>

#include <algorithm>

namespace {

/// What a line edit inside a number field keeps free before the number.
constexpr int editPadding = 2;

/// What a button that has to grow leaves free on either side of its text.
constexpr int buttonPadding = 4;

/// Of a push button the toolkit's own hint is wider than its text needs.
QSize forButton(const QPushButton *button, QSize given) {
    QStyleOptionButton option;
    option.initFrom(button);
    option.rect = {{}, given};
    const QSize available =
        button->style()->subElementRect(QStyle::SE_PushButtonContents, &option, button).size();
    const QSize text = button->fontMetrics().size(Qt::TextShowMnemonic, button->text());
    const QSize padding{text.width() > available.width() ? 2 * buttonPadding : 0, 0};
    return given - available + text + padding;
}

/// All numbers between the ends have no more digits than one of them.
QSize forNumbers(const QSpinBox *box, QSize given) {
    QStyleOptionSpinBox option;
    option.initFrom(box);
    option.frame = box->hasFrame();
    option.rect = {{}, QSize{given.width(), 2 * box->fontMetrics().height()}};
    const int available =
        box->style()
            ->subControlRect(QStyle::CC_SpinBox, &option, QStyle::SC_SpinBoxEditField, box)
            .width();
    const auto widthOf = [box](int number) {
        return box->fontMetrics().horizontalAdvance(QString::number(number));
    };
    const int text = std::max(widthOf(box->minimum()), widthOf(box->maximum()));
    return {given.width() - available + editPadding + text,
            given.height() == 0 ? 0 : box->minimumSizeHint().height()};
}

QSize needed(const QWidget *widget, QSize given) {
    if (const auto *button = qobject_cast<const QPushButton *>(widget)) {
        return forButton(button, given);
    }
    if (const auto *box = qobject_cast<const QSpinBox *>(widget)) {
        return forNumbers(box, given);
    }
    return widget->minimumSizeHint();
}

} // namespace

QSize minimumSizeFor(const QWidget *widget, QSize given) {
    const QSize text = needed(widget, given);
    return {given.width() == 0 ? 0 : std::max(given.width(), text.width()),
            given.height() == 0 ? 0 : std::max(given.height(), text.height())};
}
