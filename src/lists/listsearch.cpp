#include "lists/listsearch.h"

#include "lists/listdialog.h"
#include "widgets/fieldtext.h"

ListSearch::ListSearch(QWidget *parent, const char *name)
    : FormDialog(parent, name, "Mail List Search"),
      text_{addField(translatable("&Search for:"), listDialogLabel, {})} {
    addButtons(listDialogBorder, 20);
    fixSize(listDialogSize, listDialogSize);
}

std::string ListSearch::text() const { return fieldBytes(text_); }
