#include "widgets/listgroup.h"

#include "widgets/minimumsize.h"

ListGroup::ListGroup(const char *caption, Stretch stretch, QWidget *parent)
    : QGroupBox(QString::fromUtf8(caption), parent),
      box_{new QListBox(this)},
      column_{new QVBoxLayout} {
    QHBoxLayout *row = newRow(newGroupRows(this));
    row->addWidget(box_, stretch.box);
    row->addLayout(column_, stretch.column);
    column_->setSpacing(groupSpacing);
    box_->setAccessibleName(title());
}

QPushButton *ListGroup::addButton(const char *caption) {
    auto *button = new QPushButton(QString::fromUtf8(caption), this);
    button->setAccessibleName(title() + ": " + button->text());
    column_->addWidget(button);
    return button;
}

void ListGroup::fixColumnWidth(int width) {
    std::vector<QWidget *> widgets;
    for (int index = 0; index < column_->count(); ++index) {
        if (QWidget *widget = column_->itemAt(index)->widget()) {
            widgets.push_back(widget);
            width = minimumSizeFor(widget, {width, 0}).width();
        }
    }
    for (QWidget *widget : widgets) {
        widget->setFixedWidth(width);
    }
}
