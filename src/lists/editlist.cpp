#include "lists/editlist.h"

#include "platform/knumericspinbox.h"
#include "platform/lowscreen.h"
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
#include <QScrollArea>

#include <algorithm>
#include <array>

namespace {

constexpr int highestTrigger = 1024;
constexpr int buttonWidth = 60;
constexpr int labelHeight = 20;
constexpr int checkBoxHeight = 20;
/// What rows keep around their text's height, in pixels, in a window that is too low for all.
constexpr int aroundFieldText = 4;
constexpr int aroundNumber = 6;
constexpr int aroundCheckBoxText = 1;
constexpr int leastBoxHeight = 40;
constexpr QSize leastWindow{600, 350};
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

/// A row of its own below those that are there already.
QHBoxLayout *newRow(QVBoxLayout *rows) {
    if (rows->count() > 0) {
        addSpace(rows, groupSpacing, Shrinking::Yes);
    }
    auto *row = new QHBoxLayout;
    row->setSpacing(groupSpacing);
    rows->addLayout(row);
    return row;
}

maillist_addr_entry copyOf(const maillist_addr_entry &entry) { return {entry.addr}; }

} // namespace

const std::array<EditList::TextRow, 5> EditList::addressRows{
    {{translatable("&Mail list Name:"), &maillist_entry::name, nullptr},
     {translatable("&Posting Address:"), &maillist_entry::post, nullptr},
     {translatable("&Subscribe Address:"), &maillist_entry::admin, nullptr},
     {translatable("&Support Address:"), &maillist_entry::support, nullptr},
     {translatable("&Moderator Address:"), &maillist_entry::modrt, nullptr}}};

const std::array<EditList::TextRow, 3> EditList::fileRows{
    {{translatable("&Info file:"), &maillist_entry::info, &EditList::browseInfo},
     {translatable("&Header file:"), &maillist_entry::header, &EditList::browseHeader},
     {translatable("&Footer file:"), &maillist_entry::footer, &EditList::browseFooter}}};

EditList::EditList(QWidget *parent, const char *name, const maillist_entry *list)
    : FormDialog(parent, name, "Mailing List", aroundFieldText) {
    maillist_entry newList;
    newList.flags = newListFlags;
    const maillist_entry &shown = list != nullptr ? *list : newList;

    auto *columns = new QWidget(this);
    auto *sides = new QHBoxLayout(columns);
    auto *left = new QVBoxLayout;
    auto *right = new QVBoxLayout;
    sides->setContentsMargins(0, 0, 0, 0);
    sides->setSpacing(groupSpacing);
    sides->addLayout(left, 150);
    sides->addLayout(right, 300);
    left->setSpacing(0);
    right->setSpacing(0);
    left->addWidget(newTextFields(shown));
    addSpace(left, groupSpacing, Shrinking::Yes);
    left->addWidget(newOptions(shown));
    left->addStretch();
    right->addWidget(newAddressGroup("List Members", members_, shown,
                                     {&EditList::MemberAdd, &EditList::MemberModify,
                                      &EditList::MemberRemove, &EditList::MemberSearch,
                                      &EditList::MemberLoad, &EditList::MemberSelected}));
    addSpace(right, groupSpacing, Shrinking::Yes);
    right->addWidget(
        newAddressGroup("Allowed Posters", allowed_, shown,
                        {&EditList::AllowAdd, &EditList::AllowModify, &EditList::AllowRemove,
                         &EditList::AllowSearch, &EditList::AllowLoad, &EditList::AllowSelected}));
    addSpace(right, groupSpacing, Shrinking::Yes);
    right->addWidget(
        newAddressGroup("Blocked Posters", blocked_, shown,
                        {&EditList::BlockAdd, &EditList::BlockModify, &EditList::BlockRemove,
                         &EditList::BlockSearch, &EditList::BlockLoad, &EditList::BlockSelected}));
    members_.box->setMinimumWidth(120);
    appendRows(members_.box, members_.chain, addressShown);
    appendRows(allowed_.box, allowed_.chain, addressStored);
    appendRows(blocked_.box, blocked_.chain, addressStored);

    rows()->addWidget(columns);
    addButtons(pageBorder, pageBorder, Shrinking::Yes);
    const QSize room = roomFor(this);
    if (!fitsInto(room, layout()->totalMinimumSize())) {
        rows()->addWidget(scrolling(columns));
    }
    setMinimumSize(leastWindow.expandedTo(layout()->totalMinimumSize()).boundedTo(room));
    resize(layout()->totalSizeHint().boundedTo(room));
}

QGroupBox *EditList::newTextFields(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("List Addresses"), this);
    QVBoxLayout *rows = newGroupRows(group, Shrinking::Yes);
    addTextFields(rows, 110, addressRows, list);
    addTextFields(rows, 65, fileRows, list);
    return group;
}

template <std::size_t count>
void EditList::addTextFields(QVBoxLayout *rows, int labelWidth,
                             const std::array<TextRow, count> &fields, const maillist_entry &list) {
    CaptionColumn captions{{labelWidth, 0}};
    for (const auto &[caption, field, browse] : fields) {
        QHBoxLayout *row = newRow(rows);
        texts_.push_back({addField(row, caption, captions, list.*field), field});
        if (browse != nullptr) {
            connect(addBrowseButton(row, buttonWidth, caption), &QPushButton::clicked, this,
                    browse);
        }
    }
}

QLineEdit *EditList::fieldOf(std::string maillist_entry::*field) const {
    return std::ranges::find(texts_, field, &TextField::field)->edit;
}

QGroupBox *EditList::newOptions(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("Posting Options"), this);
    QVBoxLayout *rows = newGroupRows(group, Shrinking::Yes);
    for (const auto &[caption, bit] : options) {
        auto *box = new QCheckBox(QString::fromUtf8(caption), group);
        box->setChecked((list.flags & bit) != 0);
        addOfHeight(newRow(rows), box, checkBoxHeight, aroundCheckBoxText);
        options_.push_back({box, bit});
    }
    CaptionColumn captions{{120, labelHeight}};
    addTrigger(newRow(rows), "Digest size trigger:", captions, {" kB", 30}, &maillist_entry::diglen,
               list);
    addTrigger(newRow(rows), "Digest count trigger:", captions, {" messages", 100},
               &maillist_entry::digno, list);
    return group;
}

void EditList::addTrigger(QHBoxLayout *row, const char *caption, CaptionColumn &captions,
                          const Unit &unit, std::int32_t maillist_entry::*field,
                          const maillist_entry &list) {
    KNumericSpinBox *box = newNumberField(this, 0, highestTrigger, list.*field);
    // With an alignment the labels' fixed height does not hold the row's down.
    row->addWidget(captions.newCaption(QString::fromUtf8(caption), box), 0, Qt::AlignVCenter);
    addOfHeight(row, box, fieldHeight, aroundNumber);
    QLabel *unitLabel = newLabel(QString::fromUtf8(unit.caption), {unit.width, labelHeight}, this);
    unitLabel->setBuddy(box);
    row->addWidget(unitLabel, 0, Qt::AlignVCenter);
    row->addStretch();
    triggers_.push_back({box, field});
}

ListGroup *EditList::newAddressGroup(const char *caption, Addresses &addresses,
                                     const maillist_entry &list, const AddressSlots &slotsOf) {
    auto *group = new ListGroup(caption, {1000, 0}, this, Shrinking::Yes);
    group->box()->setMinimumHeight(leastBoxHeight);
    // The box takes what height there is; only the buttons beside it ask for some.
    group->box()->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Ignored);
    group->addEditButtons(this, slotsOf.add, slotsOf.modify, slotsOf.remove, slotsOf.selected);
    connect(group->addButton("Search..."), &QPushButton::clicked, this, slotsOf.search);
    connect(group->addButton("Load File"), &QPushButton::clicked, this, slotsOf.load);
    group->fixColumnWidth(buttonWidth);
    group->column()->addStretch();
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
