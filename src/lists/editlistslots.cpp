#include "lists/editlist.h"

#include "base/textfile.h"
#include "lists/editlistaddr.h"
#include "lists/editlistmember.h"
#include "lists/listload.h"
#include "lists/listsearch.h"
#include "platform/helpkey.h"
#include "widgets/recordrows.h"

#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>

#include <algorithm>
#include <new>

// What the buttons of the editor do to any of its lists; its window is made in editlist.cpp.

namespace {

void showUnreadable(QWidget *editor) {
    QMessageBox message{
        QMessageBox::Information, QStringLiteral("Mailling List Manager"),
        QStringLiteral("Could not open file for reading - perhaps permission denied?.\n\n"),
        QMessageBox::Ok, editor};
    message.button(QMessageBox::Ok)->setText(QStringLiteral("OK"));
    message.setWindowModality(Qt::WindowModal); // The help stays usable.
    addHelpKey(&message);
    message.exec();
}

void readMember(EditList * /*editor*/, maillist_addr_entry *entry, EditListMember *dialog) {
    entry->addr = dialog->addr(*entry);
}

} // namespace

void EditList::Add(QListBox *box, maillist_addr_entry **chain) {
    addByDialog<EditListAddr>(this, box, chain, &EditList::Read, addressStored);
}

void EditList::AddMember(QListBox *box, maillist_addr_entry **chain) {
    addByDialog<EditListMember>(this, box, chain, readMember, addressShown);
}

void EditList::Remove(QListBox *box, maillist_addr_entry **chain) {
    removeCurrent(box, chain, addressShown);
}

void EditList::Selected(QListBox *box, maillist_addr_entry **chain, const char *text) {
    changeByDialog<EditListAddr>(this, box, chain, text, &EditList::Read, addressStored);
}

void EditList::SelectedMember(QListBox *box, maillist_addr_entry **chain, const char *text) {
    changeByDialog<EditListMember>(this, box, chain, text, readMember, addressShown);
}

void EditList::Search(QListBox *box, maillist_addr_entry ** /*chain*/) {
    ListSearch dialog{this, "search"};
    if (dialog.exec() != QDialog::Accepted) {
        return;
    }
    if (const std::optional<int> row = nextRowHolding(box, dialog.text())) {
        box->setCurrentRow(*row);
        box->setTopRow(*row);
    }
}

void EditList::Load(QListBox *box, maillist_addr_entry **chain) {
    ListLoad dialog{this, "load"};
    if (dialog.exec() != QDialog::Accepted) {
        return;
    }
    try {
        FileRead file = readWholeFile(dialog.fileName());
        if (!file.bytes) {
            showUnreadable(this);
            return;
        }
        AddressChain loaded = parseAddressLines(keep(*std::move(file.bytes)));
        std::vector<std::string_view> rows;
        for (const maillist_addr_entry &address : loaded) {
            rows.push_back(address.addr);
        }
        std::ranges::reverse(rows); // The file's first address is the chain's last.
        box->reserve(rows);
        prependChain(chain, std::move(loaded));
        box->append(rows);
        if (!rows.empty()) {
            box->showRow(box->count() - 1);
        }
    } catch (const std::bad_alloc &) { // Then nothing is loaded, rather than a part.
    }
}

void EditList::Read(maillist_addr_entry *entry, EditListAddr *dialog) {
    if (entry != nullptr && dialog != nullptr) {
        entry->addr = dialog->email(entry->addr);
    }
}
