#include "lists/maillist.h"

#include "lists/editlist.h"
#include "widgets/pagelayout.h"

namespace {

KeptText shown(const maillist_entry &list) { return list.name; }

} // namespace

MailList::MailList(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      group_{new ListGroup("Mail Listing", {.box = 600, .column = 100}, this)},
      lists_{this, group_->box(), &maillist_list.head, shown, &MailList::MailListRead} {
    lists_.fill();
    group_->addEditButtons(this, &MailList::MailListAdd, &MailList::MailListModify,
                           &MailList::MailListRemove, &MailList::MailListSelected);
    group_->column()->addStretch();
    newPageLayout(this)->addWidget(group_);
}

void MailList::MailListAdd() { lists_.add(); }

void MailList::MailListRemove() { lists_.removeCurrent(); }

void MailList::MailListSelected(const char *name) { lists_.change(name); }

void MailList::MailListModify() { lists_.changeCurrent(); }

void MailList::MailListRead(maillist_entry *record, EditList *editor) {
    if (record != nullptr && editor != nullptr) {
        editor->store(*record);
    }
}
