#include "lists/editlist.h"

#include "base/textfile.h"
#include "lists/editlistaddr.h"
#include "lists/editlistmember.h"
#include "lists/listload.h"
#include "lists/listsearch.h"
#include "platform/kcontroldialog.h"

#include <QMessageBox>
#include <QPushButton>

#include <algorithm>

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

} // namespace

void EditList::Add(QListBox *box, maillist_addr_entry **chain) {
    RecordRows{this, box, chain, addressStored, &EditList::Read}.add();
}

void EditList::AddMember(QListBox *box, maillist_addr_entry **chain) {
    RecordRows{this, box, chain, addressShown, &EditList::ReadMember}.add();
}

void EditList::Remove(QListBox *box, maillist_addr_entry **chain) {
    RecordRows{this, box, chain, addressShown, &EditList::Read}.removeCurrent();
}

void EditList::Selected(QListBox *box, maillist_addr_entry **chain, const char *text) {
    RecordRows{this, box, chain, addressStored, &EditList::Read}.change(text);
}

void EditList::SelectedMember(QListBox *box, maillist_addr_entry **chain, const char *text) {
    RecordRows{this, box, chain, addressShown, &EditList::ReadMember}.change(text);
}

void EditList::chooseCurrent(Kind kind, void (EditList::*selected)(const char *)) {
    if (const std::optional<int> row = box(kind)->currentRow()) {
        (this->*selected)(std::string{box(kind)->text(*row)}.c_str());
    }
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
    FileRead file = readWholeFile(dialog.fileName());
    if (!file.bytes) {
        showUnreadable(this);
        return;
    }
    AddressChain loaded = parseAddressLines(keep(*std::move(file.bytes)));
    std::vector<KeptText> rows;
    for (const maillist_addr_entry &address : loaded) {
        rows.push_back(address.addr);
    }
    std::ranges::reverse(rows); // The file's first address is the chain's last.
    box->append(rows);
    prependChain(chain, std::move(loaded));
    if (!rows.empty()) {
        box->showRow(box->count() - 1);
    }
}

void EditList::Read(maillist_addr_entry *entry, EditListAddr *dialog) {
    if (entry != nullptr && dialog != nullptr) {
        entry->addr = dialog->email(entry->addr);
    }
}

void EditList::ReadMember(maillist_addr_entry *entry, EditListMember *dialog) {
    entry->addr = dialog->addr(*entry);
}
