#include "lists/editlist.h"

#include "base/textfile.h"
#include "lists/editlistaddr.h"
#include "lists/editlistmember.h"
#include "lists/listload.h"
#include "lists/listsearch.h"
#include "platform/knumericspinbox.h"
#include "widgets/fieldtext.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>

#include <array>
#include <new>

namespace {

constexpr int highestTrigger = 1024;
constexpr int buttonWidth = 60;
constexpr int checkBoxHeight = 20;
constexpr int labelHeight = 20;
constexpr std::uint32_t newListFlags = MAILLIST_OPEN | MAILLIST_MEMBERS_POST | MAILLIST_REPLY_TO |
                                       MAILLIST_DIGEST | MAILLIST_BLOCK_MIME;

struct Option {
    const char *caption;
    std::uint32_t bit;
};

/// In the order of the window, which is not that of the bits.
constexpr std::array<Option, 5> options{
    {{"Allow posting from any address (open list)", MAILLIST_OPEN},
     {"Allow posting by members", MAILLIST_MEMBERS_POST},
     {"Add reply-to header", MAILLIST_REPLY_TO},
     {"Block posts containing MIME attachments", MAILLIST_BLOCK_MIME},
     {"Allow digest subscriptions", MAILLIST_DIGEST}}};

struct AddressField {
    const char *caption;
    std::string maillist_entry::*field;
};

constexpr std::array<AddressField, 5> addressFields{
    {{"&Mail list Name:", &maillist_entry::name},
     {"&Posting Address:", &maillist_entry::post},
     {"&Subscribe Address:", &maillist_entry::admin},
     {"&Support Address:", &maillist_entry::support},
     {"&Moderator Address:", &maillist_entry::modrt}}};

QVBoxLayout *newEditorGroupLayout(QGroupBox *group) {
    auto *layout = new QVBoxLayout(group);
    layout->setContentsMargins(4, 2, 4, 2);
    layout->setSpacing(2);
    return layout;
}

std::string_view wholeAddress(const maillist_addr_entry &entry) {
    return entry.addr;
}

maillist_addr_entry copyOf(const maillist_addr_entry &entry) {
    return {entry.addr};
}

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

} // namespace

EditList::EditList(QWidget *parent, const char *name, const maillist_entry *list)
    : FormDialog(parent, name, "Mailing List") {
    maillist_entry newList;
    newList.flags = newListFlags;
    const maillist_entry &shown = list != nullptr ? *list : newList;

    auto *left = new QVBoxLayout;
    auto *right = new QVBoxLayout;
    QHBoxLayout *columns = addRow();
    columns->addLayout(left, 150);
    columns->addLayout(right, 300);
    left->addWidget(newAddressFields(shown));
    left->addWidget(newOptions(shown));
    left->addStretch();
    right->addWidget(newAddressGroup("List Members", members_, shown));
    right->addWidget(newAddressGroup("Allowed Posters", allowed_, shown));
    right->addWidget(newAddressGroup("Blocked Posters", blocked_, shown));
    members_.box->setMinimumWidth(120);
    connectButtons();
    addButtonRow();
    setMinimumSize(600, 350);
}

QGroupBox *EditList::newAddressFields(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("List Addresses"), this);
    auto *rows = newEditorGroupLayout(group);
    for (const auto &[caption, field] : addressFields) {
        addTextField(rows, caption, {110, fieldHeight}, field, list);
    }
    info_ = addFileField(rows, "&Info file:", &maillist_entry::info, list, &EditList::browseInfo);
    header_ =
        addFileField(rows, "&Header file:", &maillist_entry::header, list, &EditList::browseHeader);
    footer_ =
        addFileField(rows, "&Footer file:", &maillist_entry::footer, list, &EditList::browseFooter);
    return group;
}

QHBoxLayout *EditList::addTextField(QBoxLayout *rows, const char *caption, QSize label,
                                    std::string maillist_entry::*field,
                                    const maillist_entry &list) {
    auto *row = new QHBoxLayout;
    rows->addLayout(row);
    QLineEdit *edit = addField(row, caption, label, list.*field);
    texts_.push_back({edit, field});
    return row;
}

QLineEdit *EditList::addFileField(QBoxLayout *rows, const char *caption,
                                  std::string maillist_entry::*field, const maillist_entry &list,
                                  void (EditList::*browse)()) {
    QHBoxLayout *row = addTextField(rows, caption, {65, fieldHeight}, field, list);
    connect(addBrowseButton(row, buttonWidth, this), &QPushButton::clicked, this, browse);
    return texts_.back().edit;
}

QGroupBox *EditList::newOptions(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("Posting Options"), this);
    auto *rows = newEditorGroupLayout(group);
    for (const auto &[caption, bit] : options) {
        auto *box = new QCheckBox(QString::fromUtf8(caption), group);
        box->setFixedHeight(checkBoxHeight);
        box->setChecked((list.flags & bit) != 0);
        rows->addWidget(box);
        options_.push_back({box, bit});
    }
    addTrigger(rows, "Digest size trigger:", {" kB", 30}, &maillist_entry::diglen, list);
    addTrigger(rows, "Digest count trigger:", {" messages", 100}, &maillist_entry::digno, list);
    return group;
}

void EditList::addTrigger(QBoxLayout *rows, const char *caption, const Unit &unit,
                          std::int32_t maillist_entry::*field, const maillist_entry &list) {
    auto *box = new KNumericSpinBox(this);
    box->setRange(0, highestTrigger);
    box->setStep(1);
    box->setEditable(true);
    box->setValue(list.*field);
    box->setFixedSize(60, fieldHeight);
    QLabel *captionLabel = newLabel(QString::fromUtf8(caption), {120, labelHeight}, this);
    QLabel *unitLabel = newLabel(QString::fromUtf8(unit.caption), {unit.width, labelHeight}, this);
    captionLabel->setBuddy(box);
    unitLabel->setBuddy(box);
    auto *row = new QHBoxLayout;
    row->addWidget(captionLabel);
    row->addWidget(box);
    row->addWidget(unitLabel);
    row->addStretch();
    rows->addLayout(row);
    triggers_.push_back({box, field});
}

ListGroup *EditList::newAddressGroup(const char *caption, Addresses &addresses,
                                     const maillist_entry &list) {
    auto *group = new ListGroup(caption, {1000, 0}, this);
    addresses.group = group;
    addresses.box = group->box();
    addresses.chain = (list.*addresses.field).copied(copyOf);
    return group;
}

void EditList::connectButtons() {
    members_.group->addEditButtons(this, &EditList::MemberAdd, &EditList::MemberModify,
                                   &EditList::MemberRemove, &EditList::MemberSelected);
    allowed_.group->addEditButtons(this, &EditList::AllowAdd, &EditList::AllowModify,
                                   &EditList::AllowRemove, &EditList::AllowSelected);
    blocked_.group->addEditButtons(this, &EditList::BlockAdd, &EditList::BlockModify,
                                   &EditList::BlockRemove, &EditList::BlockSelected);
    addSearchAndLoad(members_, &EditList::MemberSearch, &EditList::MemberLoad);
    addSearchAndLoad(allowed_, &EditList::AllowSearch, &EditList::AllowLoad);
    addSearchAndLoad(blocked_, &EditList::BlockSearch, &EditList::BlockLoad);
    appendRows(members_.box, members_.chain, addressShown);
    appendRows(allowed_.box, allowed_.chain, wholeAddress);
    appendRows(blocked_.box, blocked_.chain, wholeAddress);
}

void EditList::addSearchAndLoad(const Addresses &addresses, void (EditList::*search)(),
                                void (EditList::*load)()) {
    ListGroup *group = addresses.group;
    connect(group->addButton("Search..."), &QPushButton::clicked, this, search);
    connect(group->addButton("Load File"), &QPushButton::clicked, this, load);
    group->fixColumnWidth(buttonWidth);
    group->column()->addStretch();
}

void EditList::store(maillist_entry &list) {
    for (const auto &[edit, field] : texts_) {
        list.*field = fieldBytes(edit);
    }
    for (const auto &[box, field] : triggers_) {
        list.*field = box->getValue();
    }
    for (const auto &[box, bit] : options_) {
        list.flags = box->isChecked() ? list.flags | bit : list.flags & ~bit;
    }
    for (Addresses *addresses : {&members_, &allowed_, &blocked_}) {
        list.*addresses->field = std::move(addresses->chain);
    }
}

void EditList::MemberAdd() {
    AddMember(members_.box, &members_.chain.head);
}

void EditList::MemberRemove() {
    Remove(members_.box, &members_.chain.head);
}

void EditList::MemberSelected(const char *text) {
    SelectedMember(members_.box, &members_.chain.head, text);
}

void EditList::MemberModify() {
    MemberSelected(currentText(members_.box));
}

void EditList::MemberSearch() {
    Search(members_.box, &members_.chain.head);
}

void EditList::MemberLoad() {
    Load(members_.box, &members_.chain.head);
}

void EditList::AllowAdd() {
    Add(allowed_.box, &allowed_.chain.head);
}

void EditList::AllowRemove() {
    Remove(allowed_.box, &allowed_.chain.head);
}

void EditList::AllowSelected(const char *text) {
    Selected(allowed_.box, &allowed_.chain.head, text);
}

void EditList::AllowModify() {
    AllowSelected(currentText(allowed_.box));
}

void EditList::AllowSearch() {
    Search(allowed_.box, &allowed_.chain.head);
}

void EditList::AllowLoad() {
    Load(allowed_.box, &allowed_.chain.head);
}

void EditList::BlockAdd() {
    Add(blocked_.box, &blocked_.chain.head);
}

void EditList::BlockRemove() {
    Remove(blocked_.box, &blocked_.chain.head);
}

void EditList::BlockSelected(const char *text) {
    Selected(blocked_.box, &blocked_.chain.head, text);
}

void EditList::BlockModify() {
    BlockSelected(currentText(blocked_.box));
}

void EditList::BlockSearch() {
    Search(blocked_.box, &blocked_.chain.head);
}

void EditList::BlockLoad() {
    Load(blocked_.box, &blocked_.chain.head);
}

void EditList::Add(QListBox *box, maillist_addr_entry **chain) {
    EditListAddr dialog{this, "Edit", nullptr};
    if (dialog.exec() == QDialog::Accepted) {
        maillist_addr_entry entry;
        Read(&entry, &dialog);
        addShown(box, chain, std::move(entry), wholeAddress);
    }
}

void EditList::AddMember(QListBox *box, maillist_addr_entry **chain) {
    EditListMember dialog{this, "Edit", nullptr};
    if (dialog.exec() == QDialog::Accepted) {
        box->append(dialog.email());
        prependRecord(chain, {dialog.addr()});
    }
}

void EditList::Remove(QListBox *box, maillist_addr_entry **chain) {
    removeCurrent(box, chain, addressShown);
}

void EditList::Selected(QListBox *box, maillist_addr_entry **chain, const char *text) {
    maillist_addr_entry **link = linkToShown(chain, text, wholeAddress);
    if (link == nullptr) {
        return;
    }
    EditListAddr dialog{this, "edit", *link};
    if (dialog.exec() == QDialog::Accepted) {
        Read(*link, &dialog);
        changeCurrentRow(box, (*link)->addr);
    }
}

void EditList::SelectedMember(QListBox *box, maillist_addr_entry **chain, const char *text) {
    maillist_addr_entry **link = linkToShown(chain, text, addressShown);
    if (link == nullptr) {
        return;
    }
    EditListMember dialog{this, "edit", *link};
    if (dialog.exec() == QDialog::Accepted) {
        (*link)->addr = dialog.addr();
        changeCurrentRow(box, dialog.email());
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
    std::vector<std::string> rows;
    AddressChain loaded;
    try {
        const std::optional<std::string> bytes = readWholeFile(dialog.fileName());
        if (!bytes) {
            QMessageBox::information(
                this, QStringLiteral("Mailling List Manager"),
                QStringLiteral(
                    "Could not open file for reading - perhaps permission denied?.\n\n"));
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
    box->setUpdatesEnabled(true);
}

void EditList::Read(maillist_addr_entry *entry, EditListAddr *dialog) {
    if (entry != nullptr && dialog != nullptr) {
        entry->addr = dialog->email();
    }
}

void EditList::browseInfo() {
    browseForFile(info_, this);
}

void EditList::browseHeader() {
    browseForFile(header_, this);
}

void EditList::browseFooter() {
    browseForFile(footer_, this);
}
