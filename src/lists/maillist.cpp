#include "lists/maillist.h"

#include "lists/editlist.h"
#include "lists/maillistfile.h"
#include "widgets/listgroup.h"
#include "widgets/pagelayout.h"
#include "widgets/recordrows.h"

namespace {

std::string_view shown(const maillist_entry &list) { return list.name; }

} // namespace

MailList::MailList(QWidget *parent, const char *name) : KConfigWidget(parent, name) {
    auto *group = new ListGroup("Mail Listing", {600, 100}, this);
    lists_ = group->box();
    appendRows(lists_, maillist_list, shown);
    group->addEditButtons(this, &MailList::MailListAdd, &MailList::MailListModify,
                          &MailList::MailListRemove, &MailList::MailListSelected);
    group->column()->addStretch();
    newPageLayout(this)->addWidget(group);
}

void MailList::loadValues() {}

void MailList::storeValues() {}

void MailList::MailListAdd() {
    addByDialog<EditList>(this, lists_, &maillist_list.head, &MailList::MailListRead, shown);
}

void MailList::MailListRemove() { removeCurrent(lists_, &maillist_list.head, shown); }

void MailList::MailListSelected(const char *name) {
    changeByDialog<EditList>(this, lists_, &maillist_list.head, name, &MailList::MailListRead,
                             shown);
}

void MailList::MailListModify() { MailListSelected(currentText(lists_)); }

void MailList::MailListRead(maillist_entry *record, EditList *editor) {
    if (record != nullptr && editor != nullptr) {
        editor->store(*record);
    }
}
