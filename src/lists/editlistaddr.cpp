#include "lists/editlistaddr.h"

#include "lists/maillistfile.h"
#include "lists/smalldialogsizes.h"
#include "widgets/textfield.h"

EditListAddr::EditListAddr(QWidget *parent, const char *name, const maillist_addr_entry *entry)
    : FormDialog(parent, name, "Mail List Address"),
      email_{addField(translatable("&Email:"), listDialogLabel,
                      entry != nullptr ? entry->addr : KeptText{})} {
    email_->setRule(lengthRule(longestTyped));
    addButtons(listDialogBorder, 20);
    fixSize(listDialogSize, listDialogSize);
}

KeptText EditListAddr::email(KeptText before) const { return email_->keptText(before); }
