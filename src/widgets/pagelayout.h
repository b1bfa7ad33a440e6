#pragma once

#include <QGroupBox>
#include <QVBoxLayout>

#include <optional>

class KNumericSpinBox;

/// The measures, in pixels, that all pages share.
constexpr int pageBorder = 10;
constexpr int groupSpacing = 5;
constexpr int spaceAboveFirstRow = 10;
constexpr int numberWidth = 60;

/// Whether borders, spacings and rows grow lower where the window is too low for all of them, each
/// by its share of what is missing.
enum class Shrinking : bool { No, Yes };

inline void addSpace(QVBoxLayout *layout, int height, Shrinking shrinking) {
    layout->addItem(
        new QSpacerItem(0, height, QSizePolicy::Minimum,
                        shrinking == Shrinking::Yes ? QSizePolicy::Maximum : QSizePolicy::Fixed));
}

/// Adds a widget, and makes it the layout's widget's child. It is `height` pixels high, or as high
/// as its text needs. With `padding` it grows lower where the window is too low, but keeps that
/// many pixels more than its font's height.
void addOfHeight(QBoxLayout *layout, QWidget *widget, int height,
                 std::optional<int> padding = std::nullopt);

/// A field for a whole number from `minimum` to `maximum`, to be typed or stepped by 1. It begins
/// with the stored `value`, be that inside the range or not.
KNumericSpinBox *newNumberField(QWidget *parent, int minimum, int maximum, int value);

inline QVBoxLayout *newPageLayout(QWidget *page) {
    auto *layout = new QVBoxLayout(page);
    layout->setContentsMargins(pageBorder, pageBorder, pageBorder, pageBorder);
    return layout;
}

/// The rows of a group, from the first one's upper edge to the last one's lower: a layout of its
/// own between the group's borders, without spacing when it shrinks.
inline QVBoxLayout *newGroupRows(QGroupBox *group, Shrinking shrinking = Shrinking::No) {
    auto *layout = new QVBoxLayout(group);
    auto *rows = new QVBoxLayout;
    layout->setContentsMargins(pageBorder, 0, pageBorder, 0);
    layout->setSpacing(0);
    rows->setSpacing(shrinking == Shrinking::Yes ? 0 : groupSpacing);
    addSpace(layout, pageBorder + spaceAboveFirstRow, shrinking);
    layout->addLayout(rows);
    addSpace(layout, pageBorder, shrinking);
    return rows;
}
