#include "server/mailsmtp.h"

#include "server/editsmtp.h"
#include "server/serverform.h"
#include "server/smtprejectfile.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

#include <QVBoxLayout>

namespace {

std::string_view shown(const smtpreject_entry &entry) { return entry.domain; }

} // namespace

MailSMTP::MailSMTP(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      form_{serverForm(this, "SMTP Server Settings",
                       {settings().smtp_sock_enabled, settings().smtp_sock_port,
                        settings().smtp_sock_timeout, settings().smtp_sock_max,
                        settings().smtp_allow, &settings().smtp_auth, settings().smtp_block})} {
    auto *group = new ListGroup("SMTP Domain Blocking", {6, 1}, this);
    rejects_ = group->box();
    appendRows(rejects_, smtpreject_list, shown);
    group->addEditButtons(this, &MailSMTP::Add, &MailSMTP::Modify, &MailSMTP::Remove,
                          &MailSMTP::Selected);
    group->column()->addStretch();
    form_.pageLayout()->addWidget(group);
    form_.pageLayout()->addStretch(1);
}

void MailSMTP::loadValues() {}

void MailSMTP::storeValues() { form_.store(); }

void MailSMTP::Add() {
    addByDialog<EditSMTP>(this, rejects_, &smtpreject_list.head, &MailSMTP::Read, shown);
}

void MailSMTP::Remove() { removeCurrent(rejects_, &smtpreject_list.head, shown); }

void MailSMTP::Selected(const char *text) {
    changeByDialog<EditSMTP>(this, rejects_, &smtpreject_list.head, text, &MailSMTP::Read, shown);
}

void MailSMTP::Modify() { Selected(currentText(rejects_)); }

void MailSMTP::Read(smtpreject_entry *entry, EditSMTP *dialog) {
    if (entry != nullptr && dialog != nullptr) {
        entry->domain = dialog->address(entry->domain);
    }
}
