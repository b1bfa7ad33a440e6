#include "server/editsmtp.h"

#include "server/smtprejectfile.h"
#include "widgets/fieldtext.h"

EditSMTP::EditSMTP(QWidget *parent, const char *name, const smtpreject_entry *entry)
    : FormDialog(parent, name, "Email Address Aliasing"),
      address_{addField(translatable("&Address:"), {60, 18},
                        entry != nullptr ? std::string_view{entry->domain} : "")} {
    addButtons(0, 15);
    fixSize({300, 70}, {298, 45});
}

std::string EditSMTP::address() const { return fieldBytes(address_); }
