#include "lists/listload.h"

#include "lists/smalldialogsizes.h"
#include "widgets/textfield.h"

#include <QHBoxLayout>
#include <QPushButton>

ListLoad::ListLoad(QWidget *parent, const char *name)
    : FormDialog(parent, name, "Load addresses from file") {
    QHBoxLayout *row = addRow();
    CaptionColumn captions{listDialogLabel};
    fileName_ = addField(row, translatable("&Filename:"), captions, {});
    connect(addBrowseButton(row, 70, translatable("&Filename:"), fileName_), &QPushButton::clicked,
            this, &ListLoad::browse);
    addButtons(listDialogBorder, 20);
    fixSize(listDialogSize, listDialogSize);
}

std::string ListLoad::fileName() const { return fileName_->bytes(); }

void ListLoad::browse() { browseForFile(fileName_, this); }
