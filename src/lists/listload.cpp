#include "lists/listload.h"

#include "lists/listdialog.h"
#include "widgets/fieldtext.h"

#include <QHBoxLayout>
#include <QPushButton>

ListLoad::ListLoad(QWidget *parent, const char *name)
    : FormDialog(parent, name, "Load addresses from file") {
    QHBoxLayout *row = addRow();
    fileName_ = addField(row, "&Filename:", listDialogLabel, {});
    connect(addBrowseButton(row, 70, this), &QPushButton::clicked, this, &ListLoad::browse);
    fixSize(listDialogSize, listDialogSize);
    addButtonRow();
}

std::string ListLoad::fileName() const { return fieldBytes(fileName_); }

void ListLoad::browse() { browseForFile(fileName_, this); }
