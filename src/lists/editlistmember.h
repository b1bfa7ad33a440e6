#pragma once

#include "base/kepttext.h"
#include "widgets/formdialog.h"

class QCheckBox;
struct maillist_addr_entry;

/// Asks for one list member and whether the member is on the digest.
class EditListMember : public FormDialog {
    Q_OBJECT

public:
    /// `entry` is what the dialog starts with; null for an empty field and no digest.
    EditListMember(QWidget *parent, const char *name, const maillist_addr_entry *entry);

    /// As a record takes it that holds `before`: behind ":" for a member on the digest.
    [[nodiscard]] KeptText addr(const maillist_addr_entry &before) const;

protected:
    void accept() override;

private:
    TextField *email_;
    QCheckBox *digest_;
    std::size_t maximumBytes_; ///< Of the record's text.
};
