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

#include <new>

// What the buttons of the editor do; its window is made in editlist.cpp.

namespace {

/// The row after the current one, from the top again behind the last, that holds the needle. The
/// current row itself is not looked at.
std::optional<int> nextRowHolding(const QListBox *box, const std::string &needle) {
    const int count = box->count();
    const std::optional<int> current = box->currentRow();
    const int tested = current ? count - 1 : count;
    for (int step = 0; step < tested; ++step) {
        const int row = (current.value_or(-1) + 1 + step) % count;
        if (box->text(row).find(needle) != std::string::npos) {
            return row;
        }
    }
    return std::nullopt;
}

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
    entry->addr = dialog->addr();
}

} // namespace

void EditList::MemberAdd() { AddMember(members_.box, &members_.chain.head); }

void EditList::MemberRemove() { Remove(members_.box, &members_.chain.head); }

void EditList::MemberSelected(const char *text) {
    SelectedMember(members_.box, &members_.chain.head, text);
}

void EditList::MemberModify() { MemberSelected(currentText(members_.box)); }

void EditList::MemberSearch() { Search(members_.box, &members_.chain.head); }

void EditList::MemberLoad() { Load(members_.box, &members_.chain.head); }

void EditList::AllowAdd() { Add(allowed_.box, &allowed_.chain.head); }

void EditList::AllowRemove() { Remove(allowed_.box, &allowed_.chain.head); }

void EditList::AllowSelected(const char *text) {
    Selected(allowed_.box, &allowed_.chain.head, text);
}

void EditList::AllowModify() { AllowSelected(currentText(allowed_.box)); }

void EditList::AllowSearch() { Search(allowed_.box, &allowed_.chain.head); }

void EditList::AllowLoad() { Load(allowed_.box, &allowed_.chain.head); }

void EditList::BlockAdd() { Add(blocked_.box, &blocked_.chain.head); }

void EditList::BlockRemove() { Remove(blocked_.box, &blocked_.chain.head); }

void EditList::BlockSelected(const char *text) {
    Selected(blocked_.box, &blocked_.chain.head, text);
}

void EditList::BlockModify() { BlockSelected(currentText(blocked_.box)); }

void EditList::BlockSearch() { Search(blocked_.box, &blocked_.chain.head); }

void EditList::BlockLoad() { Load(blocked_.box, &blocked_.chain.head); }

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
    std::vector<std::string> rows;
    AddressChain loaded;
    try {
        const std::optional<std::string> bytes = readWholeFile(dialog.fileName());
        if (!bytes) {
            showUnreadable(this);
            return;
        }
        rows = parseAddressLines(*bytes);
        for (const std::string &address : rows) {
            prependRecord(&loaded.head, {address});
        }
    } catch (const std::bad_alloc &) { // Then nothing is loaded, rather than a part.
        return;
    }
    box->setUpdatesEnabled(false);
    prependChain(chain, std::move(loaded));
    box->append(std::move(rows));
    if (box->count() > 0) {
        box->showRow(box->count() - 1);
    }
    box->setUpdatesEnabled(true);
}

void EditList::Read(maillist_addr_entry *entry, EditListAddr *dialog) {
    if (entry != nullptr && dialog != nullptr) {
        entry->addr = dialog->email();
    }
}

void EditList::browseInfo() { browseForFile(fieldOf(&maillist_entry::info), this); }

void EditList::browseHeader() { browseForFile(fieldOf(&maillist_entry::header), this); }

void EditList::browseFooter() { browseForFile(fieldOf(&maillist_entry::footer), this); }
