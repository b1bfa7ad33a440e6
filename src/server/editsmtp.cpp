#include "server/editsmtp.h"

#include "server/smtprejectfile.h"
#include "widgets/textfield.h"

EditSMTP::EditSMTP(QWidget *parent, const char *name, const smtpreject_entry *entry)
    : FormDialog(parent, name, "Email Address Aliasing"),
      address_{addField(translatable("&Address:"), {60, 18},
                        entry != nullptr ? entry->domain : KeptText{})} {
    addButtons(0, 15);
    fixSize({300, 70}, {298, 45});
}

KeptText EditSMTP::address(KeptText before) const { return address_->keptText(before); }
