#include "lists/editlistmember.h"

#include "lists/listdialog.h"
#include "lists/maillistfile.h"
#include "widgets/fieldtext.h"
#include "widgets/leastsize.h"

#include <QCheckBox>
#include <QVBoxLayout>

namespace {

constexpr QSize dialogSize{350, 100};
constexpr int checkBoxHeight = 20;
constexpr int spaceAroundDigest = 10;

} // namespace

EditListMember::EditListMember(QWidget *parent, const char *name, const maillist_addr_entry *entry)
    : FormDialog(parent, name, "Mail List Address"),
      email_{addField(translatable("&Email:"), listDialogLabel,
                      entry != nullptr ? addressShown(*entry) : KeptText{})},
      digest_{new QCheckBox(QStringLiteral("Digest List"))} {
    digest_->setFixedHeight(leastSize(digest_, {0, checkBoxHeight}).height());
    digest_->setChecked(entry != nullptr && isOnDigest(*entry));
    rows()->setSpacing(spaceAroundDigest);
    rows()->addWidget(digest_);
    addButtons(listDialogBorder, spaceAroundDigest);
    fixSize(dialogSize, dialogSize);
}

KeptText EditListMember::addr(const maillist_addr_entry &before) const {
    const KeptText address = fieldText(email_, addressShown(before));
    if (!digest_->isChecked()) {
        return address;
    }
    const std::string stored = ':' + std::string{address};
    return stored == std::string_view{before.addr} ? before.addr : keep(stored);
}
