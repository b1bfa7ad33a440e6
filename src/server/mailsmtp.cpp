#include "server/mailsmtp.h"

#include "server/editsmtp.h"
#include "server/serverform.h"
#include "server/smtprejectfile.h"

namespace {

KeptText shown(const smtpreject_entry &entry) { return entry.domain; }

} // namespace

MailSMTP::MailSMTP(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      form_{serverForm(this, "SMTP Server Settings",
                       {.enabled = settings().smtp_sock_enabled,
                        .port = settings().smtp_sock_port,
                        .timeout = settings().smtp_sock_timeout,
                        .maximum = settings().smtp_sock_max,
                        .allow = settings().smtp_allow,
                        .auth = &settings().smtp_auth,
                        .block = settings().smtp_block})},
      group_{new ListGroup("SMTP Domain Blocking", {.box = 6, .column = 1}, this)},
      rejects_{this, group_->box(), &smtpreject_list.head, shown, &MailSMTP::Read} {
    rejects_.fill();
    group_->addEditButtons(this, &MailSMTP::Add, &MailSMTP::Modify, &MailSMTP::Remove,
                           &MailSMTP::Selected);
    group_->column()->addStretch();
    form_.pageLayout()->addWidget(group_);
    form_.pageLayout()->addStretch(1);
}

void MailSMTP::Add() { rejects_.add(); }

void MailSMTP::Remove() { rejects_.removeCurrent(); }

void MailSMTP::Selected(const char *text) { rejects_.change(text); }

void MailSMTP::Modify() { rejects_.changeCurrent(); }

void MailSMTP::Read(smtpreject_entry *entry, EditSMTP *dialog) {
    if (entry != nullptr && dialog != nullptr) {
        entry->domain = dialog->address(entry->domain);
    }
}
