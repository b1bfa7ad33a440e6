#pragma once

#include <QGroupBox>
#include <QString>
#include <QVBoxLayout>

/// The measures, in pixels, that all pages share.
constexpr int pageBorder = 10;
constexpr int groupSpacing = 5;
constexpr int tightBorder = 2;
constexpr int spaceAboveFirstRow = 10;

inline QVBoxLayout *newPageLayout(QWidget *page) {
    auto *layout = new QVBoxLayout(page);
    layout->setContentsMargins(pageBorder, pageBorder, pageBorder, pageBorder);
    return layout;
}

inline QVBoxLayout *newGroupLayout(QGroupBox *group) {
    auto *layout = new QVBoxLayout(group);
    layout->setContentsMargins(pageBorder, pageBorder, pageBorder, pageBorder);
    layout->setSpacing(groupSpacing);
    layout->addSpacing(spaceAboveFirstRow);
    return layout;
}
