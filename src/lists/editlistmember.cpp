#include "lists/editlistmember.h"

#include "lists/maillistfile.h"
#include "lists/smalldialogsizes.h"
#include "widgets/minimumsize.h"
#include "widgets/textfield.h"

#include <QCheckBox>

#include <algorithm>

namespace {

constexpr QSize dialogSize{350, 100};
constexpr int checkBoxHeight = 20;
constexpr int spaceAroundDigest = 10;

} // namespace

EditListMember::EditListMember(QWidget *parent, const char *name, const maillist_addr_entry *entry)
    : FormDialog(parent, name, "Mail List Address"),
      email_{addField(translatable("&Email:"), listDialogLabel,
                      entry != nullptr ? addressShown(*entry) : KeptText{})},
      digest_{new QCheckBox(QStringLiteral("Digest List"))},
      maximumBytes_{std::max(longestTyped, entry != nullptr ? entry->addr.size() : 0)} {
    email_->setRule(lengthRule(longestTyped));
    digest_->setFixedHeight(minimumSizeFor(digest_, {0, checkBoxHeight}).height());
    digest_->setChecked(entry != nullptr && isOnDigest(*entry));
    rows()->setSpacing(spaceAroundDigest);
    rows()->addWidget(digest_);
    addButtons(listDialogBorder, spaceAroundDigest);
    fixSize(dialogSize, dialogSize);
}

void EditListMember::accept() {
    // The digest's mark takes a byte of the line as well.
    const std::size_t digestMark = digest_->isChecked() ? 1 : 0;
    if (!email_->showsPartOnly() && email_->bytes().size() + digestMark > maximumBytes_) {
        email_->showTip(lengthRule(maximumBytes_ - digestMark).toolTip);
        return;
    }
    FormDialog::accept();
}

KeptText EditListMember::addr(const maillist_addr_entry &before) const {
    const KeptText address = email_->keptText(addressShown(before));
    if (!digest_->isChecked()) {
        return address;
    }
    const std::string stored = ':' + std::string{address};
    return stored == std::string_view{before.addr} ? before.addr : keep(stored);
}
