#include "alias/mailalias.h"

#include "alias/aliasfile.h"
#include "alias/editalias.h"
#include "widgets/listgroup.h"
#include "widgets/pagelayout.h"
#include "widgets/recordrows.h"

namespace {

std::string_view shown(const alias_entry &alias) { return alias.address; }

} // namespace

MailAlias::MailAlias(QWidget *parent, const char *name) : KConfigWidget(parent, name) {
    auto *group = new ListGroup("Mail Aliasing", {600, 100}, this);
    aliases_ = group->box();
    appendRows(aliases_, alias_list, shown);
    group->addEditButtons(this, &MailAlias::MailAliasAdd, &MailAlias::MailAliasModify,
                          &MailAlias::MailAliasRemove, &MailAlias::MailAliasSelected);
    group->column()->addStretch(100);
    newPageLayout(this)->addWidget(group);
}

void MailAlias::loadValues() {}

void MailAlias::storeValues() {}

void MailAlias::MailAliasAdd() {
    addByDialog<EditAlias>(this, aliases_, &alias_list.head, &MailAlias::MailAliasRead, shown);
}

void MailAlias::MailAliasRemove() { removeCurrent(aliases_, &alias_list.head, shown); }

void MailAlias::MailAliasSelected(const char *address) {
    changeByDialog<EditAlias>(this, aliases_, &alias_list.head, address, &MailAlias::MailAliasRead,
                              shown);
}

void MailAlias::MailAliasModify() { MailAliasSelected(currentText(aliases_)); }

void MailAlias::MailAliasRead(alias_entry *alias, EditAlias *dialog) {
    if (alias != nullptr && dialog != nullptr) {
        alias->address = dialog->address(alias->address);
        alias->aliases = dialog->takeTargets();
    }
}
