#include "widgets/listgroup.h"

#include "widgets/captions.h"
#include "widgets/minimumsize.h"

namespace {

/// For a button in a group that shrinks.
constexpr int buttonHeight = 22;
constexpr int buttonPadding = 2;

} // namespace

ListGroup::ListGroup(const char *caption, Stretch stretch, QWidget *parent, Shrinking shrinking)
    : QGroupBox(QString::fromUtf8(caption), parent),
      box_{new QListBox(this)},
      column_{new QVBoxLayout},
      shrinking_{shrinking} {
    auto *row = new QHBoxLayout;
    newGroupRows(this, shrinking)->addLayout(row);
    row->setSpacing(groupSpacing);
    row->addWidget(box_, stretch.box);
    row->addLayout(column_, stretch.column);
    column_->setSpacing(shrinking == Shrinking::Yes ? 0 : groupSpacing);
    box_->setAccessibleName(title());
}

QPushButton *ListGroup::addButton(const char *caption) {
    auto *button = new QPushButton(QString::fromUtf8(caption), this);
    button->setAccessibleName(title() + ": " + button->text());
    if (shrinking_ == Shrinking::No) {
        column_->addWidget(button);
        return button;
    }
    if (column_->count() > 0) {
        addSpace(column_, groupSpacing, shrinking_);
    }
    addOfHeight(column_, button, buttonHeight, buttonPadding);
    return button;
}

void ListGroup::fixColumnWidth(int width) {
    std::vector<QWidget *> widgets;
    for (int index = 0; index < column_->count(); ++index) {
        if (QWidget *widget = column_->itemAt(index)->widget()) {
            widgets.push_back(widget);
            width = minimumSizeFor(widget, {width, buttonHeight}).width();
        }
    }
    for (QWidget *widget : widgets) {
        widget->setFixedWidth(width);
    }
}
