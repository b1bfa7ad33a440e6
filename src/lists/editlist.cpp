#include "lists/editlist.h"

#include "platform/knumericspinbox.h"
#include "widgets/fieldtext.h"
#include "widgets/listgroup.h"
#include "widgets/numberfield.h"
#include "widgets/pagelayout.h"
#include "widgets/recordrows.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include <algorithm>
#include <array>

namespace {

constexpr int highestTrigger = 1024;
constexpr int buttonWidth = 60;
constexpr int labelHeight = 20;
constexpr int checkBoxHeight = 20;
constexpr int buttonHeight = 22;
/// What the rows shrink to in a window that is lower than they need: the text stays whole.
constexpr int leastFieldHeight = 18;
constexpr int leastCheckBoxHeight = 15;
constexpr int leastButtonHeight = 16;
constexpr int leastBoxHeight = 40;
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

maillist_addr_entry copyOf(const maillist_addr_entry &entry) { return {entry.addr}; }

} // namespace

const std::array<EditList::TextRow, 5> EditList::addressRows{
    {{"&Mail list Name:", &maillist_entry::name, nullptr},
     {"&Posting Address:", &maillist_entry::post, nullptr},
     {"&Subscribe Address:", &maillist_entry::admin, nullptr},
     {"&Support Address:", &maillist_entry::support, nullptr},
     {"&Moderator Address:", &maillist_entry::modrt, nullptr}}};

const std::array<EditList::TextRow, 3> EditList::fileRows{
    {{"&Info file:", &maillist_entry::info, &EditList::browseInfo},
     {"&Header file:", &maillist_entry::header, &EditList::browseHeader},
     {"&Footer file:", &maillist_entry::footer, &EditList::browseFooter}}};

EditList::EditList(QWidget *parent, const char *name, const maillist_entry *list)
    : FormDialog(parent, name, "Mailing List") {
    maillist_entry newList;
    newList.flags = newListFlags;
    const maillist_entry &shown = list != nullptr ? *list : newList;

    auto *left = new QVBoxLayout;
    auto *right = new QVBoxLayout;
    QHBoxLayout *columns = addRow();
    left->setSpacing(0);
    right->setSpacing(0);
    columns->addLayout(left, 150);
    columns->addLayout(right, 300);
    left->addWidget(newTextFields(shown));
    left->addWidget(newOptions(shown));
    left->addStretch();
    right->addWidget(newAddressGroup("List Members", members_, shown,
                                     {&EditList::MemberAdd, &EditList::MemberModify,
                                      &EditList::MemberRemove, &EditList::MemberSearch,
                                      &EditList::MemberLoad, &EditList::MemberSelected}));
    right->addWidget(
        newAddressGroup("Allowed Posters", allowed_, shown,
                        {&EditList::AllowAdd, &EditList::AllowModify, &EditList::AllowRemove,
                         &EditList::AllowSearch, &EditList::AllowLoad, &EditList::AllowSelected}));
    right->addWidget(
        newAddressGroup("Blocked Posters", blocked_, shown,
                        {&EditList::BlockAdd, &EditList::BlockModify, &EditList::BlockRemove,
                         &EditList::BlockSearch, &EditList::BlockLoad, &EditList::BlockSelected}));
    members_.box->setMinimumWidth(120);
    appendRows(members_.box, members_.chain, addressShown);
    appendRows(allowed_.box, allowed_.chain, addressStored);
    appendRows(blocked_.box, blocked_.chain, addressStored);
    addButtonRow();
    setRowHeights(&RowHeight::full, tightBorder);
    rowsNeed_ = layout()->minimumSize().height();
    setMinimumSize(600, 350);
    resize(sizeHint().width(), rowsNeed_);
}

void EditList::resizeEvent(QResizeEvent *event) {
    FormDialog::resizeEvent(event);
    if (height() < rowsNeed_) {
        setRowHeights(&RowHeight::least, 0);
    } else {
        setRowHeights(&RowHeight::full, tightBorder);
    }
}

void EditList::setRowHeights(int RowHeight::*which, int spacing) {
    for (QLayout *rows : rowLayouts_) {
        rows->setSpacing(spacing);
    }
    for (const RowHeight &row : rowHeights_) {
        row.widget->setFixedHeight(row.*which);
    }
}

QVBoxLayout *EditList::newRows(QGroupBox *group) {
    auto *rows = new QVBoxLayout(group);
    rows->setContentsMargins(tightBorder, tightBorder, tightBorder, tightBorder);
    rowLayouts_.push_back(rows);
    return rows;
}

QGroupBox *EditList::newTextFields(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("List Addresses"), this);
    QVBoxLayout *rows = newRows(group);
    addTextFields(rows, 110, addressRows, list);
    addTextFields(rows, 65, fileRows, list);
    return group;
}

template <std::size_t count>
void EditList::addTextFields(QVBoxLayout *rows, int labelWidth,
                             const std::array<TextRow, count> &fields, const maillist_entry &list) {
    QSize label{labelWidth, leastFieldHeight};
    for (const TextRow &text : fields) {
        label = widened(label, {translated(text.caption)});
    }
    for (const auto &[caption, field, browse] : fields) {
        auto *row = new QHBoxLayout;
        rows->addLayout(row);
        QLineEdit *edit = addField(row, caption, label, list.*field);
        texts_.push_back({edit, field});
        rowHeights_.push_back({edit, fieldHeight, leastFieldHeight});
        if (browse != nullptr) {
            QPushButton *button = addBrowseButton(row, buttonWidth, this);
            connect(button, &QPushButton::clicked, this, browse);
            rowHeights_.push_back({button, fieldHeight, leastFieldHeight});
        }
    }
}

QLineEdit *EditList::fieldOf(std::string maillist_entry::*field) const {
    return std::ranges::find(texts_, field, &TextField::field)->edit;
}

QGroupBox *EditList::newOptions(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("Posting Options"), this);
    QVBoxLayout *rows = newRows(group);
    for (const auto &[caption, bit] : options) {
        auto *box = new QCheckBox(QString::fromUtf8(caption), group);
        box->setChecked((list.flags & bit) != 0);
        rows->addWidget(box);
        options_.push_back({box, bit});
        rowHeights_.push_back({box, checkBoxHeight, leastCheckBoxHeight});
    }
    const QString sizeTrigger = QStringLiteral("Digest size trigger:");
    const QString countTrigger = QStringLiteral("Digest count trigger:");
    const QSize label = widened({120, labelHeight}, {sizeTrigger, countTrigger});
    addTrigger(rows, newLabel(sizeTrigger, label, this), {" kB", 30}, &maillist_entry::diglen,
               list);
    addTrigger(rows, newLabel(countTrigger, label, this), {" messages", 100},
               &maillist_entry::digno, list);
    return group;
}

void EditList::addTrigger(QBoxLayout *rows, QLabel *caption, const Unit &unit,
                          std::int32_t maillist_entry::*field, const maillist_entry &list) {
    KNumericSpinBox *box = newNumberField(this, 0, highestTrigger, list.*field);
    QLabel *unitLabel = newLabel(QString::fromUtf8(unit.caption), {unit.width, labelHeight}, this);
    caption->setBuddy(box);
    unitLabel->setBuddy(box);
    auto *row = new QHBoxLayout;
    row->addWidget(caption);
    row->addWidget(box);
    row->addWidget(unitLabel);
    row->addStretch();
    rows->addLayout(row);
    triggers_.push_back({box, field});
    rowHeights_.push_back({box, fieldHeight, leastFieldHeight});
}

ListGroup *EditList::newAddressGroup(const char *caption, Addresses &addresses,
                                     const maillist_entry &list, const AddressSlots &slotsOf) {
    auto *group = new ListGroup(caption, {1000, 0}, this);
    group->makeTight();
    group->box()->setMinimumHeight(leastBoxHeight);
    group->addEditButtons(this, slotsOf.add, slotsOf.modify, slotsOf.remove, slotsOf.selected);
    connect(group->addButton("Search..."), &QPushButton::clicked, this, slotsOf.search);
    connect(group->addButton("Load File"), &QPushButton::clicked, this, slotsOf.load);
    group->fixColumnWidth(buttonWidth);
    group->column()->addStretch();
    for (QPushButton *button : group->findChildren<QPushButton *>()) {
        rowHeights_.push_back({button, buttonHeight, leastButtonHeight});
    }
    addresses.box = group->box();
    addresses.chain = (list.*addresses.field).copied(copyOf);
    return group;
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
