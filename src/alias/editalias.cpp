#include "alias/editalias.h"

#include "alias/aliasfield.h"
#include "alias/editaliasentry.h"
#include "widgets/textfield.h"

namespace {

KeptText shown(const alias_list_entry &target) { return target.alias; }

} // namespace

EditAlias::EditAlias(QWidget *parent, const char *name, const alias_entry *alias)
    : FormDialog(parent, name, "Email Address Aliasing"),
      address_{addField(translatable("&Address:"), {70, 18},
                        alias != nullptr ? alias->address : KeptText{})},
      group_{new ListGroup("Aliases", {.box = 250, .column = 70}, this)},
      targetRows_{this, group_->box(), &targets_.head, shown, &EditAlias::Read} {
    address_->setRule(aliasAddressRule());
    group_->addEditButtons(this, &EditAlias::Add, &EditAlias::Modify, &EditAlias::Remove,
                           &EditAlias::Selected);
    group_->column()->addStretch(100);
    rows()->addWidget(group_);
    if (alias != nullptr) {
        targets_ = alias->aliases.copied();
        targetRows_.fill();
    }
    addButtons(5, 15);
    fixSize({350, 210}, {348, 180});
}

KeptText EditAlias::address(KeptText before) const { return address_->keptText(before); }

RecordChain<alias_list_entry> EditAlias::takeTargets() { return std::move(targets_); }

void EditAlias::Add() { targetRows_.add(); }

void EditAlias::Remove() { targetRows_.removeCurrent(); }

void EditAlias::Selected(const char *text) { targetRows_.change(text); }

void EditAlias::Modify() { targetRows_.changeCurrent(); }

void EditAlias::Read(alias_list_entry *target, EditAliasEntry *dialog) {
    if (target != nullptr && dialog != nullptr) {
        dialog->store(*target);
    }
}
