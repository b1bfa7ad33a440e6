#include "lists/editlistmember.h"

#include "lists/listdialog.h"
#include "lists/maillistfile.h"
#include "widgets/fieldtext.h"

#include <QCheckBox>
#include <QVBoxLayout>

namespace {

/// As high as field, check box, buttons and the spacings between them need.
constexpr QSize dialogSize{350, 110};
constexpr int checkBoxHeight = 20;
/// With the spacing of the rows it makes 10 pixels.
constexpr int spaceAboveDigest = 5;

} // namespace

EditListMember::EditListMember(QWidget *parent, const char *name, const maillist_addr_entry *entry)
    : FormDialog(parent, name, "Mail List Address"),
      email_{addField("&Email:", listDialogLabel,
                      entry != nullptr ? addressShown(*entry) : std::string_view{})},
      digest_{new QCheckBox(QStringLiteral("Digest List"))} {
    digest_->setFixedHeight(checkBoxHeight);
    digest_->setChecked(entry != nullptr && isOnDigest(*entry));
    rows()->addSpacing(spaceAboveDigest);
    rows()->addWidget(digest_);
    fixSize(dialogSize, dialogSize);
    addButtonRow();
}

std::string EditListMember::addr() const {
    std::string addr{digest_->isChecked() ? ":" : ""};
    addr += fieldBytes(email_);
    return addr;
}
