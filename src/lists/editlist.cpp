#include "lists/editlist.h"

#include "platform/knumericspinbox.h"
#include "platform/screensize.h"
#include "widgets/textfield.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QScrollArea>

namespace {

constexpr int browseWidth = 60;
constexpr int unitHeight = 20;
constexpr int checkBoxHeight = 20;
constexpr QSize minimumWindow{600, 350};

struct TextRow {
    TranslatableText caption;
    KeptText maillist_fields::*field;
};

constexpr std::array<TextRow, 5> addressRows{
    {{translatable("&Mail list Name:"), &maillist_entry::name},
     {translatable("&Posting Address:"), &maillist_entry::post},
     {translatable("&Subscribe Address:"), &maillist_entry::admin},
     {translatable("&Support Address:"), &maillist_entry::support},
     {translatable("&Moderator Address:"), &maillist_entry::modrt}}};

struct FileRow {
    TextRow text;
    void (EditList::*browse)();
};

constexpr std::array<FileRow, 3> fileRows{
    {{{translatable("&Info file:"), &maillist_entry::info}, &EditList::browseInfo},
     {{translatable("&Header file:"), &maillist_entry::header}, &EditList::browseHeader},
     {{translatable("&Footer file:"), &maillist_entry::footer}, &EditList::browseFooter}}};

struct Option {
    const char *caption;
    std::uint32_t bit;
};

constexpr std::array<Option, 5> options{
    {{"Allow posting from any address (open list)", MAILLIST_OPEN},
     {"Allow posting by members", MAILLIST_MEMBERS_POST},
     {"Add reply-to header", MAILLIST_REPLY_TO},
     {"Block posts containing MIME attachments", MAILLIST_BLOCK_MIME},
     {"Allow digest subscriptions", MAILLIST_DIGEST}}};

struct Trigger {
    const char *caption;
    const char *unit;
    int unitWidth;
    std::int32_t maillist_fields::*field;
};

constexpr int maximumTrigger = 1024;
constexpr std::array<Trigger, 2> triggers{{{.caption = "Digest size trigger:",
                                            .unit = " kB",
                                            .unitWidth = 30,
                                            .field = &maillist_entry::diglen},
                                           {.caption = "Digest count trigger:",
                                            .unit = " messages",
                                            .unitWidth = 100,
                                            .field = &maillist_entry::digno}}};

constexpr std::array<AddressGroup::Kind, 3> addressKinds{{{.caption = "List Members",
                                                           .chain = &maillist_entry::member,
                                                           .shown = addressShown,
                                                           .add = &EditList::MemberAdd,
                                                           .modify = &EditList::MemberModify,
                                                           .remove = &EditList::MemberRemove,
                                                           .selected = &EditList::MemberSelected,
                                                           .search = &EditList::MemberSearch,
                                                           .load = &EditList::MemberLoad},
                                                          {.caption = "Allowed Posters",
                                                           .chain = &maillist_entry::allow,
                                                           .shown = addressStored,
                                                           .add = &EditList::AllowAdd,
                                                           .modify = &EditList::AllowModify,
                                                           .remove = &EditList::AllowRemove,
                                                           .selected = &EditList::AllowSelected,
                                                           .search = &EditList::AllowSearch,
                                                           .load = &EditList::AllowLoad},
                                                          {.caption = "Blocked Posters",
                                                           .chain = &maillist_entry::block,
                                                           .shown = addressStored,
                                                           .add = &EditList::BlockAdd,
                                                           .modify = &EditList::BlockModify,
                                                           .remove = &EditList::BlockRemove,
                                                           .selected = &EditList::BlockSelected,
                                                           .search = &EditList::BlockSearch,
                                                           .load = &EditList::BlockLoad}}};

maillist_entry newList() {
    maillist_entry list;
    for (const Option &option : options) {
        list.flags |= option.bit;
    }
    return list;
}

} // namespace

EditList::EditList(QWidget *parent, const char *name, const maillist_entry *list)
    : FormDialog(parent, name, "Mailing List") {
    const maillist_entry standard = newList();
    const maillist_entry &shown = list != nullptr ? *list : standard;
    auto *left = new QVBoxLayout;
    left->setSpacing(groupSpacing);
    left->addWidget(newTexts(shown));
    left->addWidget(newOptions(shown));
    left->addStretch();
    auto *right = new QVBoxLayout;
    right->setSpacing(groupSpacing);
    for (std::size_t index = 0; index < addressKinds.size(); ++index) {
        groups_.at(index) = new AddressGroup(addressKinds.at(index), this, shown);
        right->addWidget(groups_.at(index));
    }

    auto *columns = new QWidget(this);
    auto *sides = new QHBoxLayout(columns);
    sides->setContentsMargins(0, 0, 0, 0);
    sides->setSpacing(groupSpacing);
    sides->addLayout(left, 150);
    sides->addLayout(right, 300);
    rows()->addWidget(columns);
    addButtons(pageBorder, pageBorder, pageBorder);
    const QSize available = availableSize(this);
    // An area that scrolls asks for less.
    const QSize wanted = layout()->totalSizeHint();
    const int scrollBar = style()->pixelMetric(QStyle::PM_ScrollBarExtent);
    const QSize narrowest{layout()->totalMinimumSize().width() + scrollBar, 0};
    rows()->addWidget(scrolling(columns));
    setMinimumSize(minimumWindow.expandedTo(narrowest).boundedTo(available));
    resize(wanted.boundedTo(available));
}

QGroupBox *EditList::newTexts(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("List Addresses"), this);
    QVBoxLayout *rows = newGroupRows(group);
    CaptionColumn addressCaptions{{110, 0}};
    for (const auto &[caption, field] : addressRows) {
        addText(newRow(rows), caption, addressCaptions, field, list);
    }
    CaptionColumn fileCaptions{{65, 0}};
    for (std::size_t index = 0; index < fileRows.size(); ++index) {
        const auto &[text, browse] = fileRows.at(index);
        QHBoxLayout *row = newRow(rows);
        TextField *file = addText(row, text.caption, fileCaptions, text.field, list);
        connect(addBrowseButton(row, browseWidth, text.caption, file), &QPushButton::clicked, this,
                browse);
        files_.at(index) = file;
    }
    return group;
}

TextField *EditList::addText(QHBoxLayout *row, TranslatableText caption, CaptionColumn &captions,
                             KeptText maillist_fields::*field, const maillist_entry &list) {
    TextField *edit = addField(row, caption, captions, list.*field);
    edit->setRule(lengthRule(maximumBytesOf(field)));
    stores_.emplace_back(
        [edit, field](maillist_fields &fields) { fields.*field = edit->keptText(fields.*field); });
    return edit;
}

QGroupBox *EditList::newOptions(const maillist_entry &list) {
    auto *group = new QGroupBox(QStringLiteral("Posting Options"), this);
    QVBoxLayout *rows = newGroupRows(group);
    for (const auto &[caption, bit] : options) {
        auto *box = new QCheckBox(QString::fromUtf8(caption), group);
        box->setChecked((list.flags & bit) != 0);
        fixHeight(box, checkBoxHeight);
        rows->addWidget(box);
        stores_.emplace_back([box, bit = bit](maillist_fields &fields) {
            fields.flags = box->isChecked() ? fields.flags | bit : fields.flags & ~bit;
        });
    }
    CaptionColumn captions{{120, unitHeight}};
    for (const auto &[caption, unit, unitWidth, field] : triggers) {
        KNumericSpinBox *box = newNumberField(this, 0, maximumTrigger, list.*field);
        QHBoxLayout *row = newRow(rows);
        row->addWidget(captions.newCaption(QString::fromUtf8(caption), box));
        addAsField(row, box);
        row->addWidget(
            CaptionColumn{{unitWidth, unitHeight}}.newCaption(QString::fromUtf8(unit), box));
        row->addStretch();
        stores_.emplace_back(
            [box, field = field](maillist_fields &fields) { fields.*field = box->getValue(); });
    }
    return group;
}

void EditList::store(maillist_entry &list) {
    maillist_fields &record = list;
    maillist_fields fields = record;
    for (const auto &storeWidget : stores_) {
        storeWidget(fields);
    }
    record = fields;
    for (std::size_t index = 0; index < addressKinds.size(); ++index) {
        list.*addressKinds.at(index).chain = groups_.at(index)->takeChain();
    }
}
