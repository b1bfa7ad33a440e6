#include "alias/editaliasentry.h"

#include "alias/aliasfield.h"
#include "alias/aliasfile.h"
#include "widgets/textfield.h"

#include <QComboBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>

#include <algorithm>
#include <array>
#include <optional>

namespace {

struct TypeEntry {
    const char *caption;
    std::optional<std::uint8_t> type; ///< None: the file has no mark for it.
};

constexpr std::array<TypeEntry, 5> typeEntries{{{"Address", ALIAS_ADDRESS},
                                                {"Mailing List Posting", ALIAS_LIST_POSTING},
                                                {"Mailing List Admin", ALIAS_LIST_ADMIN},
                                                {"Auto Responder", std::nullopt},
                                                {"External Task", std::nullopt}}};

/// "Address" stands for every type that has no entry of its own.
int entryShownFor(std::uint8_t type) {
    const auto *found = std::ranges::find(typeEntries, type, &TypeEntry::type);
    return found == typeEntries.end() ? 0 : static_cast<int>(found - typeEntries.begin());
}

} // namespace

EditAliasEntry::EditAliasEntry(QWidget *parent, const char *name, const alias_list_entry *target)
    : FormDialog(parent, name, "Address Alias") {
    QHBoxLayout *aliasRow = addRow();
    CaptionColumn aliasCaption{{40, 18}};
    alias_ = addField(aliasRow, translatable("&Alias:"), aliasCaption,
                      target != nullptr ? target->alias : KeptText{});
    alias_->setRule(oneWordRule());
    connect(addBrowseButton(aliasRow, 70, translatable("&Alias:"), alias_), &QPushButton::clicked,
            this, &EditAliasEntry::browse);

    // Behind the field, so that Tab and the first focus go there first.
    type_ = new QComboBox(this);
    type_->setObjectName("Alias Type");
    for (const TypeEntry &entry : typeEntries) {
        type_->addItem(QString::fromUtf8(entry.caption));
    }
    type_->setCurrentIndex(target != nullptr ? entryShownFor(target->type) : 0);
    QHBoxLayout *typeRow = addRow();
    CaptionColumn typeCaption{{70, fieldHeight}};
    typeRow->addWidget(typeCaption.newCaption(QStringLiteral("Alias Type:"), type_));
    addAsField(typeRow, type_);
    typeRow->addStretch();

    addButtons(5, 10);
    fixSize({350, 100}, {348, 80});
}

void EditAliasEntry::store(alias_list_entry &target) const {
    target.alias = alias_->keptText(target.alias);
    const auto &entry = typeEntries.at(static_cast<std::size_t>(type_->currentIndex()));
    target.type = entry.type.value_or(target.type);
}

void EditAliasEntry::browse() { browseForDirectory(alias_, this); }
