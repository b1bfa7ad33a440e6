#pragma once

#include <QGroupBox>
#include <QVBoxLayout>

class KNumericSpinBox;

/// The measures, in pixels, that all pages share.
constexpr int pageBorder = 10;
constexpr int groupSpacing = 5;
constexpr int spaceAboveFirstRow = 10;
constexpr int numberWidth = 60;

/// A row below those that are there already.
inline QHBoxLayout *newRow(QVBoxLayout *rows) {
    auto *row = new QHBoxLayout;
    row->setSpacing(groupSpacing);
    rows->addLayout(row);
    return row;
}

/// Makes the widget `height` pixels high, or as high as its text needs.
void fixHeight(QWidget *widget, int height);

/// A field for a whole number from `minimum` to `maximum`, to be typed or stepped by 1. It begins
/// with the stored `value`, be that inside the range or not.
KNumericSpinBox *newNumberField(QWidget *parent, int minimum, int maximum, int value);

inline QVBoxLayout *newPageLayout(QWidget *page) {
    auto *layout = new QVBoxLayout(page);
    layout->setContentsMargins(pageBorder, pageBorder, pageBorder, pageBorder);
    return layout;
}

inline QVBoxLayout *newGroupRows(QGroupBox *group) {
    auto *rows = new QVBoxLayout(group);
    rows->setContentsMargins(pageBorder, pageBorder + spaceAboveFirstRow, pageBorder, pageBorder);
    rows->setSpacing(groupSpacing);
    return rows;
}
