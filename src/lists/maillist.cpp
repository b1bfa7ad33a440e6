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
    EditList editor{this, "Edit", nullptr};
    if (editor.exec() == QDialog::Accepted) {
        maillist_entry record;
        MailListRead(&record, &editor);
        addShown(lists_, &maillist_list.head, std::move(record), shown);
    }
}

void MailList::MailListRemove() { removeCurrent(lists_, &maillist_list.head, shown); }

void MailList::MailListSelected(const char *name) {
    maillist_entry *record = recordShown(maillist_list.head, name, shown);
    if (record == nullptr) {
        return;
    }
    EditList editor{this, "edit", record};
    if (editor.exec() == QDialog::Accepted) {
        MailListRead(record, &editor);
        changeCurrentRow(lists_, record->name);
    }
}

void MailList::MailListModify() { MailListSelected(currentText(lists_)); }

void MailList::MailListRead(maillist_entry *record, EditList *editor) {
    if (record != nullptr && editor != nullptr) {
        editor->store(*record);
    }
}
