#include "lists/editlistaddr.h"

#include "lists/listdialog.h"
#include "lists/maillistfile.h"
#include "widgets/fieldrule.h"
#include "widgets/fieldtext.h"

EditListAddr::EditListAddr(QWidget *parent, const char *name, const maillist_addr_entry *entry)
    : FormDialog(parent, name, "Mail List Address"),
      email_{addField(translatable("&Email:"), listDialogLabel,
                      entry != nullptr ? entry->addr : KeptText{})} {
    applyRule(email_, lengthRule(longestTyped));
    addButtons(listDialogBorder, 20);
    fixSize(listDialogSize, listDialogSize);
}

KeptText EditListAddr::email(KeptText before) const { return fieldText(email_, before); }
