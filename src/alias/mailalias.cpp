#include "alias/mailalias.h"

#include "alias/editalias.h"
#include "widgets/pagelayout.h"

namespace {

KeptText shown(const alias_entry &alias) { return alias.address; }

} // namespace

MailAlias::MailAlias(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      group_{new ListGroup("Mail Aliasing", {.box = 600, .column = 100}, this)},
      aliases_{this, group_->box(), &alias_list.head, shown, &MailAlias::MailAliasRead} {
    aliases_.fill();
    group_->addEditButtons(this, &MailAlias::MailAliasAdd, &MailAlias::MailAliasModify,
                           &MailAlias::MailAliasRemove, &MailAlias::MailAliasSelected);
    group_->column()->addStretch(100);
    newPageLayout(this)->addWidget(group_);
}

void MailAlias::MailAliasAdd() { aliases_.add(); }

void MailAlias::MailAliasRemove() { aliases_.removeCurrent(); }

void MailAlias::MailAliasSelected(const char *address) { aliases_.change(address); }

void MailAlias::MailAliasModify() { aliases_.changeCurrent(); }

void MailAlias::MailAliasRead(alias_entry *alias, EditAlias *dialog) {
    if (alias != nullptr && dialog != nullptr) {
        alias->address = dialog->address(alias->address);
        alias->aliases = dialog->takeTargets();
    }
}
