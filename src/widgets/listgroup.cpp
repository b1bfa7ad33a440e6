#include "widgets/listgroup.h"

#include "widgets/pagelayout.h"

#include <QHBoxLayout>

ListGroup::ListGroup(const char *caption, Stretch stretch, QWidget *parent)
    : QGroupBox(QString::fromUtf8(caption), parent),
      box_{new QListBox(this)},
      column_{new QVBoxLayout},
      layout_{newGroupLayout(this)} {
    box_->setAccessibleName(title());
    column_->setSpacing(groupSpacing);
    auto *row = new QHBoxLayout;
    row->addWidget(box_, stretch.box);
    row->addLayout(column_, stretch.column);
    layout_->addLayout(row);
}

void ListGroup::makeTight() {
    delete layout_->takeAt(0); // The space above the first row.
    layout_->setContentsMargins(tightBorder, tightBorder, tightBorder, tightBorder);
    column_->setSpacing(0);
}

QPushButton *ListGroup::addButton(const char *caption) {
    auto *button = new QPushButton(QString::fromUtf8(caption), this);
    column_->addWidget(button);
    return button;
}

void ListGroup::fixColumnWidth(int width) {
    for (int index = 0; index < column_->count(); ++index) {
        if (QWidget *widget = column_->itemAt(index)->widget()) {
            widget->setFixedWidth(width);
        }
    }
}
