#include "alias/editalias.h"

#include "alias/aliasfield.h"
#include "alias/editaliasentry.h"
#include "widgets/fieldtext.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

#include <QVBoxLayout>

namespace {

std::string_view shown(const alias_list_entry &target) { return target.alias; }

alias_list_entry copyOf(const alias_list_entry &target) {
    return {target.alias, target.type, target.bang};
}

} // namespace

EditAlias::EditAlias(QWidget *parent, const char *name, const alias_entry *alias)
    : FormDialog(parent, name, "Email Address Aliasing") {
    address_ = addField(translatable("&Address:"), {70, 18},
                        alias != nullptr ? alias->address : KeptText{});
    applyRule(address_, aliasAddressRule());

    auto *group = new ListGroup("Aliases", {250, 70}, this);
    box_ = group->box();
    group->addEditButtons(this, &EditAlias::Add, &EditAlias::Modify, &EditAlias::Remove,
                          &EditAlias::Selected);
    group->column()->addStretch(100);
    rows()->addWidget(group);
    if (alias != nullptr) {
        targets_ = alias->aliases.copied(copyOf);
        appendRows(box_, targets_, shown);
    }
    addButtons(5, 15);
    fixSize({350, 210}, {348, 180});
}

KeptText EditAlias::address(KeptText before) const { return fieldText(address_, before); }

RecordChain<alias_list_entry> EditAlias::takeTargets() { return std::move(targets_); }

void EditAlias::Add() {
    addByDialog<EditAliasEntry>(this, box_, &targets_.head, &EditAlias::Read, shown);
}

void EditAlias::Remove() { removeCurrent(box_, &targets_.head, shown); }

void EditAlias::Selected(const char *text) {
    changeByDialog<EditAliasEntry>(this, box_, &targets_.head, text, &EditAlias::Read, shown);
}

void EditAlias::Modify() { Selected(currentText(box_)); }

void EditAlias::Read(alias_list_entry *target, EditAliasEntry *dialog) {
    if (target != nullptr && dialog != nullptr) {
        dialog->store(*target);
    }
}
